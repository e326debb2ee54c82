# Installs libraries, headers, the CMake package and the pkg-config file. All
# paths are relative to the installed files: the installed tree may be moved as a
# whole. Program and data: host/CMakeLists.txt.
#
# Components: runtime (shared objects), development, codegen.
if(NOT hx_utils_OWN_PLATFORM)
  message(FATAL_ERROR "HX_INSTALL installs the platform layer of this tree; a "
                      "parent with a layer of its own installs both itself")
endif()
include(CMakePackageConfigHelpers)

# The headers of both libraries share a folder: "Naming/X.h", "platform/...".
install(TARGETS hx_utils hx_platform EXPORT hx_utils-libraries
  LIBRARY COMPONENT runtime NAMELINK_COMPONENT development
  RUNTIME COMPONENT runtime
  ARCHIVE COMPONENT development
  FILE_SET HEADERS DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/hx_utils
    COMPONENT development)

# The lists of reserved words, for every host of the library.
install(DIRECTORY data/keywords
  DESTINATION ${CMAKE_INSTALL_DATADIR}/hx_utils COMPONENT runtime)

set(packageFolder ${CMAKE_INSTALL_LIBDIR}/cmake/hx_utils)
install(EXPORT hx_utils-libraries NAMESPACE hx::
  DESTINATION ${packageFolder} COMPONENT development)
configure_package_config_file(
  cmake/hx_utils-config.cmake.in hx_utils-config.cmake
  INSTALL_DESTINATION ${packageFolder}
  NO_SET_AND_CHECK_MACRO NO_CHECK_REQUIRED_COMPONENTS_MACRO)
write_basic_package_version_file(hx_utils-config-version.cmake
  COMPATIBILITY SameMajorVersion)
install(FILES ${PROJECT_BINARY_DIR}/hx_utils-config.cmake
              ${PROJECT_BINARY_DIR}/hx_utils-config-version.cmake
  DESTINATION ${packageFolder} COMPONENT development)

# Users of the shared libraries need the macros, users of the archives need both
# archives as a group. The group is one word, because tools reorder words.
set(pcLibraries "-L\${libdir} -lhx_utils -lhx_platform")
set(pcDefinitions "-DHX_UTILS_SHARED -DHX_PLATFORM_SHARED")
set(pcPrivate "")
if(NOT BUILD_SHARED_LIBS)
  set(pcLibraries "-L\${libdir} -Wl,--undefined=hx_utils_floatingPointState,\
--start-group,-lhx_utils,-lhx_platform,--end-group")
  set(pcDefinitions "")
  set(pcPrivate "-lstdc++ -lm")  # for programs that are linked as C
endif()
cmake_path(RELATIVE_PATH CMAKE_INSTALL_FULL_LIBDIR
  BASE_DIRECTORY ${CMAKE_INSTALL_PREFIX} OUTPUT_VARIABLE pcLibdir)
cmake_path(RELATIVE_PATH CMAKE_INSTALL_FULL_INCLUDEDIR
  BASE_DIRECTORY ${CMAKE_INSTALL_PREFIX} OUTPUT_VARIABLE pcIncludedir)
cmake_path(RELATIVE_PATH CMAKE_INSTALL_PREFIX
  BASE_DIRECTORY ${CMAKE_INSTALL_FULL_LIBDIR}/pkgconfig
  OUTPUT_VARIABLE pcPrefix)
configure_file(cmake/hx_utils.pc.in hx_utils.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/hx_utils.pc
  DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig COMPONENT development)
