# SPDX-FileCopyrightText: 2026 The libkvt-common developers
# SPDX-License-Identifier: LGPL-2.1-or-later

# kvt_add_test(<name> SOURCES <file>... [LIBS <target>...] [ENV <VAR=value>...]
#              [FUNCTIONS <test function>...])
#
# With FUNCTIONS, each listed test function runs in a process of its own
# (test <name>_<function>), for state that lives as long as the process.
#
# Builds a QtTest executable and registers it with CTest. Every test runs on
# the offscreen platform with a home, settings and data folder of its own under
# the build tree, wiped before each run, so no test reads or writes the user's
# real configuration.
set(KVT_TEST_HOME_ROOT "${PROJECT_BINARY_DIR}/test-home")

if(NOT TEST kvt_wipe_test_home)
    add_test(NAME kvt_wipe_test_home
             COMMAND ${CMAKE_COMMAND} -E rm -rf "${KVT_TEST_HOME_ROOT}")
    set_tests_properties(kvt_wipe_test_home PROPERTIES FIXTURES_SETUP kvt_test_home)
endif()

set(KVT_SANITIZER_ENV "")
if(KVT_SANITIZE)
    set(KVT_SANITIZER_ENV
        "ASAN_OPTIONS=halt_on_error=1:abort_on_error=1:detect_leaks=1"
        "UBSAN_OPTIONS=halt_on_error=1:print_stacktrace=1"
        "LSAN_OPTIONS=suppressions=${PROJECT_SOURCE_DIR}/tests/lsan.supp:print_suppressions=0")
endif()
if(KVT_TSAN)
    # Any report fails the test (exit code 66). Memory functions that
    # uninstrumented code (Qt) calls are not checked: Qt's own locking is not
    # visible, so they would only report Qt's internal accesses.
    set(KVT_SANITIZER_ENV
        "TSAN_OPTIONS=suppressions=${PROJECT_SOURCE_DIR}/tests/tsan.supp:halt_on_error=1:exitcode=66:second_deadlock_stack=1:ignore_noninstrumented_modules=1:print_suppressions=0"
        "LD_PRELOAD=$<TARGET_FILE:kvt_tsan_qtsync>")
endif()

# The environment of one test: its own home, settings and data folders, the
# C.UTF-8 locale, the sanitizer options, then the given extra entries.
function(_kvt_test_environment out test platform extra)
    set(home "${KVT_TEST_HOME_ROOT}/${test}")
    set(${out} "${platform};HOME=${home};XDG_CONFIG_HOME=${home}/config;XDG_DATA_HOME=${home}/data;XDG_CACHE_HOME=${home}/cache;LC_ALL=C.UTF-8;LANG=C.UTF-8;KVT_TEST_HOME=${home};${KVT_SANITIZER_ENV};${extra}" PARENT_SCOPE)
endfunction()

function(kvt_add_test name)
    cmake_parse_arguments(ARG "" "" "SOURCES;LIBS;ENV;FUNCTIONS" ${ARGN})
    add_executable(${name} ${ARG_SOURCES})
    target_link_libraries(${name} PRIVATE KvtCommon::KvtCommon kvttestsupport Qt5::Test ${ARG_LIBS})
    if(KVT_TSAN)
        add_dependencies(${name} kvt_tsan_qtsync)
    endif()
    set(tests)
    if(ARG_FUNCTIONS)
        foreach(fn IN LISTS ARG_FUNCTIONS)
            add_test(NAME ${name}_${fn} COMMAND ${name} ${fn})
            list(APPEND tests ${name}_${fn})
        endforeach()
    else()
        add_test(NAME ${name} COMMAND ${name})
        set(tests ${name})
    endif()
    foreach(test IN LISTS tests)
        _kvt_test_environment(env ${test} "QT_QPA_PLATFORM=offscreen" "${ARG_ENV}")
        set_tests_properties(${test} PROPERTIES
            FIXTURES_REQUIRED kvt_test_home
            TIMEOUT 300
            ENVIRONMENT "${env}")
    endforeach()
endfunction()

# kvt_add_gui_test(<name> SOURCES <file>... [LIBS <target>...] [ENV <VAR=value>...])
#
# Like kvt_add_test, but the test runs in a real X server: the wrapper
# tests/support/run-in-xvfb.sh starts Xvfb on a free display, runs the test
# there on the xcb platform and stops the server. When Xvfb cannot start, the
# wrapper says why and the test is reported as skipped.
function(kvt_add_gui_test name)
    cmake_parse_arguments(ARG "" "" "SOURCES;LIBS;ENV" ${ARGN})
    add_executable(${name} ${ARG_SOURCES})
    target_link_libraries(${name} PRIVATE KvtCommon::KvtCommon kvttestsupport Qt5::Test ${ARG_LIBS})
    add_test(NAME ${name}
             COMMAND sh "${PROJECT_SOURCE_DIR}/tests/support/run-in-xvfb.sh" $<TARGET_FILE:${name}>)
    _kvt_test_environment(env ${name} "KVT_GUI_TEST=1" "${ARG_ENV}")
    set_tests_properties(${name} PROPERTIES
        FIXTURES_REQUIRED kvt_test_home
        TIMEOUT 300
        SKIP_RETURN_CODE 77
        ENVIRONMENT "${env}")
endfunction()
