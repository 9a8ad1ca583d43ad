# Pictures need Cairo; without it the tool has none.
ovphoto_add_test(plot/diagram_test)
target_link_libraries(plot_diagram_test PRIVATE ovphoto_plot)
ovphoto_add_test(plot/plot_test)
target_link_libraries(plot_plot_test PRIVATE ovphoto_plot)
add_dependencies(plot_plot_test ovphoto ovphoto_faults)

# Reports in a browser.
find_program(OVPHOTO_SYSTEM_PYTHON python3 PATHS /usr/bin NO_DEFAULT_PATH)  # Selenium is Debian's
add_test(NAME plot_browser_test
  COMMAND ${OVPHOTO_SYSTEM_PYTHON} ${CMAKE_CURRENT_LIST_DIR}/browser_test.py $<TARGET_FILE:ovphoto> ${PROJECT_SOURCE_DIR})
set_tests_properties(plot_browser_test PROPERTIES TIMEOUT 300)
