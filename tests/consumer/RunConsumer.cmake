# Runs a consumer and looks at what it prints and what it was linked with.
function(run_consumer program)
  execute_process(COMMAND ${program} COMMAND_ERROR_IS_FATAL ANY
                  OUTPUT_VARIABLE printed)
  if(NOT printed STREQUAL "Sa1_Speed_Gain 408\n")
    message(SEND_ERROR "The consumer printed: ${printed}")
  endif()
  # Nothing refers to the file that sets the floating-point state.
  execute_process(COMMAND ${NM} ${program} OUTPUT_VARIABLE symbols)
  if(KIND STREQUAL "static" AND NOT symbols MATCHES "hx_utils_floatingPointState")
    message(SEND_ERROR "The consumer does not set the floating-point state")
  endif()
endfunction()
