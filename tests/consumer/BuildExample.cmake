# Builds and runs the generator of docs/example and compares the output.
#
#   cmake -DSOURCE=<tree> -DWORK=<folder> -DGENERATOR=<name> -DCOMPILER=<c++>
#         -P BuildExample.cmake
set(example ${SOURCE}/docs/example)
foreach(step IN ITEMS
    "-G;${GENERATOR};-S;${example};-B;${WORK};-DHX_SOURCE=${SOURCE};-DHX_UNITY=ON;-DCMAKE_CXX_COMPILER=${COMPILER}"
    "--build;${WORK};--target;generator")
  execute_process(COMMAND ${CMAKE_COMMAND} ${step} COMMAND_ERROR_IS_FATAL ANY
                  OUTPUT_QUIET)
endforeach()
execute_process(COMMAND ${WORK}/generator COMMAND_ERROR_IS_FATAL ANY
                OUTPUT_VARIABLE printed ERROR_VARIABLE reported)
if(NOT printed STREQUAL "Sa1_Speed_Gain\nSa1_Speed_Gain_a\n1 problem reported\n"
   OR NOT reported STREQUAL "C keyword while used as identifier.\n")
  message(FATAL_ERROR "The example printed:\n${printed}${reported}")
endif()
