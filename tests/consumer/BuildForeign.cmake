# Builds and runs the generator of foreign/ and compares the output.
#
#   cmake -DSOURCE=<tree> -DWORK=<folder> -DGENERATOR=<name> -DCOMPILER=<c++>
#         -P BuildForeign.cmake
foreach(step IN ITEMS
    "-G;${GENERATOR};-S;${CMAKE_CURRENT_LIST_DIR}/foreign;-B;${WORK};-DHX_SOURCE=${SOURCE};-DHX_UNITY=ON;-DCMAKE_CXX_COMPILER=${COMPILER};-DCMAKE_CXX_FLAGS=-O0"
    "--build;${WORK};--target;foreign")
  execute_process(COMMAND ${CMAKE_COMMAND} ${step} COMMAND_ERROR_IS_FATAL ANY
                  OUTPUT_QUIET)
endforeach()
execute_process(COMMAND ${WORK}/foreign COMMAND_ERROR_IS_FATAL ANY
                OUTPUT_VARIABLE printed)
if(NOT printed STREQUAL "Sa1_Speed_Gain\nSa1_Speed_Gain_a\n\
a_very_long_name_that_has_to_fit_into_31\n\
a_very_long_name_that_has_to__a\nx=2 y=1 rest\n-9223372036854775808\n")
  message(FATAL_ERROR "The generator printed:\n${printed}")
endif()
