# With the preset tsan these alone are built and run.
ovphoto_add_test(threads/threads_test)
