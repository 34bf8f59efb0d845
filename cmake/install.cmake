# Header, shared library, program, CMake package, pkg-config file and manual pages. Components follow the usual Debian split.
include(CMakePackageConfigHelpers)
include(${CMAKE_CURRENT_LIST_DIR}/man_pages.cmake)
if(REISTI_DEBIAN_PACKAGES)
  include(${CMAKE_CURRENT_LIST_DIR}/debian.cmake)
endif()

set(package_dir ${CMAKE_INSTALL_LIBDIR}/cmake/reisti)

install(TARGETS reisti EXPORT reisti-targets
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT library NAMELINK_COMPONENT development
  ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT development)
install(DIRECTORY include/reisti DESTINATION ${CMAKE_INSTALL_INCLUDEDIR} COMPONENT development)
install(EXPORT reisti-targets NAMESPACE reisti:: DESTINATION ${package_dir} COMPONENT development)

# What hosts of a static library link besides. The C runtime comes with every compiler.
set(REISTI_RUNTIME_LIBRARIES ${CMAKE_CXX_IMPLICIT_LINK_LIBRARIES})
list(FILTER REISTI_RUNTIME_LIBRARIES EXCLUDE REGEX "^(c|gcc|gcc_s)$")
list(REMOVE_DUPLICATES REISTI_RUNTIME_LIBRARIES)
list(TRANSFORM REISTI_RUNTIME_LIBRARIES PREPEND -l OUTPUT_VARIABLE REISTI_PC_PRIVATE_LIBS)
get_target_property(library_type reisti TYPE)
set(REISTI_NEEDS_RUV OFF)
if(REISTI_EXTERNAL_RUV AND library_type STREQUAL STATIC_LIBRARY)
  set(REISTI_NEEDS_RUV ON)
  list(PREPEND REISTI_PC_PRIVATE_LIBS -lruv)
  install(FILES cmake/Findruv.cmake DESTINATION ${package_dir} COMPONENT development)
endif()
list(JOIN REISTI_PC_PRIVATE_LIBS " " REISTI_PC_PRIVATE_LIBS)

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
