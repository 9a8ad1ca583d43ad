set(OVPHOTO_SUPPORT_SOURCES
  devices.cpp                        # memory and standard streams as devices
  file.cpp                           # files as devices
  path.cpp path_${OVPHOTO_PLATFORM}.cpp  # wide texts and paths, UTF-8 outside
  textFormat.cpp)                    # numbers as text, by the conversions of printf
list(TRANSFORM OVPHOTO_SUPPORT_SOURCES PREPEND ${CMAKE_CURRENT_LIST_DIR}/)
if(WIN32)
  # In every file that computes.
  add_library(ovphoto_sincos STATIC ${CMAKE_CURRENT_LIST_DIR}/sincos_windows.cpp)
  target_link_libraries(ovphoto_flags INTERFACE ovphoto_sincos)
endif()
