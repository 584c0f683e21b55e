# One Debian package with everything a workstation needs: the hotfolder
# host, the EPS filter module, the host SDK (headers, library, CMake
# package) and the message catalogues. `cpack -G DEB` in the build tree.
set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME hotfolder)
set(CPACK_PACKAGE_VERSION ${PROJECT_VERSION})
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY
  "Hot-folder print client with its EPS input filter and host SDK")
set(CPACK_PACKAGE_DESCRIPTION
  "Watches folders for EPS files, lays them out as PostScript jobs on the printer's paper and submits them to CUPS. Includes the SDK for building further input filters.")
set(CPACK_PACKAGE_CONTACT "Hot folder developers <hotfolder-dev@localhost>")
set(CPACK_DEBIAN_PACKAGE_MAINTAINER "Hot folder developers <hotfolder-dev@localhost>")
set(CPACK_DEBIAN_PACKAGE_SECTION utils)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
# Installed as a system package; the host finds its module and libraries
# relative to itself, so the prefix is free.
set(CPACK_PACKAGING_INSTALL_PREFIX /usr)

find_program(HF_DPKG_SHLIBDEPS dpkg-shlibdeps)
if(HF_DPKG_SHLIBDEPS)
  # The package's own library satisfies its programs' need for it.
  set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
  set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS
    "${CMAKE_BINARY_DIR}/lib")
else()
  set(CPACK_DEBIAN_PACKAGE_DEPENDS "libwxbase3.2-1, libwxgtk3.2-1, libcups2")
endif()
# Conversion output is checked with Ghostscript and printed through CUPS.
set(CPACK_DEBIAN_PACKAGE_RECOMMENDS "cups-client, ghostscript")

# The service is enabled at install (it starts at boot) and stopped at removal.
set(CPACK_DEBIAN_PACKAGE_CONTROL_EXTRA
  "${CMAKE_CURRENT_LIST_DIR}/debian/postinst;${CMAKE_CURRENT_LIST_DIR}/debian/prerm;${CMAKE_CURRENT_LIST_DIR}/debian/postrm")
set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)

include(CPack)
