#include <gtest/gtest.h>

#include <GeographicLib/Geocentric.hpp>
#include <algorithm>
#include <cmath>
#include <limits>

#include "geodesy/csv_table.h"
#include "support/refdata.h"
#include "svymath/foundation/constants.h"
#include "svymath/geodesy/ellipsoid.h"
#include "svymath/geodesy/geo_coord.h"

namespace {

using svy_math::units::kDegToRad;
using svy_math::units::kHalfPi;

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

// Over a global grid (poles, 1e-7 deg from them, both sides of the antimeridian, heights from below sea
// level to GNSS orbit): forward against the independent library, and reverse judged by where the result
// lies, which stays meaningful at the poles where the longitude is arbitrary.
TEST(GeodeticCartesian, MatchesIndependentLibraryOverGlobalGrid) {
  const svy_math::TEllipsoidParams& ell = svy_math::ellipsoidParams();
  const GeographicLib::Geocentric earth(ell.a, 1.0 - std::sqrt(1.0 - ell.e2));
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

// 516 points computed independently for the stored eccentricity, and for the usual flattening: the stored
// e (kept as the decimal, not derived from 1/f) puts results up to 0.4 mm from the usual ellipsoid. The
// table stays in the shared reference folder, so this runs only where that folder is present.
TEST(GeodeticCartesian, MatchesReferenceTableForTheStoredEccentricity) {
  SVY_SKIP_WITHOUT_REFDATA();
  const svy_test::CsvColumns t =
      svy_test::readCsvColumns(svy_test::refdataPath("geodetic/geodetic_ecef_cartconvert.csv"));
  ASSERT_EQ(t.at("lat_deg").size(), 516u);
  double largestEllipsoidDifference = 0.0;
  for (std::size_t r = 0; r < 516; ++r) {
    const auto at = [&t, r](const std::string& x) {
      return Coord(t.at("X_" + x)[r], t.at("Y_" + x)[r], t.at("Z_" + x)[r]);
    };
    const Coord expected = at("e0818191913305"),
                c = toCartesian(t.at("lat_deg")[r], t.at("lon_deg")[r], t.at("h_m")[r]);
    ASSERT_LT(distance(c, expected), kForwardTol) << t.at("lat_deg")[r] << " " << t.at("lon_deg")[r];
    ASSERT_LT(distance(toCartesian(0, 0, 0).blh2xyz(toGeodetic(expected)), expected), kReverseTol);
    largestEllipsoidDifference = std::max(largestEllipsoidDifference, distance(c, at("wgs84")));
  }
  EXPECT_GT(largestEllipsoidDifference, 1e-4);
  EXPECT_LT(largestEllipsoidDifference, 5e-4);
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

}  // namespace
