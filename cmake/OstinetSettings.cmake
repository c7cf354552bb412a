# SPDX-License-Identifier: MIT
# What every target of the project is compiled with.

set(CMAKE_CXX_STANDARD 20)
set(CMAKE_CXX_STANDARD_REQUIRED ON)
set(CMAKE_CXX_EXTENSIONS OFF)
set(CMAKE_CXX_VISIBILITY_PRESET hidden)
set(CMAKE_VISIBILITY_INLINES_HIDDEN ON)
set(CMAKE_POSITION_INDEPENDENT_CODE ON)
set(CMAKE_EXPORT_COMPILE_COMMANDS ON)

option(OSTINET_BUILD_TESTS "Build the tests" ON)
option(OSTINET_BUILD_BENCH "Build the benchmarks" OFF)
option(OSTINET_WARNINGS_AS_ERRORS "Treat warnings as errors" ON)
set(OSTINET_SANITIZE "" CACHE STRING "Value for -fsanitize=, empty for none")

find_program(CCACHE_PROGRAM ccache)
if(CCACHE_PROGRAM AND NOT CMAKE_CXX_COMPILER_LAUNCHER)
  set(CMAKE_CXX_COMPILER_LAUNCHER ${CCACHE_PROGRAM})
endif()

add_library(ostinet_settings INTERFACE)
target_compile_options(ostinet_settings INTERFACE
  -Wall -Wextra -Wpedantic -Wshadow -Wconversion
  $<$<BOOL:${OSTINET_WARNINGS_AS_ERRORS}>:-Werror>)
if(OSTINET_SANITIZE)
  target_compile_options(ostinet_settings INTERFACE
    -fsanitize=${OSTINET_SANITIZE} -fno-sanitize-recover=all -fno-omit-frame-pointer)
  target_link_options(ostinet_settings INTERFACE -fsanitize=${OSTINET_SANITIZE})
endif()

find_package(Threads REQUIRED)
find_package(Boost 1.74 REQUIRED)
