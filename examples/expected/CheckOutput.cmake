# Runs PROGRAM and compares what it prints on standard output with the file EXPECTED.
execute_process(
  COMMAND ${PROGRAM}
  RESULT_VARIABLE code
  OUTPUT_VARIABLE printed)
if(NOT code EQUAL 0)
  message(FATAL_ERROR "${PROGRAM} ended with ${code}; it printed:\n${printed}")
endif()
file(READ ${EXPECTED} expected)
if(NOT printed STREQUAL expected)
  message(FATAL_ERROR "${PROGRAM} printed\n${printed}\nwhere ${EXPECTED} has\n${expected}")
endif()
