# SPDX-FileCopyrightText: 2026 The libkvt-common developers
# SPDX-License-Identifier: LGPL-2.1-or-later

# Loading a directory of 50 plugins of 20 modules each through
# PluginContainer::loadPlugins, beside a bare QPluginLoader loop (load and
# instance) over the same files. The plugins are one source built 50 times
# with different definitions: distinct file names and module ids.
set(KVT_BENCH_PLUGIN_DIR "${CMAKE_CURRENT_BINARY_DIR}/bench-plugins")
set(bench_plugin_targets)
foreach(index RANGE 1 50)
    set(target kvt_bench_plugin_${index})
    add_library(${target} MODULE "${CMAKE_CURRENT_LIST_DIR}/bench_plugin_sample.cpp")
    target_link_libraries(${target} PRIVATE KvtCommon::KvtCommon)
    target_compile_definitions(${target} PRIVATE KVT_BENCH_PLUGIN_INDEX=${index} KVT_BENCH_MODULES=20)
    set_target_properties(${target} PROPERTIES
        OUTPUT_NAME bench${index}
        PREFIX ""
        LIBRARY_OUTPUT_DIRECTORY "${KVT_BENCH_PLUGIN_DIR}")
    list(APPEND bench_plugin_targets ${target})
endforeach()

kvt_add_benchmark(bench_plugin "${CMAKE_CURRENT_LIST_DIR}/bench_plugin.cpp" LIBS Qt5::Widgets)
target_compile_definitions(bench_plugin PRIVATE KVT_BENCH_PLUGIN_DIR="${KVT_BENCH_PLUGIN_DIR}")
add_dependencies(bench_plugin ${bench_plugin_targets})
