# Settings of every target of this project. No setting is global.

# Compiles several sources of a library as one where HX_UNITY asks for that.
# Sources of such a library use different local names.
function(hx_target_unity target)
  set_target_properties(${target} PROPERTIES
    UNITY_BUILD ${HX_UNITY} UNITY_BUILD_BATCH_SIZE 12)
endfunction()

# Language, visibility, warnings and exact floating point for one target.
function(hx_target_defaults target)
  target_compile_features(${target} PUBLIC cxx_std_20)
  set(hide_inlines ON)
  if(WIN32)
    set(hide_inlines OFF)  # MinGW would export no inline function at all
  endif()
  set_target_properties(${target} PROPERTIES
    CXX_EXTENSIONS OFF
    CXX_VISIBILITY_PRESET hidden
    VISIBILITY_INLINES_HIDDEN ${hide_inlines}
    VERIFY_INTERFACE_HEADER_SETS ON)
  if(NOT MSVC)
    file(RELATIVE_PATH src_from_build ${CMAKE_BINARY_DIR} ${PROJECT_SOURCE_DIR}/src)
    target_compile_options(${target} PRIVATE
      -Wall -Wextra -Wpedantic -Wconversion -Wshadow
      # Objects hold no path of this machine: two builds in two folders are
      # byte-equal. Debug builds keep the paths for the debugger.
      "$<$<NOT:$<CONFIG:Debug>>:-ffile-prefix-map=${PROJECT_SOURCE_DIR}/=>"
      "$<$<NOT:$<CONFIG:Debug>>:-ffile-prefix-map=${CMAKE_BINARY_DIR}=.>"
      # Error codes show the path below src/. Two forms, because a compiler cache
      # may make the path relative to the build folder.
      -fmacro-prefix-map=${PROJECT_SOURCE_DIR}/src/=
      -fmacro-prefix-map=${src_from_build}/=
      # g++ 12 warns wrongly of moved variants and joined std::strings after much
      # inlining. The sanitizers find the true cases.
      $<$<CXX_COMPILER_ID:GNU>:-Wno-array-bounds>
      $<$<CXX_COMPILER_ID:GNU>:-Wno-maybe-uninitialized>
      $<$<CXX_COMPILER_ID:GNU>:-Wno-restrict>
      $<$<CXX_COMPILER_ID:GNU>:-Wno-stringop-overflow>
      $<$<CXX_COMPILER_ID:GNU>:-Wno-stringop-overread>
      # A unity build includes sources as if they were headers.
      $<$<AND:$<BOOL:${HX_UNITY}>,$<CXX_COMPILER_ID:GNU>>:-Wno-subobject-linkage>
      # A double operation rounds once, to double: no fused multiply-add, and
      # on 32-bit x86 no 80-bit intermediate results.
      -ffp-contract=off)
    if(CMAKE_SIZEOF_VOID_P EQUAL 4 AND CMAKE_SYSTEM_PROCESSOR MATCHES "86|AMD64")
      target_compile_options(${target} PRIVATE -msse2 -mfpmath=sse)
    endif()
    if(HX_WARNINGS_AS_ERRORS)
      target_compile_options(${target} PRIVATE -Werror)
    endif()
  endif()
endfunction()
