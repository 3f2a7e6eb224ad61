#include <gtest/gtest.h>

#include <GeographicLib/Geodesic.hpp>
#include <cmath>
#include <cstdint>
#include <limits>

#include "svymath/foundation/angle_functions.h"
#include "svymath/foundation/constants.h"
#include "svymath/foundation/math_angle.h"
#include "svymath/geodesy/ellipsoid.h"

namespace {

using svy_math::units::kDegToRad;
using svy_math::units::kPi;
using svy_math::units::kTwoPi;

// Azimuth agreement with the independent geodesic solution (radians): the iteration stops on a change of
// 1e-12 rad in the auxiliary longitude.
constexpr double kAzimuthTol = 1e-9;

const GeographicLib::Geodesic& independentGeodesic() {
  const svy_math::TEllipsoidParams& ell = svy_math::ellipsoidParams();
  static const GeographicLib::Geodesic geodesic(ell.a, 1.0 - std::sqrt(1.0 - ell.e2));
  return geodesic;
}

double independentAzimuth(double lat1Deg, double lon1Deg, double lat2Deg, double lon2Deg, double* distance) {
  double azi1 = 0, azi2 = 0;
  independentGeodesic().Inverse(lat1Deg, lon1Deg, lat2Deg, lon2Deg, *distance, azi1, azi2);
  return azi1 * kDegToRad;
}

double angleDifference(double a, double b) { return std::remainder(a - b, kTwoPi); }

// A fixed pseudo-random sequence in [0, 1), so that the pairs are the same on every run.
class Lcg {
 public:
  double next() {
    m_state = m_state * 6364136223846793005ULL + 1442695040888963407ULL;
    return static_cast<double>(m_state >> 11) / 9007199254740992.0;
  }

 private:
  std::uint64_t m_state = 20260101;
};

// Pairs all over the ellipsoid, long and short, excluding the neighbourhood of the antipode.
TEST(GeodesicAzimuth, MatchesIndependentInverseAcrossTheGlobe) {
  Lcg random;
  int compared = 0;
  for (int i = 0; i < 4000; ++i) {
    const double lat1 = random.next() * 180.0 - 90.0;
    const double lon1 = random.next() * 360.0 - 180.0;
    // Every fourth pair is a survey-scale line (up to ~1 km).
    const bool shortLine = i % 4 == 0;
    const double lat2 = shortLine ? std::max(-90.0, std::min(90.0, lat1 + (random.next() - 0.5) * 0.02))
                                  : random.next() * 180.0 - 90.0;
    const double lon2 = shortLine ? lon1 + (random.next() - 0.5) * 0.02 : random.next() * 360.0 - 180.0;
    double distance = 0;
    const double expected = independentAzimuth(lat1, lon1, lat2, lon2, &distance);
    if (distance > 19.9e6) continue;  // within ~100 km of the antipode
    CMathAngle az;
    ASSERT_TRUE(az.setAzFromLatLon(lat1 * kDegToRad, lon1 * kDegToRad, lat2 * kDegToRad, lon2 * kDegToRad));
    ASSERT_NEAR(angleDifference(az.getRad(), expected), 0.0, kAzimuthTol)
        << lat1 << " " << lon1 << " -> " << lat2 << " " << lon2;
    ++compared;
  }
  EXPECT_GT(compared, 3900);
}

struct AzimuthCase {
  double lat1, lon1, lat2, lon2, azimuthDeg;
};

class GeodesicAzimuthCardinal : public ::testing::TestWithParam<AzimuthCase> {};

// Meridians and the equator: the geodesic runs due north, south, east or west. South is stored as +pi.
TEST_P(GeodesicAzimuthCardinal, RunsAlongMeridianOrEquator) {
  const AzimuthCase c = GetParam();
  CMathAngle az;
  ASSERT_TRUE(az.setAzFromLatLon(c.lat1 * kDegToRad, c.lon1 * kDegToRad, c.lat2 * kDegToRad, c.lon2 * kDegToRad));
  EXPECT_NEAR(az.getRad(), c.azimuthDeg * kDegToRad, 1e-12);
}

INSTANTIATE_TEST_SUITE_P(MeridiansAndEquator, GeodesicAzimuthCardinal,
                         ::testing::Values(AzimuthCase{10.0, 20.0, 50.0, 20.0, 0.0},
                                           AzimuthCase{50.0, -120.0, -10.0, -120.0, 180.0},
                                           AzimuthCase{0.0, 10.0, 0.0, 40.0, 90.0}, AzimuthCase{0.0, 10.0, 0.0, -20.0, -90.0},
                                           AzimuthCase{0.0, 179.0, 0.0, -179.0, 90.0},
                                           AzimuthCase{-45.0, -179.5, -40.0, -179.5, 0.0},
                                           AzimuthCase{-90.0, 0.0, 10.0, 0.0, 0.0}));

TEST(GeodesicAzimuth, NoDirectionForCoincidentOrInvalidPositions) {
  const double nan = std::numeric_limits<double>::quiet_NaN();
  const double inf = std::numeric_limits<double>::infinity();
  const struct {
    double lat1, lon1, lat2, lon2;
  } cases[] = {{0.5, 0.3, 0.5, 0.3},           {0.5, 0.3, 0.5, 0.3 + kTwoPi}, {nan, 0.0, 0.1, 0.1},
               {0.1, 0.1, 0.2, inf},           {1.6, 0.0, 0.0, 0.0},          {0.0, 0.0, -2.0, 0.0}};
  for (const auto& c : cases) {
    CMathAngle az(30.0);
    EXPECT_FALSE(az.setAzFromLatLon(c.lat1, c.lon1, c.lat2, c.lon2)) << c.lat1 << " " << c.lon2;
    EXPECT_NEAR(az.getDeg(), 30.0, 1e-12);
  }
}

// Within a degree of the antipode the classic iteration oscillates; the damped one recovers the geodesic
// for nearly all such pairs, and every pair (exact antipodes included) still ends with a direction.
TEST(GeodesicAzimuth, NearlyAntipodalPairsMostlyMatchAndAlwaysEnd) {
  Lcg random;
  int agreeing = 0;
  constexpr int kPairs = 2000;
  for (int i = 0; i < kPairs; ++i) {
    const double lat1 = random.next() * 180.0 - 90.0, lon1 = random.next() * 360.0 - 180.0;
    const double lat2 = std::max(-90.0, std::min(90.0, -lat1 + (random.next() - 0.5) * 2.0));
    const double lon2 = lon1 + 180.0 + (random.next() - 0.5) * 2.0;
    double distance = 0;
    const double expected = independentAzimuth(lat1, lon1, lat2, lon2, &distance);
    CMathAngle az;
    ASSERT_TRUE(az.setAzFromLatLon(lat1 * kDegToRad, lon1 * kDegToRad, lat2 * kDegToRad, lon2 * kDegToRad));
    ASSERT_TRUE(std::isfinite(az.getRad()));
    if (std::fabs(angleDifference(az.getRad(), expected)) < 1e-8) ++agreeing;
  }
  EXPECT_GT(agreeing, kPairs * 99 / 100);
  for (const double lat : {0.0, 30.0, -89.0}) {
    CMathAngle az;
    EXPECT_TRUE(az.setAzFromLatLon(lat * kDegToRad, 0.0, -lat * kDegToRad, kPi));
    EXPECT_LE(std::fabs(az.getRad()), kPi);
  }
}

// ---- geocentric angle between Cartesian coordinates ----

Coord onSphere(double latDeg, double lonDeg, double radius) {
  const double lat = latDeg * kDegToRad;
  const double lon = lonDeg * kDegToRad;
  return Coord(radius * std::cos(lat) * std::cos(lon), radius * std::cos(lat) * std::sin(lon), radius * std::sin(lat));
}

// Central angle by the haversine formula, an independent route from latitudes and longitudes.
double haversineAngle(double lat1Deg, double lon1Deg, double lat2Deg, double lon2Deg) {
  const double dLat = (lat2Deg - lat1Deg) * kDegToRad;
  const double dLon = (lon2Deg - lon1Deg) * kDegToRad;
  const double h = std::pow(std::sin(dLat / 2), 2) +
                   std::cos(lat1Deg * kDegToRad) * std::cos(lat2Deg * kDegToRad) * std::pow(std::sin(dLon / 2), 2);
  return 2.0 * std::asin(std::min(1.0, std::sqrt(h)));
}

TEST(GeocentricAngle, MatchesHaversineForDirectionsOfAnyLength) {
  Lcg random;
  for (int i = 0; i < 2000; ++i) {
    const double lat1 = random.next() * 180.0 - 90.0, lon1 = random.next() * 360.0 - 180.0;
    const double lat2 = random.next() * 180.0 - 90.0, lon2 = random.next() * 360.0 - 180.0;
    // The radii differ: the angle depends on the directions only.
    const Coord a = onSphere(lat1, lon1, 6.4e6 + 1e5 * random.next());
    const Coord b = onSphere(lat2, lon2, 2.0e7 * random.next() + 1.0);
    const double expected = haversineAngle(lat1, lon1, lat2, lon2);
    ASSERT_NEAR(rotRange(a, b), expected, 1e-12);
    ASSERT_NEAR(rotRange(b, a), expected, 1e-12);
  }
}

// Tiny and nearly opposite angles keep their precision; a zero vector or non-finite input has no angle.
TEST(GeocentricAngle, SmallOppositeAndUndefined) {
  const Coord p = onSphere(37.0, -122.0, 6378137.0);
  EXPECT_EQ(rotRange(p, p), 0.0);
  EXPECT_NEAR(rotRange(p, Coord(-p.x(), -p.y(), -p.z())), kPi, 1e-15);
  EXPECT_NEAR(rotRange(onSphere(0.0, 0.0, 1.0), onSphere(0.0, 1e-9, 5.0)), 1e-9 * kDegToRad, 1e-22);
  EXPECT_TRUE(std::isnan(rotRange(p, Coord(0.0, 0.0, 0.0))));
  EXPECT_TRUE(std::isnan(rotRange(Coord(0.0, 0.0, 0.0), p)));
  EXPECT_TRUE(std::isnan(rotRange(p, Coord(std::numeric_limits<double>::quiet_NaN(), 0.0, 1.0))));
}

}  // namespace
