include(CMakePackageConfigHelpers)

install(TARGETS lumenutility EXPORT LumenUtilityTargets
        LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}
        ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR}
        RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR})
install(DIRECTORY include/lumen DESTINATION ${CMAKE_INSTALL_INCLUDEDIR})
install(EXPORT LumenUtilityTargets NAMESPACE LumenUtility::
        DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/LumenUtility)

configure_package_config_file(cmake/LumenUtilityConfig.cmake.in
  ${PROJECT_BINARY_DIR}/LumenUtilityConfig.cmake
  INSTALL_DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/LumenUtility)
write_basic_package_version_file(${PROJECT_BINARY_DIR}/LumenUtilityConfigVersion.cmake
  COMPATIBILITY SameMajorVersion)
install(FILES ${PROJECT_BINARY_DIR}/LumenUtilityConfig.cmake
              ${PROJECT_BINARY_DIR}/LumenUtilityConfigVersion.cmake
        DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/LumenUtility)

file(RELATIVE_PATH LUMEN_PC_RELATIVE_PREFIX "${CMAKE_INSTALL_FULL_LIBDIR}/pkgconfig"
     "${CMAKE_INSTALL_PREFIX}")
configure_file(cmake/lumenutility.pc.in ${PROJECT_BINARY_DIR}/lumenutility.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/lumenutility.pc
        DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig)
