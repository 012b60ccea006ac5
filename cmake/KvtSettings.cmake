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

# Where translations live once installed, and where the build tree keeps them.
set(KVT_TRANSLATIONS_INSTALL_DIR "${CMAKE_INSTALL_DATADIR}/brel/translations")
set(KVT_TRANSLATIONS_BUILD_DIR "${PROJECT_BINARY_DIR}/translations")
set(KVT_FORWARD_INCLUDE_DIR "${PROJECT_BINARY_DIR}/include")
