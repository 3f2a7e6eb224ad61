// Geodetic <-> Cartesian conversions, timed beside an independent implementation on the same ellipsoid, and
// GPS time conversions. Each case cycles through a fixed set of points spread over the globe.
#include <benchmark/benchmark.h>

#include <GeographicLib/Geocentric.hpp>
#include <array>
#include <cmath>
#include <cstddef>

#include "svymath/foundation/constants.h"
#include "svymath/geodesy/ellipsoid.h"
#include "svymath/geodesy/geo_coord.h"
#include "svymath/geodesy/gps_time.h"

namespace {

constexpr std::size_t kPoints = 64;

std::array<GeoCoord, kPoints> geodeticPoints() {
  std::array<GeoCoord, kPoints> points;
  for (std::size_t i = 0; i < kPoints; ++i) {
    const double lat = (-89.0 + 178.0 * static_cast<double>(i) / (kPoints - 1)) * svy_math::units::kDegToRad;
    const double lon = std::fmod(static_cast<double>(i) * 137.5, 360.0) * svy_math::units::kDegToRad;
    points[i] = GeoCoord(lat, lon, static_cast<double>(i % 8) * 250.0);
  }
  return points;
}

std::array<Coord, kPoints> cartesianPoints() {
  std::array<Coord, kPoints> points;
  const auto geodetic = geodeticPoints();
  for (std::size_t i = 0; i < kPoints; ++i) points[i].blh2xyz(geodetic[i]);
  return points;
}

const GeographicLib::Geocentric& independentEarth() {
  const svy_math::TEllipsoidParams& ell = svy_math::ellipsoidParams();
  static const GeographicLib::Geocentric earth(ell.a, 1.0 - std::sqrt(1.0 - ell.e2));
  return earth;
}

void BM_Geodesy_blh2xyz(benchmark::State& state) {
  const auto points = geodeticPoints();
  std::size_t i = 0;
  Coord c;
  for (auto _ : state) {
    c.blh2xyz(points[i++ % kPoints]);
    benchmark::DoNotOptimize(c);
  }
}
BENCHMARK(BM_Geodesy_blh2xyz);

void BM_Geodesy_IndependentForward(benchmark::State& state) {
  const auto points = geodeticPoints();
  const GeographicLib::Geocentric& earth = independentEarth();
  std::size_t i = 0;
  double x = 0, y = 0, z = 0;
  for (auto _ : state) {
    const GeoCoord& g = points[i++ % kPoints];
    earth.Forward(g.lat() * svy_math::units::kRadToDeg, g.lon() * svy_math::units::kRadToDeg, g.height(), x, y, z);
    benchmark::DoNotOptimize(x);
    benchmark::DoNotOptimize(y);
    benchmark::DoNotOptimize(z);
  }
}
BENCHMARK(BM_Geodesy_IndependentForward);

void BM_Geodesy_xyz2blh(benchmark::State& state) {
  const auto points = cartesianPoints();
  std::size_t i = 0;
  GeoCoord g;
  for (auto _ : state) {
    g.xyz2blh(points[i++ % kPoints]);
    benchmark::DoNotOptimize(g);
  }
}
BENCHMARK(BM_Geodesy_xyz2blh);

void BM_Geodesy_IndependentReverse(benchmark::State& state) {
  const auto points = cartesianPoints();
  const GeographicLib::Geocentric& earth = independentEarth();
  std::size_t i = 0;
  double lat = 0, lon = 0, h = 0;
  for (auto _ : state) {
    const Coord& c = points[i++ % kPoints];
    earth.Reverse(c.x(), c.y(), c.z(), lat, lon, h);
    benchmark::DoNotOptimize(lat);
    benchmark::DoNotOptimize(lon);
    benchmark::DoNotOptimize(h);
  }
}
BENCHMARK(BM_Geodesy_IndependentReverse);

void BM_GpsTime_CalendarToGps(benchmark::State& state) {
  int day = 0;
  int week = 0;
  double secondsOfWeek = 0.0;
  for (auto _ : state) {
    ymdhms_to_gps(2000 + day % 99, 1 + day % 12, 1 + day % 28, day % 24, day % 60, 12.345, &week, &secondsOfWeek);
    ++day;
    benchmark::DoNotOptimize(week);
    benchmark::DoNotOptimize(secondsOfWeek);
  }
}
BENCHMARK(BM_GpsTime_CalendarToGps);

void BM_GpsTime_GpsToCalendar(benchmark::State& state) {
  int step = 0;
  int year = 0, month = 0, day = 0, hour = 0, minute = 0;
  double second = 0.0;
  for (auto _ : state) {
    gps_to_ymdhms(1000 + step % 3000, static_cast<double>(step % 604800) + 0.25, &year, &month, &day, &hour, &minute,
                  &second);
    ++step;
    benchmark::DoNotOptimize(year);
    benchmark::DoNotOptimize(second);
  }
}
BENCHMARK(BM_GpsTime_GpsToCalendar);

}  // namespace
