# SPDX-FileCopyrightText: 2026 The libkvt-common developers
# SPDX-License-Identifier: LGPL-2.1-or-later

# Project-wide compiler, Qt and install settings.

set(CMAKE_CXX_STANDARD 17)
set(CMAKE_CXX_STANDARD_REQUIRED ON)
set(CMAKE_CXX_EXTENSIONS OFF)
set(CMAKE_AUTOMOC ON)
set(CMAKE_AUTOUIC ON)
set(CMAKE_AUTORCC ON)
set(CMAKE_CXX_VISIBILITY_PRESET hidden)
set(CMAKE_VISIBILITY_INLINES_HIDDEN ON)
set(CMAKE_POSITION_INDEPENDENT_CODE ON)
if(NOT CMAKE_BUILD_TYPE AND NOT CMAKE_CONFIGURATION_TYPES)
    set(CMAKE_BUILD_TYPE RelWithDebInfo CACHE STRING "Build type" FORCE)
endif()

include(GNUInstallDirs)

set(KVT_QT_COMPONENTS Core Gui Widgets PrintSupport XmlPatterns Concurrent)
find_package(Qt5 5.11 REQUIRED COMPONENTS ${KVT_QT_COMPONENTS} LinguistTools)

add_compile_options(-Wall -Wextra)
add_compile_definitions(QT_NO_CAST_FROM_BYTEARRAY QT_NO_URL_CAST_FROM_STRING
                        QT_DEPRECATED_WARNINGS)

if(KVT_SANITIZE)
    add_compile_options(-fsanitize=address,undefined -fno-sanitize-recover=all
                        -fno-omit-frame-pointer)
    add_link_options(-fsanitize=address,undefined -fno-sanitize-recover=all)
endif()

# ThreadSanitizer: the library and its tests are instrumented, Qt is not;
# tests/tsan.supp explains what that costs.
if(KVT_TSAN)
    add_compile_options(-fsanitize=thread -fno-omit-frame-pointer)
    add_link_options(-fsanitize=thread)
endif()

# Where translations live once installed. The build tree mirrors the install
# layout (the library in <build>/<libdir>, translations in <build>/<datadir>/...)
# so that the library finds its translations from its own location in both.
set(KVT_TRANSLATIONS_INSTALL_DIR "${CMAKE_INSTALL_DATADIR}/brel/translations")
set(KVT_TRANSLATIONS_BUILD_DIR "${PROJECT_BINARY_DIR}/${KVT_TRANSLATIONS_INSTALL_DIR}")
set(KVT_LIBRARY_BUILD_DIR "${PROJECT_BINARY_DIR}/${CMAKE_INSTALL_LIBDIR}")
# The translations folder as seen from the library's folder: a relative path
# that does not depend on the install prefix, so changing the prefix does not
# rebuild the library.
file(RELATIVE_PATH KVT_TRANSLATIONS_FROM_LIBDIR "/prefix/${CMAKE_INSTALL_LIBDIR}"
     "/prefix/${KVT_TRANSLATIONS_INSTALL_DIR}")
set(KVT_FORWARD_INCLUDE_DIR "${PROJECT_BINARY_DIR}/include")
