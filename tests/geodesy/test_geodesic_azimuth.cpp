#include <gtest/gtest.h>

#include <GeographicLib/Geodesic.hpp>
#include <algorithm>
#include <cmath>
#include <limits>
#include <random>

#include "svymath/foundation/angle_functions.h"
#include "svymath/foundation/constants.h"
#include "svymath/foundation/math_angle.h"
#include "svymath/geodesy/ellipsoid.h"

namespace {

using svy_math::units::kDegToRad;
using svy_math::units::kPi;
using svy_math::units::kTwoPi;

bool setAzimuthDeg(CMathAngle& az, double lat1, double lon1, double lat2, double lon2) {
  return az.setAzFromLatLon(lat1 * kDegToRad, lon1 * kDegToRad, lat2 * kDegToRad, lon2 * kDegToRad);
}

// Random pairs against the independent geodesic solution: all over the ellipsoid, survey-scale lines (up to
// ~1 km), and pairs within a degree of the antipode, where the classic iteration oscillates and the damped
// one must recover the geodesic for nearly all of them (each still ends with a direction).
TEST(GeodesicAzimuth, MatchesIndependentInverse) {
  const svy_math::TEllipsoidParams& ell = svy_math::ellipsoidParams();
  const GeographicLib::Geodesic geodesic(ell.a, 1.0 - std::sqrt(1.0 - ell.e2));
  std::mt19937_64 engine(20260101);
  std::uniform_real_distribution<double> unit(0.0, 1.0);
  int antipodal = 0, antipodalAgreeing = 0;
  for (int i = 0; i < 6000; ++i) {
    const double lat1 = unit(engine) * 180.0 - 90.0, lon1 = unit(engine) * 360.0 - 180.0;
    double lat2 = unit(engine) * 180.0 - 90.0, lon2 = unit(engine) * 360.0 - 180.0;
    if (i % 3 == 1) lat2 = lat1 + (lat2 / 90.0) * 0.01, lon2 = lon1 + (lon2 / 180.0) * 0.01;
    if (i % 3 == 2) lat2 = -lat1 + lat2 / 90.0, lon2 = lon1 + 180.0 + lon2 / 180.0;
    lat2 = std::max(-90.0, std::min(90.0, lat2));
    double distance = 0, azi1 = 0, azi2 = 0;
    geodesic.Inverse(lat1, lon1, lat2, lon2, distance, azi1, azi2);
    CMathAngle az;
    ASSERT_TRUE(setAzimuthDeg(az, lat1, lon1, lat2, lon2));
    const double error = std::fabs(std::remainder(az.getRad() - azi1 * kDegToRad, kTwoPi));
    if (distance > 19.9e6) {  // within ~100 km of the antipode
      ++antipodal;
      antipodalAgreeing += error < 1e-8 ? 1 : 0;
    } else {  // the iteration stops on a change of 1e-12 rad in the auxiliary longitude
      ASSERT_LT(error, 1e-9) << lat1 << " " << lon1 << " -> " << lat2 << " " << lon2;
    }
  }
  EXPECT_GT(antipodalAgreeing, antipodal * 99 / 100);
}

// Meridians (from a pole too) and the equator, across the antimeridian: due north, south (stored as +pi),
// east or west. Exact antipodes (NaN here) still give a direction within [-pi, pi]. Coincident or invalid
// positions (radians) give none and leave the angle as it was.
TEST(GeodesicAzimuth, CardinalDirectionsAndNoDirection) {
  const double any = std::numeric_limits<double>::quiet_NaN(), inf = std::numeric_limits<double>::infinity();
  const double cardinal[][5] = {{10, 20, 50, 20, 0},  {50, -120, -10, -120, 180}, {0, 10, 0, 40, 90},
                                {0, 10, 0, -20, -90}, {0, 179, 0, -179, 90},      {-45, -179.5, -40, -179.5, 0},
                                {-90, 0, 10, 0, 0},   {0, 0, 0, 180, any},        {30, 0, -30, 180, any}};
  for (const auto& c : cardinal) {
    SCOPED_TRACE(::testing::Message() << c[0] << " " << c[1] << " -> " << c[2] << " " << c[3]);
    CMathAngle az;
    ASSERT_TRUE(setAzimuthDeg(az, c[0], c[1], c[2], c[3]));
    if (std::isnan(c[4]))
      EXPECT_LE(std::fabs(az.getRad()), kPi);
    else
      EXPECT_NEAR(az.getRad(), c[4] * kDegToRad, 1e-12);
  }
  const double none[][4] = {{0.5, 0.3, 0.5, 0.3}, {0.5, 0.3, 0.5, 0.3 + kTwoPi}, {any, 0.0, 0.1, 0.1},
                            {0.1, 0.1, 0.2, inf}, {1.6, 0.0, 0.0, 0.0},          {0.0, 0.0, -2.0, 0.0}};
  for (const auto& c : none) {
    CMathAngle az(30.0);
    EXPECT_FALSE(az.setAzFromLatLon(c[0], c[1], c[2], c[3])) << c[0] << " " << c[3];
    EXPECT_NEAR(az.getDeg(), 30.0, 1e-12);
  }
}

Coord onSphere(double latDeg, double lonDeg, double radius) {
  const double lat = latDeg * kDegToRad, lon = lonDeg * kDegToRad;
  return Coord(radius * std::cos(lat) * std::cos(lon), radius * std::cos(lat) * std::sin(lon), radius * std::sin(lat));
}

// The angle at the earth's centre against the haversine formula, for radii that differ (the angle depends on
// the directions only); tiny and opposite angles keep their precision; a zero or non-finite vector has none.
TEST(GeocentricAngle, MatchesHaversineAndEdgeCases) {
  std::mt19937_64 engine(7);
  std::uniform_real_distribution<double> lat(-90.0, 90.0), lon(-180.0, 180.0), radius(1.0, 2.0e7);
  for (int i = 0; i < 2000; ++i) {
    const double lat1 = lat(engine), lon1 = lon(engine), lat2 = lat(engine), lon2 = lon(engine);
    const double h =
        std::pow(std::sin((lat2 - lat1) * kDegToRad / 2), 2) +
        std::cos(lat1 * kDegToRad) * std::cos(lat2 * kDegToRad) * std::pow(std::sin((lon2 - lon1) * kDegToRad / 2), 2);
    const double expected = 2.0 * std::asin(std::min(1.0, std::sqrt(h)));
    const Coord a = onSphere(lat1, lon1, radius(engine)), b = onSphere(lat2, lon2, radius(engine));
    ASSERT_NEAR(rotRange(a, b), expected, 1e-12);
    ASSERT_NEAR(rotRange(b, a), expected, 1e-12);
  }
  const Coord p = onSphere(37.0, -122.0, 6378137.0), zero(0.0, 0.0, 0.0);
  EXPECT_EQ(rotRange(p, p), 0.0);
  EXPECT_NEAR(rotRange(p, Coord(-p.x(), -p.y(), -p.z())), kPi, 1e-15);
  EXPECT_NEAR(rotRange(onSphere(0.0, 0.0, 1.0), onSphere(0.0, 1e-9, 5.0)), 1e-9 * kDegToRad, 1e-22);
  for (const auto& pair :
       {std::make_pair(p, zero), std::make_pair(zero, p), std::make_pair(p, Coord(std::nan(""), 0, 1))})
    EXPECT_TRUE(std::isnan(rotRange(pair.first, pair.second)));
}

}  // namespace
