# Header, shared library, program, CMake package, pkg-config file and manual pages. Components follow the usual Debian split.
include(CMakePackageConfigHelpers)
include(man_pages)
if(REISTI_DEBIAN_PACKAGES)
  include(debian)
endif()

set(package_dir ${CMAKE_INSTALL_LIBDIR}/cmake/reisti)

install(TARGETS reisti EXPORT reisti-targets
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT library NAMELINK_COMPONENT development)
install(DIRECTORY include/reisti DESTINATION ${CMAKE_INSTALL_INCLUDEDIR} COMPONENT development)
install(EXPORT reisti-targets NAMESPACE reisti:: DESTINATION ${package_dir} COMPONENT development)

configure_package_config_file(packaging/reisti-config.cmake.in ${PROJECT_BINARY_DIR}/reisti-config.cmake
  INSTALL_DESTINATION ${package_dir})
write_basic_package_version_file(${PROJECT_BINARY_DIR}/reisti-config-version.cmake COMPATIBILITY SameMajorVersion)
install(FILES ${PROJECT_BINARY_DIR}/reisti-config.cmake ${PROJECT_BINARY_DIR}/reisti-config-version.cmake
  DESTINATION ${package_dir} COMPONENT development)

# The prefix is found from the place of the .pc file, so that an installed tree can be moved.
file(RELATIVE_PATH REISTI_PC_PREFIX /${CMAKE_INSTALL_LIBDIR}/pkgconfig /)
string(REGEX REPLACE "/$" "" REISTI_PC_PREFIX "${REISTI_PC_PREFIX}")
configure_file(packaging/reisti.pc.in ${PROJECT_BINARY_DIR}/reisti.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/reisti.pc DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig COMPONENT development)

# man finds the page of the C interface under the name of each function.
reisti_install_man_page(packaging/man/reisti.3 development)
file(STRINGS abi/exports.txt functions)
foreach(function IN LISTS functions)
  file(CONFIGURE OUTPUT ${PROJECT_BINARY_DIR}/man/${function}.3 CONTENT ".so man3/reisti.3\n")
  reisti_install_man_page(${PROJECT_BINARY_DIR}/man/${function}.3 development)
endforeach()

if(REISTI_BUILD_CLI)
  file(RELATIVE_PATH from_program_to_library /${CMAKE_INSTALL_BINDIR} /${CMAKE_INSTALL_LIBDIR})
  set_target_properties(reisti_cli PROPERTIES INSTALL_RPATH "$ORIGIN/${from_program_to_library}")
  install(TARGETS reisti_cli RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR} COMPONENT tools)
  reisti_install_man_page(packaging/man/reisti.1 tools)
endif()
