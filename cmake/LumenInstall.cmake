include(CMakePackageConfigHelpers)

# Install components, one per Debian package (cmake/Packaging.cmake): `runtime` is the shared
# library a program loads, `development` what building against it needs, `tool` lumenutil.
install(TARGETS lumenutility EXPORT LumenUtilityTargets
        LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT runtime
                NAMELINK_COMPONENT development
        ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT development
        RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR} COMPONENT runtime)
install(DIRECTORY include/lumen DESTINATION ${CMAKE_INSTALL_INCLUDEDIR} COMPONENT development)
install(EXPORT LumenUtilityTargets NAMESPACE LumenUtility::
        DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/LumenUtility COMPONENT development)

configure_package_config_file(cmake/LumenUtilityConfig.cmake.in
  ${PROJECT_BINARY_DIR}/LumenUtilityConfig.cmake
  INSTALL_DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/LumenUtility)
write_basic_package_version_file(${PROJECT_BINARY_DIR}/LumenUtilityConfigVersion.cmake
  COMPATIBILITY SameMajorVersion)
install(FILES ${PROJECT_BINARY_DIR}/LumenUtilityConfig.cmake
              ${PROJECT_BINARY_DIR}/LumenUtilityConfigVersion.cmake
        DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/LumenUtility COMPONENT development)

file(RELATIVE_PATH LUMEN_PC_RELATIVE_PREFIX "${CMAKE_INSTALL_FULL_LIBDIR}/pkgconfig"
     "${CMAKE_INSTALL_PREFIX}")
configure_file(cmake/lumenutility.pc.in ${PROJECT_BINARY_DIR}/lumenutility.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/lumenutility.pc
        DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig COMPONENT development)
