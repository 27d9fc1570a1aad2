# What a preset may vary, and the compiler settings that every target shares.
option(KELVO_WITH_QT "Build the parts that stand on Qt: host platform, service, tools, application" ON)
option(KELVO_TESTS "Build the tests" ON)
option(KELVO_BENCH "Build the benchmarks" OFF)
option(KELVO_FUZZ "Build the libFuzzer targets (clang only)" OFF)
option(KELVO_WERROR "Treat warnings as errors" OFF)
set(KELVO_SANITIZE "" CACHE STRING "Sanitizers for every target, as -fsanitize= takes them")

# ccache keeps nothing that was compiled with a precompiled header unless it is told that it may.
if("${CMAKE_CXX_COMPILER_LAUNCHER}" MATCHES "ccache" AND NOT "$ENV{CCACHE_SLOPPINESS}" MATCHES "pch_defines")
    set(CMAKE_DISABLE_PRECOMPILE_HEADERS ON)
endif()

# What most files include one way or another takes half of the time that they are compiled for. A file still includes
# whatever it uses: the packages' build and the thread sanitizer's precompile nothing.
set(KELVO_COMMON_HEADERS <algorithm> <chrono> <functional> <memory> <optional> <string> <string_view> <utility> <vector>
    <fmt/format.h>)

set(CMAKE_CXX_STANDARD 20)
set(CMAKE_CXX_STANDARD_REQUIRED ON)
set(CMAKE_CXX_EXTENSIONS OFF)
set(CMAKE_EXPORT_COMPILE_COMMANDS ON)
set(CMAKE_POSITION_INDEPENDENT_CODE ON)

if(NOT CMAKE_BUILD_TYPE)
    set(CMAKE_BUILD_TYPE Release CACHE STRING "" FORCE)
endif()

add_compile_options(-Wall -Wextra -Wpedantic -Wconversion -Wno-sign-conversion -Wnon-virtual-dtor
                    -Woverloaded-virtual)
if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
    add_compile_options(-Wno-restrict)  # GCC 12 sees overlaps in std::string's operator+ that are not there
endif()
# Every processor shows the same texts as x86-64: there a product is rounded before something is added to it, and char has a
# sign.
if(NOT CMAKE_SYSTEM_PROCESSOR STREQUAL "x86_64")
    add_compile_options(-ffp-contract=off -fsigned-char)
endif()
if(CMAKE_CXX_COMPILER_ID STREQUAL "Clang")
    add_compile_options(-Wthread-safety)  # data that a lock guards is touched under it (platform/system/Mutex.h)
endif()
if(KELVO_WERROR)
    add_compile_options(-Werror)
endif()
if(KELVO_SANITIZE)
    add_compile_options(-fsanitize=${KELVO_SANITIZE} -fno-omit-frame-pointer -fno-sanitize-recover=all)
    add_link_options(-fsanitize=${KELVO_SANITIZE})
    add_compile_definitions(KELVO_SANITIZED)
    if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
        add_compile_options(-Wno-maybe-uninitialized)  # GCC 12 loses track of std::variant in instrumented code
    endif()
endif()
if(KELVO_FUZZ)
    add_compile_options(-fsanitize=fuzzer-no-link)  # the libraries count their branches for the fuzz targets
endif()

# Headers are included by their path from the root: "platform/values/Value.h".
include_directories(${CMAKE_SOURCE_DIR})
