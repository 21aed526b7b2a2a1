# What every target of the project is compiled with.
set(CMAKE_CXX_STANDARD 20)
set(CMAKE_CXX_STANDARD_REQUIRED ON)
set(CMAKE_CXX_EXTENSIONS OFF)
set(CMAKE_POSITION_INDEPENDENT_CODE ON)
set(CMAKE_CXX_VISIBILITY_PRESET hidden)
set(CMAKE_VISIBILITY_INLINES_HIDDEN ON)
set(CMAKE_EXPORT_COMPILE_COMMANDS ON)

if(NOT CMAKE_BUILD_TYPE AND NOT CMAKE_CONFIGURATION_TYPES)
  set(CMAKE_BUILD_TYPE Release)
endif()

find_program(CCACHE_PROGRAM ccache)
if(CCACHE_PROGRAM AND NOT CMAKE_CXX_COMPILER_LAUNCHER)
  # Without this, ccache leaves alone what includes a precompiled header.
  set(CMAKE_CXX_COMPILER_LAUNCHER
    "${CMAKE_COMMAND}" -E env CCACHE_SLOPPINESS=pch_defines,time_macros "${CCACHE_PROGRAM}")
endif()

# Specified results are bit-exact: no contraction into fused multiply-add, on any compiler.
add_library(tarnell_settings INTERFACE)
target_compile_options(tarnell_settings INTERFACE
  -ffp-contract=off -Wall -Wextra -Wpedantic -Wshadow -Wconversion -Wsign-conversion -Wold-style-cast
  -Wnon-virtual-dtor -Woverloaded-virtual -Wcast-qual -Wformat=2 -Wundef -Wimplicit-fallthrough)
if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU" AND CMAKE_CXX_COMPILER_VERSION VERSION_LESS 13)
  # gcc 12 sees overlaps inside std::string's operator+ that are not there (its bug 105329).
  target_compile_options(tarnell_settings INTERFACE -Wno-restrict)
endif()
if(TARNELL_FBX_DEVELOPER)
  target_compile_options(tarnell_settings INTERFACE -Werror)
endif()
if(TARNELL_FBX_COVERAGE)
  target_compile_options(tarnell_settings INTERFACE -fprofile-instr-generate -fcoverage-mapping)
  target_link_options(tarnell_settings INTERFACE -fprofile-instr-generate)
endif()
if(TARNELL_FBX_SANITIZE)
  target_compile_options(tarnell_settings INTERFACE
    -fsanitize=${TARNELL_FBX_SANITIZE} -fno-omit-frame-pointer -fno-sanitize-recover=all)
  target_link_options(tarnell_settings INTERFACE -fsanitize=${TARNELL_FBX_SANITIZE})
endif()
