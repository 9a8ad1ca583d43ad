# What `cmake --install` puts where, and what `cpack` makes of it.
include(GNUInstallDirs)
include(CMakePackageConfigHelpers)

set(summary "photometric files of luminaires: a library and a command-line tool")

# The module finds its texts, and the tool the module, beside themselves: they share a folder. Where programs have one
# of their own, it holds a link to the tool.
set(moduleFolder ${CMAKE_INSTALL_LIBDIR}/ovphoto)
if(WIN32)
  set(moduleFolder ${CMAKE_INSTALL_BINDIR})
endif()
set(moduleFile ${CMAKE_SHARED_MODULE_PREFIX}OVphoto${CMAKE_SHARED_MODULE_SUFFIX})
set(packageFolder ${CMAKE_INSTALL_LIBDIR}/cmake/ovphoto)

# Interfaces still change between minor versions. Nobody links the module, so its name says no version.
set_target_properties(OVhost PROPERTIES
  VERSION ${PROJECT_VERSION} SOVERSION ${PROJECT_VERSION_MAJOR}.${PROJECT_VERSION_MINOR})
set_target_properties(OVphoto PROPERTIES NO_SONAME ON INSTALL_RPATH $ORIGIN/..)

# Who uses the installed library needs its language and its headers, not the flags that it was built with.
set_target_properties(OVhost PROPERTIES INTERFACE_LINK_LIBRARIES $<BUILD_INTERFACE:ovphoto_flags>)
set_target_properties(ovphoto_support PROPERTIES
  EXPORT_NAME support INTERFACE_LINK_LIBRARIES "$<BUILD_INTERFACE:ovphoto_flags>;OVhost")
target_compile_features(OVhost INTERFACE cxx_std_20)

install(TARGETS OVhost ovphoto_support EXPORT ovphoto
  RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR}
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}
  ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR}
  INCLUDES DESTINATION ${CMAKE_INSTALL_INCLUDEDIR} ${CMAKE_INSTALL_INCLUDEDIR}/ovphoto)
install(TARGETS OVphoto EXPORT ovphoto LIBRARY DESTINATION ${moduleFolder})
if(TARGET ovphoto)
  set_target_properties(ovphoto PROPERTIES INSTALL_RPATH $ORIGIN/..)
  install(TARGETS ovphoto RUNTIME DESTINATION ${moduleFolder})
endif()
if(NOT WIN32)
  file(RELATIVE_PATH tool /${CMAKE_INSTALL_BINDIR} /${moduleFolder}/ovphoto)
  file(MAKE_DIRECTORY ${PROJECT_BINARY_DIR}/install)
  file(CREATE_LINK ${tool} ${PROJECT_BINARY_DIR}/install/ovphoto SYMBOLIC)
  install(FILES ${PROJECT_BINARY_DIR}/install/ovphoto DESTINATION ${CMAKE_INSTALL_BINDIR})
endif()

# English beside the module, other languages in folders.
file(GLOB languages RELATIVE ${PROJECT_SOURCE_DIR}/messages ${PROJECT_SOURCE_DIR}/messages/*.msg)
foreach(language ${languages})
  string(REPLACE ".msg" "" folder ${language})
  string(REGEX REPLACE "^en$" "." folder ${folder})
  install(FILES ${CMAKE_LIBRARY_OUTPUT_DIRECTORY}/${folder}/libOVphotoRes.dll DESTINATION ${moduleFolder}/${folder})
endforeach()

# The headers of host and support go below ovphoto/, so that no other's "host" meets them.
install(DIRECTORY ${PROJECT_SOURCE_DIR}/include/ovphoto DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}
  FILES_MATCHING PATTERN *.h)
install(DIRECTORY ${PROJECT_SOURCE_DIR}/host DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/ovphoto
  FILES_MATCHING PATTERN *.h PATTERN arguments.h EXCLUDE PATTERN streamState.h EXCLUDE)
install(DIRECTORY ${PROJECT_SOURCE_DIR}/components/support
  DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/ovphoto/components
  FILES_MATCHING PATTERN *.h PATTERN text*.h EXCLUDE)
install(FILES ${PROJECT_SOURCE_DIR}/docs/man/ovphoto.1 DESTINATION ${CMAKE_INSTALL_MANDIR}/man1)
install(FILES ${PROJECT_SOURCE_DIR}/LICENSE DESTINATION ${CMAKE_INSTALL_DOCDIR})

# The notices of what is compiled into the programs, from the packages that it comes in.
set(contents libcli11-dev nlohmann-json3-dev)
if(WIN32)
  list(APPEND contents mingw-w64-x86-64-dev g++-mingw-w64-x86-64-posix)
endif()
foreach(package ${contents})
  install(FILES /usr/share/doc/${package}/copyright DESTINATION ${CMAKE_INSTALL_DOCDIR}/licences RENAME ${package}
    OPTIONAL)
endforeach()

# find_package(ovphoto)
install(EXPORT ovphoto NAMESPACE ovphoto:: FILE ovphotoTargets.cmake DESTINATION ${packageFolder})
configure_package_config_file(${CMAKE_CURRENT_LIST_DIR}/ovphotoConfig.cmake.in
  ${PROJECT_BINARY_DIR}/install/ovphotoConfig.cmake
  INSTALL_DESTINATION ${packageFolder} NO_SET_AND_CHECK_MACRO NO_CHECK_REQUIRED_COMPONENTS_MACRO)
write_basic_package_version_file(${PROJECT_BINARY_DIR}/install/ovphotoConfigVersion.cmake
  COMPATIBILITY SameMinorVersion)
install(FILES ${PROJECT_BINARY_DIR}/install/ovphotoConfig.cmake
  ${PROJECT_BINARY_DIR}/install/ovphotoConfigVersion.cmake DESTINATION ${packageFolder})

# pkg-config ovphoto. The import library's full name is found where programs are linked with -static, too.
set(hostLibrary OVhost)
if(WIN32)
  set(hostLibrary :libOVhost.dll.a)
endif()
file(RELATIVE_PATH prefixFromPkgconfig /prefix/${CMAKE_INSTALL_LIBDIR}/pkgconfig /prefix)
string(REGEX REPLACE "/$" "" prefixFromPkgconfig ${prefixFromPkgconfig})
configure_file(${CMAKE_CURRENT_LIST_DIR}/ovphoto.pc.in ${PROJECT_BINARY_DIR}/install/ovphoto.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/install/ovphoto.pc DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig)

# cpack: a .deb where there is dpkg, a .zip for Windows.
find_program(OVPHOTO_DPKG dpkg)
set(CPACK_GENERATOR TGZ)
if(WIN32)
  set(CPACK_GENERATOR ZIP)
elseif(OVPHOTO_DPKG)
  set(CPACK_GENERATOR DEB)
endif()
set(CPACK_PACKAGE_CONTACT "the ovphoto authors")
set(CPACK_PACKAGE_VENDOR "the ovphoto authors")
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY ${summary})
string(CONCAT CPACK_PACKAGE_DESCRIPTION
  "Reads, converts and checks IES, CIBSE, NIMB and TBT files, answers how many candela\ngo in any direction, and works "
  "out the light of sun and sky.")
set(CPACK_RESOURCE_FILE_LICENSE ${PROJECT_SOURCE_DIR}/LICENSE)
set(CPACK_STRIP_FILES ON)
set(CPACK_INSTALL_DEFAULT_DIRECTORY_PERMISSIONS
  OWNER_READ OWNER_WRITE OWNER_EXECUTE GROUP_READ GROUP_EXECUTE WORLD_READ WORLD_EXECUTE)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_SECTION graphics)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS ${CMAKE_LIBRARY_OUTPUT_DIRECTORY})
set(CPACK_DEBIAN_PACKAGE_GENERATE_SHLIBS ON)
include(CPack)
