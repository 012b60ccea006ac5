# SPDX-FileCopyrightText: 2026 The libkvt-common developers
# SPDX-License-Identifier: LGPL-2.1-or-later
#
# Driven by the library_paths test: the library, without its debugging
# sections (which distributions strip into separate packages), must not name
# the build tree or the install prefix. It finds its data from its own location
# at run time, so it stays valid wherever it is installed.
file(REMOVE_RECURSE "${WORK_DIR}")
file(MAKE_DIRECTORY "${WORK_DIR}")
set(copy "${WORK_DIR}/library.so")
execute_process(COMMAND "${OBJCOPY}" --strip-debug "${LIBRARY}" "${copy}" RESULT_VARIABLE rc)
if(NOT rc EQUAL 0)
    message(FATAL_ERROR "objcopy failed on ${LIBRARY}")
endif()
file(STRINGS "${copy}" strings)
set(forbidden "${BUILD_DIR}")
# The fixed system translations folder is under /usr: a /usr prefix cannot be told apart.
if(NOT PREFIX STREQUAL "/usr")
    list(APPEND forbidden "${PREFIX}/")
endif()
foreach(path IN LISTS forbidden)
    foreach(s IN LISTS strings)
        string(FIND "${s}" "${path}" at)
        if(NOT at EQUAL -1)
            message(FATAL_ERROR "the library names ${path}: ${s}")
        endif()
    endforeach()
endforeach()
