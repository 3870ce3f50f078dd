include(CMakePackageConfigHelpers)

install(TARGETS kvveldra_tag EXPORT kvveldra_tagTargets
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}
  INCLUDES DESTINATION ${CMAKE_INSTALL_INCLUDEDIR})
install(DIRECTORY ${PROJECT_SOURCE_DIR}/include/kvveldra DESTINATION ${CMAKE_INSTALL_INCLUDEDIR})
install(EXPORT kvveldra_tagTargets NAMESPACE kvveldra::
  DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/kvveldra_tag)

configure_package_config_file(${PROJECT_SOURCE_DIR}/cmake/kvveldra_tagConfig.cmake.in
  ${PROJECT_BINARY_DIR}/kvveldra_tagConfig.cmake
  INSTALL_DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/kvveldra_tag)
write_basic_package_version_file(${PROJECT_BINARY_DIR}/kvveldra_tagConfigVersion.cmake
  COMPATIBILITY SameMajorVersion)
install(FILES ${PROJECT_BINARY_DIR}/kvveldra_tagConfig.cmake
  ${PROJECT_BINARY_DIR}/kvveldra_tagConfigVersion.cmake
  DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/kvveldra_tag)

configure_file(${PROJECT_SOURCE_DIR}/cmake/kvveldra_tag.pc.in
  ${PROJECT_BINARY_DIR}/kvveldra_tag.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/kvveldra_tag.pc
  DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig)
