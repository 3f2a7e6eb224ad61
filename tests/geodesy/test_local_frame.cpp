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

using Vec3 = svy_math::TAbstractPoint3<double>;
using svy_math::units::kDegToRad;
using svy_math::units::kTwoPi;

// (east, north, up) of Cartesian differences against an independent local Cartesian frame, at origins that
// include both poles, the antimeridian and the equator, for targets near and far (a rotation of a vector of
// up to 2.6e7 m: a few ulps).
TEST(LocalFrame, MatchesIndependentLocalCartesian) {
  const svy_math::TEllipsoidParams& ell = svy_math::ellipsoidParams();
  const GeographicLib::Geocentric earth(ell.a, 1.0 - std::sqrt(1.0 - ell.e2));
  const double origins[][3] = {
      {0.0, 0.0, 0.0},      {53.8, 2.13, 73.0}, {-33.9, 151.2, 40.0},        {90.0, 0.0, 0.0},
      {-90.0, 30.0, 100.0}, {12.5, 180.0, 0.0}, {-45.0, -179.9999999, 10.0}, {89.9999999, -75.0, 3000.0}};
  for (const auto& o : origins) {
    const GeographicLib::LocalCartesian frame(o[0], o[1], o[2], earth);
    Coord origin;
    origin.blh2xyz(GeoCoord(o[0] * kDegToRad, o[1] * kDegToRad, o[2]));
    for (double dLat : {-30.0, -0.001, 0.0, 2.0})
      for (double dLon : {-90.0, 0.0, 0.00002, 45.0})
        for (double h : {-50.0, 1500.0, 2.02e7}) {
          const double lat = std::max(-90.0, std::min(90.0, o[0] + dLat)), lon = o[1] + dLon;
          double enu[3] = {0, 0, 0};
          frame.Forward(lat, lon, h, enu[0], enu[1], enu[2]);
          Coord target;
          target.blh2xyz(GeoCoord(lat * kDegToRad, lon * kDegToRad, h));
          const Vec3 local = blh_to_neu(Vec3(o[0] * kDegToRad, o[1] * kDegToRad, o[2]), target - origin);
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
