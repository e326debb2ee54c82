# Builds a few objects in two folders and compares them byte for byte: an object
# with file names in error codes, an object of the platform layer, the object
# with version and time. No other object can differ, because no source asks for
# date or time of the compilation.
#
#   cmake -DROOT=<tree> -DWORK=<folder> -DCOMPILER=<c++>
#         -P CheckReproducible.cmake
cmake_minimum_required(VERSION 3.25)
set(objects CMakeFiles/hx_utils.dir/src/FLAG.cpp.o
            platform/messages/CMakeFiles/hx_platform_messages.dir/HX_MessageHandler.cpp.o
            host/CMakeFiles/hx_codegen.dir/program/HX_Version.cpp.o)
set(parts src platform host)

foreach(part IN LISTS parts)
  file(GLOB_RECURSE sources ${ROOT}/${part}/*.h ${ROOT}/${part}/*.cpp)
  foreach(source IN LISTS sources)
    file(STRINGS ${source} found REGEX "__(DATE|TIME|TIMESTAMP)__")
    if(found)
      message(SEND_ERROR "${source} asks for the time of the compilation: ${found}")
    endif()
  endforeach()
endforeach()

set(ENV{SOURCE_DATE_EPOCH} 86400)
set(ENV{CCACHE_DISABLE} 1)
file(REMOVE_RECURSE ${WORK})
foreach(folder IN ITEMS ${WORK}/one ${WORK}/another/one)
  foreach(part IN LISTS parts ITEMS CMakeLists.txt cmake data docs)
    file(COPY ${ROOT}/${part} DESTINATION ${folder})
  endforeach()
  foreach(step IN ITEMS
      "-G;Ninja;-S;${folder};-B;${folder}/build;-DHX_BUILD_TESTING=OFF;-DHX_INSTALL=OFF;-DCMAKE_CXX_COMPILER=${COMPILER};-DCMAKE_BUILD_TYPE=RelWithDebInfo;-DCMAKE_CXX_FLAGS_RELWITHDEBINFO=-g1"
      "--build;${folder}/build;--target;${objects}")
    execute_process(COMMAND ${CMAKE_COMMAND} ${step} COMMAND_ERROR_IS_FATAL ANY
                    OUTPUT_QUIET)
  endforeach()
endforeach()

foreach(object IN LISTS objects)
  file(SHA256 ${WORK}/one/build/${object} first)
  file(SHA256 ${WORK}/another/one/build/${object} second)
  if(NOT first STREQUAL second)
    message(SEND_ERROR "Two builds differ in ${object}")
  endif()
endforeach()
list(GET objects -1 program)
file(STRINGS ${WORK}/one/build/${program} found REGEX "1970-01-02")
if(NOT found)
  message(SEND_ERROR "The program does not take its time from SOURCE_DATE_EPOCH")
endif()
