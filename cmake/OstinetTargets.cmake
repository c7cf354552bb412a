# SPDX-License-Identifier: MIT
# One object target a folder, which links only the folders below it.

define_property(GLOBAL PROPERTY OSTINET_COMPONENTS BRIEF_DOCS "All components")

# ostinet_folders(src/core ...): adds each folder that is there.
macro(ostinet_folders)
  foreach(folder IN ITEMS ${ARGN})
    if(EXISTS ${CMAKE_CURRENT_SOURCE_DIR}/${folder}/CMakeLists.txt)
      add_subdirectory(${folder})
    endif()
  endforeach()
endmacro()

# ostinet_component(core SOURCES a.cpp b.cpp [DEPENDS other...] [LIBRARIES external...])
function(ostinet_component name)
  cmake_parse_arguments(ARG "" "" "SOURCES;DEPENDS;LIBRARIES" ${ARGN})
  set(target ostinet_${name})
  add_library(${target} OBJECT ${ARG_SOURCES})
  target_compile_definitions(${target} PRIVATE OSTINET_BUILDING)
  target_include_directories(${target} PUBLIC
    ${PROJECT_SOURCE_DIR}/include ${PROJECT_SOURCE_DIR}/src)
  list(TRANSFORM ARG_DEPENDS PREPEND ostinet_)
  target_link_libraries(${target} PRIVATE ostinet_settings
    PUBLIC ${ARG_DEPENDS} ${ARG_LIBRARIES} Boost::headers Threads::Threads)
  if(OSTINET_PRECOMPILE)
    target_precompile_headers(${target} PRIVATE ${OSTINET_PRECOMPILED})
  endif()
  set_property(GLOBAL APPEND PROPERTY OSTINET_COMPONENTS ${target})
endfunction()

# The shared library for hosts, and the same objects as a static one whose insides tests may reach.
function(ostinet_library)
  get_property(components GLOBAL PROPERTY OSTINET_COMPONENTS)
  add_library(ostinet SHARED)
  add_library(Ostinet::ostinet ALIAS ostinet)
  add_library(ostinet_internals STATIC)
  target_link_libraries(ostinet PRIVATE ${components} ostinet_settings PUBLIC Boost::headers)
  target_link_libraries(ostinet_internals PUBLIC ${components})
  target_include_directories(ostinet PUBLIC
    $<BUILD_INTERFACE:${PROJECT_SOURCE_DIR}/include> $<INSTALL_INTERFACE:include>)
  target_compile_definitions(ostinet_internals PUBLIC OSTINET_STATIC)
  set_target_properties(ostinet PROPERTIES VERSION ${PROJECT_VERSION} SOVERSION 0)
  if(NOT WIN32)
    set(map ${PROJECT_SOURCE_DIR}/cmake/ostinet.map)
    target_link_options(ostinet PRIVATE LINKER:--version-script=${map})
    set_target_properties(ostinet PROPERTIES LINK_DEPENDS ${map})
    if(NOT OSTINET_SANITIZE)
      target_link_options(ostinet PRIVATE LINKER:--no-undefined)
    endif()
  endif()
endfunction()

# What most files read, and what costs most to read. The dev and release presets do without it in the
# library, so that a file that leans on it does not go unnoticed.
set(OSTINET_PRECOMPILED
  <algorithm> <atomic> <filesystem> <functional> <map> <memory> <mutex> <string> <vector>
  <boost/bind/bind.hpp> <boost/function.hpp> <boost/operators.hpp> <boost/optional.hpp>
  <boost/shared_ptr.hpp> <boost/variant.hpp>)

# All test programs share one precompiled header.
function(ostinet_precompile_for_tests target)
  if(NOT TARGET ostinet_tests_precompiled)
    # A program like those that use it, for the compiler asks that all flags be the same.
    file(CONFIGURE OUTPUT ${PROJECT_BINARY_DIR}/precompiled.cpp CONTENT "int main() {}\n")
    add_executable(ostinet_tests_precompiled EXCLUDE_FROM_ALL ${PROJECT_BINARY_DIR}/precompiled.cpp)
    target_link_libraries(ostinet_tests_precompiled PRIVATE ostinet_internals ostinet_settings
      GTest::gmock_main)
    target_precompile_headers(ostinet_tests_precompiled PRIVATE <gmock/gmock.h> <gtest/gtest.h>
      ${OSTINET_PRECOMPILED})
  endif()
  target_precompile_headers(${target} REUSE_FROM ostinet_tests_precompiled)
endfunction()

# ostinet_tests(core SOURCES ... [LIBRARIES ...]): one program a folder; each test runs in a process
# of its own.
function(ostinet_tests name)
  cmake_parse_arguments(ARG "" "" "SOURCES;LIBRARIES" ${ARGN})
  set(target ${name}_tests)
  add_executable(${target} ${ARG_SOURCES})
  target_include_directories(${target} PRIVATE ${PROJECT_SOURCE_DIR}/tests)
  target_link_libraries(${target} PRIVATE ostinet_internals ostinet_settings ${ARG_LIBRARIES}
    GTest::gmock_main)
  ostinet_precompile_for_tests(${target})
  # Compiled together under every preset: reading GoogleTest is most of their cost.
  set_target_properties(${target} PROPERTIES UNITY_BUILD ON)
  gtest_discover_tests(${target} DISCOVERY_MODE PRE_TEST DISCOVERY_TIMEOUT 60
    PROPERTIES LABELS ${name} TIMEOUT 120)
endfunction()
