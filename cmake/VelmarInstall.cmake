# Install the library, its public headers, a CMake package and a pkg-config file.
include(CMakePackageConfigHelpers)

install(TARGETS Velmar EXPORT VelmarTargets
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}
  ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR}
  RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR}
  INCLUDES DESTINATION ${CMAKE_INSTALL_INCLUDEDIR})
install(DIRECTORY ${PROJECT_SOURCE_DIR}/include/Velmar
  DESTINATION ${CMAKE_INSTALL_INCLUDEDIR} FILES_MATCHING PATTERN "*.h")
install(FILES ${PROJECT_BINARY_DIR}/include/Velmar/VelmarExport.h
  DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/Velmar)

set(VELMAR_CMAKE_DIR ${CMAKE_INSTALL_LIBDIR}/cmake/Velmar)
install(EXPORT VelmarTargets NAMESPACE Velmar:: DESTINATION ${VELMAR_CMAKE_DIR})
configure_package_config_file(${PROJECT_SOURCE_DIR}/cmake/VelmarConfig.cmake.in
  ${PROJECT_BINARY_DIR}/VelmarConfig.cmake INSTALL_DESTINATION ${VELMAR_CMAKE_DIR})
write_basic_package_version_file(${PROJECT_BINARY_DIR}/VelmarConfigVersion.cmake
  COMPATIBILITY SameMajorVersion)
install(FILES ${PROJECT_BINARY_DIR}/VelmarConfig.cmake ${PROJECT_BINARY_DIR}/VelmarConfigVersion.cmake
  DESTINATION ${VELMAR_CMAKE_DIR})

configure_file(${PROJECT_SOURCE_DIR}/cmake/velmar.pc.in ${PROJECT_BINARY_DIR}/velmar.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/velmar.pc DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig)

# The classic C interface: its library, its headers in a folder of their own (only classic
# programs put it on their path), the build function and a pkg-config file.
install(TARGETS velmar-classic EXPORT VelmarTargets
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}
  ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR}
  RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR})
install(DIRECTORY ${PROJECT_SOURCE_DIR}/include/classic/
  DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/velmar-classic FILES_MATCHING PATTERN "*.h")
install(FILES ${PROJECT_SOURCE_DIR}/cmake/VelmarClassic.cmake DESTINATION ${VELMAR_CMAKE_DIR})
install(TARGETS velmar-classic-mkres RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR})
configure_file(${PROJECT_SOURCE_DIR}/cmake/velmar-classic.pc.in
  ${PROJECT_BINARY_DIR}/velmar-classic.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/velmar-classic.pc DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig)
