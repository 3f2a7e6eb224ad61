# Installs the libraries, their headers and a CMake package: find_package(svymath CONFIG) gives svymath::svymath.
include(CMakePackageConfigHelpers)

set(SVYMATH_CMAKE_DIR ${CMAKE_INSTALL_LIBDIR}/cmake/svymath)

install(TARGETS svyutils svymath EXPORT svymathTargets
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}
  ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR}
  RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR}
  INCLUDES DESTINATION ${CMAKE_INSTALL_INCLUDEDIR})
install(DIRECTORY ${PROJECT_SOURCE_DIR}/svyutils/ DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/svyutils
  FILES_MATCHING PATTERN "*.h")
install(DIRECTORY ${PROJECT_SOURCE_DIR}/svymath/ DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/svymath
  FILES_MATCHING PATTERN "*.h")
install(FILES ${PROJECT_BINARY_DIR}/generated/svymath/version.h DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/svymath)
install(EXPORT svymathTargets NAMESPACE svymath:: DESTINATION ${SVYMATH_CMAKE_DIR})

configure_package_config_file(${PROJECT_SOURCE_DIR}/cmake/svymathConfig.cmake.in
  ${PROJECT_BINARY_DIR}/svymathConfig.cmake INSTALL_DESTINATION ${SVYMATH_CMAKE_DIR})
write_basic_package_version_file(${PROJECT_BINARY_DIR}/svymathConfigVersion.cmake
  COMPATIBILITY SameMajorVersion)
install(FILES ${PROJECT_BINARY_DIR}/svymathConfig.cmake ${PROJECT_BINARY_DIR}/svymathConfigVersion.cmake
  DESTINATION ${SVYMATH_CMAKE_DIR})
