# What others build against the installed package.
find_program(OVPHOTO_PKG_CONFIG pkg-config REQUIRED)
set(flags)
if(OVPHOTO_SANITIZE)
  set(flags -fsanitize=${OVPHOTO_SANITIZE})
elseif(CMAKE_CROSSCOMPILING)
  set(flags -static)  # the compiler's runtime, as in the toolchain file
endif()
add_test(NAME consumer.buildsAgainstTheInstalledPackage
  COMMAND ${CMAKE_COMMAND} -DBUILD=${PROJECT_BINARY_DIR} -DSOURCE=${PROJECT_SOURCE_DIR} -DGENERATOR=${CMAKE_GENERATOR}
          -DCOMPILER=${CMAKE_CXX_COMPILER} -DFLAGS=${flags} -DPKG_CONFIG=${OVPHOTO_PKG_CONFIG}
          -DLIBDIR=${CMAKE_INSTALL_LIBDIR} -DTOOLCHAIN=${CMAKE_TOOLCHAIN_FILE} -DSUFFIX=${CMAKE_EXECUTABLE_SUFFIX}
          "-DEMULATOR=${CMAKE_CROSSCOMPILING_EMULATOR}" -P ${CMAKE_CURRENT_LIST_DIR}/run.cmake)
