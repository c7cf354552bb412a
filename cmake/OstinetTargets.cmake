# SPDX-License-Identifier: MIT
# One object target a folder, which links only the folders below it.

define_property(GLOBAL PROPERTY OSTINET_COMPONENTS BRIEF_DOCS "All components" FULL_DOCS "All components")

# ostinet_component(core SOURCES a.cpp b.cpp [DEPENDS other...] [LIBRARIES external...])
function(ostinet_component name)
  cmake_parse_arguments(ARG "" "" "SOURCES;DEPENDS;LIBRARIES" ${ARGN})
  set(target ostinet_${name})
  add_library(${target} OBJECT ${ARG_SOURCES})
  target_compile_definitions(${target} PRIVATE OSTINET_BUILDING)
  target_include_directories(${target} PUBLIC ${PROJECT_SOURCE_DIR}/include ${PROJECT_SOURCE_DIR}/src)
  list(TRANSFORM ARG_DEPENDS PREPEND ostinet_)
  target_link_libraries(${target} PRIVATE ostinet_settings
    PUBLIC ${ARG_DEPENDS} ${ARG_LIBRARIES} Boost::headers Threads::Threads)
  set_property(GLOBAL APPEND PROPERTY OSTINET_COMPONENTS ${target})
endfunction()

# The shared library for hosts, and the same objects as a static one whose insides tests may reach.
function(ostinet_library)
  get_property(components GLOBAL PROPERTY OSTINET_COMPONENTS)
  add_library(ostinet SHARED)
  add_library(Ostinet::ostinet ALIAS ostinet)
  add_library(ostinet_internals STATIC)
  foreach(component IN LISTS components)
    foreach(library ostinet ostinet_internals)
      target_sources(${library} PRIVATE $<TARGET_OBJECTS:${component}>)
    endforeach()
    target_link_libraries(ostinet PRIVATE $<BUILD_INTERFACE:${component}>)
    target_link_libraries(ostinet_internals PUBLIC $<BUILD_INTERFACE:${component}>)
  endforeach()
  target_include_directories(ostinet PUBLIC
    $<BUILD_INTERFACE:${PROJECT_SOURCE_DIR}/include> $<INSTALL_INTERFACE:include>)
  target_link_libraries(ostinet PUBLIC Boost::headers PRIVATE ostinet_settings)
  target_compile_definitions(ostinet_internals PUBLIC OSTINET_STATIC)
  set_target_properties(ostinet PROPERTIES VERSION ${PROJECT_VERSION} SOVERSION 0)
endfunction()

# ostinet_tests(core SOURCES ...): one program a folder; each test runs in a process of its own.
function(ostinet_tests name)
  cmake_parse_arguments(ARG "" "" "SOURCES;LIBRARIES" ${ARGN})
  set(target ${name}_tests)
  add_executable(${target} ${ARG_SOURCES})
  target_include_directories(${target} PRIVATE ${PROJECT_SOURCE_DIR}/tests)
  target_link_libraries(${target} PRIVATE ostinet_internals ostinet_settings ${ARG_LIBRARIES}
    GTest::gmock_main)
  gtest_discover_tests(${target} DISCOVERY_MODE PRE_TEST PROPERTIES LABELS ${name} TIMEOUT 120)
endfunction()
