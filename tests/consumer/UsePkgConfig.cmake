# Builds consumer.cpp with the flags of pkg-config and the library in PREFIX.
set(ENV{PKG_CONFIG_PATH} ${PREFIX}/${LIBDIR}/pkgconfig)
execute_process(COMMAND pkg-config --cflags --libs "hx_utils >= 1.0"
                COMMAND_ERROR_IS_FATAL ANY OUTPUT_VARIABLE flags)
separate_arguments(flags UNIX_COMMAND "${flags}")
execute_process(COMMAND ${COMPILER} -std=c++20 -o ${WORK}/consumer
                        ${CMAKE_CURRENT_LIST_DIR}/consumer.cpp ${flags}
                COMMAND_ERROR_IS_FATAL ANY)
set(ENV{LD_LIBRARY_PATH} ${PREFIX}/${LIBDIR})
include(${CMAKE_CURRENT_LIST_DIR}/RunConsumer.cmake)
run_consumer(${WORK}/consumer)
