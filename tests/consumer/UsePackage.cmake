# Builds the project package/ with the library installed in PREFIX. PROGRAM:
# whether the program is installed too.
set(folder ${WORK}/package)
foreach(step IN ITEMS
    "--fresh;-G;${GENERATOR};-S;${CMAKE_CURRENT_LIST_DIR}/package;-B;${folder};-DCMAKE_CXX_COMPILER=${COMPILER};-DCMAKE_PREFIX_PATH=${PREFIX};-DPROGRAM=${PROGRAM};-DMODEL=${SOURCE}/host/models/cruise_control.json"
    "--build;${folder}")
  execute_process(COMMAND ${CMAKE_COMMAND} ${step} COMMAND_ERROR_IS_FATAL ANY
                  OUTPUT_QUIET)
endforeach()
include(${CMAKE_CURRENT_LIST_DIR}/RunConsumer.cmake)
run_consumer(${folder}/consumer)
