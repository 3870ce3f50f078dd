# Install rules, each in one of three components (the Debian packages of
# cmake/Packaging.cmake): "runtime" the shared libraries, "dev" what building
# against them needs, "tools" the programs.
include(CMakePackageConfigHelpers)

install(TARGETS kvveldra_tag EXPORT kvveldra_tagTargets
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT runtime NAMELINK_COMPONENT dev)
install(DIRECTORY ${PROJECT_SOURCE_DIR}/include/kvveldra DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}
  COMPONENT dev)
install(EXPORT kvveldra_tagTargets NAMESPACE kvveldra::
  DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/kvveldra_tag COMPONENT dev)

# The public headers need the C++ standard library alone, and the shared
# library links everything else privately: the package config finds no
# dependencies. It uses none of the PACKAGE_ paths either, only the targets
# file beside it, so that the same file serves the build tree
# (cmake/BuildTreePackage.cmake).
configure_package_config_file(${PROJECT_SOURCE_DIR}/cmake/kvveldra_tagConfig.cmake.in
  ${PROJECT_BINARY_DIR}/kvveldra_tagConfig.cmake
  INSTALL_DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/kvveldra_tag)
write_basic_package_version_file(${PROJECT_BINARY_DIR}/kvveldra_tagConfigVersion.cmake
  COMPATIBILITY SameMajorVersion)
install(FILES ${PROJECT_BINARY_DIR}/kvveldra_tagConfig.cmake
  ${PROJECT_BINARY_DIR}/kvveldra_tagConfigVersion.cmake
  DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/kvveldra_tag COMPONENT dev)

# The .pc file finds the prefix from its own folder, so that it holds wherever
# the tree is installed or unpacked: one ".." per part of <libdir>/pkgconfig
# (lib/pkgconfig, or Debian's lib/<triplet>/pkgconfig). Absolute install
# directories are written as they are.
if(IS_ABSOLUTE "${CMAKE_INSTALL_LIBDIR}")
  set(KVVELDRA_PC_LIBDIR "${CMAKE_INSTALL_LIBDIR}")
  set(KVVELDRA_PC_PREFIX "${CMAKE_INSTALL_PREFIX}")
else()
  string(REGEX REPLACE "[^/]+" ".." KVVELDRA_PC_PREFIX "${CMAKE_INSTALL_LIBDIR}/pkgconfig")
  set(KVVELDRA_PC_PREFIX "\${pcfiledir}/${KVVELDRA_PC_PREFIX}")
  set(KVVELDRA_PC_LIBDIR "\${prefix}/${CMAKE_INSTALL_LIBDIR}")
endif()
if(IS_ABSOLUTE "${CMAKE_INSTALL_INCLUDEDIR}")
  set(KVVELDRA_PC_INCLUDEDIR "${CMAKE_INSTALL_INCLUDEDIR}")
else()
  set(KVVELDRA_PC_INCLUDEDIR "\${prefix}/${CMAKE_INSTALL_INCLUDEDIR}")
endif()
configure_file(${PROJECT_SOURCE_DIR}/cmake/kvveldra_tag.pc.in
  ${PROJECT_BINARY_DIR}/kvveldra_tag.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/kvveldra_tag.pc
  DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig COMPONENT dev)

# The user's guide, when the tree has one, goes with the development files.
file(GLOB KVVELDRA_GUIDE_FILES CONFIGURE_DEPENDS ${PROJECT_SOURCE_DIR}/docs/*.md)
if(KVVELDRA_GUIDE_FILES)
  install(FILES ${KVVELDRA_GUIDE_FILES}
    DESTINATION ${CMAKE_INSTALL_DATAROOTDIR}/doc/libkvveldra-tag-dev COMPONENT dev)
endif()

include(${CMAKE_CURRENT_LIST_DIR}/ManPages.cmake)
include(${CMAKE_CURRENT_LIST_DIR}/BuildTreePackage.cmake)
