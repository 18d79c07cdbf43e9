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

# The pkg-config file names the prefix it is installed under, as `cmake --install --prefix`
# or the Debian packages (/usr) give it at install time: pkg-config then recognises
# /usr/include and /usr/lib/<arch> as system directories and keeps them out of the flags,
# which a prefix computed from ${pcfiledir} defeats. A tree unpacked elsewhere is used with
# PKG_CONFIG_SYSROOT_DIR. Everything but the prefix is filled in now.
set(LUMEN_PC_PREFIX "@LUMEN_PC_PREFIX@")
configure_file(cmake/lumenutility.pc.in ${PROJECT_BINARY_DIR}/lumenutility.pc.in @ONLY)
install(CODE "
  # One file per destination, so that installs into different places may run at once.
  string(MD5 lumen_pc_key \"\$ENV{DESTDIR}\${CMAKE_INSTALL_PREFIX}\")
  set(lumen_pc \"${PROJECT_BINARY_DIR}/pkgconfig-\${lumen_pc_key}/lumenutility.pc\")
  set(LUMEN_PC_PREFIX \"\${CMAKE_INSTALL_PREFIX}\")
  configure_file(\"${PROJECT_BINARY_DIR}/lumenutility.pc.in\" \"\${lumen_pc}\" @ONLY)
  file(INSTALL \"\${lumen_pc}\" DESTINATION \"\${CMAKE_INSTALL_PREFIX}/${CMAKE_INSTALL_LIBDIR}/pkgconfig\")
" COMPONENT development)
