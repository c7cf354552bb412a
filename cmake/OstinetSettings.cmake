# SPDX-License-Identifier: MIT
# What every target of the project is compiled with.

set(CMAKE_CXX_STANDARD 20)
set(CMAKE_CXX_STANDARD_REQUIRED ON)
set(CMAKE_CXX_EXTENSIONS OFF)
set(CMAKE_CXX_VISIBILITY_PRESET hidden)
set(CMAKE_VISIBILITY_INLINES_HIDDEN ON)
set(CMAKE_POSITION_INDEPENDENT_CODE ON)
set(CMAKE_EXPORT_COMPILE_COMMANDS ON)

# Programs and the library lie side by side, so that on Windows each program finds the DLL.
set(CMAKE_RUNTIME_OUTPUT_DIRECTORY ${PROJECT_BINARY_DIR}/bin)
set(CMAKE_LIBRARY_OUTPUT_DIRECTORY ${PROJECT_BINARY_DIR}/lib)
set(CMAKE_ARCHIVE_OUTPUT_DIRECTORY ${PROJECT_BINARY_DIR}/lib)

if(NOT CMAKE_BUILD_TYPE AND NOT CMAKE_CONFIGURATION_TYPES)
  set(CMAKE_BUILD_TYPE Release CACHE STRING "Debug, Release, RelWithDebInfo or MinSizeRel" FORCE)
endif()

option(OSTINET_BUILD_TESTS "Build the tests" ${PROJECT_IS_TOP_LEVEL})
option(OSTINET_BUILD_EXAMPLES "Build the example hosts" ${PROJECT_IS_TOP_LEVEL})
option(OSTINET_BUILD_BENCH "Build the benchmarks" OFF)
option(OSTINET_BUILD_FUZZ "Build the fuzz targets (clang)" OFF)
option(OSTINET_WARNINGS_AS_ERRORS "Treat warnings as errors" ${PROJECT_IS_TOP_LEVEL})
option(OSTINET_PRECOMPILE "Precompile headers for the library too, which saves time" OFF)
set(OSTINET_SANITIZE "" CACHE STRING "Value for -fsanitize=, empty for none")

# Documents of real instruments, which are no part of the tree.
set(OSTINET_NAME_CORPUS "${PROJECT_SOURCE_DIR}/../shared/corpus/midnam" CACHE PATH
  "Folder of name documents that tests and benchmarks read, where it is there")

find_program(CCACHE_PROGRAM ccache)
if(CCACHE_PROGRAM AND NOT CMAKE_CXX_COMPILER_LAUNCHER)
  # Paths are told relative to the tree, so that clones share what they compiled, and precompiled
  # headers do not hinder the cache.
  set(CMAKE_CXX_COMPILER_LAUNCHER ${CMAKE_COMMAND} -E env
    CCACHE_BASEDIR=${PROJECT_SOURCE_DIR} CCACHE_NOHASHDIR=1
    CCACHE_SLOPPINESS=pch_defines,time_macros,include_file_mtime,include_file_ctime
    ${CCACHE_PROGRAM})
endif()

add_library(ostinet_settings INTERFACE)
target_compile_options(ostinet_settings INTERFACE
  -Wall -Wextra -Wpedantic -Wshadow -Wconversion
  $<$<CXX_COMPILER_ID:Clang>:-Wthread-safety>
  # g++ 12 sees overlapping copies in the sum of a literal and a std::string, once it optimises.
  $<$<AND:$<CXX_COMPILER_ID:GNU>,$<VERSION_LESS:$<CXX_COMPILER_VERSION>,13>>:-Wno-restrict>
  # Optimising, GCC 12 takes the small buffers of boost::function and std::optional for unset.
  $<$<CXX_COMPILER_ID:GNU>:-Wno-maybe-uninitialized>
  $<$<AND:$<CXX_COMPILER_ID:GNU>,$<BOOL:${WIN32}>>:-Wno-uninitialized>
  # Nor does it know that the distance between two ends of a vector is never negative.
  $<$<AND:$<CXX_COMPILER_ID:GNU>,$<NOT:$<CONFIG:Debug>>>:-Wno-stringop-overread>
  $<$<AND:$<CXX_COMPILER_ID:GNU>,$<NOT:$<CONFIG:Debug>>>:-Wno-stringop-overflow>
  # Where files are compiled together, what one has in its unnamed namespace may be its member.
  $<$<AND:$<CXX_COMPILER_ID:GNU>,$<BOOL:${CMAKE_UNITY_BUILD}>>:-Wno-subobject-linkage>
  # Without a time in them, precompiled headers made anew are the same to the compiler cache.
  "$<$<CXX_COMPILER_ID:Clang>:SHELL:-Xclang -fno-pch-timestamp>"
  $<$<BOOL:${OSTINET_WARNINGS_AS_ERRORS}>:-Werror>)

# Sanitizers see everything that is compiled here, GoogleTest included.
if(OSTINET_SANITIZE)
  add_compile_options(-fsanitize=${OSTINET_SANITIZE} -fno-sanitize-recover=all
    -fno-omit-frame-pointer)
  add_link_options(-fsanitize=${OSTINET_SANITIZE})
endif()
