# Debian packages, one per install component, made by `cpack -G DEB` (or plain
# `cpack`) in the build directory:
#
#   runtime -> libkvveldra-tag1     libkvveldra_tag.so.1* and libkvsslinit.so.13
#   dev     -> libkvveldra-tag-dev  headers, CMake package, pkg-config file and
#                                   the libkvveldra_tag.so link
#   tools   -> kvveldra-tools       the command-line tools and the reference
#                                   tag service
#   python  -> python3-kvveldra     the Python module kvveldra in Debian's
#                                   dist-packages (when the tree builds it)
#
# Only these components are packaged. Whatever installs under another
# component or under none ("Unspecified") stays out of every package; tests,
# benchmarks and the host stand-in install nothing at all. The demo installs as
# component "demo" and is left out: it runs only against a broker and a service
# set up as scripts/demo.sh does, and its source is the part worth reading.
#
# The packages take the install directories of the build, Debian's (usr/bin,
# usr/include, usr/lib/<triplet>: see cmake/InstallDirs.cmake), and each holds
# the files Debian wants in every package: copyright, changelog and lintian
# overrides (cmake/DebianFiles.cmake). The package test runs lintian on them.

if(KVVELDRA_MULTIARCH_LIBDIR AND NOT CMAKE_INSTALL_LIBDIR STREQUAL KVVELDRA_MULTIARCH_LIBDIR)
  message(WARNING "The Debian packages of this tree hold the libraries in usr/${CMAKE_INSTALL_LIBDIR}, "
    "not in Debian's usr/${KVVELDRA_MULTIARCH_LIBDIR}: reconfigure with -U CMAKE_INSTALL_LIBDIR "
    "for the default.")
endif()

set(KVVELDRA_PACKAGE_MAINTAINER "kvveldra_tag maintainers <kvveldra-tag@example.org>"
  CACHE STRING "Maintainer field of the Debian packages")
set(KVVELDRA_PACKAGE_RELEASE "1"
  CACHE STRING "Debian revision of the packages (the part after the version's hyphen)")

set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME kvveldra-tag)
set(CPACK_PACKAGE_VENDOR "kvveldra_tag")
set(CPACK_PACKAGE_VERSION ${PROJECT_VERSION})
set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
# Release packages carry no debug sections; the build tree keeps them.
set(CPACK_STRIP_FILES ON)

set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_COMPONENTS_ALL runtime dev tools)
set(CPACK_COMPONENT_DEV_DEPENDS runtime)
set(CPACK_COMPONENT_TOOLS_DEPENDS runtime)
if(TARGET _kvveldra)
  list(APPEND CPACK_COMPONENTS_ALL python)
  set(CPACK_COMPONENT_PYTHON_DEPENDS runtime)
endif()

set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_RELEASE ${KVVELDRA_PACKAGE_RELEASE})
set(CPACK_DEBIAN_PACKAGE_MAINTAINER "${KVVELDRA_PACKAGE_MAINTAINER}")
set(CPACK_DEBIAN_PACKAGE_PRIORITY optional)
# The component dependencies above become "<package> (= <version>-<release>)".
set(CPACK_DEBIAN_ENABLE_COMPONENT_DEPENDS ON)
# dpkg-shlibdeps names the shared libraries' packages as the Debian release the
# packages are built on calls them (librabbitmq4, libssl3, libstdc++6, ...).
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
# For a tool that links libkvveldra_tag.so.1, dpkg-shlibdeps finds the library
# in the build tree; the component dependency names its package.
get_target_property(kvveldra_tag_dir kvveldra_tag LIBRARY_OUTPUT_DIRECTORY)
if(NOT kvveldra_tag_dir)
  get_target_property(kvveldra_tag_dir kvveldra_tag BINARY_DIR)
endif()
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS ${kvveldra_tag_dir})

set(CPACK_DEBIAN_RUNTIME_PACKAGE_NAME libkvveldra-tag1)
set(CPACK_DEBIAN_RUNTIME_PACKAGE_SECTION libs)
# A shlibs file in the package of each shared library (only the runtime
# package has any), so that packages built against them depend on it.
set(CPACK_DEBIAN_PACKAGE_GENERATE_SHLIBS ON)
set(CPACK_DEBIAN_PACKAGE_GENERATE_SHLIBS_POLICY ">=")
# Debian runs ldconfig through its trigger, which the runtime package activates
# (packaging/triggers); maintainer scripts that call ldconfig themselves are
# out of date. CPack writes such a postinst and postrm for a package of shared
# libraries unless the package brings its own: the two names below, which no
# file has, stand for them. cpack warns that they are missing, and puts in the
# package only the control files that exist.
set(CPACK_DEBIAN_RUNTIME_PACKAGE_CONTROL_EXTRA
  ${PROJECT_SOURCE_DIR}/packaging/triggers
  ${PROJECT_BINARY_DIR}/no-maintainer-scripts/postinst
  ${PROJECT_BINARY_DIR}/no-maintainer-scripts/postrm)
set(CPACK_DEBIAN_RUNTIME_DESCRIPTION
  "Client library for a tag service over an AMQP message bus
Named, typed current values with keywords, properties and aggregates, kept by
remote services that an AMQP 0-9-1 broker connects. The library exports two
families of functions: blocking TagConsole* calls with standard C++ types and
non-blocking TagWB* calls for a graphical dataflow host.
.
This package holds the shared library and libkvsslinit, the TLS start-up
library that it loads at run time.")

set(CPACK_DEBIAN_DEV_PACKAGE_NAME libkvveldra-tag-dev)
set(CPACK_DEBIAN_DEV_PACKAGE_SECTION libdevel)
set(CPACK_DEBIAN_DEV_DESCRIPTION
  "Client library for a tag service - development files
The public headers (kvveldra/TagConsole.h, kvveldra/TagWB.h), the CMake package
(find_package(kvveldra_tag), target kvveldra::kvveldra_tag) and the pkg-config
file (kvveldra_tag) for building programs against libkvveldra_tag.")

set(CPACK_DEBIAN_TOOLS_PACKAGE_NAME kvveldra-tools)
set(CPACK_DEBIAN_TOOLS_PACKAGE_SECTION net)
set(CPACK_DEBIAN_TOOLS_DESCRIPTION
  "Client library for a tag service - tools
Command-line tools for the tag library and kvveldra-tagservice, a reference tag
service that keeps tags in memory or in an SQLite file and answers on the
message bus.")

set(CPACK_DEBIAN_PYTHON_PACKAGE_NAME python3-kvveldra)
set(CPACK_DEBIAN_PYTHON_PACKAGE_SECTION python)
# The extension is built for one Python version, the interpreter's of the build.
if(TARGET _kvveldra)
  math(EXPR kvveldra_python_next "${KVVELDRA_PYTHON_MINOR} + 1")
  set(CPACK_DEBIAN_PYTHON_PACKAGE_DEPENDS
    "python3 (>= ${KVVELDRA_PYTHON_MAJOR}.${KVVELDRA_PYTHON_MINOR}), python3 (<< ${KVVELDRA_PYTHON_MAJOR}.${kvveldra_python_next})")
endif()
set(CPACK_DEBIAN_PYTHON_DESCRIPTION
  "Client library for a tag service - Python module
The module kvveldra: a Client that opens, creates and lists tags, and Tag
objects that write and read values, keywords, properties and aggregates,
with Python's own types and exceptions, over the library's blocking
TagConsole functions. Type stubs are included.")

include(${CMAKE_CURRENT_LIST_DIR}/DebianFiles.cmake)
include(CPack)
