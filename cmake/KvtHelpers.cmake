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
# Each one gets a forwarding header in the build tree so that code built
# against the build tree includes it exactly as an installed consumer does:
# #include <kvt-common/name.h>.
function(kvt_public_headers)
    foreach(h IN LISTS ARGN)
        set(abs "${CMAKE_CURRENT_SOURCE_DIR}/${h}")
        target_sources(KvtCommon PRIVATE "${abs}")
        set_property(GLOBAL APPEND PROPERTY KVT_PUBLIC_HEADERS "${abs}")
        get_filename_component(name "${h}" NAME)
        set(fwd "${KVT_FORWARD_INCLUDE_DIR}/kvt-common/${name}")
        set(content "#include \"${abs}\"\n")
        if(EXISTS "${fwd}")
            file(READ "${fwd}" old)
        else()
            set(old "")
        endif()
        if(NOT old STREQUAL content)
            file(WRITE "${fwd}" "${content}")
        endif()
    endforeach()
endfunction()
