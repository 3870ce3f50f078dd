# The install directories: GNUInstallDirs, except that on a Debian-family
# system the libraries go to Debian's multiarch directory lib/<triplet> for
# every prefix, where GNUInstallDirs chooses it for /usr alone.
#
# So the Debian packages hold usr/lib/<triplet> whatever prefix the tree was
# configured with (cpack installs with prefix /usr), as Debian's own build
# helpers install libraries; and a plain `cmake --install` with the default
# prefix /usr/local puts the library in /usr/local/lib/<triplet>, which
# Debian's loader searches (/etc/ld.so.conf.d/<triplet>.conf), as do pkg-config
# and find_package. The default prefix stays /usr/local: /usr belongs to the
# package manager. A CMAKE_INSTALL_LIBDIR given on the command line wins.
unset(KVVELDRA_MULTIARCH_LIBDIR)
if(CMAKE_LIBRARY_ARCHITECTURE AND EXISTS /etc/debian_version)
  set(KVVELDRA_MULTIARCH_LIBDIR "lib/${CMAKE_LIBRARY_ARCHITECTURE}")
  if(NOT DEFINED CMAKE_INSTALL_LIBDIR)
    set(CMAKE_INSTALL_LIBDIR "${KVVELDRA_MULTIARCH_LIBDIR}"
      CACHE PATH "Object code libraries (${KVVELDRA_MULTIARCH_LIBDIR})")
  endif()
endif()

set(kvveldra_libdir_before "${CMAKE_INSTALL_LIBDIR}")
include(GNUInstallDirs)
# When the prefix of a configured tree changes from /usr to another,
# GNUInstallDirs turns lib/<triplet>, its default for /usr, into lib; keep it.
if(KVVELDRA_MULTIARCH_LIBDIR AND kvveldra_libdir_before STREQUAL KVVELDRA_MULTIARCH_LIBDIR
   AND NOT CMAKE_INSTALL_LIBDIR STREQUAL kvveldra_libdir_before)
  set_property(CACHE CMAKE_INSTALL_LIBDIR PROPERTY VALUE "${kvveldra_libdir_before}")
  GNUInstallDirs_get_absolute_install_dir(CMAKE_INSTALL_FULL_LIBDIR CMAKE_INSTALL_LIBDIR LIBDIR)
endif()
