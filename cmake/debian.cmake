# One Debian package for each install component, made by cpack. Everything here serves the packages alone.
if(NOT BUILD_SHARED_LIBS)
  message(FATAL_ERROR "Debian packages hold the shared library: BUILD_SHARED_LIBS has to be ON")
endif()
set(REISTI_DEBIAN_REVISION 1)
set(REISTI_LIBRARY_PACKAGE libreisti${REISTI_SOVERSION})

# reisti_compress(FILE NAME RESULT): FILE compressed as NAME, the same bytes each time; sets RESULT to its path.
find_program(GZIP gzip REQUIRED)
function(reisti_compress file name result)
  cmake_path(ABSOLUTE_PATH file BASE_DIRECTORY ${PROJECT_SOURCE_DIR})
  set(compressed ${PROJECT_BINARY_DIR}/compressed/${name})
  file(MAKE_DIRECTORY ${PROJECT_BINARY_DIR}/compressed)
  execute_process(COMMAND ${GZIP} -9 --no-name --stdout INPUT_FILE ${file} OUTPUT_FILE ${compressed}
    COMMAND_ERROR_IS_FATAL ANY)
  set_property(DIRECTORY APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS ${file})
  set(${result} ${compressed} PARENT_SCOPE)
endfunction()

set(CPACK_GENERATOR DEB)
set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_COMPONENTS_ALL library development tools)
set(CPACK_STRIP_FILES ON)
# As umask 022 would make them, whatever it is.
set(CPACK_INSTALL_DEFAULT_DIRECTORY_PERMISSIONS
  OWNER_READ OWNER_WRITE OWNER_EXECUTE GROUP_READ GROUP_EXECUTE WORLD_READ WORLD_EXECUTE)

set(CPACK_PACKAGE_CONTACT "reisti developers <developers@reisti.example>")
set(CPACK_DEBIAN_PACKAGE_SOURCE reisti)
set(CPACK_DEBIAN_PACKAGE_RELEASE ${REISTI_DEBIAN_REVISION})
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)
set(CPACK_DEBIAN_PACKAGE_GENERATE_SHLIBS ON)
set(CPACK_DEBIAN_PACKAGE_GENERATE_SHLIBS_POLICY ">=")
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
# Where the program's dependencies are looked for: the library is in a package of its own.
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS ${PROJECT_BINARY_DIR}/src)

# The first line of each description is its summary.
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "")
set(about "reisti constructs experimental designs: definitive screening designs and
mixture designs (simplex centroid, simplex lattice, extreme vertices on
regions with bounds and linear constraints).
")

configure_file(packaging/debian/symbols.in debian/symbols @ONLY)
set(CPACK_DEBIAN_LIBRARY_PACKAGE_NAME ${REISTI_LIBRARY_PACKAGE})
set(CPACK_DEBIAN_LIBRARY_PACKAGE_SECTION libs)
set(CPACK_DEBIAN_LIBRARY_PACKAGE_CONTROL_EXTRA
  ${PROJECT_SOURCE_DIR}/packaging/debian/triggers ${PROJECT_BINARY_DIR}/debian/symbols)
set(CPACK_DEBIAN_LIBRARY_DESCRIPTION "experimental designs - shared library
${about}
This package holds the library that programs are linked with.")

set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_NAME libreisti-dev)
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_SECTION libdevel)
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_DEPENDS
  "${REISTI_LIBRARY_PACKAGE} (= ${PROJECT_VERSION}-${REISTI_DEBIAN_REVISION})")
set(CPACK_DEBIAN_DEVELOPMENT_DESCRIPTION "experimental designs - development files
${about}
This package holds what programs that use the library are built with:
header, CMake package, pkg-config file and manual page.")

set(CPACK_DEBIAN_TOOLS_PACKAGE_NAME reisti)
set(CPACK_DEBIAN_TOOLS_PACKAGE_SECTION math)
set(CPACK_DEBIAN_TOOLS_PACKAGE_DEPENDS "${REISTI_LIBRARY_PACKAGE} (>= ${PROJECT_VERSION})")
set(CPACK_DEBIAN_TOOLS_DESCRIPTION "experimental designs - command line program
${about}
This package holds the program, which writes designs as tables, CSV or JSON.")

# scripts/package sets SOURCE_DATE_EPOCH, which TIMESTAMP then takes for the present.
string(TIMESTAMP REISTI_DEBIAN_DATE "%a, %d %b %Y %H:%M:%S +0000" UTC)
configure_file(packaging/debian/changelog.in debian/changelog @ONLY)
reisti_compress(${PROJECT_BINARY_DIR}/debian/changelog changelog.Debian.gz debian_changelog)
reisti_compress(CHANGELOG.md changelog.gz changelog)
file(READ packaging/debian/copyright copyright)
file(READ packaging/debian/copyright.tools copyright_tools)
file(CONFIGURE OUTPUT debian/library/copyright CONTENT "${copyright}" @ONLY)
file(CONFIGURE OUTPUT debian/development/copyright CONTENT "${copyright}" @ONLY)
file(CONFIGURE OUTPUT debian/tools/copyright CONTENT "${copyright}${copyright_tools}" @ONLY)
foreach(component IN LISTS CPACK_COMPONENTS_ALL)
  string(TOUPPER ${component} COMPONENT)
  set(package ${CPACK_DEBIAN_${COMPONENT}_PACKAGE_NAME})
  install(FILES ${PROJECT_BINARY_DIR}/debian/${component}/copyright ${debian_changelog} ${changelog}
    DESTINATION ${CMAKE_INSTALL_DATAROOTDIR}/doc/${package} COMPONENT ${component})
  configure_file(packaging/debian/lintian-overrides.in debian/${component}/lintian-overrides @ONLY)
  install(FILES ${PROJECT_BINARY_DIR}/debian/${component}/lintian-overrides
    DESTINATION ${CMAKE_INSTALL_DATAROOTDIR}/lintian/overrides RENAME ${package} COMPONENT ${component})
endforeach()

set(CPACK_POST_BUILD_SCRIPTS ${PROJECT_SOURCE_DIR}/packaging/debian/finish.cmake)
include(CPack)
