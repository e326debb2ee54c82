# Debian packages: shared objects, development files, the program. Built,
# installed, tried and removed by script/package.
# REQUIRES: BUILD_SHARED_LIBS and the prefix /usr.
set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME hx-utils)
set(CPACK_PACKAGE_VERSION ${PROJECT_VERSION})
set(CPACK_PACKAGE_CONTACT "The hx_utils maintainers <hx-utils@localhost>"
    CACHE STRING "Maintainer of the packages")
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "")  # each package has its own
set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
set(CPACK_STRIP_FILES ON)
set(CPACK_COMPONENTS_ALL runtime development codegen)
set(CPACK_COMPONENT_DEVELOPMENT_DEPENDS runtime)
set(CPACK_COMPONENT_CODEGEN_DEPENDS runtime)

set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_ENABLE_COMPONENT_DEPENDS ON)
set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)
# No installed package holds our own libraries yet: dpkg-shlibdeps looks here.
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS
    ${PROJECT_BINARY_DIR} ${PROJECT_BINARY_DIR}/platform)

set(CPACK_DEBIAN_PACKAGE_GENERATE_SHLIBS ON)
set(CPACK_DEBIAN_RUNTIME_PACKAGE_CONTROL_EXTRA
    ${PROJECT_SOURCE_DIR}/cmake/debian/triggers)
execute_process(COMMAND date --utc --rfc-email --date=${hx_utils_RELEASE_DATE}
                OUTPUT_VARIABLE debianReleaseDate OUTPUT_STRIP_TRAILING_WHITESPACE
                COMMAND_ERROR_IS_FATAL ANY)
configure_file(cmake/debian/changelog.in changelog @ONLY)
execute_process(COMMAND gzip -9nkf ${PROJECT_BINARY_DIR}/changelog
                COMMAND_ERROR_IS_FATAL ANY)

# hx_package(<component> <name> <section> <summary> <text>): apt shows the text
# below the summary.
macro(hx_package component name section summary text)
  string(TOUPPER ${component} upper)
  set(CPACK_DEBIAN_${upper}_PACKAGE_NAME ${name})
  set(CPACK_DEBIAN_${upper}_PACKAGE_SECTION ${section})
  set(CPACK_COMPONENT_${upper}_DESCRIPTION "${summary}\n${text}")
  install(FILES ${PROJECT_BINARY_DIR}/changelog.gz
    DESTINATION ${CMAKE_INSTALL_DATADIR}/doc/${name} COMPONENT ${component})
endmacro()
hx_package(runtime libhx-utils${PROJECT_VERSION_MAJOR} libs
  "utilities of a production C code generator"
  "Forms C names from templates, keeps name spaces, orders definitions before
their uses, and does arithmetic as the generated code has to.")
hx_package(development libhx-utils-dev libdevel
  "utilities of a production C code generator - development files"
  "Headers, link names, and the packages for CMake and pkg-config.")
hx_package(codegen hx-codegen devel
  "forms the names and the C code of a model document"
  "Reads a model document in JSON and writes a table of names, C code, or how
each name came about.")

include(CPack)
