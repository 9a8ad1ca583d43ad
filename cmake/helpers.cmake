# ovphoto_add_format(<folder> <source>...): the sources of a file format, in its folder below components/photo.
function(ovphoto_add_format folder)
  target_sources(ovphoto_core PRIVATE ${ARGN})
  set_property(GLOBAL APPEND PROPERTY OVPHOTO_FORMATS ${folder})
endfunction()

# ovphoto_add_module(<name> <source>...): a loadable module around the core, with the entry that every module has. One
# of its sources, or a library that it links, says which builders it has (components/module/registration.h).
function(ovphoto_add_module name)
  set(entry ${PROJECT_SOURCE_DIR}/components/module/moduleEntry)
  add_library(${name} MODULE ${entry}.cpp ${entry}_${OVPHOTO_PLATFORM}.cpp ${ARGN})
  target_link_libraries(${name} PRIVATE ovphoto_core)
endfunction()

# ovphoto_add_test_program(<source without .cpp> [<more sources>]): a program of tests over the core, below tests/.
function(ovphoto_add_test_program source)
  string(REPLACE "/" "_" name ${source})
  add_executable(${name} ${source}.cpp ${ARGN})
  target_link_libraries(${name} PRIVATE ovphoto_builders ovphoto_test_support GTest::gmock GTest::gtest_main)
  target_compile_definitions(${name} PRIVATE _GLIBCXX_ASSERTIONS)
  # Tests run once: what they test is optimised, they are soon compiled.
  target_compile_options(${name} PRIVATE $<$<NOT:$<CONFIG:Debug>>:-O1>)
endfunction()

# ovphoto_add_test(<source without .cpp> [<more sources>]): one whose tests ctest runs.
function(ovphoto_add_test source)
  ovphoto_add_test_program(${source} ${ARGN})
  string(REPLACE "/" "_" name ${source})
  gtest_discover_tests(${name} TEST_PREFIX ${name}. DISCOVERY_TIMEOUT 60 PROPERTIES TIMEOUT 300)
endfunction()

# ovphoto_find_headers(<package> <target> <folder>): a package that is nothing but headers in <folder>. Programs for
# another system take those of the build machine, and nothing else that lies beside them.
function(ovphoto_find_headers package target folder)
  if(NOT CMAKE_CROSSCOMPILING)
    find_package(${package} REQUIRED)
    return()
  endif()
  find_path(${package}_PARENT ${folder} NO_CMAKE_FIND_ROOT_PATH REQUIRED)
  file(MAKE_DIRECTORY ${CMAKE_BINARY_DIR}/headers)
  file(CREATE_LINK ${${package}_PARENT}/${folder} ${CMAKE_BINARY_DIR}/headers/${folder} SYMBOLIC)
  add_library(${target} INTERFACE IMPORTED)
  target_include_directories(${target} INTERFACE ${CMAKE_BINARY_DIR}/headers)
endfunction()

# ovphoto_read_asset(<file> <variable>): its text, and in <variable>_HASH its SHA-256 in base 64, as the content policy
# of a page wants it.
function(ovphoto_read_asset file variable)
  set(digits ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/)
  file(READ ${file} text)
  string(SHA256 hash "${text}")
  set(base64)
  foreach(at RANGE 0 60 6)
    string(SUBSTRING ${hash}00 ${at} 6 bytes)  # the last byte is filled up
    foreach(shift 18 12 6 0)
      math(EXPR digit "(0x${bytes} >> ${shift}) & 63")
      string(SUBSTRING ${digits} ${digit} 1 digit)
      string(APPEND base64 ${digit})
    endforeach()
  endforeach()
  string(SUBSTRING ${base64} 0 43 base64)
  set(${variable} "${text}" PARENT_SCOPE)
  set(${variable}_HASH "${base64}=" PARENT_SCOPE)
endfunction()
