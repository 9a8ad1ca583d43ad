find_program(OVPHOTO_GENCAT gencat REQUIRED)

# gencat adds to a catalogue that exists, and under some locales drops texts that are not ASCII. An open catalogue
# is mapped, not copied: it is replaced whole, by renaming.
function(ovphoto_compile_messages language folder)
  set(source ${CMAKE_CURRENT_SOURCE_DIR}/${language}.msg)
  set(compiled ${folder}/libOVphotoRes.dll)
  add_custom_command(
    OUTPUT ${compiled}
    COMMAND ${CMAKE_COMMAND} -E make_directory ${folder}
    COMMAND ${CMAKE_COMMAND} -E rm -f ${compiled}.new
    COMMAND ${CMAKE_COMMAND} -E env LC_ALL=C ${OVPHOTO_GENCAT} ${compiled}.new ${source}
    COMMAND ${CMAKE_COMMAND} -E rename ${compiled}.new ${compiled}
    DEPENDS ${source}
    COMMENT "Compiling messages/${language}.msg"
    VERBATIM)
  add_custom_target(ovphoto_messages_${language} DEPENDS ${compiled})
  add_dependencies(ovphoto_messages ovphoto_messages_${language})
endfunction()
