# Builds the Debian package from the build tree, unpacks it into a scratch
# root and runs the packaged host from there.
#   cmake -DBUILD_DIR=... -DSCRATCH=... -P PackageInstallTest.cmake
foreach(built bin/hotfolder bin/hotfolder-manager lib/hotfolder/filters/EPS.so)
  if(NOT EXISTS "${BUILD_DIR}/${built}")
    message(FATAL_ERROR "${BUILD_DIR}/${built} is missing: build the whole tree "
      "(targets hotfolder and EPS) before packaging")
  endif()
endforeach()
find_program(DPKG_DEB dpkg-deb REQUIRED)

file(REMOVE_RECURSE "${SCRATCH}")
file(MAKE_DIRECTORY "${SCRATCH}/out" "${SCRATCH}/root")
execute_process(COMMAND "${CMAKE_CPACK_COMMAND}" -G DEB -B "${SCRATCH}/out"
  WORKING_DIRECTORY "${BUILD_DIR}" RESULT_VARIABLE packed OUTPUT_VARIABLE log ERROR_VARIABLE log)
file(GLOB debs "${SCRATCH}/out/*.deb")
list(LENGTH debs count)
if(NOT packed EQUAL 0 OR NOT count EQUAL 1)
  message(FATAL_ERROR "cpack failed (${packed}, ${count} packages):\n${log}")
endif()

execute_process(COMMAND "${DPKG_DEB}" -f ${debs} Package Depends
  RESULT_VARIABLE read OUTPUT_VARIABLE control)
if(NOT read EQUAL 0 OR NOT control MATCHES "Package: hotfolder" OR NOT control MATCHES "libwx")
  message(FATAL_ERROR "package control fields wrong:\n${control}")
endif()

# The maintainer scripts enable the service at install (it starts at boot).
file(MAKE_DIRECTORY "${SCRATCH}/control")
execute_process(COMMAND "${DPKG_DEB}" -e ${debs} "${SCRATCH}/control" RESULT_VARIABLE extracted)
file(READ "${SCRATCH}/control/postinst" postinst)
if(NOT extracted EQUAL 0 OR NOT postinst MATCHES "deb-systemd-helper enable hotfolder.service"
    OR NOT EXISTS "${SCRATCH}/control/prerm")
  message(FATAL_ERROR "the package does not enable and stop the service:\n${postinst}")
endif()

execute_process(COMMAND "${DPKG_DEB}" -x ${debs} "${SCRATCH}/root" RESULT_VARIABLE unpacked)
if(NOT unpacked EQUAL 0)
  message(FATAL_ERROR "dpkg-deb -x failed")
endif()
set(root "${SCRATCH}/root/usr")
foreach(file bin/hotfolder lib/hotfolder/filters/EPS.so include/hotfolder/HFPlugin.h
    lib/cmake/HotFolderSDK/HotFolderSDKConfig.cmake lib/systemd/system/hotfolder.service
    bin/hotfolder-manager share/applications/hotfolder-manager.desktop
    share/icons/hicolor/scalable/apps/hotfolder-manager.svg)
  if(NOT EXISTS "${root}/${file}")
    message(FATAL_ERROR "the package lacks /usr/${file}")
  endif()
endforeach()
# The desktop entry as installed must satisfy the desktops' own checker.
find_program(DESKTOP_FILE_VALIDATE desktop-file-validate REQUIRED)
execute_process(COMMAND "${DESKTOP_FILE_VALIDATE}" "${root}/share/applications/hotfolder-manager.desktop"
  RESULT_VARIABLE valid OUTPUT_VARIABLE complaints ERROR_VARIABLE complaints)
if(NOT valid EQUAL 0 OR NOT complaints STREQUAL "")
  message(FATAL_ERROR "the desktop entry is not clean:\n${complaints}")
endif()
file(GLOB sdk_libs "${root}/lib/libhotfolder_sdk.so*")
file(GLOB_RECURSE catalogues "${root}/share/hotfolder/locale/*.mo")
if(NOT sdk_libs OR NOT catalogues)
  message(FATAL_ERROR "the package lacks the SDK library or the catalogues")
endif()

# The packaged host must find the packaged module, not the build tree's.
execute_process(COMMAND "${CMAKE_COMMAND}" -E env --unset=HOTFOLDER_MODULE
    "LD_LIBRARY_PATH=${root}/lib"
    "${root}/bin/hotfolder" info
  WORKING_DIRECTORY "${SCRATCH}" RESULT_VARIABLE ran OUTPUT_VARIABLE out ERROR_VARIABLE err)
if(NOT ran EQUAL 0 OR NOT out MATCHES "Orv\\.EPS\\.1")
  message(FATAL_ERROR "packaged hotfolder info failed (${ran}):\n${out}\n${err}")
endif()
string(FIND "${out}" "${root}/lib/hotfolder/filters/EPS.so" packaged_module)
if(packaged_module EQUAL -1)
  message(FATAL_ERROR "packaged hotfolder did not load the packaged module:\n${out}")
endif()
message(STATUS "package ${debs} installs and runs")
