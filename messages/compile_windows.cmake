# A library without code that holds the texts as string resources.
function(ovphoto_compile_messages language folder)
  set(source ${CMAKE_CURRENT_SOURCE_DIR}/${language}.msg)
  set(script ${CMAKE_CURRENT_SOURCE_DIR}/stringTable.sed)
  set(strings ${CMAKE_CURRENT_BINARY_DIR}/${language}.rc)
  add_custom_command(
    OUTPUT ${strings}
    COMMAND sed -n -f ${script} ${source} > ${strings}
    DEPENDS ${source} ${script}
    COMMENT "Making string resources of messages/${language}.msg"
    VERBATIM)
  set(target ovphoto_messages_${language})
  add_library(${target} MODULE ${strings})
  target_link_options(${target} PRIVATE -nostdlib -s -Wl,--entry=0)
  set_target_properties(${target} PROPERTIES
    LINKER_LANGUAGE CXX OUTPUT_NAME libOVphotoRes PREFIX "" LIBRARY_OUTPUT_DIRECTORY ${folder})
  add_dependencies(ovphoto_messages ${target})
endfunction()
