# What others build against the installed package.
find_program(OVPHOTO_PKG_CONFIG pkg-config REQUIRED)
set(sanitize)
if(OVPHOTO_SANITIZE)
  set(sanitize -fsanitize=${OVPHOTO_SANITIZE})
endif()
add_test(NAME consumer.buildsAgainstTheInstalledPackage
  COMMAND ${CMAKE_COMMAND} -DBUILD=${PROJECT_BINARY_DIR} -DSOURCE=${PROJECT_SOURCE_DIR} -DGENERATOR=${CMAKE_GENERATOR}
          -DCOMPILER=${CMAKE_CXX_COMPILER} -DFLAGS=${sanitize} -DPKG_CONFIG=${OVPHOTO_PKG_CONFIG}
          -DLIBDIR=${CMAKE_INSTALL_LIBDIR} -P ${CMAKE_CURRENT_LIST_DIR}/run.cmake)
