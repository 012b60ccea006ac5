# Configuration-file rewrite beside sed -i doing the same edit.
kvt_add_benchmark(bench_configfile bench_system/configfilebench.cpp)
