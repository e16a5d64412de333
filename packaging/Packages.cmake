# The packages for Debian, one for each component. tools/package makes them.
set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME tessel)
set(CPACK_PACKAGE_VERSION "${PROJECT_VERSION}")
set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
set(CPACK_COMPONENTS_ALL host dev modrig)
set(CPACK_STRIP_FILES ON)
set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_COMPRESSION_TYPE xz)
set(CPACK_DEBIAN_PACKAGE_MAINTAINER "The Modrig developers <modrig@packages.invalid>")
set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS "${TESSEL_APP_BINARIES}")

# The toolkit loads what draws for it by a name with its own version in it.
find_library(GNUSTEP_GUI gnustep-gui REQUIRED)
file(REAL_PATH "${GNUSTEP_GUI}" gui)
string(REGEX REPLACE ".*[.]so[.]([0-9]+[.][0-9]+).*" "gnustep-back\\1-cairo" backend "${gui}")

set(CPACK_DEBIAN_HOST_PACKAGE_NAME tessel)
set(CPACK_DEBIAN_HOST_PACKAGE_SECTION graphics)
set(CPACK_DEBIAN_HOST_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_HOST_PACKAGE_DEPENDS "${backend}, fonts-dejavu-core")
set(CPACK_DEBIAN_HOST_PACKAGE_RECOMMENDS "fonts-inter, xdg-utils")
set(CPACK_DEBIAN_HOST_DESCRIPTION "CAD host that loads applications of many kinds
Tessel reads commands and Lisp, and loads applications: bundles, core
modules, object-database modules and Lisp files. Modrig, which comes with
it, loads and unloads them in a dialog and keeps those that are loaded at
every start.")

set(CPACK_DEBIAN_DEV_PACKAGE_NAME tessel-dev)
set(CPACK_DEBIAN_DEV_PACKAGE_SECTION devel)
set(CPACK_DEBIAN_DEV_PACKAGE_DEPENDS "tessel (= ${PROJECT_VERSION})")
set(CPACK_DEBIAN_DEV_PACKAGE_RECOMMENDS "g++, cmake, llvm, lld")
set(CPACK_DEBIAN_DEV_PACKAGE_SUGGESTS "libgtest-dev, libgmock-dev, libicu-dev, pkgconf")
set(CPACK_DEBIAN_DEV_DESCRIPTION "what applications for Tessel are written with
The SDK of Tessel: headers that describe every service of the host, what
CMake and pkg-config find it by, a command that writes a project to begin
with, a host in memory for tests of modules, the tests that every host has
to pass, the guide for authors of modules, and the sources of a sample of
every kind of application.")

set(CPACK_DEBIAN_MODRIG_PACKAGE_NAME modrig)
set(CPACK_DEBIAN_MODRIG_PACKAGE_SECTION graphics)
set(CPACK_DEBIAN_MODRIG_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_MODRIG_DESCRIPTION "application loader for hosts with the Tessel SDK
Modrig is a module for a host that offers the services of the Tessel SDK.
It loads and unloads applications in a dialog, remembers them, and loads
those of its Startup Suite at every start. The package tessel has it
already; this is for other hosts.")
include(CPack)
