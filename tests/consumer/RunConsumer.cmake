# Runs a consumer; checks the output and the linked symbols.
function(run_consumer program)
  execute_process(COMMAND ${program} COMMAND_ERROR_IS_FATAL ANY
                  OUTPUT_VARIABLE printed)
  if(NOT printed STREQUAL "Sa1_Speed_Gain 408\n")
    message(SEND_ERROR "The consumer printed: ${printed}")
  endif()
  # No symbol refers to the object of the floating-point state: the linker must
  # be told.
  execute_process(COMMAND ${NM} ${program} OUTPUT_VARIABLE symbols)
  if(KIND STREQUAL "static" AND NOT symbols MATCHES "hx_utils_floatingPointState")
    message(SEND_ERROR "The consumer does not set the floating-point state")
  endif()
endfunction()
