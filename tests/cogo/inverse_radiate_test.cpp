#include "svymath/cogo/inverse_radiate.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "svymath/foundation/constants.h"

namespace {

using svy_math::units::kDegToRad;
using svy_math::units::kPi;
using svy_math::units::kTwoPi;

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInf = std::numeric_limits<double>::infinity();

TCoords coords(double north, double east, double height = 0.0) {
  TCoords c;
  c.north = north;
  c.east = east;
  c.height = height;
  return c;
}

// Inverse2D followed by Radiate2D returns to the target, in every quadrant and at grid coordinates.
TEST(InverseRadiateRoundTrip, AzimuthMatchesQuadrantAndRadiateReturnsToTarget) {
  const double k34 = std::atan2(3.0, 4.0);
  struct { double e1, n1, dE, dN, azimuth; } const cases[] = {
      {0, 0, 0, 10, 0.0},       {0, 0, 0, -10, kPi}, {0, 0, -1, 0, 1.5 * kPi}, {0, 0, 3, -4, kPi - k34},
      {0, 0, -3, 4, kTwoPi - k34}, {500000.0, 5000000.0, -0.25, -3000.75, kTwoPi + std::atan2(-0.25, -3000.75)},
      {312345.678, 4084593.748, 10.0, -0.001, std::atan2(10.0, -0.001)}};
  for (const auto& c : cases) {
    SCOPED_TRACE(::testing::Message() << c.e1 << " " << c.dE << " " << c.dN);
    const double e2 = c.e1 + c.dE, n2 = c.n1 + c.dN;
    double azimuth = -1.0, distance = -1.0, e = 0.0, n = 0.0;
    ASSERT_TRUE(Inverse2D(c.e1, c.n1, e2, n2, azimuth, distance));
    // Forming the target rounds it by up to 4.7e-10 m at grid coordinates, which turns the direction.
    EXPECT_NEAR(azimuth, c.azimuth, 1e-12 + 1e-9 / distance);
    EXPECT_TRUE(azimuth >= 0.0 && azimuth < kTwoPi);
    EXPECT_TRUE(Radiate2D(c.e1, c.n1, azimuth, distance, e, n));
    EXPECT_NEAR(std::hypot(e - e2, n - n2), 0.0, 5e-9);  // grid coordinates near 5e6 are 9.3e-10 m apart
  }
}

TEST(Inverse2D, CoincidenceZeroWindowAndNonFiniteInput) {
  double azimuth = -1.0, distance = -1.0;
  EXPECT_TRUE(Inverse2D(500000.0, 5000000.0, 500000.0, 5000000.0, azimuth, distance));
  EXPECT_TRUE(azimuth == 0.0 && distance == 0.0);
  // West by 0.9e-12 would be 3 pi / 2 but lies inside the strict zero window; 2e-12 is outside it.
  EXPECT_TRUE(Inverse2D(0.0, 0.0, -0.9e-12, 0.0, azimuth, distance) && azimuth == 0.0);
  EXPECT_TRUE(Inverse2D(0.0, 0.0, -2e-12, 0.0, azimuth, distance) && azimuth == 1.5 * kPi);
  // Non-finite input fails but writes the outputs.
  EXPECT_FALSE(Inverse2D(0.0, 0.0, kNaN, 1.0, azimuth, distance) || !std::isnan(distance));
  EXPECT_FALSE(Inverse2D(0.0, 0.0, 1.0, kInf, azimuth, distance) || !std::isinf(distance) || azimuth != 0.0);
  EXPECT_FALSE(Inverse2D(-1e308, 0.0, 1e308, 0.0, azimuth, distance));  // the difference overflows
}

TEST(Inverse3D, ZenithFromTheUpwardVerticalAndIdenticalPointsFail) {
  struct {
    double e2, n2, z2, slope, zenith;
  } const cases[] = {{0, 0, 3, 3.0, 0.0}, {0, 0, -4, 4.0, kPi}, {-4, 0, 0, 4.0, kPi / 2},
                     {3, 4, 5, 5.0 * std::sqrt(2.0), kPi / 4}};
  for (const auto& c : cases) {
    double azimuth = -1.0, slope = -1.0, zenith = -1.0;
    ASSERT_TRUE(Inverse3D(0.0, 0.0, 0.0, c.e2, c.n2, c.z2, azimuth, slope, zenith));
    EXPECT_DOUBLE_EQ(slope, c.slope);
    EXPECT_DOUBLE_EQ(zenith, c.zenith);
  }
  double azimuth = -1.0, slope = -2.0, zenith = -3.0;
  EXPECT_FALSE(Inverse3D(1.0, 2.0, 3.0, 1.0, 2.0, 3.0, azimuth, slope, zenith));
  EXPECT_TRUE(azimuth == -1.0 && slope == -2.0 && zenith == -3.0);
}

// The extended point lies on the line from -> through, |distance| beyond `through` (behind it for a negative
// distance; back to the start for minus the line's length).
TEST(Compute3DPoint, ExtendedPointLiesOnTheLine) {
  const TCoords cases[][2] = {{coords(0, 0, 0), coords(-3, 4, -12)},
                              {coords(5000000, 500000, 250), coords(4999900, 500010, 240)},
                              {coords(10, 10, 0), coords(10, 10, 5)}};
  for (const auto& c : cases) {
    const double dN = c[1].north - c[0].north, dE = c[1].east - c[0].east, dZ = c[1].height - c[0].height;
    const double length = std::hypot(std::hypot(dN, dE), dZ);
    for (double distance : {7.5, -30.0, -length}) {
      SCOPED_TRACE(::testing::Message() << c[0].north << " " << distance);
      TCoords out = coords(kNaN, kNaN, kNaN);
      ASSERT_EQ(Compute3DPoint(c[0], c[1], distance, out), 1);
      const double t = distance / length;
      EXPECT_NEAR(std::hypot(out.north - c[1].north - t * dN, out.east - c[1].east - t * dE), 0.0, 1e-8);
      EXPECT_NEAR(out.height, c[1].height + t * dZ, 1e-8);
    }
  }
}

TEST(Compute3DPoint, LineWithoutDirectionFailsAndWritesNothing) {
  TCoords out = coords(-1.0, -2.0, -3.0);
  out.mask = TCoords::kNorthValid;
  const TCoords a = coords(100.0, 200.0, 300.0);
  for (const TCoords& b : {a, coords(100.0, 200.0 + 0.9e-5, 300.0), coords(kNaN, 200.0, 300.0),
                           coords(100.0, kInf, 300.0)})
    EXPECT_EQ(Compute3DPoint(a, b, 10.0, out), 0);  // coincident, shorter than 1e-5 m, non-finite
  EXPECT_TRUE(out.north == -1.0 && out.east == -2.0 && out.height == -3.0);
  EXPECT_EQ(Compute3DPoint(a, coords(100.0, 200.0 + 2e-5, 300.0), 10.0, out), 1);  // just long enough
  EXPECT_NEAR(out.east, 210.00002, 1e-9);
  EXPECT_EQ(out.mask, TCoords::kNorthValid);
}

// +90 degrees added: right of the direction of travel (south of east-bound travel); none added: Radiate2D.
TEST(Compute2DPoint, AddedRightAngleGivesTheOffsetAcrossTheAzimuth) {
  double e = 0, n = 0, eRad = 0, nRad = 0;
  Compute2DPoint(500000.0, 5000000.0, 12.5, 90.0, 90.0, e, n);
  EXPECT_NEAR(std::hypot(n - 4999987.5, e - 500000.0), 0.0, 1e-9);
  Compute2DPoint(500000.0, 5000000.0, 12.5, -45.0, -90.0, e, n);
  EXPECT_NEAR(std::hypot(n - 5000000.0 + 12.5 / std::sqrt(2.0), e - 500000.0 + 12.5 / std::sqrt(2.0)), 0.0, 1e-9);
  Compute2DPoint(500000.0, 5000000.0, 12.5, 135.0, 0.0, e, n);
  Radiate2D(500000.0, 5000000.0, 135.0 * kDegToRad, 12.5, eRad, nRad);
  EXPECT_TRUE(e == eRad && n == nRad);
}

// Against the exact direct problem on the sphere. The mid-latitude step is of first order: for a step of
// delta = 100 / 6.371e6 rad it neglects terms of delta^2 times tan(latitude), 1.4 mm at latitude 60.
TEST(Compute2DPointBLH, SmallStepsAgreeWithTheSphericalDirectProblem) {
  const double R = svy_math::units::kSphereEarthRadius;
  const double steps[][4] = {{0.0, 10.0, 90.0, 0.0}, {-33.9, 151.2, 200.0, 0.0}, {60.0, 25.0, 45.0, 45.0},
                             {-70.0, -60.0, 300.0, -10.0}, {89.0, 0.0, 135.0, 0.0}};
  for (const auto& s : steps) {
    SCOPED_TRACE(::testing::Message() << s[0] << " " << s[1] << " " << s[2]);
    double lat = 0, lon = 0;
    Compute2DPointBLH(s[0], s[1], 100.0, s[2], s[3], lat, lon);
    const double phi1 = s[0] * kDegToRad, theta = (s[2] + s[3]) * kDegToRad, delta = 100.0 / R;
    const double phi2 =
        std::asin(std::sin(phi1) * std::cos(delta) + std::cos(phi1) * std::sin(delta) * std::cos(theta));
    const double dLon = std::atan2(std::sin(theta) * std::sin(delta) * std::cos(phi1),
                                   std::cos(delta) - std::sin(phi1) * std::sin(phi2));
    const double latTol = delta * delta * (1.0 + std::fabs(std::tan(phi1))) / kDegToRad;
    EXPECT_NEAR(lat, phi2 / kDegToRad, latTol);
    EXPECT_NEAR(lon, s[1] + dLon / kDegToRad, latTol * (1.0 + std::fabs(std::tan(phi1))) / std::cos(phi1));
  }
  // 1 degree of arc along the meridian, and no longitude change at the poles.
  double lat = 0, lon = 0;
  Compute2DPointBLH(12.0, 34.0, R * kDegToRad, 180.0, 0.0, lat, lon);
  EXPECT_TRUE(std::fabs(lat - 11.0) <= 1e-12 && std::fabs(lon - 34.0) <= 1e-12) << lat << " " << lon;
  for (double pole : {90.0, -90.0}) {
    Compute2DPointBLH(pole, 17.0, 0.0, 90.0, 0.0, lat, lon);
    EXPECT_TRUE(lat == pole && lon == 17.0);
  }
}

// Steps of kilometres keep a constant azimuth: on the sphere that is the rhumb line, whose latitude changes by
// distance * cos(azimuth) exactly and whose longitude changes by tan(azimuth) times the change of isometric
// latitude. The parallel taken at the mean latitude matches it to third order in the step (below 1e-7 deg
// here); the start latitude's parallel would be 1.2e-4 deg (6.8 m) off at 60 N for 10 km north-east.
TEST(Compute2DPointBLH, KilometreStepsFollowTheRhumbLine) {
  const double R = svy_math::units::kSphereEarthRadius;
  const double steps[][3] = {{60.0, 45.0, 10000.0}, {-45.0, 300.0, 20000.0}, {0.0, 30.0, 15000.0},
                             {75.0, 160.0, 5000.0}, {-30.0, 225.0, 10000.0}};
  const auto isometric = [](double phi) { return std::log(std::tan(kPi / 4.0 + phi / 2.0)); };
  for (const auto& s : steps) {
    SCOPED_TRACE(::testing::Message() << s[0] << " " << s[1]);
    double lat = 0, lon = 0;
    Compute2DPointBLH(s[0], 10.0, s[2], s[1], 0.0, lat, lon);
    const double phi1 = s[0] * kDegToRad, theta = s[1] * kDegToRad;
    const double phi2 = phi1 + s[2] / R * std::cos(theta);
    EXPECT_NEAR(lat, phi2 / kDegToRad, 1e-12);
    EXPECT_NEAR(lon, 10.0 + std::tan(theta) * (isometric(phi2) - isometric(phi1)) / kDegToRad, 1e-7);
  }
}

TEST(dENSoutInfo, RotatingBackRestoresAndShortVectorsGiveZeros) {
  double a = 0, b = 0, h = 0, a2 = 0, b2 = 0, h2 = 0;
  ASSERT_EQ(dENSoutInfo(3.0, -4.0, 12.5, -1000.0, a, b, h), 1);
  ASSERT_EQ(dENSoutInfo(a, b, h, 1000.0, a2, b2, h2), 1);
  EXPECT_TRUE(std::hypot(a2 - 3.0, b2 + 4.0) < 1e-12 && h2 == 12.5);
  ASSERT_EQ(dENSoutInfo(1.0, 0.0, 0.0, 90.0, a, b, h), 1);
  EXPECT_NEAR(std::hypot(a, b - 1.0), 0.0, 1e-15);
  EXPECT_EQ(dENSoutInfo(0.9e-8, 0.0, 42.0, 30.0, a, b, h), 0);  // shorter than 1e-8: zeros and the height
  EXPECT_TRUE(a == 0.0 && b == 0.0 && h == 42.0);
  EXPECT_EQ(dENSoutInfo(1.1e-8, 0.0, 42.0, 30.0, a, b, h), 1);
}

// The TCoords forms: the distance ignores the height but needs finite plan values; the azimuth fails for
// points within the (inclusive) coincidence window of 1e-10, although Inverse2D gives one there.
TEST(CoordsForms, DistanceIgnoresHeightAndAzimuthFailsWithinTheCoincidenceWindow) {
  double distance = -1.0, azimuth = -1.0;
  ASSERT_TRUE(boCompute2DDistanceBetweenCoords(coords(5000000, 500000, 0), coords(5000004, 500003, 999), distance));
  EXPECT_DOUBLE_EQ(distance, 5.0);
  EXPECT_TRUE(boCompute2DDistanceBetweenCoords(coords(0, 0, kNaN), coords(1, 1, 0), distance));
  distance = -1.0;
  const TCoords p = coords(5000000.0, 500000.0);
  const TCoords pairs[][2] = {{coords(kNaN, 0), coords(1, 1)}, {coords(0, 0), coords(1, -kInf)}};
  for (const auto& q : pairs) {
    EXPECT_FALSE(boCompute2DDistanceBetweenCoords(q[0], q[1], distance));
    EXPECT_FALSE(boComputeAzimuthBetweenCoords(q[0], q[1], azimuth));
  }
  EXPECT_FALSE(boComputeAzimuthBetweenCoords(p, p, azimuth));
  EXPECT_FALSE(boComputeAzimuthBetweenCoords(coords(0, 0), coords(0, 1e-10), azimuth));
  EXPECT_TRUE(distance == -1.0 && azimuth == -1.0);
  EXPECT_FALSE(boCompute2DDistanceBetweenCoords(coords(-1e308, 0), coords(1e308, 0), distance));
  EXPECT_TRUE(Inverse2D(0.0, 0.0, 1e-10, 0.0, azimuth, distance) && azimuth == kPi / 2);
  azimuth = -1.0;  // beyond the window, at grid coordinates: due east
  EXPECT_TRUE(boComputeAzimuthBetweenCoords(p, coords(p.north, p.east + 3e-10, 7.0), azimuth) && azimuth == kPi / 2);
}

}  // namespace
