# Pictures need Cairo; without it the tool has none.
ovphoto_add_test(plot/diagram_test)
target_link_libraries(plot_diagram_test PRIVATE ovphoto_plot)
ovphoto_add_test(plot/plot_test)
target_link_libraries(plot_plot_test PRIVATE ovphoto_plot)
add_dependencies(plot_plot_test ovphoto)
