# Runs PROGRAM with ARGUMENTS and fails unless it exits with 0 and its standard output is the
# text of EXPECTED.
execute_process(COMMAND ${PROGRAM} ${ARGUMENTS}
                OUTPUT_VARIABLE output
                RESULT_VARIABLE result)
if(NOT result STREQUAL "0")
  message(FATAL_ERROR "${PROGRAM} exited with ${result}; its output:\n${output}")
endif()
file(READ ${EXPECTED} expected)
if(NOT output STREQUAL expected)
  message(FATAL_ERROR "${PROGRAM} printed:\n${output}\nbut ${EXPECTED} says:\n${expected}")
endif()
