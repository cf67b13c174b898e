# Runs COMMAND (a list) and fails unless it ends with EXIT_CODE, says nothing on the error stream, and its output
# matches the regular expression EXPECTED up to its end. A test property could ask for one of these, not for all.
execute_process(COMMAND ${COMMAND} RESULT_VARIABLE code OUTPUT_VARIABLE output ERROR_VARIABLE errors)
if(NOT code STREQUAL EXIT_CODE OR NOT errors STREQUAL "" OR NOT output MATCHES "${EXPECTED}\n$")
  message(FATAL_ERROR "Exit code ${code}, not ${EXIT_CODE}; or another output than\n${EXPECTED}\n"
                      "errors:\n${errors}\noutput:\n${output}")
endif()
