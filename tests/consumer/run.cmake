# Installs the build, builds programs against what was installed and runs them. The installed tree is moved first:
# nothing in it may know where it was made. TOOLCHAIN and EMULATOR are those of a cross build, else empty.
cmake_minimum_required(VERSION 3.20)
set(work ${BUILD}/consumer)
set(prefix ${work}/prefix)

# run(<expected output> <program> <argument>...): the program must succeed and print just that.
function(run expected)
  execute_process(COMMAND ${EMULATOR} ${ARGN} OUTPUT_VARIABLE output RESULT_VARIABLE status OUTPUT_STRIP_TRAILING_WHITESPACE)
  if(NOT status EQUAL 0 OR NOT output STREQUAL expected)
    list(JOIN ARGN " " command)
    message(FATAL_ERROR "${command}\n  status ${status}, printed: ${output}\n  instead of: ${expected}")
  endif()
endfunction()

function(must)
  execute_process(COMMAND ${ARGN} OUTPUT_QUIET COMMAND_ERROR_IS_FATAL ANY)
endfunction()

# pkgConfig(<variable> <argument>...): what pkg-config answers, as a list.
function(pkgConfig variable)
  execute_process(COMMAND ${PKG_CONFIG} ${ARGN} ovphoto
    OUTPUT_VARIABLE answer OUTPUT_STRIP_TRAILING_WHITESPACE COMMAND_ERROR_IS_FATAL ANY)
  separate_arguments(answer)
  set(${variable} ${answer} PARENT_SCOPE)
endfunction()

set(ENV{LC_ALL} C)
file(REMOVE_RECURSE ${work})
must(${CMAKE_COMMAND} --install ${BUILD} --prefix ${work}/first)
file(RENAME ${work}/first ${prefix})
set(file ${SOURCE}/examples/downlight.ies)

# By CMake.
if(TOOLCHAIN)
  set(compiler -DCMAKE_TOOLCHAIN_FILE=${TOOLCHAIN} -DCMAKE_FIND_ROOT_PATH=${prefix})
  set(ENV{WINEPATH} Z:${prefix}/bin)
else()
  set(compiler -DCMAKE_CXX_COMPILER=${COMPILER} -DCMAKE_CXX_FLAGS=${FLAGS})
endif()
must(${CMAKE_COMMAND} -G ${GENERATOR} -S ${SOURCE}/tests/consumer -B ${work}/cmake -DCMAKE_PREFIX_PATH=${prefix}
  ${compiler})
must(${CMAKE_COMMAND} --build ${work}/cmake)
run("2150.0 cd" ${work}/cmake/consumer${SUFFIX} ${file})

# By pkg-config.
set(ENV{PKG_CONFIG_PATH} ${prefix}/${LIBDIR}/pkgconfig)
pkgConfig(flags --cflags --libs)
pkgConfig(module --variable=module)
pkgConfig(libraries --variable=libdir)
if(NOT TOOLCHAIN)
  list(APPEND flags -Wl,-rpath,${libraries})
endif()
must(${COMPILER} -std=c++20 ${FLAGS} -DMODULE="${module}" ${SOURCE}/tests/consumer/main.cpp
  -o ${work}/byPkgConfig${SUFFIX} ${flags})
run("2150.0 cd" ${work}/byPkgConfig${SUFFIX} ${file})

# The program of the guide for hosts.
file(READ ${SOURCE}/docs/embedding.md guide)
string(REGEX MATCH "```cpp\n([^`]*)```" found "${guide}")
file(WRITE ${work}/host.cpp "${CMAKE_MATCH_1}")
must(${COMPILER} -std=c++20 -Wall -Wextra -Werror ${FLAGS} ${work}/host.cpp
  -o ${work}/host${SUFFIX} ${flags})
run("2150 cd, loaded 2150 cd" ${work}/host${SUFFIX} ${module} ${file} ${work}/saved.txt)

# A refused file is explained in German, by that program, and by the tool, which finds module and texts by itself.
function(refuses)
  execute_process(COMMAND ${EMULATOR} ${ARGN} RESULT_VARIABLE status OUTPUT_VARIABLE messages ERROR_VARIABLE messages)
  if(NOT status EQUAL 1 OR NOT messages MATCHES "sie muss mindestens 1 sein")
    message(FATAL_ERROR "a broken file, ${ARGV0}: status ${status}, messages: ${messages}")
  endif()
endfunction()

file(WRITE ${work}/broken.ies "IESNA91\nTILT=NONE\n0")
refuses(${work}/host${SUFFIX} ${module} ${work}/broken.ies ${work}/none.txt)
unset(ENV{WINEPATH})
set(ENV{LC_ALL} de_DE.UTF-8)
refuses(${prefix}/bin/ovphoto${SUFFIX} check ${work}/broken.ies)
