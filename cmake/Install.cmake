# The installed package: find_package(cimdelta) gives cimdelta::host, cimdelta::zelcore and cimdelta::delta.
include(CMakePackageConfigHelpers)

set(cimdelta_config_dir ${CMAKE_INSTALL_LIBDIR}/cmake/cimdelta)

install(TARGETS host zelcore delta cimdelta EXPORT cimdelta-targets
  RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR}
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}
  FILE_SET HEADERS DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/cimdelta)
install(EXPORT cimdelta-targets NAMESPACE cimdelta:: DESTINATION ${cimdelta_config_dir})
configure_package_config_file(cmake/Config.cmake.in ${PROJECT_BINARY_DIR}/cimdelta-config.cmake INSTALL_DESTINATION ${cimdelta_config_dir})
write_basic_package_version_file(${PROJECT_BINARY_DIR}/cimdelta-config-version.cmake COMPATIBILITY SameMinorVersion)
install(FILES ${PROJECT_BINARY_DIR}/cimdelta-config.cmake ${PROJECT_BINARY_DIR}/cimdelta-config-version.cmake
  DESTINATION ${cimdelta_config_dir})
