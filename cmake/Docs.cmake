# API reference: `cmake --build <dir> --target docs` runs Doxygen over include/lumen/ and
# writes HTML into <dir>/docs/html. A public class or function without a comment, or a
# comment Doxygen cannot read, fails the target; the warnings are also in
# <dir>/docs/warnings.log.
find_package(Doxygen 1.9 QUIET)
if(NOT DOXYGEN_FOUND)
  message(STATUS "Doxygen not found: the docs target is not available")
  return()
endif()

set(LUMEN_DOCS_OUTPUT ${PROJECT_BINARY_DIR}/docs)
set(LUMEN_DOCS_WARN_AS_ERROR FAIL_ON_WARNINGS CACHE STRING
    "Doxygen's WARN_AS_ERROR for the docs target (FAIL_ON_WARNINGS, YES or NO)")
configure_file(${PROJECT_SOURCE_DIR}/docs/Doxyfile.in ${LUMEN_DOCS_OUTPUT}/Doxyfile @ONLY)

# Doxygen runs on every build of the target: it takes a few seconds, and a failed run still
# leaves HTML behind that a file-based rule would take as up to date.
add_custom_target(docs
  COMMAND ${CMAKE_COMMAND} -E rm -f ${LUMEN_DOCS_OUTPUT}/warnings.log
  COMMAND Doxygen::doxygen ${LUMEN_DOCS_OUTPUT}/Doxyfile
  WORKING_DIRECTORY ${LUMEN_DOCS_OUTPUT}
  COMMENT "API reference (Doxygen) in ${LUMEN_DOCS_OUTPUT}/html"
  VERBATIM)
