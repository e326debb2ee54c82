# Builds generate/ with the program installed in PREFIX: the second build does
# nothing, and a changed block compiles the component of the block again, and
# nothing else.
foreach(generator IN ITEMS "Ninja" "Unix Makefiles")
  string(MAKE_C_IDENTIFIER ${generator} folder)
  set(folder ${WORK}/generate_${folder})
  file(REMOVE_RECURSE ${folder})
  file(MAKE_DIRECTORY ${folder})
  file(READ ${CMAKE_CURRENT_LIST_DIR}/generate/model.json model)
  file(WRITE ${folder}/model.json "${model}")

  function(build)
    execute_process(COMMAND ${CMAKE_COMMAND} --build ${folder} -j2
                    COMMAND_ERROR_IS_FATAL ANY OUTPUT_QUIET)
  endfunction()
  # The files with a name like <pattern> that a build has written.
  function(expect_new pattern expected)
    execute_process(COMMAND sleep 0.05)
    file(TOUCH ${folder}/marker)
    execute_process(COMMAND sleep 0.05)
    if(ARGC GREATER 2)
      file(WRITE ${folder}/model.json "${ARGV2}")
    endif()
    build()
    execute_process(COMMAND find ${folder} -newer ${folder}/marker
                            -name ${pattern} -printf "%f\n"
                    OUTPUT_VARIABLE found)
    string(REGEX MATCHALL "[^\n]+" found "${found}")
    list(SORT found)
    if(NOT "${found}" STREQUAL "${expected}")
      message(SEND_ERROR "${generator}: new are '${found}', not '${expected}'")
    endif()
  endfunction()
  function(expect_printed expected)
    execute_process(COMMAND ${folder}/generated OUTPUT_VARIABLE printed)
    if(NOT printed STREQUAL "${expected}\n")
      message(SEND_ERROR "${generator}: printed ${printed}")
    endif()
  endfunction()

  execute_process(COMMAND ${CMAKE_COMMAND} -G ${generator}
                          -S ${CMAKE_CURRENT_LIST_DIR}/generate -B ${folder}
                          -DCMAKE_PREFIX_PATH=${PREFIX}
                  COMMAND_ERROR_IS_FATAL ANY OUTPUT_QUIET)
  build()
  expect_printed("1 2")
  expect_new("*.o" "")
  expect_new("*.stamp" "")
  string(REPLACE "\"initial\": 2" "\"initial\": 3" changed "${model}")
  expect_new("*.o" "plant_Right.c.o" "${changed}")
  expect_printed("1 3")
  expect_new("*.stamp" "")
endforeach()
