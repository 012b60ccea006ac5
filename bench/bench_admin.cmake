# SPDX-FileCopyrightText: 2026 The libkvt-common developers
# SPDX-License-Identifier: LGPL-2.1-or-later

# kvt-admin: the selection round trip in the main window (element chosen,
# read task on a worker, widget filled) beside the same read done directly,
# and the start-up of `kvt-admin --list` beside a bare program doing the
# same reads.
if(KVT_BUILD_APPS)
    set(conffiles_format "${PROJECT_SOURCE_DIR}/plugins/conffiles/conffileformat.cpp")
    add_executable(bench_admin_floor "${CMAKE_CURRENT_LIST_DIR}/bench_admin_floor.cpp" ${conffiles_format})
    target_include_directories(bench_admin_floor PRIVATE "${PROJECT_SOURCE_DIR}/plugins/conffiles")
    target_link_libraries(bench_admin_floor PRIVATE KvtCommon::KvtCommon)

    kvt_add_benchmark(bench_admin "${CMAKE_CURRENT_LIST_DIR}/bench_admin.cpp" ${conffiles_format}
                      LIBS KvtAdminCore)
    target_include_directories(bench_admin PRIVATE "${PROJECT_SOURCE_DIR}/plugins/conffiles")
    target_compile_definitions(bench_admin PRIVATE
        KVT_ADMIN_PLUGIN_DIR="${KVT_ADMIN_PLUGIN_BUILD_DIR}"
        KVT_ADMIN_EXECUTABLE="$<TARGET_FILE:kvt-admin>"
        KVT_ADMIN_FLOOR_EXECUTABLE="$<TARGET_FILE:bench_admin_floor>")
    get_property(kvt_admin_plugins GLOBAL PROPERTY KVT_ADMIN_PLUGINS)
    add_dependencies(bench_admin kvt-admin bench_admin_floor ${kvt_admin_plugins})
endif()
