// Geodesic inverse and direct problems timed beside an independent geodesic solution on the same ellipsoid
// and the same pairs: a global mix in which every fourth pair is within a degree of the antipode.
#include <benchmark/benchmark.h>

#include <GeographicLib/Geodesic.hpp>
#include <array>
#include <cmath>
#include <cstddef>
#include <random>

#include "svymath/foundation/constants.h"
#include "svymath/geodesy/ellipsoid.h"
#include "svymath/geodesy/geodesic.h"

namespace {

constexpr std::size_t kPairs = 256;

struct Pair {
  double lat1, lon1, lat2, lon2;  // degrees
};

const std::array<Pair, kPairs>& pairs() {
  static const std::array<Pair, kPairs> all = [] {
    std::array<Pair, kPairs> p{};
    std::mt19937_64 engine(42);
    std::uniform_real_distribution<double> lat(-90.0, 90.0), lon(-180.0, 180.0), near(-1.0, 1.0);
    for (std::size_t i = 0; i < kPairs; ++i) {
      p[i] = {lat(engine), lon(engine), lat(engine), lon(engine)};
      if (i % 4 == 0) p[i].lat2 = -p[i].lat1 + near(engine), p[i].lon2 = p[i].lon1 + 180.0 + near(engine);
    }
    return p;
  }();
  return all;
}

const GeographicLib::Geodesic& independentGeodesic() {
  const svy_math::TEllipsoidParams& ell = svy_math::ellipsoidParams();
  static const GeographicLib::Geodesic geodesic(ell.a, 1.0 - std::sqrt(1.0 - ell.e2));
  return geodesic;
}

void BM_GeodesicInverse(benchmark::State& state) {
  std::size_t i = 0;
  const double k = svy_math::units::kDegToRad;
  for (auto _ : state) {
    const Pair& p = pairs()[i++ % kPairs];
    double s = 0, az1 = 0, az2 = 0;
    svy_math::invers(p.lat1 * k, p.lon1 * k, p.lat2 * k, p.lon2 * k, s, az1, az2);
    benchmark::DoNotOptimize(s);
    benchmark::DoNotOptimize(az2);
  }
}
BENCHMARK(BM_GeodesicInverse);

void BM_GeodesicInverse_Independent(benchmark::State& state) {
  const GeographicLib::Geodesic& g = independentGeodesic();
  std::size_t i = 0;
  for (auto _ : state) {
    const Pair& p = pairs()[i++ % kPairs];
    double s = 0, az1 = 0, az2 = 0;
    g.Inverse(p.lat1, p.lon1, p.lat2, p.lon2, s, az1, az2);
    benchmark::DoNotOptimize(s);
    benchmark::DoNotOptimize(az2);
  }
}
BENCHMARK(BM_GeodesicInverse_Independent);

void BM_GeodesicDirect(benchmark::State& state) {
  std::size_t i = 0;
  const double k = svy_math::units::kDegToRad;
  for (auto _ : state) {
    const Pair& p = pairs()[i++ % kPairs];
    double lat = 0, lon = 0, az2 = 0;
    svy_math::frgeod(p.lat1 * k, p.lon1 * k, p.lon2 * k, p.lat2 * 1e5, lat, lon, az2);
    benchmark::DoNotOptimize(lat);
    benchmark::DoNotOptimize(lon);
  }
}
BENCHMARK(BM_GeodesicDirect);

void BM_GeodesicDirect_Independent(benchmark::State& state) {
  const GeographicLib::Geodesic& g = independentGeodesic();
  std::size_t i = 0;
  for (auto _ : state) {
    const Pair& p = pairs()[i++ % kPairs];
    double lat = 0, lon = 0, az2 = 0;
    g.Direct(p.lat1, p.lon1, p.lon2, p.lat2 * 1e5, lat, lon, az2);
    benchmark::DoNotOptimize(lat);
    benchmark::DoNotOptimize(lon);
  }
}
BENCHMARK(BM_GeodesicDirect_Independent);

}  // namespace
