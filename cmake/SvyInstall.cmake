# Installs the libraries, their headers and a CMake package: find_package(svymath CONFIG) gives svymath::svymath.
include(CMakePackageConfigHelpers)

set(SVYMATH_CMAKE_DIR ${CMAKE_INSTALL_LIBDIR}/cmake/svymath)

# Installed binaries find their libraries relative to themselves, wherever the prefix is and without
# LD_LIBRARY_PATH or ldconfig: a library finds its sibling in its own folder, the tool looks from bin/ into
# lib/. The run path is RUNPATH, so a user's LD_LIBRARY_PATH still wins when they set one on purpose.
file(RELATIVE_PATH SVY_BIN_TO_LIB ${CMAKE_INSTALL_FULL_BINDIR} ${CMAKE_INSTALL_FULL_LIBDIR})
set_target_properties(svyutils svymath PROPERTIES INSTALL_RPATH "$ORIGIN")
if(TARGET svy)
  set_target_properties(svy PROPERTIES INSTALL_RPATH "$ORIGIN/${SVY_BIN_TO_LIB}")
endif()

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
