# The build tree as a package of its own, so that a program builds and runs
# against the library without an install:
#
#   cmake -DCMAKE_PREFIX_PATH=<build>   find_package(kvveldra_tag) finds
#       kvveldra_tagConfig.cmake at the top of the build tree; it includes the
#       targets file beside it, which export() writes here: the library of the
#       build tree, the headers of the source tree.
#   PKG_CONFIG_PATH=<build>             pkg-config takes
#       kvveldra_tag-uninstalled.pc, which it prefers to kvveldra_tag.pc in
#       every folder it searches. Its Libs carry the library's folder as run
#       path too, as CMake gives its programs, so that they run as built.
#
# The package test builds and runs a consumer both ways.
export(EXPORT kvveldra_tagTargets NAMESPACE kvveldra::
  FILE ${PROJECT_BINARY_DIR}/kvveldra_tagTargets.cmake)

configure_file(${PROJECT_SOURCE_DIR}/cmake/kvveldra_tag-uninstalled.pc.in
  ${PROJECT_BINARY_DIR}/CMakeFiles/kvveldra_tag-uninstalled.pc.in @ONLY)
file(GENERATE OUTPUT ${PROJECT_BINARY_DIR}/kvveldra_tag-uninstalled.pc
  INPUT ${PROJECT_BINARY_DIR}/CMakeFiles/kvveldra_tag-uninstalled.pc.in)
