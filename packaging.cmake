# Debian package of the console's tree: `cpack -G DEB` in the build folder writes
# dorvex_<version>_<arch>.deb, which installs everything under /opt/olv.

set(CPACK_PACKAGE_NAME "dorvex")
set(CPACK_PACKAGE_VENDOR "dorvex developers")
set(CPACK_PACKAGE_VERSION ${PROJECT_VERSION})
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY
    "vital product data of a rack installation: the dorvex query program and its database")
set(CPACK_PACKAGE_DESCRIPTION
    "dorvex runs on the management console of a rack installation and prints the vital\n\
product data of its switch chassis, bulk power assemblies and CEC switch adapters from\n\
the VPD database under /opt/olv/data. vpdload imports and exports that database as a\n\
JSON inventory. The package also carries stand-ins for the console's hardware-server\n\
client, power-controller commands and rackprobe tool, the vpdDB headers and library\n\
for other producers, and an example installation.")
set(CPACK_PACKAGING_INSTALL_PREFIX "/opt/olv")
# The package carries no debug information; build trees keep it.
set(CPACK_STRIP_FILES ON)

set(CPACK_DEBIAN_PACKAGE_MAINTAINER "dorvex developers <dorvex@localhost>")
set(CPACK_DEBIAN_PACKAGE_SECTION "admin")
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
# The libraries' dependencies come from dpkg-shlibdeps (package dpkg-dev) when it is there;
# without it, the C and C++ runtimes are named by hand.
find_program(DORVEX_DPKG_SHLIBDEPS dpkg-shlibdeps)
if(DORVEX_DPKG_SHLIBDEPS)
  set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
  # The package's own libraries are found through the programs' run path.
  set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS "${CMAKE_BINARY_DIR}/platform/chronicle"
      "${CMAKE_BINARY_DIR}/platform/nodebridge" "${CMAKE_BINARY_DIR}/platform/rackpower")
else()
  set(CPACK_DEBIAN_PACKAGE_DEPENDS "libc6, libstdc++6, libgcc-s1")
endif()

set(CPACK_GENERATOR "DEB")
include(CPack)
