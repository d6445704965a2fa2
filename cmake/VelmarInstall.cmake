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
