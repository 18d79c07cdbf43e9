# The manual page of lumenutil, written by hand in tools/man/lumenutil.1: compressed as Debian
# wants it (gzip -9n keeps neither name nor time, so two builds give the same bytes),
# installed with the tool, and checked to render without warnings.
if(NOT LUMEN_BUILD_TOOLS)
  return()
endif()

set(LUMEN_MAN_PAGE ${PROJECT_SOURCE_DIR}/tools/man/lumenutil.1)
set(LUMEN_MAN_PAGE_GZ ${PROJECT_BINARY_DIR}/man/lumenutil.1.gz)
add_custom_command(OUTPUT ${LUMEN_MAN_PAGE_GZ}
  COMMAND ${CMAKE_COMMAND} -E make_directory ${PROJECT_BINARY_DIR}/man
  COMMAND sh -c "gzip -9n -c \"$0\" > \"$1\"" ${LUMEN_MAN_PAGE} ${LUMEN_MAN_PAGE_GZ}
  DEPENDS ${LUMEN_MAN_PAGE}
  COMMENT "Compressing the manual page of lumenutil"
  VERBATIM)
add_custom_target(lumenutil_man_page ALL DEPENDS ${LUMEN_MAN_PAGE_GZ})
install(FILES ${LUMEN_MAN_PAGE_GZ} DESTINATION ${CMAKE_INSTALL_MANDIR}/man1 COMPONENT tool)

if(LUMEN_BUILD_TESTS)
  add_test(NAME ManPageRendersWithoutWarnings
           COMMAND bash ${PROJECT_SOURCE_DIR}/tools/man/check_man_page.sh ${LUMEN_MAN_PAGE}
                   ${PROJECT_VERSION} $<TARGET_FILE:lumenutil>)
endif()
