# Benchmark-only dependencies.

# GeographicLib: the geodesy benchmarks time its geocentric conversions beside ours. Debian's package ships
# a find module and no imported target, so the target is made here.
list(APPEND CMAKE_MODULE_PATH /usr/share/cmake/geographiclib)
find_package(GeographicLib REQUIRED)
if(NOT TARGET GeographicLib::GeographicLib)
  add_library(GeographicLib::GeographicLib UNKNOWN IMPORTED)
  set_target_properties(GeographicLib::GeographicLib PROPERTIES
    IMPORTED_LOCATION "${GeographicLib_LIBRARIES}"
    INTERFACE_INCLUDE_DIRECTORIES "${GeographicLib_INCLUDE_DIRS}")
endif()
target_link_libraries(svymath_bench PRIVATE GeographicLib::GeographicLib)
