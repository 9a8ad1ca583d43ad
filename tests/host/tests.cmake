ovphoto_add_test(host/platform_test)
ovphoto_add_test(host/processController_test)

# Modules for the component manager to load: one that is whole, one without an entry point.
foreach(module hostTestModule hostEmptyModule)
  add_library(${module} MODULE host/testModule.cpp)
  target_link_libraries(${module} PRIVATE OVhost)
  target_link_options(${module} PRIVATE -Wl,--version-script=${PROJECT_SOURCE_DIR}/components/module/module.map)
endforeach()
target_compile_definitions(hostEmptyModule PRIVATE TEST_MODULE_EMPTY)
ovphoto_add_test(host/componentManager_test)
add_dependencies(host_componentManager_test hostTestModule hostEmptyModule)
ovphoto_add_test(host/formatted_test)
