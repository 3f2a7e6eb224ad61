#include <gtest/gtest.h>

#include <GeographicLib/Geocentric.hpp>
#include <GeographicLib/LocalCartesian.hpp>
#include <cmath>
#include <limits>

#include "svymath/foundation/constants.h"
#include "svymath/geodesy/ellipsoid.h"
#include "svymath/geodesy/geo_coord.h"
#include "svymath/geodesy/local_frame.h"

namespace {

using svy_math::TAbstractPoint3;
using svy_math::units::kDegToRad;
using svy_math::units::kPi;
using svy_math::units::kTwoPi;

// A rotation of a vector of up to 2.6e7 m: a few ulps.
constexpr double kLocalTol = 1e-7;

struct Origin {
  double latDeg, lonDeg, h;
};

class LocalFrame : public ::testing::TestWithParam<Origin> {};

// (east, north, up) of Cartesian differences against an independent local Cartesian frame, at origins that
// include both poles, the antimeridian and the equator, for targets near and far.
TEST_P(LocalFrame, MatchesIndependentLocalCartesian) {
  const Origin o = GetParam();
  const svy_math::TEllipsoidParams& ell = svy_math::ellipsoidParams();
  const GeographicLib::Geocentric earth(ell.a, 1.0 - std::sqrt(1.0 - ell.e2));
  const GeographicLib::LocalCartesian frame(o.latDeg, o.lonDeg, o.h, earth);
  Coord origin;
  origin.blh2xyz(GeoCoord(o.latDeg * kDegToRad, o.lonDeg * kDegToRad, o.h));
  const TAbstractPoint3<double> originBlh(o.latDeg * kDegToRad, o.lonDeg * kDegToRad, o.h);
  for (double dLat : {-30.0, -0.001, 0.0, 2.0})
    for (double dLon : {-90.0, 0.0, 0.00002, 45.0})
      for (double h : {-50.0, 1500.0, 2.02e7}) {
        const double lat = std::max(-90.0, std::min(90.0, o.latDeg + dLat));
        const double lon = o.lonDeg + dLon;
        double east = 0, north = 0, up = 0;
        frame.Forward(lat, lon, h, east, north, up);
        Coord target;
        target.blh2xyz(GeoCoord(lat * kDegToRad, lon * kDegToRad, h));
        const TAbstractPoint3<double> enu = blh_to_neu(originBlh, target - origin);
        ASSERT_NEAR(enu[0], east, kLocalTol) << lat << " " << lon << " " << h;
        ASSERT_NEAR(enu[1], north, kLocalTol) << lat << " " << lon << " " << h;
        ASSERT_NEAR(enu[2], up, kLocalTol) << lat << " " << lon << " " << h;
      }
}

INSTANTIATE_TEST_SUITE_P(Origins, LocalFrame,
                         ::testing::Values(Origin{0.0, 0.0, 0.0}, Origin{53.8, 2.13, 73.0}, Origin{-33.9, 151.2, 40.0},
                                           Origin{90.0, 0.0, 0.0}, Origin{-90.0, 30.0, 100.0},
                                           Origin{12.5, 180.0, 0.0}, Origin{-45.0, -179.9999999, 10.0},
                                           Origin{89.9999999, -75.0, 3000.0}));

struct PolarCase {
  double azimuthDeg, elevationDeg, distance;
};

class LocalPolar : public ::testing::TestWithParam<PolarCase> {};

// Polar form against the vector built from it: azimuth clockwise from north in [0, 2 pi), elevation above
// the horizon, slope distance.
TEST_P(LocalPolar, RecoversAzimuthElevationAndDistance) {
  const PolarCase c = GetParam();
  const double az = c.azimuthDeg * kDegToRad;
  const double el = c.elevationDeg * kDegToRad;
  const TAbstractPoint3<double> v(c.distance * std::cos(el) * std::sin(az), c.distance * std::cos(el) * std::cos(az),
                                  c.distance * std::sin(el));
  const TAbstractPoint3<double> polar = neu_to_polar(v);
  EXPECT_NEAR(polar[0], el, 1e-14);
  if (std::fabs(c.elevationDeg) < 90.0) {
    EXPECT_NEAR(polar[1], std::fmod(az + kTwoPi, kTwoPi), 1e-14);
  }
  EXPECT_GE(polar[1], 0.0);
  EXPECT_LT(polar[1], kTwoPi);
  EXPECT_NEAR(polar[2], c.distance, 1e-9 * c.distance);
}

INSTANTIATE_TEST_SUITE_P(Directions, LocalPolar,
                         ::testing::Values(PolarCase{0.0, 0.0, 100.0}, PolarCase{90.0, 10.0, 25.0},
                                           PolarCase{180.0, -5.0, 1000.0}, PolarCase{270.0, 45.0, 3.5},
                                           PolarCase{-0.5, 1.0, 2.0e7}, PolarCase{359.9999, -89.0, 0.01},
                                           PolarCase{0.0, 90.0, 12.0}, PolarCase{0.0, -90.0, 12.0},
                                           PolarCase{123.456, 0.0, 1e-5}));

// A vector without direction: horizontal length squared and up both inside +-1e-12. The test is on the
// squared horizontal length, so anything up to 1e-6 m across with no height counts as no direction.
TEST(LocalPolarUndefined, ShortVectorsHaveNoDirection) {
  const double kMax = std::numeric_limits<double>::max();
  for (const TAbstractPoint3<double>& v : {TAbstractPoint3<double>(0.0, 0.0, 0.0), TAbstractPoint3<double>(5e-7, -5e-7, 0.0),
                                           TAbstractPoint3<double>(0.0, 0.0, -9e-13)}) {
    const TAbstractPoint3<double> polar = neu_to_polar(v);
    EXPECT_EQ(polar[0], kMax);
    EXPECT_EQ(polar[1], kMax);
    EXPECT_EQ(polar[2], 0.0);
  }
  const TAbstractPoint3<double> justAbove = neu_to_polar(TAbstractPoint3<double>(1.1e-6, 0.0, 0.0));
  EXPECT_EQ(justAbove[1], kPi / 2);
  EXPECT_NEAR(justAbove[2], 1.1e-6, 1e-20);
}

}  // namespace
