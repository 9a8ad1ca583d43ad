# A module beside the library's, in a folder of its own: what lies beside the tool is loaded.
ovphoto_add_module(OVtoy ${CMAKE_CURRENT_LIST_DIR}/toyModule.cpp)
set_target_properties(OVtoy PROPERTIES LIBRARY_OUTPUT_DIRECTORY ${CMAKE_LIBRARY_OUTPUT_DIRECTORY}/toy)
ovphoto_add_test(toy/toy_test)
add_dependencies(toy_toy_test OVtoy OVphoto ovphoto ovphoto_messages)
