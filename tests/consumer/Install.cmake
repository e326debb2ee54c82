# Installs the library, moves the installed tree to PREFIX, and looks for paths
# of this machine in the tree. The static library comes from the build tree TREE;
# the shared library is built first.
cmake_minimum_required(VERSION 3.25)
if(KIND STREQUAL "shared")
  set(TREE ${WORK}/build)
  foreach(step IN ITEMS
      "-G;${GENERATOR};-S;${SOURCE};-B;${TREE};-DCMAKE_CXX_COMPILER=${COMPILER};-DBUILD_SHARED_LIBS=ON;-DHX_UNITY=ON;-DHX_BUILD_TESTING=OFF;-DHX_BUILD_HOST=OFF"
      "--build;${TREE}")
    execute_process(COMMAND ${CMAKE_COMMAND} ${step} COMMAND_ERROR_IS_FATAL ANY
                    OUTPUT_QUIET)
  endforeach()
endif()
file(REMOVE_RECURSE ${WORK}/installed ${PREFIX})
execute_process(COMMAND ${CMAKE_COMMAND} --install ${TREE}
                        --prefix ${WORK}/installed
                COMMAND_ERROR_IS_FATAL ANY OUTPUT_QUIET)
file(RENAME ${WORK}/installed ${PREFIX})

file(GLOB_RECURSE files ${PREFIX}/*)
foreach(file IN LISTS files)
  # Debug information may name the sources; only this build has debug
  # information.
  if(KIND STREQUAL "static" AND file MATCHES "\\.a$|/hx_codegen$")
    continue()
  endif()
  file(STRINGS ${file} lines)
  foreach(path IN ITEMS ${SOURCE} ${TREE} ${WORK} /usr/local)
    string(FIND "${lines}" ${path} position)
    if(NOT position EQUAL -1)
      message(SEND_ERROR "${file} holds the path ${path}")
    endif()
  endforeach()
endforeach()
