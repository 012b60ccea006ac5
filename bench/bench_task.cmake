kvt_add_benchmark(bench_task "${CMAKE_CURRENT_LIST_DIR}/task_bench.cpp")
