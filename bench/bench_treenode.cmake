kvt_add_benchmark(bench_treenodemodel "${CMAKE_CURRENT_LIST_DIR}/treenodemodel_bench.cpp")
