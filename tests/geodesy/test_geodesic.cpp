// Geodesic inverse and direct problems and the north/east offsets, against an independent geodesic
// solution on the same ellipsoid, and by round trips between the two problems.
#include <gtest/gtest.h>

#include <GeographicLib/Geodesic.hpp>
#include <algorithm>
#include <cmath>
#include <functional>
#include <limits>
#include <random>
#include <thread>
#include <vector>

#include "svymath/foundation/constants.h"
#include "svymath/geodesy/ellipsoid.h"
#include "svymath/geodesy/geodesic.h"

namespace {

using svy_math::units::kDegToRad;
using svy_math::units::kTwoPi;

// The goal is 0.1 mm; both solutions reach a few nanometres, so the tolerances sit well below it.
constexpr double kDistanceTol = 1e-6;   // metres
constexpr double kPositionTol = 1e-6;   // metres on the ground (an angle times the earth's radius)
constexpr double kEarthRadius = 6.4e6;  // metres, to turn angles into ground lengths

const GeographicLib::Geodesic& independentGeodesic() {
  static const GeographicLib::Geodesic geodesic(svy_math::ellipsoidParams().a,
                                                1.0 - std::sqrt(1.0 - svy_math::ellipsoidParams().e2));
  return geodesic;
}

double angleDiff(double a, double b) { return std::fabs(std::remainder(a - b, kTwoPi)); }

struct Pair {
  double lat1, lon1, lat2, lon2;  // degrees
};

// A global random set with every third pair near-antipodal (within a degree) and every third within 0.01
// degree; then meridians, the equator (both sides of the (1 - f) pi limit of equatorial geodesics), poles,
// exact antipodes and the pairs that defeat the classic iteration.
std::vector<Pair> testPairs() {
  std::vector<Pair> pairs = {{0, 0, 0, 179.3},      {0, 0, 0, 179.5},   {0, 0, 0.5, 179.7},  {-90, 0, 90, 0},
                             {90, 10, -90, 70},     {-90, 0, 10, 170},  {0, 0, 0, 180},      {30, 0, -30, 180},
                             {-30, 12, 29.9, -168}, {0, 0, -0.5, 179.7}, {0.1, 0, -0.1, 179.9}, {45, 0, 45, 0},
                             {0, -179.9, 0, 179.9}, {89.999, 0, 89.999, 180}, {-1e-9, 0, 1e-9, 180}, {10, 20, 10, 20.0000001}};
  std::mt19937_64 engine(15);
  std::uniform_real_distribution<double> unit(0.0, 1.0);
  for (int i = 0; i < 30000; ++i) {
    Pair p{unit(engine) * 180.0 - 90.0, unit(engine) * 360.0 - 180.0, unit(engine) * 180.0 - 90.0,
           unit(engine) * 360.0 - 180.0};
    if (i % 3 == 1) p.lat2 = p.lat1 + (p.lat2 / 90.0) * 0.01, p.lon2 = p.lon1 + (p.lon2 / 180.0) * 0.01;
    if (i % 3 == 2) p.lat2 = -p.lat1 + p.lat2 / 90.0, p.lon2 = p.lon1 + 180.0 + p.lon2 / 180.0;
    p.lat2 = std::max(-90.0, std::min(90.0, p.lat2));
    pairs.push_back(p);
  }
  return pairs;
}

// The inverse against the independent solution: the distance, and the azimuths judged by where they lead
// (the direct problem of the independent solution from each end). Near the antipode many azimuths give
// nearly the same distance, so the azimuth itself is checked through the end point it reaches.
TEST(GeodesicInverse, MatchesIndependentSolutionEverywhere) {
  const GeographicLib::Geodesic& g = independentGeodesic();
  for (const Pair& p : testPairs()) {
    double s = 0, az1 = 0, az2 = 0, sRef = 0, az1Ref = 0, az2Ref = 0;
    ASSERT_TRUE(svy_math::invers(p.lat1 * kDegToRad, p.lon1 * kDegToRad, p.lat2 * kDegToRad, p.lon2 * kDegToRad, s,
                                 az1, az2));
    g.Inverse(p.lat1, p.lon1, p.lat2, p.lon2, sRef, az1Ref, az2Ref);
    ASSERT_NEAR(s, sRef, kDistanceTol) << p.lat1 << " " << p.lon1 << " -> " << p.lat2 << " " << p.lon2;
    double lat = 0, lon = 0, back = 0;
    g.Direct(p.lat1, p.lon1, az1 / kDegToRad, s, lat, lon);
    double end = kEarthRadius * kDegToRad * std::hypot(lat - p.lat2, std::remainder(lon - p.lon2, 360.0) * std::cos(lat * kDegToRad));
    g.Direct(p.lat2, p.lon2, az2 / kDegToRad + 180.0, s, lat, lon, back);
    end = std::max(end, kEarthRadius * kDegToRad *
                            std::hypot(lat - p.lat1, std::remainder(lon - p.lon1, 360.0) * std::cos(lat * kDegToRad)));
    ASSERT_LT(end, kPositionTol) << p.lat1 << " " << p.lon1 << " -> " << p.lat2 << " " << p.lon2;
    // Away from the antipode the azimuths are well defined: compare them directly.
    if (sRef < 19.9e6 && sRef > 1.0) {
      ASSERT_LT(angleDiff(az1, az1Ref * kDegToRad), 1e-9) << p.lat1 << " " << p.lon1 << " -> " << p.lat2;
      ASSERT_LT(angleDiff(az2, az2Ref * kDegToRad), 1e-9) << p.lat1 << " " << p.lon1 << " -> " << p.lat2;
    }
  }
}

// The direct problem against the independent one, and back through the inverse (lengths up to 20 000 km,
// negative ones too).
TEST(GeodesicDirect, MatchesIndependentSolutionAndInvertsTheInverse) {
  const GeographicLib::Geodesic& g = independentGeodesic();
  std::mt19937_64 engine(1515);
  std::uniform_real_distribution<double> lat(-90.0, 90.0), lon(-180.0, 180.0), azimuth(-180.0, 180.0),
      length(-2.0e7, 2.0e7);
  for (int i = 0; i < 20000; ++i) {
    const double lat1 = i == 0 ? 90.0 : lat(engine), lon1 = lon(engine), az1 = azimuth(engine);
    const double s = i % 4 == 0 ? length(engine) * 1e-5 : length(engine);
    double lat2 = 0, lon2 = 0, az2 = 0, lat2Ref = 0, lon2Ref = 0, az2Ref = 0;
    ASSERT_TRUE(svy_math::frgeod(lat1 * kDegToRad, lon1 * kDegToRad, az1 * kDegToRad, s, lat2, lon2, az2));
    g.Direct(lat1, lon1, az1, s, lat2Ref, lon2Ref, az2Ref);
    const double cosLat = std::cos(lat2);
    ASSERT_LT(kEarthRadius * std::hypot(lat2 - lat2Ref * kDegToRad,
                                        cosLat * std::remainder(lon2 - lon2Ref * kDegToRad, kTwoPi)),
              kPositionTol)
        << lat1 << " " << lon1 << " " << az1 << " " << s;
    ASSERT_LE(std::fabs(lon2), svy_math::units::kPi);
    if (cosLat > 1e-6) {
      ASSERT_LT(angleDiff(az2, az2Ref * kDegToRad), 1e-11);
    }
    // Up to 15 000 km every geodesic is still the shortest path: the inverse gives its length back.
    if (std::fabs(s) > 1.5e7) continue;
    double sBack = 0, az1Back = 0, az2Back = 0;
    ASSERT_TRUE(svy_math::invers(lat1 * kDegToRad, lon1 * kDegToRad, lat2, lon2, sBack, az1Back, az2Back));
    ASSERT_NEAR(sBack, std::fabs(s), kDistanceTol);
  }
}

// North/east offsets: shifting and measuring back are inverse, from a metre to a continent; a short
// northward step is a meridian arc (latitude only), an eastward one leaves along the parallel.
TEST(GeodesicOffsets, ShiftAndOffsetRoundTrip) {
  const double cases[][4] = {{47.5, 8.3, 1.0, 0.0}, {47.5, 8.3, 0.0, -1.0},   {-33.9, 151.2, 1234.5, -987.6},
                             {89.9, 0.0, 500.0, 500.0}, {0.0, 179.999, 25.0, 300.0}, {-60.0, -70.0, 3.0e6, 4.0e6}};
  for (const auto& c : cases) {
    double lat = 0, lon = 0, dn = 0, de = 0;
    ASSERT_TRUE(svy_math::shiftLatLonByDelta(c[0] * kDegToRad, c[1] * kDegToRad, c[2], c[3], lat, lon));
    ASSERT_TRUE(svy_math::GetNeOffsetFromLatLon(c[0] * kDegToRad, c[1] * kDegToRad, lat, lon, dn, de));
    EXPECT_NEAR(dn, c[2], 1e-8) << c[0] << " " << c[1];
    EXPECT_NEAR(de, c[3], 1e-8) << c[0] << " " << c[1];
    if (c[3] == 0.0) {
      EXPECT_NEAR(std::remainder(lon - c[1] * kDegToRad, kTwoPi), 0.0, 1e-15);
    }
  }
}

// Bad input writes nothing and fails; coincident points are at distance 0.
TEST(GeodesicInverse, BadInputAndCoincidentPoints) {
  const double nan = std::numeric_limits<double>::quiet_NaN(), inf = std::numeric_limits<double>::infinity();
  double s = -1, a1 = -1, a2 = -1;
  for (const auto& c : {Pair{nan, 0, 0, 0}, Pair{0, inf, 0, 0}, Pair{1.6, 0, 0, 0}, Pair{0, 0, -1.6, 0}})
    EXPECT_FALSE(svy_math::invers(c.lat1, c.lon1, c.lat2, c.lon2, s, a1, a2));
  EXPECT_FALSE(svy_math::frgeod(0, 0, nan, 1, s, a1, a2));
  EXPECT_FALSE(svy_math::frgeod(0, 0, 0, inf, s, a1, a2));
  EXPECT_EQ(s, -1.0);
  ASSERT_TRUE(svy_math::invers(0.7, 0.1, 0.7, 0.1 + kTwoPi, s, a1, a2));
  EXPECT_EQ(s, 0.0);
}

// Nothing is shared but the ellipsoid, built once on first use: threads solving at once (the first call
// among them) get the answers of one thread alone.
TEST(GeodesicConcurrency, ThreadsGetTheSameAnswers) {
  const std::vector<Pair> all = testPairs();
  const std::vector<Pair> pairs(all.begin(), all.begin() + 600);
  auto solveAll = [&pairs](std::vector<double>& out) {
    for (const Pair& p : pairs) {
      double s = 0, a1 = 0, a2 = 0;
      svy_math::invers(p.lat1 * kDegToRad, p.lon1 * kDegToRad, p.lat2 * kDegToRad, p.lon2 * kDegToRad, s, a1, a2);
      out.push_back(s + a1 + a2);
    }
  };
  std::vector<std::vector<double>> results(4);
  std::vector<std::thread> threads;
  for (auto& r : results) threads.emplace_back(solveAll, std::ref(r));
  for (auto& t : threads) t.join();
  std::vector<double> alone;
  solveAll(alone);
  for (const auto& r : results) EXPECT_EQ(r, alone);
}

}  // namespace
