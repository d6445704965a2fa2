# Install the library, its public headers, a CMake package and a pkg-config file, in two
# components: "runtime" (the shared library) and "dev" (everything a build needs). The
# Debian packages (cmake/VelmarPackaging.cmake) are made from these components.
include(CMakePackageConfigHelpers)

install(TARGETS Velmar EXPORT VelmarTargets
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT runtime NAMELINK_COMPONENT dev
  ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT dev
  RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR} COMPONENT runtime
  INCLUDES DESTINATION ${CMAKE_INSTALL_INCLUDEDIR})
install(DIRECTORY ${PROJECT_SOURCE_DIR}/include/Velmar
  DESTINATION ${CMAKE_INSTALL_INCLUDEDIR} COMPONENT dev FILES_MATCHING PATTERN "*.h")
install(FILES ${PROJECT_BINARY_DIR}/include/Velmar/VelmarExport.h
  DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/Velmar COMPONENT dev)

set(VELMAR_CMAKE_DIR ${CMAKE_INSTALL_LIBDIR}/cmake/Velmar)
install(EXPORT VelmarTargets NAMESPACE Velmar:: DESTINATION ${VELMAR_CMAKE_DIR} COMPONENT dev)
configure_package_config_file(${PROJECT_SOURCE_DIR}/cmake/VelmarConfig.cmake.in
  ${PROJECT_BINARY_DIR}/VelmarConfig.cmake INSTALL_DESTINATION ${VELMAR_CMAKE_DIR})
write_basic_package_version_file(${PROJECT_BINARY_DIR}/VelmarConfigVersion.cmake
  COMPATIBILITY SameMajorVersion)
install(FILES ${PROJECT_BINARY_DIR}/VelmarConfig.cmake ${PROJECT_BINARY_DIR}/VelmarConfigVersion.cmake
  DESTINATION ${VELMAR_CMAKE_DIR} COMPONENT dev)

# The prefix is found from the file's own place, so that a copy unpacked anywhere (a package
# extracted into a scratch root, a moved prefix) still points at its own headers.
set(VELMAR_PC_DIR ${CMAKE_INSTALL_LIBDIR}/pkgconfig)
file(RELATIVE_PATH VELMAR_PC_TO_PREFIX /${VELMAR_PC_DIR} /)
string(REGEX REPLACE "/$" "" VELMAR_PC_TO_PREFIX "${VELMAR_PC_TO_PREFIX}")
configure_file(${PROJECT_SOURCE_DIR}/cmake/velmar.pc.in ${PROJECT_BINARY_DIR}/velmar.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/velmar.pc DESTINATION ${VELMAR_PC_DIR} COMPONENT dev)

# The classic C interface: its library, its headers in a folder of their own (only classic
# programs put it on their path), the build function and a pkg-config file.
install(TARGETS velmar-classic EXPORT VelmarTargets
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT runtime NAMELINK_COMPONENT dev
  ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT dev
  RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR} COMPONENT runtime)
install(DIRECTORY ${PROJECT_SOURCE_DIR}/include/classic/
  DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/velmar-classic COMPONENT dev
  FILES_MATCHING PATTERN "*.h")
install(FILES ${PROJECT_SOURCE_DIR}/cmake/VelmarClassic.cmake DESTINATION ${VELMAR_CMAKE_DIR}
  COMPONENT dev)
install(TARGETS velmar-classic-mkres RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR} COMPONENT dev)
configure_file(${PROJECT_SOURCE_DIR}/cmake/velmar-classic.pc.in
  ${PROJECT_BINARY_DIR}/velmar-classic.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/velmar-classic.pc DESTINATION ${VELMAR_PC_DIR} COMPONENT dev)

include(${PROJECT_SOURCE_DIR}/cmake/VelmarPackaging.cmake)
