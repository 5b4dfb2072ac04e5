include(CMakePackageConfigHelpers)

install(TARGETS velkcore velkui EXPORT velkuiTargets
  ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR}
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}
  RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR}
  INCLUDES DESTINATION ${CMAKE_INSTALL_INCLUDEDIR})

# Each subsystem keeps its public headers in <subsystem>/include.
foreach(subsystem core pictel ui arrange layout controls automateui dialogs utility utils datatransfer sharedui)
  if(EXISTS ${PROJECT_SOURCE_DIR}/${subsystem}/include)
    install(DIRECTORY ${PROJECT_SOURCE_DIR}/${subsystem}/include/
      DESTINATION ${CMAKE_INSTALL_INCLUDEDIR} FILES_MATCHING PATTERN "*.h")
  endif()
endforeach()

set(VELKUI_CMAKE_DIR ${CMAKE_INSTALL_LIBDIR}/cmake/velkui)
install(EXPORT velkuiTargets NAMESPACE velkui:: DESTINATION ${VELKUI_CMAKE_DIR})
configure_package_config_file(cmake/velkuiConfig.cmake.in
  ${CMAKE_CURRENT_BINARY_DIR}/velkuiConfig.cmake INSTALL_DESTINATION ${VELKUI_CMAKE_DIR})
write_basic_package_version_file(${CMAKE_CURRENT_BINARY_DIR}/velkuiConfigVersion.cmake
  COMPATIBILITY SameMinorVersion)
install(FILES
  ${CMAKE_CURRENT_BINARY_DIR}/velkuiConfig.cmake
  ${CMAKE_CURRENT_BINARY_DIR}/velkuiConfigVersion.cmake
  cmake/VelkuiDependencies.cmake
  DESTINATION ${VELKUI_CMAKE_DIR})
