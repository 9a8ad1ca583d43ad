ovphoto_add_test(tool/numbers_test)
target_link_libraries(tool_numbers_test PRIVATE ovphoto_numbers)

# These run the built tool as a process, in a shell: one for another system is run by those of this one.
if(NOT CMAKE_CROSSCOMPILING)
  add_custom_target(ovphoto_tool_tests)
  add_library(ovphoto_faults MODULE tool/faults.cpp)
  set_target_properties(ovphoto_faults PROPERTIES CXX_VISIBILITY_PRESET default)
  target_link_libraries(ovphoto_faults PRIVATE ovphoto_flags ${CMAKE_DL_LIBS})
  foreach(name usage_test reading_test writing_test conversion_test check_test sun_test)
    ovphoto_add_test(tool/${name})
    add_dependencies(tool_${name} ovphoto ovphoto_faults)
    add_dependencies(ovphoto_tool_tests tool_${name})
  endforeach()
  # Two tools are compared where there are two: script/test --windows runs this.
  ovphoto_add_test_program(tool/windows_test)
  add_dependencies(tool_windows_test ovphoto)
  add_dependencies(ovphoto_tool_tests tool_windows_test)
endif()
