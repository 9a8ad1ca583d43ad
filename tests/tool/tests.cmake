ovphoto_add_test(tool/numbers_test ${PROJECT_SOURCE_DIR}/tools/ovphoto/numbers.cpp)

# These run the built tool as a process.
foreach(name usage_test reading_test writing_test conversion_test check_test sun_test
             windows_test)
  ovphoto_add_test(tool/${name})
  add_dependencies(tool_${name} ovphoto)
endforeach()
