# SPDX-License-Identifier: MIT
# What hosts get: the library, its headers and data, the host kit, and ways to find them.

include(GNUInstallDirs)
include(CMakePackageConfigHelpers)

set(libraries ostinet)
if(TARGET ostinet_hostkit)
  list(APPEND libraries ostinet_hostkit)
  set_target_properties(ostinet_hostkit PROPERTIES EXPORT_NAME hostkit)
endif()
install(TARGETS ${libraries} EXPORT OstinetTargets
  RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR}
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}
  ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR})

install(DIRECTORY ${PROJECT_SOURCE_DIR}/include/ DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}
  FILES_MATCHING PATTERN "*.h")
if(IS_DIRECTORY ${PROJECT_SOURCE_DIR}/hostkit/include)
  install(DIRECTORY ${PROJECT_SOURCE_DIR}/hostkit/include/ DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}
    FILES_MATCHING PATTERN "*.h")
endif()
if(IS_DIRECTORY ${PROJECT_SOURCE_DIR}/data)
  install(DIRECTORY ${PROJECT_SOURCE_DIR}/data/ DESTINATION ${CMAKE_INSTALL_DATADIR}/ostinet
    PATTERN "CMakeLists.txt" EXCLUDE PATTERN "tables" EXCLUDE)
endif()
install(FILES ${PROJECT_SOURCE_DIR}/LICENSE DESTINATION ${CMAKE_INSTALL_DOCDIR})

set(package_folder ${CMAKE_INSTALL_LIBDIR}/cmake/Ostinet)
install(EXPORT OstinetTargets NAMESPACE Ostinet:: DESTINATION ${package_folder})
configure_package_config_file(${CMAKE_CURRENT_LIST_DIR}/OstinetConfig.cmake.in
  ${PROJECT_BINARY_DIR}/OstinetConfig.cmake INSTALL_DESTINATION ${package_folder})
write_basic_package_version_file(${PROJECT_BINARY_DIR}/OstinetConfigVersion.cmake
  COMPATIBILITY SameMinorVersion)
install(FILES ${PROJECT_BINARY_DIR}/OstinetConfig.cmake
  ${PROJECT_BINARY_DIR}/OstinetConfigVersion.cmake DESTINATION ${package_folder})

configure_file(${CMAKE_CURRENT_LIST_DIR}/ostinet.pc.in ${PROJECT_BINARY_DIR}/ostinet.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/ostinet.pc DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig)
