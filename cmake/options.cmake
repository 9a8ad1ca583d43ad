# What every target of ours is built with, on one interface target.

option(OVPHOTO_TESTS "Build the tests" ON)
option(OVPHOTO_BENCH "Build the benchmarks" OFF)
option(OVPHOTO_FUZZ "Build the fuzz targets for libFuzzer, which needs Clang and the sanitizer fuzzer-no-link" OFF)
set(pictures ON)
if(WIN32)
  set(pictures OFF)  # Debian has no Cairo for MinGW
endif()
option(OVPHOTO_PICTURES "Build the tool with pictures and reports, which needs Cairo" ${pictures})
option(OVPHOTO_UNITY "Compile sources together: faster from scratch, slower after a small change" OFF)
set(OVPHOTO_SANITIZE "" CACHE STRING "Sanitizers, such as address,undefined")
option(OVPHOTO_COVERAGE "Count what the tests run" OFF)

if(NOT CMAKE_BUILD_TYPE)
  set(CMAKE_BUILD_TYPE Release CACHE STRING "" FORCE)
endif()

set(CMAKE_RUNTIME_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/bin)
set(CMAKE_LIBRARY_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/bin)
set(CMAKE_ARCHIVE_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/lib)
set(CMAKE_BUILD_RPATH_USE_ORIGIN ON)
set(CMAKE_POSITION_INDEPENDENT_CODE ON)
set(CMAKE_CXX_VISIBILITY_PRESET hidden)
set(CMAKE_VISIBILITY_INLINES_HIDDEN ON)

# Sources for one operating system end in this: <name>_posix.cpp, <name>_windows.cpp.
set(OVPHOTO_PLATFORM posix)
if(WIN32)
  set(OVPHOTO_PLATFORM windows)
endif()

find_program(CCACHE_PROGRAM ccache)
if(CCACHE_PROGRAM)
  set(CMAKE_CXX_COMPILER_LAUNCHER ${CCACHE_PROGRAM})
endif()

add_library(ovphoto_flags INTERFACE)
target_compile_features(ovphoto_flags INTERFACE cxx_std_20)
target_include_directories(ovphoto_flags INTERFACE ${PROJECT_SOURCE_DIR} ${PROJECT_SOURCE_DIR}/include)
if(WIN32)
  target_compile_definitions(ovphoto_flags INTERFACE UNICODE WIN32_LEAN_AND_MEAN)
endif()
# Results must not depend on the compiler: no contraction of products and sums, and never fast-math.
target_compile_options(ovphoto_flags INTERFACE -ffp-contract=off -Wall -Wextra -Wshadow -Wconversion -Werror)
if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU" AND CMAKE_CXX_COMPILER_VERSION VERSION_LESS 13)
  # GCC 12 takes the sum of a literal and a string for overlapping memory (its bug 105651).
  target_compile_options(ovphoto_flags INTERFACE -Wno-restrict)
endif()
if(OVPHOTO_SANITIZE)
  target_compile_options(ovphoto_flags INTERFACE -fsanitize=${OVPHOTO_SANITIZE} -fno-sanitize-recover=all
                                                 -fno-omit-frame-pointer)
  if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
    # Instrumented code makes GCC doubt what std::regex initialises.
    target_compile_options(ovphoto_flags INTERFACE -Wno-maybe-uninitialized)
  endif()
  target_link_options(ovphoto_flags INTERFACE -fsanitize=${OVPHOTO_SANITIZE})
endif()
if(OVPHOTO_COVERAGE)
  target_compile_options(ovphoto_flags INTERFACE --coverage)
  target_link_options(ovphoto_flags INTERFACE --coverage)
endif()
if(OVPHOTO_SANITIZE OR CMAKE_BUILD_TYPE STREQUAL "Debug")
  # The standard containers check their indices; so they do in the tests of every build.
  target_compile_definitions(ovphoto_flags INTERFACE _GLIBCXX_ASSERTIONS)
endif()
