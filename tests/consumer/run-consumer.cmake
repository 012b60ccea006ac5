# SPDX-FileCopyrightText: 2026 The libkvt-common developers
# SPDX-License-Identifier: LGPL-2.1-or-later

# Driven by the consumer_install test; see CMakeLists.txt beside this file.
function(run)
    execute_process(COMMAND ${ARGN} RESULT_VARIABLE rc OUTPUT_VARIABLE out ERROR_VARIABLE err)
    if(NOT rc EQUAL 0)
        message(FATAL_ERROR "command failed (${rc}): ${ARGN}\n${out}\n${err}")
    endif()
    set(LAST_OUTPUT "${out}" PARENT_SCOPE)
endfunction()

set(prefix "${WORK_DIR}/prefix")
file(REMOVE_RECURSE "${WORK_DIR}")
run(${CMAKE_COMMAND} --install "${BUILD_DIR}" --prefix "${prefix}")

foreach(f include/kvt-common/treenode.h include/kvt-common/kvtcommon_export.h
          include/kvt-common/kvtcommon_version.h)
    if(NOT EXISTS "${prefix}/${f}")
        message(FATAL_ERROR "not installed: ${f}")
    endif()
endforeach()
file(GLOB libs "${prefix}/lib*/libkvt-common.so.0" "${prefix}/lib*/*/libkvt-common.so.0")
if(NOT libs)
    message(FATAL_ERROR "libkvt-common.so.0 not installed under ${prefix}")
endif()
list(GET libs 0 lib)
get_filename_component(libdir "${lib}" DIRECTORY)

set(flags "")
if(SANITIZE)
    set(flags "-fsanitize=address,undefined")
endif()

run(${CMAKE_COMMAND} -S "${PROJECT_DIR}" -B "${WORK_DIR}/build"
    "-DCMAKE_PREFIX_PATH=${prefix}" "-DCMAKE_BUILD_TYPE=${BUILD_TYPE}"
    "-DCMAKE_CXX_FLAGS=${flags}" "-DCMAKE_EXE_LINKER_FLAGS=${flags}")
run(${CMAKE_COMMAND} --build "${WORK_DIR}/build")
run("${WORK_DIR}/build/kvt-consumer")
if(NOT LAST_OUTPUT MATCHES "consumer: 2 rows, Name/Value, version ${VERSION}")
    message(FATAL_ERROR "unexpected consumer output: ${LAST_OUTPUT}")
endif()
# The installed library finds its translations beside itself, in this prefix.
run(${CMAKE_COMMAND} -E env LC_ALL=ru_RU.UTF-8 LANG=ru_RU.UTF-8 "${WORK_DIR}/build/kvt-consumer")
if(NOT LAST_OUTPUT MATCHES "consumer: 2 rows, Имя/Значение")
    message(FATAL_ERROR "no Russian translation from ${prefix}: ${LAST_OUTPUT}")
endif()

# An 0.x version accepts only its own minor version.
file(WRITE "${WORK_DIR}/version/CMakeLists.txt" "cmake_minimum_required(VERSION 3.16)
project(VersionProbe LANGUAGES CXX)
find_package(KvtCommon \${WANTED} REQUIRED)
")
foreach(case "${VERSION_MAJOR}.${VERSION_MINOR};1" "${VERSION_MAJOR}.${NEXT_MINOR};0")
    list(GET case 0 wanted)
    list(GET case 1 expected)
    file(REMOVE_RECURSE "${WORK_DIR}/version/build")
    execute_process(COMMAND ${CMAKE_COMMAND} -S "${WORK_DIR}/version" -B "${WORK_DIR}/version/build"
                            "-DCMAKE_PREFIX_PATH=${prefix}" "-DWANTED=${wanted}"
                    RESULT_VARIABLE rc OUTPUT_VARIABLE out ERROR_VARIABLE err)
    if(rc EQUAL 0)
        set(found 1)
    else()
        set(found 0)
    endif()
    if(NOT found EQUAL expected)
        message(FATAL_ERROR "find_package(KvtCommon ${wanted}) found=${found}, expected ${expected}\n${out}\n${err}")
    endif()
endforeach()

# pkg-config: the same program, compiled by hand with the flags it gives.
find_program(PKG_CONFIG pkg-config)
if(PKG_CONFIG)
    set(ENV{PKG_CONFIG_PATH} "${libdir}/pkgconfig")
    run(${PKG_CONFIG} --cflags --libs kvt-common)
    string(STRIP "${LAST_OUTPUT}" pc_flags)
    separate_arguments(pc_flags UNIX_COMMAND "${pc_flags}")
    run(c++ -std=c++17 -fPIC ${flags} "${PROJECT_DIR}/main.cpp" -o "${WORK_DIR}/kvt-consumer-pc"
        ${pc_flags} "-Wl,-rpath,${libdir}")
    run("${WORK_DIR}/kvt-consumer-pc")
    if(NOT LAST_OUTPUT MATCHES "consumer: 2 rows, Name/Value, version ${VERSION}")
        message(FATAL_ERROR "unexpected pkg-config consumer output: ${LAST_OUTPUT}")
    endif()
endif()
