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
    # Any report fails the test (exit code 66).
    set(KVT_SANITIZER_ENV
        "TSAN_OPTIONS=suppressions=${PROJECT_SOURCE_DIR}/tests/tsan.supp:halt_on_error=1:exitcode=66:second_deadlock_stack=1:print_suppressions=0")
endif()

function(kvt_add_test name)
    cmake_parse_arguments(ARG "" "" "SOURCES;LIBS;ENV;FUNCTIONS" ${ARGN})
    add_executable(${name} ${ARG_SOURCES})
    target_link_libraries(${name} PRIVATE KvtCommon::KvtCommon kvttestsupport Qt5::Test ${ARG_LIBS})
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
        set(home "${KVT_TEST_HOME_ROOT}/${test}")
        set_tests_properties(${test} PROPERTIES
        FIXTURES_REQUIRED kvt_test_home
        TIMEOUT 300
        ENVIRONMENT "QT_QPA_PLATFORM=offscreen;HOME=${home};XDG_CONFIG_HOME=${home}/config;XDG_DATA_HOME=${home}/data;XDG_CACHE_HOME=${home}/cache;LC_ALL=C.UTF-8;LANG=C.UTF-8;KVT_TEST_HOME=${home};${KVT_SANITIZER_ENV};${ARG_ENV}")
    endforeach()
endfunction()
