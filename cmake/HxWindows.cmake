# Version resources of Windows modules.
enable_language(RC)

# hx_version_resource(<target> <description>): versions from the project, the
# file name from the target.
function(hx_version_resource target description)
  set(hx_DESCRIPTION "${description}")
  set(hx_TYPE VFT_DLL)
  get_target_property(type ${target} TYPE)
  if(type STREQUAL "EXECUTABLE")
    set(hx_TYPE VFT_APP)
  endif()
  get_target_property(name ${target} OUTPUT_NAME)
  if(NOT name)
    set(name ${target})
  endif()
  set(hx_NAME ${name})
  string(REPLACE "." "," hx_NUMBERS "${PROJECT_VERSION}.0")
  set(file ${CMAKE_CURRENT_BINARY_DIR}/${target}_version.rc)
  configure_file(${hx_utils_SOURCE_DIR}/cmake/version.rc.in ${file} @ONLY)
  target_sources(${target} PRIVATE ${file})
endfunction()
