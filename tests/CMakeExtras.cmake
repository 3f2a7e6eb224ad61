# Test-only dependencies.

# GeographicLib: an independent geodesy implementation that the geodesy tests compare against. Debian's
# package ships a find module and a static library but no imported target, so the target is made here.
list(APPEND CMAKE_MODULE_PATH /usr/share/cmake/geographiclib)
find_package(GeographicLib REQUIRED)
if(NOT TARGET GeographicLib::GeographicLib)
  add_library(GeographicLib::GeographicLib UNKNOWN IMPORTED)
  set_target_properties(GeographicLib::GeographicLib PROPERTIES
    IMPORTED_LOCATION "${GeographicLib_LIBRARIES}"
    INTERFACE_INCLUDE_DIRECTORIES "${GeographicLib_INCLUDE_DIRS}")
endif()
if(TARGET test_geodesy)
  target_link_libraries(test_geodesy PRIVATE GeographicLib::GeographicLib)
endif()
