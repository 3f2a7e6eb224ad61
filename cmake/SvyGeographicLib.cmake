# GeographicLib: an independent geodesy implementation that the geodesy tests compare against and the
# benchmarks time beside ours (never a dependency of the library). Debian's package ships a find module and
# a library but no imported target, so the target GeographicLib::GeographicLib is made here.
list(APPEND CMAKE_MODULE_PATH /usr/share/cmake/geographiclib)
find_package(GeographicLib REQUIRED)
if(NOT TARGET GeographicLib::GeographicLib)
  add_library(GeographicLib::GeographicLib UNKNOWN IMPORTED)
  set_target_properties(GeographicLib::GeographicLib PROPERTIES
    IMPORTED_LOCATION "${GeographicLib_LIBRARIES}"
    INTERFACE_INCLUDE_DIRECTORIES "${GeographicLib_INCLUDE_DIRS}")
endif()
