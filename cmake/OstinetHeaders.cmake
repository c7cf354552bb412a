# SPDX-License-Identifier: MIT
# Each header under include/ compiles alone, in C++17 and in C++20: the target ostinet_headers.

function(ostinet_header_checks)
  file(GLOB_RECURSE headers CONFIGURE_DEPENDS RELATIVE ${PROJECT_SOURCE_DIR}/include
    ${PROJECT_SOURCE_DIR}/include/*.h)
  add_custom_target(ostinet_headers)
  foreach(standard IN ITEMS 17 20)
    set(sources "")
    foreach(header IN LISTS headers)
      string(REPLACE "/" "_" name ${header})
      set(source ${PROJECT_BINARY_DIR}/headers/${standard}/${name}.cpp)
      # Twice, so that a header without its guard is found too.
      file(CONFIGURE OUTPUT ${source} CONTENT "#include \"${header}\"\n#include \"${header}\"\n")
      list(APPEND sources ${source})
    endforeach()
    set(target ostinet_headers_${standard})
    add_library(${target} OBJECT EXCLUDE_FROM_ALL ${sources})
    set_target_properties(${target} PROPERTIES CXX_STANDARD ${standard})
    target_include_directories(${target} PRIVATE ${PROJECT_SOURCE_DIR}/include)
    target_link_libraries(${target} PRIVATE ostinet_settings Boost::headers)
    add_dependencies(ostinet_headers ${target})
  endforeach()
endfunction()
