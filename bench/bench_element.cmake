kvt_add_benchmark(bench_element "${CMAKE_CURRENT_LIST_DIR}/bench_element.cpp" LIBS Qt5::Gui)
