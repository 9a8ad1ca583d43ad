# ovphoto_add_test(<source without .cpp> [<more sources>]): one test program over the core, below tests/.
function(ovphoto_add_test source)
  string(REPLACE "/" "_" name ${source})
  add_executable(${name} ${source}.cpp ${ARGN})
  target_link_libraries(${name} PRIVATE ovphoto_core ovphoto_test_support GTest::gmock GTest::gtest_main)
  gtest_discover_tests(${name} TEST_PREFIX ${name}. DISCOVERY_TIMEOUT 60 PROPERTIES TIMEOUT 300)
endfunction()
