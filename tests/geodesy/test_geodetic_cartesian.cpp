#include <gtest/gtest.h>

#include <GeographicLib/Geocentric.hpp>
#include <GeographicLib/LocalCartesian.hpp>
#include <algorithm>
#include <cmath>
#include <limits>

#include "svymath/foundation/constants.h"
#include "svymath/geodesy/ellipsoid.h"
#include "svymath/geodesy/geo_coord.h"
#include "svymath/geodesy/local_frame.h"

namespace {

using svy_math::units::kDegToRad;
using svy_math::units::kHalfPi;
using svy_math::units::kTwoPi;
using Vec3 = svy_math::TAbstractPoint3<double>;

// Forward: both sides evaluate closed formulas, a few ulps of 2.6e7 m. Reverse (as a distance): the latitude
// iteration stops on a change of 1e-10 in tan(B) and contracts by ~e^2 per step, which leaves up to
// ~7e-13 rad (4 micrometres) at low latitudes.
constexpr double kForwardTol = 1e-7;
constexpr double kReverseTol = 1e-5;

Coord toCartesian(double latDeg, double lonDeg, double h) {
  Coord c;
  return c.blh2xyz(GeoCoord(latDeg * kDegToRad, lonDeg * kDegToRad, h));
}

GeoCoord toGeodetic(const Coord& c) {
  GeoCoord g;
  return g.xyz2blh(c);
}

double distance(const Coord& p, const Coord& q) { return (p - q).Module(); }

const GeographicLib::Geocentric& independentEarth() {
  static const GeographicLib::Geocentric earth(svy_math::ellipsoidParams().a,
                                               1.0 - std::sqrt(1.0 - svy_math::ellipsoidParams().e2));
  return earth;
}

// Over a global grid (poles, 1e-7 deg from them, both sides of the antimeridian, heights from below sea
// level to GNSS orbit): forward against the independent library, and reverse judged by where the result
// lies, which stays meaningful at the poles where the longitude is arbitrary.
TEST(GeodeticCartesian, MatchesIndependentLibraryOverGlobalGrid) {
  const GeographicLib::Geocentric& earth = independentEarth();
  for (int i = -13; i <= 13; ++i) {
    const double lat = i == 13 ? 89.9999999 : i == -13 ? -90.0 : 7.5 * i;
    for (int j = -13; j <= 12; ++j) {
      const double lon = j == -13 ? -179.9999999 : 15.0 * j;
      for (double h : {-1000.0, 0.0, 8848.86, 1.0e5, 2.02e7}) {
        double x = 0, y = 0, z = 0;
        earth.Forward(lat, lon, h, x, y, z);
        const Coord expected(x, y, z);
        ASSERT_LT(distance(toCartesian(lat, lon, h), expected), kForwardTol) << lat << " " << lon << " " << h;
        const GeoCoord g = toGeodetic(expected);
        earth.Forward(g.lat() / kDegToRad, g.lon() / kDegToRad, g.height(), x, y, z);
        ASSERT_LT(distance(Coord(x, y, z), expected), kReverseTol) << lat << " " << lon << " " << h;
        ASSERT_NEAR(g.height(), h, kReverseTol);
      }
    }
  }
}

// The equator on the prime meridian (exactly on the X axis both ways); the centre of the earth (h = -a); the
// polar axis, within 1e-10 m of it, where the height is |Z| - b; a western longitude, which comes back
// increased by 2 pi.
TEST(GeodeticCartesian, SpecialPositions) {
  EXPECT_EQ(toCartesian(0.0, 0.0, 0.0), Coord(6378137.0, 0.0, 0.0));
  const double b = std::sqrt(1.0 - 0.0818191913305 * 0.0818191913305) * 6378137.0;
  const struct {
    Coord xyz;
    double lat, lon, h;
  } cases[] = {{Coord(6378137.0, 0, 0), 0, 0, 0},
               {Coord(0, 0, 0), 0, 0, -6378137.0},
               {Coord(0, 0, 7e6), kHalfPi, 0, 7e6 - b},
               {Coord(5e-11, 0, -10.0), -kHalfPi, 0, 10.0 - b},
               {toCartesian(10.0, -75.5, 10.0), 10.0 * kDegToRad, 284.5 * kDegToRad, 10.0}};
  for (const auto& c : cases) {
    const GeoCoord g = toGeodetic(c.xyz);
    EXPECT_NEAR(g.lat(), c.lat, 1e-12) << c.xyz.x() << " " << c.xyz.z();
    EXPECT_NEAR(g.lon(), c.lon, 1e-15);
    EXPECT_NEAR(g.height(), c.h, kReverseTol);
  }
}

// Non-finite input gives NaN at once. Absurd finite input terminates: squares that overflow, a huge Z just
// off the axis (tan B overflows), and the slowest region of the iteration, about 42.7 km from the axis a few
// micrometres off the equatorial plane, where the latitude map has a slope near 1 (millions of steps).
TEST(GeodeticCartesian, NonFiniteAndAbsurdInputEnds) {
  const double nan = std::numeric_limits<double>::quiet_NaN(), inf = std::numeric_limits<double>::infinity();
  for (const Coord& c : {Coord(nan, 0, 0), Coord(1e6, 1e6, nan), Coord(0, -inf, 1), Coord(1e6, 0, inf)}) {
    const GeoCoord g = toGeodetic(c);
    EXPECT_TRUE(std::isnan(g.lat()) && std::isnan(g.lon()) && std::isnan(g.height()));
  }
  EXPECT_FALSE(std::isnan(toGeodetic(Coord(1e300, 1e300, 1e300)).lon()));
  const GeoCoord steep = toGeodetic(Coord(2e-10, 0.0, 1e300));
  EXPECT_TRUE(std::isnan(steep.lat()) || std::fabs(steep.lat()) <= kHalfPi);
  EXPECT_LT(std::fabs(toGeodetic(Coord(42697.673, 0.0, 6.9e-6)).lat()), 0.01);
}

// (east, north, up) of Cartesian differences against an independent local Cartesian frame, at origins that
// include both poles, the antimeridian and the equator, for targets near and far (a rotation of a vector of
// up to 2.6e7 m: a few ulps).
TEST(LocalFrame, MatchesIndependentLocalCartesian) {
  const double origins[][3] = {
      {0.0, 0.0, 0.0},      {53.8, 2.13, 73.0}, {-33.9, 151.2, 40.0},        {90.0, 0.0, 0.0},
      {-90.0, 30.0, 100.0}, {12.5, 180.0, 0.0}, {-45.0, -179.9999999, 10.0}, {89.9999999, -75.0, 3000.0}};
  for (const auto& o : origins) {
    const GeographicLib::LocalCartesian frame(o[0], o[1], o[2], independentEarth());
    const Coord origin = toCartesian(o[0], o[1], o[2]);
    for (double dLat : {-30.0, -0.001, 0.0, 2.0})
      for (double dLon : {-90.0, 0.0, 0.00002, 45.0})
        for (double h : {-50.0, 1500.0, 2.02e7}) {
          const double lat = std::max(-90.0, std::min(90.0, o[0] + dLat)), lon = o[1] + dLon;
          double enu[3] = {0, 0, 0};
          frame.Forward(lat, lon, h, enu[0], enu[1], enu[2]);
          const Vec3 local =
              blh_to_neu(Vec3(o[0] * kDegToRad, o[1] * kDegToRad, o[2]), toCartesian(lat, lon, h) - origin);
          for (int k = 0; k < 3; ++k)
            ASSERT_NEAR(local[k], enu[k], 1e-7) << o[0] << " " << o[1] << ": " << lat << " " << lon << " " << h;
        }
  }
}

// Polar form (elevation, azimuth clockwise from north in [0, 2 pi), slope distance) of the vector built from
// it. A vector without direction (horizontal length squared and up both inside +-1e-12, so anything up to
// 1e-6 m across with no height) gives the largest double for both angles and a zero distance.
TEST(LocalPolar, RecoversAzimuthElevationAndDistance) {
  const double cases[][3] = {{0.0, 0.0, 100.0},  {90.0, 10.0, 25.0}, {180.0, -5.0, 1000.0},
                             {270.0, 45.0, 3.5}, {-0.5, 1.0, 2.0e7}, {359.9999, -89.0, 0.01},
                             {0.0, 90.0, 12.0},  {0.0, -90.0, 12.0}, {123.456, 0.0, 1e-5}};
  for (const auto& c : cases) {
    SCOPED_TRACE(::testing::Message() << c[0] << " " << c[1] << " " << c[2]);
    const double az = c[0] * kDegToRad, el = c[1] * kDegToRad;
    const Vec3 polar =
        neu_to_polar(Vec3(c[2] * std::cos(el) * std::sin(az), c[2] * std::cos(el) * std::cos(az), c[2] * std::sin(el)));
    EXPECT_NEAR(polar[0], el, 1e-14);
    if (std::fabs(c[1]) < 90.0) {
      EXPECT_NEAR(polar[1], std::fmod(az + kTwoPi, kTwoPi), 1e-14);
    }
    EXPECT_TRUE(polar[1] >= 0.0 && polar[1] < kTwoPi) << polar[1];
    EXPECT_NEAR(polar[2], c[2], 1e-9 * c[2]);
  }
  const double kMax = std::numeric_limits<double>::max();
  for (const Vec3& v : {Vec3(0.0, 0.0, 0.0), Vec3(5e-7, -5e-7, 0.0), Vec3(0.0, 0.0, -9e-13)}) {
    const Vec3 polar = neu_to_polar(v);
    EXPECT_TRUE(polar[0] == kMax && polar[1] == kMax && polar[2] == 0.0) << v[0] << " " << v[2];
  }
  const Vec3 justAbove = neu_to_polar(Vec3(1.1e-6, 0.0, 0.0));
  EXPECT_EQ(justAbove[1], svy_math::units::kPi / 2);
  EXPECT_NEAR(justAbove[2], 1.1e-6, 1e-20);
}

}  // namespace
