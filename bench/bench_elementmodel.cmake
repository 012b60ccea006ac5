kvt_add_benchmark(bench_elementmodel "${CMAKE_CURRENT_LIST_DIR}/bench_elementmodel.cpp" LIBS Qt5::Gui)
