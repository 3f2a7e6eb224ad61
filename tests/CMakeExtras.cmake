# Test-only dependencies.
include(${PROJECT_SOURCE_DIR}/cmake/SvyGeographicLib.cmake)
if(TARGET test_geodesy)
  target_link_libraries(test_geodesy PRIVATE GeographicLib::GeographicLib)
endif()
