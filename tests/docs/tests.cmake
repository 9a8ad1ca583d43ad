ovphoto_add_test(docs/readme_test)
add_dependencies(docs_readme_test ovphoto)
