#include <gtest/gtest.h>

#include <GeographicLib/Geocentric.hpp>
#include <cmath>
#include <limits>
#include <vector>

#include "geodesy/csv_table.h"
#include "support/refdata.h"
#include "svymath/foundation/constants.h"
#include "svymath/geodesy/ellipsoid.h"
#include "svymath/geodesy/geo_coord.h"

namespace {

using svy_math::units::kDegToRad;
using svy_math::units::kRadToDeg;

// Forward conversion: both sides evaluate closed formulas, so they agree to a few ulps of 2.6e7 m.
constexpr double kForwardTol = 1e-7;
// Reverse conversion, as a distance (metres) along the meridian, the parallel and the normal: the latitude
// iteration stops on a change of 1e-10 in tan(B) and contracts by ~e^2 per step, which leaves up to
// ~7e-13 rad (4 micrometres) at low latitudes.
constexpr double kReverseTol = 1e-5;

double flatteningOfStoredEllipsoid() { return 1.0 - std::sqrt(1.0 - svy_math::ellipsoidParams().e2); }

const GeographicLib::Geocentric& independentEarth() {
  static const GeographicLib::Geocentric earth(svy_math::ellipsoidParams().a, flatteningOfStoredEllipsoid());
  return earth;
}

Coord toCartesian(double latDeg, double lonDeg, double h) {
  Coord c;
  c.blh2xyz(GeoCoord(latDeg * kDegToRad, lonDeg * kDegToRad, h));
  return c;
}

GeoCoord toGeodetic(const Coord& c) {
  GeoCoord g;
  g.xyz2blh(c);
  return g;
}

double distance(const Coord& p, const Coord& q) { return (p - q).Module(); }

// Differences of two geodetic positions as distances: along the meridian, along the parallel, in height.
void expectSamePosition(const GeoCoord& got, double latDeg, double lonDeg, double h, double tol) {
  const double radius = svy_math::ellipsoidParams().a + std::fabs(h);
  EXPECT_NEAR(got.lat() * kRadToDeg, latDeg, tol / radius * kRadToDeg) << latDeg << " " << lonDeg << " " << h;
  if (std::fabs(latDeg) < 89.9) {
    const double dLon = std::remainder(got.lon() * kRadToDeg - lonDeg, 360.0);
    EXPECT_NEAR(dLon, 0.0, tol / (radius * std::cos(latDeg * kDegToRad)) * kRadToDeg) << latDeg << " " << lonDeg;
  }
  EXPECT_NEAR(got.height(), h, tol) << latDeg << " " << lonDeg;
}

struct GridPoint {
  double latDeg, lonDeg, h;
};

// A global grid: every 7.5 deg of latitude with the poles and points 1e-7 deg from them, every 15 deg of
// longitude with both sides of the antimeridian, heights from below sea level to GNSS orbit.
std::vector<GridPoint> globalGrid() {
  std::vector<double> lats;
  for (int i = -12; i <= 12; ++i) lats.push_back(7.5 * i);
  for (double lat : {89.9999999, -89.9999999, 0.1234567, 45.0000001}) lats.push_back(lat);
  std::vector<double> lons;
  for (int i = -12; i <= 12; ++i) lons.push_back(15.0 * i);
  for (double lon : {179.9999999, -179.9999999, 0.0000001, -0.0000001}) lons.push_back(lon);
  std::vector<GridPoint> grid;
  for (double lat : lats)
    for (double lon : lons)
      for (double h : {-1000.0, 0.0, 123.456, 8848.86, 1.0e5, 2.02e7}) grid.push_back({lat, lon, h});
  return grid;
}

TEST(GeodeticCartesian, ForwardMatchesIndependentLibraryOverGlobalGrid) {
  for (const GridPoint& p : globalGrid()) {
    double x = 0, y = 0, z = 0;
    independentEarth().Forward(p.latDeg, p.lonDeg, p.h, x, y, z);
    const Coord c = toCartesian(p.latDeg, p.lonDeg, p.h);
    ASSERT_LT(distance(c, Coord(x, y, z)), kForwardTol) << p.latDeg << " " << p.lonDeg << " " << p.h;
  }
}

TEST(GeodeticCartesian, ReverseMatchesIndependentLibraryOverGlobalGrid) {
  for (const GridPoint& p : globalGrid()) {
    double x = 0, y = 0, z = 0;
    independentEarth().Forward(p.latDeg, p.lonDeg, p.h, x, y, z);
    double lat = 0, lon = 0, h = 0;
    independentEarth().Reverse(x, y, z, lat, lon, h);
    expectSamePosition(toGeodetic(Coord(x, y, z)), lat, lon, h, kReverseTol);
  }
}

// Cartesian -> geodetic -> Cartesian returns to the start, poles and antimeridian included.
TEST(GeodeticCartesian, RoundTripReturnsToStart) {
  for (const GridPoint& p : globalGrid()) {
    const Coord c = toCartesian(p.latDeg, p.lonDeg, p.h);
    Coord back;
    back.blh2xyz(toGeodetic(c));
    ASSERT_LT(distance(back, c), kReverseTol) << p.latDeg << " " << p.lonDeg << " " << p.h;
  }
}

// 516 points computed independently for the stored eccentricity (and for the usual flattening): the
// stored e keeps results within 0.5 mm of the usual ellipsoid, yet measurably apart from it.
TEST(GeodeticCartesian, MatchesReferenceTableForTheStoredEccentricity) {
  const svy_test::CsvTable table =
      svy_test::readCsvTable(svy_test::testdataPath("geodesy/geodetic_ecef_cartconvert.csv"));
  ASSERT_EQ(table.rows.size(), 516u);
  const std::size_t cLat = table.column("lat_deg"), cLon = table.column("lon_deg"), cH = table.column("h_m"),
                    cX = table.column("X_e0818191913305"), cY = table.column("Y_e0818191913305"),
                    cZ = table.column("Z_e0818191913305"), cXw = table.column("X_wgs84"),
                    cYw = table.column("Y_wgs84"), cZw = table.column("Z_wgs84");
  ASSERT_LT(cZ, table.columns.size());
  double largestEllipsoidDifference = 0.0;
  for (const auto& row : table.rows) {
    const Coord expected(row[cX], row[cY], row[cZ]);
    const Coord c = toCartesian(row[cLat], row[cLon], row[cH]);
    ASSERT_LT(distance(c, expected), kForwardTol) << row[cLat] << " " << row[cLon] << " " << row[cH];
    expectSamePosition(toGeodetic(expected), row[cLat], row[cLon], row[cH], kReverseTol);
    const double ellipsoidDifference = distance(c, Coord(row[cXw], row[cYw], row[cZw]));
    EXPECT_LT(ellipsoidDifference, 5e-4);
    largestEllipsoidDifference = std::max(largestEllipsoidDifference, ellipsoidDifference);
  }
  EXPECT_GT(largestEllipsoidDifference, 1e-4);
}

TEST(GeodeticCartesian, StoredEccentricityIsTheDecimalNotAFlattening) {
  const svy_math::TEllipsoidParams& ell = svy_math::ellipsoidParams();
  EXPECT_EQ(ell.e, 0.0818191913305);
  EXPECT_NEAR(ell.e2, 0.006694380069977, 1e-15);
  const double usualFlattening = 1.0 / 298.257223563;
  EXPECT_NEAR(ell.e2 - usualFlattening * (2.0 - usualFlattening), 8e-11, 1e-11);
  EXPECT_EQ(&ell, &svy_math::ellipsoidParams());
}

// ---- special positions ----

TEST(GeodeticCartesian, EquatorPrimeMeridianIsOnTheXAxis) {
  const Coord c = toCartesian(0.0, 0.0, 0.0);
  EXPECT_EQ(c.x(), 6378137.0);
  EXPECT_EQ(c.y(), 0.0);
  EXPECT_EQ(c.z(), 0.0);
  const GeoCoord g = toGeodetic(c);
  EXPECT_EQ(g.lat(), 0.0);
  EXPECT_EQ(g.lon(), 0.0);
  EXPECT_NEAR(g.height(), 0.0, 1e-9);
}

TEST(GeodeticCartesian, CentreOfTheEarthIsMinusAOnTheEquator) {
  const GeoCoord g = toGeodetic(Coord(0.0, 0.0, 0.0));
  EXPECT_EQ(g.lat(), 0.0);
  EXPECT_EQ(g.lon(), 0.0);
  EXPECT_EQ(g.height(), -6378137.0);
}

struct PolarAxisCase {
  double z, expectedLat;
};

class GeodeticOnPolarAxis : public ::testing::TestWithParam<PolarAxisCase> {};

// On the polar axis the height is measured from the pole: |Z| - b, with b = sqrt(1 - e2) a.
TEST_P(GeodeticOnPolarAxis, LatitudeIsAPoleAndHeightIsFromThePole) {
  const PolarAxisCase c = GetParam();
  const double b = std::sqrt(1.0 - svy_math::ellipsoidParams().e2) * svy_math::ellipsoidParams().a;
  for (double offAxis : {0.0, 5e-11}) {
    const GeoCoord g = toGeodetic(Coord(offAxis, 0.0, c.z));
    EXPECT_EQ(g.lat(), c.expectedLat);
    EXPECT_EQ(g.lon(), 0.0);
    EXPECT_DOUBLE_EQ(g.height(), std::fabs(c.z) - b);
  }
}

INSTANTIATE_TEST_SUITE_P(NorthAndSouth, GeodeticOnPolarAxis,
                         ::testing::Values(PolarAxisCase{6356752.314, svy_math::units::kHalfPi},
                                           PolarAxisCase{7000000.0, svy_math::units::kHalfPi},
                                           PolarAxisCase{-6356752.314, -svy_math::units::kHalfPi},
                                           PolarAxisCase{-10.0, -svy_math::units::kHalfPi}));

// Longitudes come back in [0, 2 pi): a western longitude is returned increased by 2 pi.
TEST(GeodeticCartesian, WesternLongitudeIsReturnedAbovePi) {
  const GeoCoord west = toGeodetic(toCartesian(10.0, -75.5, 10.0));
  EXPECT_NEAR(west.lon(), (360.0 - 75.5) * kDegToRad, 1e-15);
  const GeoCoord antimeridian = toGeodetic(toCartesian(-33.0, -179.9999999, 0.0));
  EXPECT_GT(antimeridian.lon(), svy_math::units::kPi);
  EXPECT_LT(antimeridian.lon(), svy_math::units::kTwoPi);
}

// ---- input that must end ----

TEST(GeodeticCartesian, NonFiniteInputEndsWithNaN) {
  const double nan = std::numeric_limits<double>::quiet_NaN();
  const double inf = std::numeric_limits<double>::infinity();
  for (const Coord& c : {Coord(nan, 0, 0), Coord(0, nan, 0), Coord(1e6, 1e6, nan), Coord(inf, 0, 0),
                         Coord(0, -inf, 1), Coord(1e6, 0, inf)}) {
    const GeoCoord g = toGeodetic(c);
    EXPECT_TRUE(std::isnan(g.lat()) && std::isnan(g.lon()) && std::isnan(g.height()));
  }
}

// Absurd but finite input terminates: coordinates whose squares overflow, a tiny distance from the axis
// with a huge Z (tan B overflows), and the slowest region of the iteration deep inside the earth, where
// the latitude map has a slope near 1 (about 42.7 km from the axis, a few micrometres off the equator).
TEST(GeodeticCartesian, AbsurdFiniteInputTerminates) {
  const GeoCoord huge = toGeodetic(Coord(1e300, 1e300, 1e300));
  EXPECT_FALSE(std::isnan(huge.lon()));
  const GeoCoord steep = toGeodetic(Coord(2e-10, 0.0, 1e300));
  EXPECT_TRUE(std::isnan(steep.lat()) || std::fabs(steep.lat()) <= svy_math::units::kHalfPi);
  const GeoCoord deep = toGeodetic(Coord(42697.673, 0.0, 6.9e-6));
  EXPECT_TRUE(std::isfinite(deep.lat()));
  EXPECT_LT(std::fabs(deep.lat()), 0.01);
  EXPECT_NEAR(deep.height(), 42697.673 - 6378137.0, 50.0);
}

// Published worked example (geographic to geocentric), values to the millimetre on the usual ellipsoid.
TEST(GeodeticCartesian, PublishedWorkedExampleWhenReferenceDataPresent) {
  SVY_SKIP_WITHOUT_REFDATA();
  const svy_test::CsvTable table = svy_test::readCsvTable(svy_test::refdataPath("geodetic/iogp_gn7-2_worked_examples.csv"));
  ASSERT_EQ(table.rows.size(), 2u);
  const auto& row = table.rows[0];
  const Coord expected(row[table.column("X_m")], row[table.column("Y_m")], row[table.column("Z_m")]);
  // 53 deg 48' 33.820" N, 2 deg 07' 46.380" E, 73 m (the file gives them as text with decimal degrees).
  const Coord c = toCartesian(53.0 + 48.0 / 60.0 + 33.820 / 3600.0, 2.0 + 7.0 / 60.0 + 46.380 / 3600.0, 73.0);
  // 0.5 mm of rounding in the published values plus up to 0.4 mm between the two ellipsoids.
  EXPECT_LT(distance(c, expected), 1.5e-3);
}

}  // namespace
