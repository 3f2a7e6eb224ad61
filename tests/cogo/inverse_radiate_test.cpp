#include "svymath/cogo/inverse_radiate.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "svymath/foundation/constants.h"

namespace {

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

// ---------------------------------------------------------------------------------------------------
// Inverse2D followed by Radiate2D returns to the target, in every quadrant and at grid coordinates.

struct InverseCase {
  double e1, n1, dE, dN;  // start and the difference to the target
  double azimuth;         // expected azimuth (radians), from the geometry of the difference
};

class InverseRadiateRoundTrip : public ::testing::TestWithParam<InverseCase> {};

TEST_P(InverseRadiateRoundTrip, AzimuthMatchesQuadrantAndRadiateReturnsToTarget) {
  const InverseCase& c = GetParam();
  const double e2 = c.e1 + c.dE;
  const double n2 = c.n1 + c.dN;
  double azimuth = -1.0;
  double distance = -1.0;
  ASSERT_TRUE(Inverse2D(c.e1, c.n1, e2, n2, azimuth, distance));
  // The differences are representable, so the distance is that of (dE, dN) up to rounding.
  EXPECT_NEAR(distance, std::hypot(c.dE, c.dN), 1e-9);
  // Forming the target rounds it by up to 4.7e-10 m at grid coordinates, which turns the direction.
  EXPECT_NEAR(azimuth, c.azimuth, 1e-12 + 1e-9 / distance);
  EXPECT_GE(azimuth, 0.0);
  EXPECT_LT(azimuth, kTwoPi);

  double e = 0.0;
  double n = 0.0;
  EXPECT_TRUE(Radiate2D(c.e1, c.n1, azimuth, distance, e, n));
  // Grid coordinates near 5e6 are spaced 9.3e-10 m apart: a few spacings of rounding.
  EXPECT_NEAR(e, e2, 5e-9);
  EXPECT_NEAR(n, n2, 5e-9);
}

const double kAtan34 = std::atan2(3.0, 4.0);  // azimuth of (dE 3, dN 4)

INSTANTIATE_TEST_SUITE_P(
    AllQuadrants, InverseRadiateRoundTrip,
    ::testing::Values(
        // At the origin: the cardinal directions and one direction per quadrant.
        InverseCase{0, 0, 0, 10, 0.0}, InverseCase{0, 0, 10, 0, kPi / 2},
        InverseCase{0, 0, 0, -10, kPi}, InverseCase{0, 0, -1, 0, 1.5 * kPi},
        InverseCase{0, 0, 3, 4, kAtan34}, InverseCase{0, 0, 3, -4, kPi - kAtan34},
        InverseCase{0, 0, -3, -4, kPi + kAtan34}, InverseCase{0, 0, -3, 4, kTwoPi - kAtan34},
        InverseCase{0, 0, 1, 1, kPi / 4}, InverseCase{0, 0, -1, 1, 1.75 * kPi},
        // At grid coordinates (E 500 000, N 5 000 000) with survey-sized legs.
        InverseCase{500000.0, 5000000.0, 123.456, 789.012, std::atan2(123.456, 789.012)},
        InverseCase{500000.0, 5000000.0, 1234.5, -0.001, std::atan2(1234.5, -0.001)},
        InverseCase{500000.0, 5000000.0, -0.25, -3000.75, kTwoPi + std::atan2(-0.25, -3000.75)},
        InverseCase{500000.0, 5000000.0, -4321.0, 0.5, kTwoPi + std::atan2(-4321.0, 0.5)},
        InverseCase{312345.678, 4084593.748, 10.0, -0.001, std::atan2(10.0, -0.001)}));

// ---------------------------------------------------------------------------------------------------
// Inverse2D: coincidence, the strict zero window, non-finite input.

TEST(Inverse2D, PointWithItselfGivesZeroAzimuthAndDistance) {
  double azimuth = -1.0;
  double distance = -1.0;
  EXPECT_TRUE(Inverse2D(500000.0, 5000000.0, 500000.0, 5000000.0, azimuth, distance));
  EXPECT_EQ(azimuth, 0.0);
  EXPECT_EQ(distance, 0.0);
}

TEST(Inverse2D, DifferencesInsideTheStrictZeroWindowGiveAzimuthZero) {
  double azimuth = -1.0;
  double distance = -1.0;
  // West by 0.9e-12 would be 3 pi / 2 but lies inside the window.
  EXPECT_TRUE(Inverse2D(0.0, 0.0, -0.9e-12, 0.0, azimuth, distance));
  EXPECT_EQ(azimuth, 0.0);
  // Outside the window the direction counts.
  EXPECT_TRUE(Inverse2D(0.0, 0.0, -2e-12, 0.0, azimuth, distance));
  EXPECT_DOUBLE_EQ(azimuth, 1.5 * kPi);
}

TEST(Inverse2D, NonFiniteInputFailsButWritesOutputs) {
  double azimuth = -1.0;
  double distance = -1.0;
  EXPECT_FALSE(Inverse2D(0.0, 0.0, kNaN, 1.0, azimuth, distance));
  EXPECT_TRUE(std::isnan(distance));
  azimuth = -1.0;
  distance = -1.0;
  EXPECT_FALSE(Inverse2D(0.0, 0.0, 1.0, kInf, azimuth, distance));
  EXPECT_TRUE(std::isinf(distance));
  EXPECT_EQ(azimuth, 0.0);  // atan2(1, inf)
  // Differences that overflow: finite inputs, infinite distance.
  EXPECT_FALSE(Inverse2D(-1e308, 0.0, 1e308, 0.0, azimuth, distance));
}

// ---------------------------------------------------------------------------------------------------
// Inverse3D and Compute3DPoint.

TEST(Inverse3D, ZenithIsMeasuredFromTheUpwardVertical) {
  double azimuth = -1.0;
  double slope = -1.0;
  double zenith = -1.0;
  ASSERT_TRUE(Inverse3D(10.0, 20.0, 5.0, 10.0, 20.0, 8.0, azimuth, slope, zenith));
  EXPECT_EQ(zenith, 0.0);
  EXPECT_EQ(slope, 3.0);
  ASSERT_TRUE(Inverse3D(10.0, 20.0, 5.0, 10.0, 20.0, 1.0, azimuth, slope, zenith));
  EXPECT_DOUBLE_EQ(zenith, kPi);
  // Level and 45 degrees up, toward the west.
  ASSERT_TRUE(Inverse3D(0.0, 0.0, 0.0, -4.0, 0.0, 0.0, azimuth, slope, zenith));
  EXPECT_DOUBLE_EQ(zenith, kPi / 2);
  EXPECT_DOUBLE_EQ(azimuth, 1.5 * kPi);
  ASSERT_TRUE(Inverse3D(0.0, 0.0, 0.0, 3.0, 4.0, 5.0, azimuth, slope, zenith));
  EXPECT_DOUBLE_EQ(zenith, kPi / 4);
  EXPECT_DOUBLE_EQ(slope, 5.0 * std::sqrt(2.0));
}

TEST(Inverse3D, IdenticalPointsFailAndWriteNothing) {
  double azimuth = -1.0;
  double slope = -2.0;
  double zenith = -3.0;
  EXPECT_FALSE(Inverse3D(1.0, 2.0, 3.0, 1.0, 2.0, 3.0, azimuth, slope, zenith));
  EXPECT_EQ(azimuth, -1.0);
  EXPECT_EQ(slope, -2.0);
  EXPECT_EQ(zenith, -3.0);
}

struct Line3DCase {
  TCoords from, through;
  double distance;
};

class Compute3DPointRoundTrip : public ::testing::TestWithParam<Line3DCase> {};

// The extended point lies on the line: seen from `through` it has the direction of from -> through
// (or the opposite one for a negative distance) at |distance|.
TEST_P(Compute3DPointRoundTrip, ExtendedPointKeepsTheDirectionOfTheLine) {
  const Line3DCase& c = GetParam();
  TCoords out = coords(kNaN, kNaN, kNaN);
  ASSERT_EQ(Compute3DPoint(c.from, c.through, c.distance, out), 1);

  double lineAz = 0, lineSlope = 0, lineZenith = 0;
  ASSERT_TRUE(Inverse3D(c.from.east, c.from.north, c.from.height, c.through.east, c.through.north,
                        c.through.height, lineAz, lineSlope, lineZenith));
  double az = 0, slope = 0, zenith = 0;
  ASSERT_TRUE(Inverse3D(c.through.east, c.through.north, c.through.height, out.east, out.north,
                        out.height, az, slope, zenith));
  EXPECT_NEAR(slope, std::fabs(c.distance), 1e-8);
  if (c.distance > 0) {
    EXPECT_NEAR(std::remainder(az - lineAz, kTwoPi), 0.0, 1e-10);
    EXPECT_NEAR(zenith, lineZenith, 1e-10);
  } else {
    EXPECT_NEAR(std::remainder(az - lineAz - kPi, kTwoPi), 0.0, 1e-10);
    EXPECT_NEAR(zenith, kPi - lineZenith, 1e-10);
  }
  // From the start the new point is |line| + distance away.
  ASSERT_TRUE(Inverse3D(c.from.east, c.from.north, c.from.height, out.east, out.north, out.height,
                        az, slope, zenith));
  EXPECT_NEAR(slope, std::fabs(lineSlope + c.distance), 1e-8);
}

INSTANTIATE_TEST_SUITE_P(
    Lines, Compute3DPointRoundTrip,
    ::testing::Values(Line3DCase{coords(0, 0, 0), coords(3, 4, 12), 13.0},
                      Line3DCase{coords(0, 0, 0), coords(-3, 4, -12), 2.5},
                      Line3DCase{coords(5000000, 500000, 250), coords(5000100, 499950, 252), 40.0},
                      Line3DCase{coords(5000000, 500000, 250), coords(4999900, 500010, 240), -30.0},
                      Line3DCase{coords(10, 10, 0), coords(10, 10, 5), 7.0}));

TEST(Compute3DPoint, NegativeDistanceOfTheWholeLineGivesTheStart) {
  const TCoords from = coords(5000000.0, 500000.0, 100.0);
  const TCoords through = coords(5000030.0, 500040.0, 100.0);
  TCoords out;
  ASSERT_EQ(Compute3DPoint(from, through, -50.0, out), 1);
  EXPECT_NEAR(out.north, from.north, 1e-9);
  EXPECT_NEAR(out.east, from.east, 1e-9);
  EXPECT_NEAR(out.height, from.height, 1e-12);
}

TEST(Compute3DPoint, LineWithoutDirectionFailsAndWritesNothing) {
  TCoords out = coords(-1.0, -2.0, -3.0);
  out.mask = TCoords::kNorthValid;
  const TCoords a = coords(100.0, 200.0, 300.0);
  // Coincident, shorter than 1e-5 m, non-finite.
  EXPECT_EQ(Compute3DPoint(a, a, 10.0, out), 0);
  EXPECT_EQ(Compute3DPoint(a, coords(100.0, 200.0 + 0.9e-5, 300.0), 10.0, out), 0);
  EXPECT_EQ(Compute3DPoint(a, coords(kNaN, 200.0, 300.0), 10.0, out), 0);
  EXPECT_EQ(Compute3DPoint(a, coords(100.0, kInf, 300.0), 10.0, out), 0);
  EXPECT_EQ(out.north, -1.0);
  EXPECT_EQ(out.east, -2.0);
  EXPECT_EQ(out.height, -3.0);
  // Just long enough.
  EXPECT_EQ(Compute3DPoint(a, coords(100.0, 200.0 + 2e-5, 300.0), 10.0, out), 1);
  EXPECT_NEAR(out.east, 210.00002, 1e-9);
  EXPECT_EQ(out.mask, TCoords::kNorthValid);
}

// ---------------------------------------------------------------------------------------------------
// Degree-based radiation: Compute2DPoint against the offset rule of the axis convention.

TEST(Compute2DPoint, AddedRightAngleGivesTheOffsetAcrossTheAzimuth) {
  const double e0 = 500000.0;
  const double n0 = 5000000.0;
  for (double azimuthDeg : {0.0, 30.0, 135.0, 200.0, 315.0, -45.0}) {
    SCOPED_TRACE(azimuthDeg);
    const double a = azimuthDeg * svy_math::units::kDegToRad;
    const double d = 12.5;
    double e = 0, n = 0;
    // +90: right of the direction of travel, (N0 - d sin a, E0 + d cos a).
    Compute2DPoint(e0, n0, d, azimuthDeg, 90.0, e, n);
    EXPECT_NEAR(n, n0 - d * std::sin(a), 1e-9);
    EXPECT_NEAR(e, e0 + d * std::cos(a), 1e-9);
    Compute2DPoint(e0, n0, d, azimuthDeg, -90.0, e, n);
    EXPECT_NEAR(n, n0 + d * std::sin(a), 1e-9);
    EXPECT_NEAR(e, e0 - d * std::cos(a), 1e-9);
    // No added angle: the same point as the radian radiation.
    double eRad = 0, nRad = 0;
    Compute2DPoint(e0, n0, d, azimuthDeg, 0.0, e, n);
    Radiate2D(e0, n0, a, d, eRad, nRad);
    EXPECT_EQ(e, eRad);
    EXPECT_EQ(n, nRad);
  }
}

TEST(Radiate2D, AzimuthZeroMovesOnlyTheNorthing) {
  double e = 0, n = 0;
  EXPECT_TRUE(Radiate2D(500000.0, 5000000.0, 0.0, 25.0, e, n));
  EXPECT_EQ(e, 500000.0);
  EXPECT_EQ(n, 5000025.0);
}

// ---------------------------------------------------------------------------------------------------
// Compute2DPointBLH against the exact direct problem on the sphere. The mid-latitude step is of first
// order: for a step of delta = 100 / 6.371e6 rad it neglects terms of delta^2 times tan(latitude)
// (the turn of the meridians), 1.4 mm at latitude 60.

void sphereDirect(double latDeg, double lonDeg, double distance, double azimuthDeg, double& lat2,
                  double& lon2) {
  const double k = svy_math::units::kDegToRad;
  const double phi1 = latDeg * k;
  const double theta = azimuthDeg * k;
  const double delta = distance / svy_math::units::kSphereEarthRadius;
  const double phi2 =
      std::asin(std::sin(phi1) * std::cos(delta) + std::cos(phi1) * std::sin(delta) * std::cos(theta));
  const double dLon = std::atan2(std::sin(theta) * std::sin(delta) * std::cos(phi1),
                                 std::cos(delta) - std::sin(phi1) * std::sin(phi2));
  lat2 = phi2 / k;
  lon2 = lonDeg + dLon / k;
}

TEST(Compute2DPointBLH, SmallStepsAgreeWithTheSphericalDirectProblem) {
  struct Step {
    double lat, lon, azimuth, added;
  };
  const Step steps[] = {{0.0, 10.0, 0.0, 0.0},     {0.0, 10.0, 90.0, 0.0},   {45.0, -73.0, 30.0, 0.0},
                        {-33.9, 151.2, 200.0, 0.0}, {60.0, 25.0, 45.0, 45.0}, {-70.0, -60.0, 300.0, -10.0},
                        {89.0, 0.0, 135.0, 0.0}};
  for (const Step& s : steps) {
    SCOPED_TRACE(::testing::Message() << s.lat << " " << s.lon << " " << s.azimuth);
    double lat = 0, lon = 0, latRef = 0, lonRef = 0;
    Compute2DPointBLH(s.lat, s.lon, 100.0, s.azimuth, s.added, lat, lon);
    sphereDirect(s.lat, s.lon, 100.0, s.azimuth + s.added, latRef, lonRef);
    const double delta = 100.0 / svy_math::units::kSphereEarthRadius;
    const double phi = s.lat * svy_math::units::kDegToRad;
    const double latTol = delta * delta * (1.0 + std::fabs(std::tan(phi))) * svy_math::units::kRadToDeg;
    EXPECT_NEAR(lat, latRef, latTol);
    EXPECT_NEAR(lon, lonRef, latTol * (1.0 + std::fabs(std::tan(phi))) / std::cos(phi));
  }
}

TEST(Compute2DPointBLH, OneDegreeOfArcAlongTheMeridian) {
  // 1 degree of a 6 371 km sphere is 111 194.93 m.
  const double oneDegree = svy_math::units::kSphereEarthRadius * svy_math::units::kDegToRad;
  double lat = 0, lon = 0;
  Compute2DPointBLH(12.0, 34.0, oneDegree, 180.0, 0.0, lat, lon);
  EXPECT_NEAR(lat, 11.0, 1e-12);
  EXPECT_NEAR(lon, 34.0, 1e-12);
}

TEST(Compute2DPointBLH, AtThePoleTheLongitudeIsUnchanged) {
  for (double pole : {90.0, -90.0}) {
    double lat = 0, lon = 0;
    Compute2DPointBLH(pole, 17.0, 0.0, 90.0, 0.0, lat, lon);
    EXPECT_EQ(lat, pole);
    EXPECT_EQ(lon, 17.0);
  }
}

// ---------------------------------------------------------------------------------------------------
// dENSoutInfo: a plane rotation.

TEST(dENSoutInfo, RotationKeepsLengthAndRotatingBackRestores) {
  const double angles[] = {0.0, 90.0, -90.0, 33.3, 180.0, 271.5, -1000.0};
  for (double angle : angles) {
    SCOPED_TRACE(angle);
    double a = 0, b = 0, h = 0;
    ASSERT_EQ(dENSoutInfo(3.0, -4.0, 12.5, angle, a, b, h), 1);
    EXPECT_EQ(h, 12.5);
    EXPECT_NEAR(std::hypot(a, b), 5.0, 1e-12);
    double a2 = 0, b2 = 0, h2 = 0;
    ASSERT_EQ(dENSoutInfo(a, b, h, -angle, a2, b2, h2), 1);
    EXPECT_NEAR(a2, 3.0, 1e-12);
    EXPECT_NEAR(b2, -4.0, 1e-12);
  }
  double a = 0, b = 0, h = 0;
  ASSERT_EQ(dENSoutInfo(1.0, 0.0, 0.0, 90.0, a, b, h), 1);
  EXPECT_NEAR(a, 0.0, 1e-15);
  EXPECT_NEAR(b, 1.0, 1e-15);
}

TEST(dENSoutInfo, VectorWithoutLengthReturnsZeroWithZerosAndTheHeight) {
  double a = 7, b = 7, h = 7;
  EXPECT_EQ(dENSoutInfo(0.0, 0.0, 42.0, 30.0, a, b, h), 0);
  EXPECT_EQ(a, 0.0);
  EXPECT_EQ(b, 0.0);
  EXPECT_EQ(h, 42.0);
  // Shorter than 1e-8: still no direction.
  EXPECT_EQ(dENSoutInfo(0.9e-8, 0.0, 42.0, 30.0, a, b, h), 0);
  EXPECT_EQ(dENSoutInfo(1.1e-8, 0.0, 42.0, 30.0, a, b, h), 1);
}

// ---------------------------------------------------------------------------------------------------
// The TCoords forms.

TEST(boCompute2DDistanceBetweenCoords, IgnoresHeightAndRejectsNonFinitePlanValues) {
  double distance = -1.0;
  ASSERT_TRUE(boCompute2DDistanceBetweenCoords(coords(5000000, 500000, 0),
                                               coords(5000004, 500003, 999), distance));
  EXPECT_DOUBLE_EQ(distance, 5.0);
  EXPECT_DOUBLE_EQ(distance, HorizontalDistance(500000, 5000000, 500003, 5000004));
  // A missing height does not matter; a missing plan value does.
  EXPECT_TRUE(boCompute2DDistanceBetweenCoords(coords(0, 0, kNaN), coords(1, 1, 0), distance));
  distance = -1.0;
  EXPECT_FALSE(boCompute2DDistanceBetweenCoords(coords(kNaN, 0), coords(1, 1), distance));
  EXPECT_FALSE(boCompute2DDistanceBetweenCoords(coords(0, 0), coords(1, -kInf), distance));
  EXPECT_EQ(distance, -1.0);
  EXPECT_FALSE(boCompute2DDistanceBetweenCoords(coords(-1e308, 0), coords(1e308, 0), distance));
}

TEST(boComputeAzimuthBetweenCoords, SamePointWithinTheCoincidenceWindowFails) {
  double azimuth = -1.0;
  const TCoords p = coords(5000000.0, 500000.0);
  EXPECT_FALSE(boComputeAzimuthBetweenCoords(p, p, azimuth));
  // 1e-10 apart is still the same point (the window is inclusive), although Inverse2D would give an
  // azimuth for it.
  EXPECT_FALSE(boComputeAzimuthBetweenCoords(coords(0, 0), coords(0, 1e-10), azimuth));
  EXPECT_FALSE(boComputeAzimuthBetweenCoords(coords(0, 0), coords(kNaN, 5), azimuth));
  EXPECT_FALSE(boComputeAzimuthBetweenCoords(coords(0, kInf), coords(0, 5), azimuth));
  EXPECT_EQ(azimuth, -1.0);
  double distance = 0.0;
  EXPECT_TRUE(Inverse2D(0.0, 0.0, 1e-10, 0.0, azimuth, distance));
  EXPECT_DOUBLE_EQ(azimuth, kPi / 2);
  // Beyond the window, at grid coordinates: due east.
  azimuth = -1.0;
  EXPECT_TRUE(boComputeAzimuthBetweenCoords(p, coords(p.north, p.east + 3e-10, 7.0), azimuth));
  EXPECT_DOUBLE_EQ(azimuth, kPi / 2);
}

}  // namespace
