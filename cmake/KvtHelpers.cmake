# SPDX-FileCopyrightText: 2026 The libkvt-common developers
# SPDX-License-Identifier: LGPL-2.1-or-later

# Helpers used by the subsystem folders of src/.

# kvt_sources(<file>...): adds sources (and private headers) of the current
# folder to the library.
function(kvt_sources)
    set(files)
    foreach(f IN LISTS ARGN)
        list(APPEND files "${CMAKE_CURRENT_SOURCE_DIR}/${f}")
    endforeach()
    target_sources(KvtCommon PRIVATE ${files})
endfunction()

# kvt_public_headers(<header>...): adds installed headers of the current folder.
# Each one gets a symbolic link in the build tree's include/kvt-common/, so that
# code built against the build tree sees exactly the installed layout: it
# writes #include <kvt-common/name.h>, and the headers' own "sibling.h"
# includes resolve inside that one folder as they do once installed.
function(kvt_public_headers)
    foreach(h IN LISTS ARGN)
        set(abs "${CMAKE_CURRENT_SOURCE_DIR}/${h}")
        target_sources(KvtCommon PRIVATE "${abs}")
        set_property(GLOBAL APPEND PROPERTY KVT_PUBLIC_HEADERS "${abs}")
        get_filename_component(name "${h}" NAME)
        set(link "${KVT_FORWARD_INCLUDE_DIR}/kvt-common/${name}")
        if(IS_SYMLINK "${link}")
            file(READ_SYMLINK "${link}" old)
        else()
            set(old "")
        endif()
        if(NOT old STREQUAL abs)
            file(REMOVE "${link}")
            file(MAKE_DIRECTORY "${KVT_FORWARD_INCLUDE_DIR}/kvt-common")
            file(CREATE_LINK "${abs}" "${link}" SYMBOLIC)
        endif()
    endforeach()
endfunction()
