# SPDX-License-Identifier: MIT
# Everything from outside, found once for all folders:
#
#   Boost::headers  EXPAT::EXPAT  utf8proc::utf8proc  nlohmann_json::nlohmann_json  CLI11::CLI11
#   Threads::Threads  GTest::gmock_main  benchmark::benchmark
#   RtMidi::RtMidi  Jack::Jack (not on Windows)
#
# The Windows build finds its own in build/windows-deps, where scripts/windows-dependencies puts
# them; the toolchain file sees to it that nothing of the building machine is found instead.

find_package(Threads REQUIRED)
find_package(Boost 1.74 REQUIRED)
find_package(EXPAT 2.5 REQUIRED)

find_path(UTF8PROC_INCLUDE_DIR utf8proc.h REQUIRED)
find_library(UTF8PROC_LIBRARY utf8proc REQUIRED)
mark_as_advanced(UTF8PROC_INCLUDE_DIR UTF8PROC_LIBRARY)
add_library(utf8proc::utf8proc UNKNOWN IMPORTED)
set_target_properties(utf8proc::utf8proc PROPERTIES
  IMPORTED_LOCATION ${UTF8PROC_LIBRARY}
  INTERFACE_INCLUDE_DIRECTORIES ${UTF8PROC_INCLUDE_DIR})

# Both are header-only.
foreach(package IN ITEMS nlohmann_json:nlohmann/json.hpp CLI11:CLI/CLI.hpp)
  string(REPLACE ":" ";" package "${package}")
  list(GET package 0 name)
  list(GET package 1 header)
  find_path(${name}_INCLUDE_DIR ${header} REQUIRED)
  mark_as_advanced(${name}_INCLUDE_DIR)
  if(NOT TARGET ${name}::${name})
    add_library(${name}::${name} INTERFACE IMPORTED)
    set_target_properties(${name}::${name} PROPERTIES
      INTERFACE_INCLUDE_DIRECTORIES ${${name}_INCLUDE_DIR})
  endif()
endforeach()

if(WIN32)
  # Linked in statically, so that a host ships one DLL.
  set_property(TARGET EXPAT::EXPAT APPEND PROPERTY INTERFACE_COMPILE_DEFINITIONS XML_STATIC)
  set_property(TARGET utf8proc::utf8proc APPEND PROPERTY
    INTERFACE_COMPILE_DEFINITIONS UTF8PROC_STATIC)
else()
  find_path(RTMIDI_INCLUDE_DIR RtMidi.h PATH_SUFFIXES rtmidi REQUIRED)
  find_library(RTMIDI_LIBRARY rtmidi REQUIRED)
  mark_as_advanced(RTMIDI_INCLUDE_DIR RTMIDI_LIBRARY)
  add_library(RtMidi::RtMidi UNKNOWN IMPORTED)
  set_target_properties(RtMidi::RtMidi PROPERTIES
    IMPORTED_LOCATION ${RTMIDI_LIBRARY}
    INTERFACE_INCLUDE_DIRECTORIES ${RTMIDI_INCLUDE_DIR})

  find_path(JACK_INCLUDE_DIR jack/jack.h REQUIRED)
  find_library(JACK_LIBRARY jack REQUIRED)
  mark_as_advanced(JACK_INCLUDE_DIR JACK_LIBRARY)
  add_library(Jack::Jack UNKNOWN IMPORTED)
  set_target_properties(Jack::Jack PROPERTIES
    IMPORTED_LOCATION ${JACK_LIBRARY}
    INTERFACE_INCLUDE_DIRECTORIES ${JACK_INCLUDE_DIR})
endif()

if(OSTINET_BUILD_TESTS)
  include(GoogleTest)
  if(OSTINET_SANITIZE OR CMAKE_CROSSCOMPILING)
    set(INSTALL_GTEST OFF)
    set(gtest_disable_pthreads OFF)
    add_subdirectory(/usr/src/googletest ${PROJECT_BINARY_DIR}/googletest EXCLUDE_FROM_ALL SYSTEM)
  else()
    find_package(GTest 1.12 REQUIRED)
  endif()
endif()
if(OSTINET_BUILD_BENCH)
  find_package(benchmark REQUIRED)
endif()
