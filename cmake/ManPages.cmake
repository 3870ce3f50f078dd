# The manual page of every program that the tools package installs:
# <program>.1 beside the program's sources. A program missing here fails the
# package test: lintian warns of a program without its manual page.
include(${CMAKE_CURRENT_LIST_DIR}/Gzip.cmake)

foreach(program IN ITEMS kvtag kvveldra-tagservice)
  if(TARGET ${program})
    get_target_property(program_dir ${program} SOURCE_DIR)
    kvveldra_gzip(${program_dir}/${program}.1 page)
    install(FILES ${page} DESTINATION ${CMAKE_INSTALL_MANDIR}/man1 COMPONENT tools)
  endif()
endforeach()
