# Debian packages with CPack (scripts/package.sh): "libvelmar<soversion>" holds the shared
# library, "libvelmar-dev" the headers, the CMake package and velmar.pc. The runtime
# package's dependencies on the Qt 6 and ICU libraries are read from the library itself by
# dpkg-shlibdeps, so they follow whatever the build linked.
set(VELMAR_DEB_RUNTIME libvelmar${PROJECT_VERSION_MAJOR})

set(CPACK_PACKAGE_NAME velmar)
set(CPACK_PACKAGE_VENDOR "Velmar")
set(CPACK_PACKAGE_VERSION ${PROJECT_VERSION})
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "Classic Toolbox and Carbon interfaces on Qt")
set(CPACK_PACKAGE_CONTACT "Velmar developers <velmar@localhost>")
set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
set(CPACK_COMPONENTS_ALL runtime dev)
set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_SECTION libs)
set(CPACK_STRIP_FILES ON) # the debugging information stays in the build tree

set(CPACK_DEBIAN_RUNTIME_PACKAGE_NAME ${VELMAR_DEB_RUNTIME})
set(CPACK_DEBIAN_RUNTIME_PACKAGE_SHLIBDEPS ON)
# The classic library needs the main one, which is in this package too.
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS ${PROJECT_BINARY_DIR}/src)
# The platform plugins: X11 (xcb) and Wayland desktops.
set(CPACK_DEBIAN_RUNTIME_PACKAGE_RECOMMENDS "qt6-qpa-plugins, qt6-wayland")
set(CPACK_COMPONENT_RUNTIME_DESCRIPTION
  "The shared library: runs programs written for the classic Macintosh Toolbox and Carbon\ninterfaces on Qt 6, on X11 and Wayland desktops.")

set(CPACK_DEBIAN_DEV_PACKAGE_NAME libvelmar-dev)
set(CPACK_DEBIAN_DEV_PACKAGE_SECTION libdevel)
# The CMake package and velmar.pc ask for Qt 6's own development files.
set(CPACK_DEBIAN_DEV_PACKAGE_DEPENDS "${VELMAR_DEB_RUNTIME} (= ${PROJECT_VERSION}), qt6-base-dev (>= 6.4)")
set(CPACK_COMPONENT_DEV_DESCRIPTION
  "Development files: the headers, the CMake package (find_package(Velmar)) and velmar.pc.")

include(CPack)
