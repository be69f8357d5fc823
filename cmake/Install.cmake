# Installation and the Debian packages.
#
#   lib/cmpi/libvsprprovider_Module.so         component module
#   share/vsprprovider/*.mof, *.reg            component module
#   bin/vspr-register                          component module
#   lib/cmpi/libdtruj.so                       component simulator
#
# The module opens the adapter library by its bare name. Its RUNPATH is
# $ORIGIN, so the simulated library installed beside it is found without
# touching the system's library path, while a host's own library, where
# there is no simulator beside the module, comes from the usual places. The
# build tree's module carries the same RUNPATH: nothing sits beside it
# there, and the tests keep finding the library through LD_LIBRARY_PATH.
include(GNUInstallDirs)

# lib/cmpi whatever the architecture: the place CIM servers' provider
# packages use, and the one vspr-register looks in.
set(VSPR_MODULE_DIR "lib/cmpi")
set(VSPR_DATA_DIR "${CMAKE_INSTALL_DATADIR}/vsprprovider")

if(TARGET vsprprovider_Module)
  set_target_properties(vsprprovider_Module PROPERTIES
    INSTALL_RPATH "\$ORIGIN" BUILD_WITH_INSTALL_RPATH ON)
  install(TARGETS vsprprovider_Module LIBRARY
    DESTINATION "${VSPR_MODULE_DIR}" COMPONENT module)
endif()
if(TARGET dtruj)
  install(TARGETS dtruj LIBRARY
    DESTINATION "${VSPR_MODULE_DIR}" COMPONENT simulator)
endif()

install(FILES
    "${CMAKE_SOURCE_DIR}/schema/mof/vespera.mof"
    "${CMAKE_SOURCE_DIR}/schema/mof/vespera-interop.mof"
    "${CMAKE_SOURCE_DIR}/schema/vsprprovider.reg"
    "${CMAKE_SOURCE_DIR}/schema/vsprprovider-pegasus.mof"
  DESTINATION "${VSPR_DATA_DIR}" COMPONENT module)

# vspr-register finds the installed files relative to its own place, so
# that an install under another prefix works as well.
file(RELATIVE_PATH VSPR_BIN_TO_PREFIX
  "/prefix/${CMAKE_INSTALL_BINDIR}" "/prefix")
configure_file("${CMAKE_SOURCE_DIR}/tools/vspr-register.in"
  "${CMAKE_BINARY_DIR}/vspr-register" @ONLY
  FILE_PERMISSIONS OWNER_READ OWNER_WRITE OWNER_EXECUTE
                   GROUP_READ GROUP_EXECUTE WORLD_READ WORLD_EXECUTE)
install(PROGRAMS "${CMAKE_BINARY_DIR}/vspr-register"
  DESTINATION "${CMAKE_INSTALL_BINDIR}" COMPONENT module)

# Packages: vsprprovider (the module, its classes and registrations) and
# vsprprovider-simulator (the simulated adapter library, for a host without
# adapters). The maintainer scripts register the module with the CIM
# servers whose tools they find, and take the registration back on removal.
set(CPACK_GENERATOR "DEB")
set(CPACK_PACKAGE_NAME "vsprprovider")
set(CPACK_PACKAGE_VENDOR "Vespera")
set(CPACK_PACKAGE_CONTACT "Vespera <support@vespera.invalid>")
set(CPACK_PACKAGE_VERSION "${PROJECT_VERSION}")
set(CPACK_PACKAGING_INSTALL_PREFIX "/usr")
set(CPACK_STRIP_FILES ON)
set(CPACK_COMPONENTS_ALL module simulator)
set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_SECTION "admin")
set(CPACK_DEBIAN_MODULE_PACKAGE_NAME "vsprprovider")
set(CPACK_DEBIAN_SIMULATOR_PACKAGE_NAME "vsprprovider-simulator")
set(CPACK_DEBIAN_MODULE_DESCRIPTION
"CMPI provider module for Vespera FC HBAs and converged network adapters
Makes the host's adapters manageable through a CIM server (SFCB or
OpenPegasus) in the terms of the DMTF CIM schema and the SMI-S HBA
profiles. Installing registers it with the servers found on the host.")
set(CPACK_DEBIAN_SIMULATOR_DESCRIPTION
"Simulated Vespera adapter library for the CIM provider module
Stands in for the vendor's adapter library on a host without adapters:
the module finds it beside itself. Leave it off a host with adapters.")
set(CPACK_DEBIAN_MODULE_PACKAGE_SUGGESTS "sblim-sfcb, vsprprovider-simulator")
set(CPACK_DEBIAN_SIMULATOR_PACKAGE_DEPENDS "vsprprovider (= ${PROJECT_VERSION})")
# Library dependencies come from dpkg-shlibdeps where it is installed; else
# the one library the module needs beyond libc is named by hand.
find_program(VSPR_DPKG_SHLIBDEPS dpkg-shlibdeps)
if(VSPR_DPKG_SHLIBDEPS)
  set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
else()
  set(CPACK_DEBIAN_MODULE_PACKAGE_DEPENDS "libjsoncpp25 | libjsoncpp24 | libjsoncpp1")
endif()

set(_deb "${CMAKE_SOURCE_DIR}/cmake/deb")
set(CPACK_DEBIAN_MODULE_PACKAGE_CONTROL_EXTRA
  "${_deb}/postinst;${_deb}/prerm;${_deb}/postrm")
set(CPACK_DEBIAN_MODULE_PACKAGE_CONTROL_STRICT_PERMISSION ON)

include(CPack)
