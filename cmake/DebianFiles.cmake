# Debian's files of every package: in usr/share/doc/<package> the copyright
# file and the changelog (changelog.Debian.gz, the packages' versions having a
# Debian revision), and in usr/share/lintian/overrides/<package> the lintian
# tags that do not apply to them. They belong to the packages alone, so they
# install only with a component install (EXCLUDE_FROM_ALL), as cpack does; a
# plain `cmake --install` leaves them out.
#
# packaging/changelog needs an entry for each version of the packages: the
# package test checks that its latest entry is the packages' version.
include(${CMAKE_CURRENT_LIST_DIR}/Gzip.cmake)

kvveldra_gzip(${PROJECT_SOURCE_DIR}/packaging/changelog changelog_gz)
foreach(component IN LISTS CPACK_COMPONENTS_ALL)
  string(TOUPPER ${component} upper)
  set(package ${CPACK_DEBIAN_${upper}_PACKAGE_NAME})
  set(doc_dir ${CMAKE_INSTALL_DATAROOTDIR}/doc/${package})
  install(FILES ${PROJECT_SOURCE_DIR}/packaging/copyright
    DESTINATION ${doc_dir} COMPONENT ${component} EXCLUDE_FROM_ALL)
  install(FILES ${changelog_gz} RENAME changelog.Debian.gz
    DESTINATION ${doc_dir} COMPONENT ${component} EXCLUDE_FROM_ALL)
  install(FILES ${PROJECT_SOURCE_DIR}/packaging/lintian-overrides RENAME ${package}
    DESTINATION ${CMAKE_INSTALL_DATAROOTDIR}/lintian/overrides COMPONENT ${component} EXCLUDE_FROM_ALL)
endforeach()
