# Debian packages of the build, one per install component:
#   liblumenutility1      the shared library (component runtime)
#   liblumenutility-dev   headers, the unversioned link, CMake package and pkg-config files
#                         (component development)
#   lumenutil             the tool and its manual page (component tool)
# `cpack -G DEB` in the build directory writes them (scripts/package.sh does the whole job).
# Only these components are packaged: whatever a test, benchmark or fuzz target installs, or a
# target without a component, stays out.
set(LUMEN_DEB_LIBRARY liblumenutility${PROJECT_VERSION_MAJOR})
set(LUMEN_DEB_MAINTAINER "lumen-utility maintainers <maintainers@lumen-utility.example>")

# The SONAME carries the major version, and the runtime package is named after it.
get_target_property(lumen_soversion lumenutility SOVERSION)
if(NOT lumen_soversion STREQUAL PROJECT_VERSION_MAJOR)
  message(FATAL_ERROR "liblumenutility.so.${lumen_soversion} would be packaged as "
                      "${LUMEN_DEB_LIBRARY}: the SONAME version and the package name differ")
endif()

# The changelog's newest entry is the version the packages carry.
file(STRINGS ${PROJECT_SOURCE_DIR}/packaging/changelog lumen_changelog_head LIMIT_COUNT 1)
if(NOT lumen_changelog_head MATCHES "^lumen-utility \\(${PROJECT_VERSION}\\) ")
  message(FATAL_ERROR "packaging/changelog starts with '${lumen_changelog_head}'; add an "
                      "entry for version ${PROJECT_VERSION} on top")
endif()

# Each package carries its copyright file and the changelog, compressed without name or time
# so that two builds give the same bytes.
set(lumen_changelog_gz ${PROJECT_BINARY_DIR}/packaging/changelog.gz)
add_custom_command(OUTPUT ${lumen_changelog_gz}
  COMMAND ${CMAKE_COMMAND} -E make_directory ${PROJECT_BINARY_DIR}/packaging
  COMMAND sh -c "gzip -9n -c \"$0\" > \"$1\"" ${PROJECT_SOURCE_DIR}/packaging/changelog
          ${lumen_changelog_gz}
  DEPENDS ${PROJECT_SOURCE_DIR}/packaging/changelog
  VERBATIM)
add_custom_target(lumen_package_changelog ALL DEPENDS ${lumen_changelog_gz})

set(lumen_components runtime development)
set(lumen_packages ${LUMEN_DEB_LIBRARY} liblumenutility-dev)
if(LUMEN_BUILD_TOOLS)
  list(APPEND lumen_components tool)
  list(APPEND lumen_packages lumenutil)
endif()
foreach(component package IN ZIP_LISTS lumen_components lumen_packages)
  install(FILES ${PROJECT_SOURCE_DIR}/packaging/copyright ${lumen_changelog_gz}
          DESTINATION ${CMAKE_INSTALL_DATAROOTDIR}/doc/${package} COMPONENT ${component})
endforeach()

set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME lumen-utility)
set(CPACK_PACKAGE_VERSION ${PROJECT_VERSION})
set(CPACK_PACKAGE_VENDOR "lumen-utility developers")
set(CPACK_PACKAGE_CONTACT "${LUMEN_DEB_MAINTAINER}")
set(CPACK_PACKAGE_DIRECTORY ${PROJECT_BINARY_DIR}/packages)
set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
set(CPACK_STRIP_FILES ON)
set(CPACK_COMPONENTS_ALL ${lumen_components})

set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_MAINTAINER "${LUMEN_DEB_MAINTAINER}")
set(CPACK_DEBIAN_PACKAGE_SOURCE lumen-utility)
set(CPACK_DEBIAN_PACKAGE_PRIORITY optional)
set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)
# Run-time dependencies come from the binaries (dpkg-shlibdeps); the packages of the same
# build depend on each other at exactly this version.
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
# dpkg-shlibdeps runs in each component's staging directory; the tool's finds the library it
# links in the runtime component's tree beside it (its dependency is the exact one below).
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS ../runtime/usr/${CMAKE_INSTALL_LIBDIR})
set(CPACK_DEBIAN_ENABLE_COMPONENT_DEPENDS ON)
set(CPACK_COMPONENT_DEVELOPMENT_DEPENDS runtime)
set(CPACK_COMPONENT_TOOL_DEPENDS runtime)

set(CPACK_DEBIAN_RUNTIME_PACKAGE_NAME ${LUMEN_DEB_LIBRARY})
set(CPACK_DEBIAN_RUNTIME_PACKAGE_SECTION libs)
# A shlibs file, so that programs built against the library depend on this version or later
# (only the runtime package holds a shared object).
set(CPACK_DEBIAN_PACKAGE_GENERATE_SHLIBS ON)
set(CPACK_DEBIAN_PACKAGE_GENERATE_SHLIBS_POLICY ">=")
# The linker cache is refreshed through dpkg's ldconfig trigger, as Debian wants; the package's
# own postinst and postrm keep CPack from writing scripts that call ldconfig directly.
set(CPACK_DEBIAN_RUNTIME_PACKAGE_CONTROL_EXTRA ${PROJECT_SOURCE_DIR}/packaging/triggers
    ${PROJECT_SOURCE_DIR}/packaging/postinst ${PROJECT_SOURCE_DIR}/packaging/postrm)
set(CPACK_DEBIAN_RUNTIME_DESCRIPTION
"utility library of vector network analyzer measurement software
lumen-utility is the shared C++ library of a vector network analyzer's
measurement software: complex values and trace formats, stimulus arrays,
interpolation, Touchstone and CSV readers, phase-coherent acquisition,
property bags, interprocess messages, shared-memory data capture,
diagnostics, global instrument settings and ZIP archiving.

This package holds the shared library.")

set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_NAME liblumenutility-dev)
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_SECTION libdevel)
# The public headers include Boost headers (shared_ptr, function, any).
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_DEPENDS "libboost-dev (>= 1.74)")
set(CPACK_DEBIAN_DEVELOPMENT_DESCRIPTION
"utility library of vector network analyzer software - development files
lumen-utility is the shared C++ library of a vector network analyzer's
measurement software.

This package holds the C++20 headers, the link library, the CMake package
(find_package(LumenUtility), target LumenUtility::lumenutility) and the
pkg-config file (lumenutility).")

set(CPACK_DEBIAN_TOOL_PACKAGE_NAME lumenutil)
set(CPACK_DEBIAN_TOOL_PACKAGE_SECTION electronics)
set(CPACK_DEBIAN_TOOL_DESCRIPTION
"command-line tool for network analyzer measurement files
lumenutil reads, exports, plots, resamples, converts and compares Touchstone
files, reads phase calibration files of a phase reference, packs and unpacks
ZIP archives, maps analyzer error codes to error numbers and reads data
capture blocks from shared memory.")

include(CPack)
