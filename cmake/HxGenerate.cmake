# Code of a model, by component, in a build of CMake.
#
#   find_package(hx_utils 1.0 CONFIG REQUIRED COMPONENTS codegen)
#   hx_codegen_generate(cruise MODEL cruise.slx
#                       COMPONENTS "cruise/Plant" "cruise/Controller"
#                       RULES rules.json LOCK names.lock)
#   target_link_libraries(application PRIVATE cruise)
#
# Makes the static library TARGET of the C files of the components and of
# everything outside them. Without COMPONENTS the components are asked of the
# model while CMake runs; the list is asked again when the model changes.
#
#   LOCK     file of the names, in the source tree: kept from build to build.
#            Without LOCK the file lies in the build tree.
#   OUT      folder for the files; TARGET.code in the build tree otherwise
#   OPTIONS  further options of hx_codegen generate
#
# A first command gives the names (the lock), then each component is a command
# of its own. Commands run again only if a file changes that the last run has
# read; a file with the same content is not touched, so the compiler runs for
# changed components only.
function(hx_codegen_generate target)
  cmake_parse_arguments(PARSE_ARGV 1 arg "" "MODEL;RULES;LOCK;OUT"
                        "COMPONENTS;OPTIONS")
  if(NOT arg_MODEL OR arg_UNPARSED_ARGUMENTS)
    message(FATAL_ERROR "hx_codegen_generate(<target> MODEL <file> "
      "[COMPONENTS <path>...] [RULES <file>] [LOCK <file>] [OUT <folder>] "
      "[OPTIONS <option>...])")
  endif()
  cmake_path(ABSOLUTE_PATH arg_MODEL BASE_DIRECTORY ${CMAKE_CURRENT_SOURCE_DIR})
  set(work ${CMAKE_CURRENT_BINARY_DIR}/${target}.code)
  if(NOT arg_OUT)
    set(arg_OUT ${work})
  endif()
  set(lock ${work}/names.lock)
  if(arg_LOCK)
    cmake_path(ABSOLUTE_PATH arg_LOCK BASE_DIRECTORY ${CMAKE_CURRENT_SOURCE_DIR})
    set(lock ${arg_LOCK})
  endif()
  set(options ${arg_OPTIONS})
  if(arg_RULES)
    cmake_path(ABSOLUTE_PATH arg_RULES BASE_DIRECTORY ${CMAKE_CURRENT_SOURCE_DIR})
    list(APPEND options --rules ${arg_RULES})
  endif()
  file(MAKE_DIRECTORY ${work})

  # Path and file name of each component.
  get_target_property(program hx::codegen LOCATION)
  set_property(DIRECTORY APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS ${arg_MODEL})
  execute_process(COMMAND ${program} components ${arg_MODEL} ${arg_OPTIONS}
                  COMMAND_ERROR_IS_FATAL ANY OUTPUT_VARIABLE lines ERROR_QUIET)
  string(REGEX MATCHALL "[^\n]+" lines "${lines}")

  # The names of all components; the stamp because an unchanged lock keeps its
  # time.
  set(names ${work}/names.stamp)
  add_custom_command(OUTPUT ${names}
    COMMAND hx::codegen generate ${arg_MODEL} --lock ${lock} --quiet ${options}
            --out ${work}/whole --depfile ${work}/names.d
            --depfile-target ${names}
    COMMAND ${CMAKE_COMMAND} -E touch ${names}
    DEPENDS ${arg_MODEL} ${arg_RULES} hx::codegen DEPFILE ${work}/names.d
    COMMENT "Forming the names of ${arg_MODEL}" VERBATIM)
  add_custom_target(${target}_names DEPENDS ${names})

  set(sources)
  set(folders)
  set(found)
  foreach(line IN LISTS lines)
    string(REGEX REPLACE "\t.*" "" path "${line}")
    string(REGEX REPLACE ".*\t" "" name "${line}")
    list(APPEND found "${path}")
    if(arg_COMPONENTS AND NOT path STREQUAL "."
       AND NOT path IN_LIST arg_COMPONENTS)
      continue()
    endif()
    set(source ${arg_OUT}/${name}/${name}.c)
    set(stamp ${work}/${name}.stamp)
    add_custom_command(OUTPUT ${stamp} BYPRODUCTS ${source}
      COMMAND hx::codegen generate ${arg_MODEL} --component ${path}
              --lock ${lock} --quiet ${options} --out ${arg_OUT}
              --silence 17260,30303,30304,30307,412,415,511
              --depfile ${work}/${name}.d --depfile-target ${stamp}
      COMMAND ${CMAKE_COMMAND} -E touch ${stamp}
      DEPENDS ${names} hx::codegen DEPFILE ${work}/${name}.d
      COMMENT "Generating ${path}" VERBATIM)
    list(APPEND stamps ${stamp})
    list(APPEND sources ${source})
    list(APPEND folders ${arg_OUT}/${name})
  endforeach()
  foreach(path IN LISTS arg_COMPONENTS)
    if(NOT path IN_LIST found)
      message(FATAL_ERROR "${arg_MODEL} has no component '${path}'")
    endif()
  endforeach()
  add_custom_target(${target}_code DEPENDS ${stamps})
  add_dependencies(${target}_code ${target}_names)
  set_source_files_properties(${sources} PROPERTIES GENERATED TRUE)
  add_library(${target} STATIC ${sources})
  add_dependencies(${target} ${target}_code)
  target_include_directories(${target} PUBLIC ${folders})
endfunction()
