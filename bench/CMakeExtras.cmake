# Benchmark-only dependencies.
include(${PROJECT_SOURCE_DIR}/cmake/SvyGeographicLib.cmake)
target_link_libraries(svymath_bench PRIVATE GeographicLib::GeographicLib)
