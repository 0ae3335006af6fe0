# What `cmake --install` puts where. Three components: vorl_Runtime (the shared library),
# vorl_Development (headers, archive, package files) and vorl_Tools (the programs).
include(CMakePackageConfigHelpers)
include(${CMAKE_CURRENT_LIST_DIR}/VorlHeaders.cmake)

set(package_dir ${CMAKE_INSTALL_LIBDIR}/cmake/vorl)

install(TARGETS vorl EXPORT vorlTargets
  RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR} COMPONENT vorl_Runtime
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT vorl_Runtime
    NAMELINK_COMPONENT vorl_Development
  ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT vorl_Development)

vorl_public_headers(headers)
foreach(header IN LISTS headers)
  get_filename_component(folder ${header} DIRECTORY)
  install(FILES ${header} DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/${folder}
    COMPONENT vorl_Development)
endforeach()

install(EXPORT vorlTargets NAMESPACE vorl:: DESTINATION ${package_dir} COMPONENT vorl_Development)

# A static library hands its own dependencies on to whoever links it; a shared one keeps them.
get_target_property(library_type vorl TYPE)
set(VORL_PACKAGE_DEPENDENCIES "")
if(library_type STREQUAL "STATIC_LIBRARY")
  set(VORL_PACKAGE_DEPENDENCIES "include(CMakeFindDependencyMacro)\nfind_dependency(Threads)\n")
  if(NOT WIN32)
    string(APPEND VORL_PACKAGE_DEPENDENCIES
      "find_dependency(PkgConfig)\n"
      "pkg_check_modules(VORL_DEVICE REQUIRED IMPORTED_TARGET pixman-1 freetype2 fontconfig)\n")
  endif()
endif()
configure_package_config_file(cmake/vorlConfig.cmake.in ${PROJECT_BINARY_DIR}/vorlConfig.cmake
  INSTALL_DESTINATION ${package_dir})
# Before 1.0 a new minor version may change the interface.
write_basic_package_version_file(${PROJECT_BINARY_DIR}/vorlConfigVersion.cmake
  COMPATIBILITY SameMinorVersion)
install(FILES ${PROJECT_BINARY_DIR}/vorlConfig.cmake ${PROJECT_BINARY_DIR}/vorlConfigVersion.cmake
  DESTINATION ${package_dir} COMPONENT vorl_Development)
install(FILES LICENSE DESTINATION ${CMAKE_INSTALL_DOCDIR} COMPONENT vorl_Development)

if(TARGET vorl_cli)
  install(TARGETS vorl_cli RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR} COMPONENT vorl_Tools)
  # The installed tool finds the library beside it, wherever both are moved.
  file(RELATIVE_PATH library_path ${CMAKE_INSTALL_FULL_BINDIR} ${CMAKE_INSTALL_FULL_LIBDIR})
  set_target_properties(vorl_cli PROPERTIES INSTALL_RPATH "$ORIGIN/${library_path}")
endif()
