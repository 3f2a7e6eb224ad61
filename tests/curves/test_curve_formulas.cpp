// Circular-curve formulas: published degree-of-curve values, the deliberate edge values, round trips from
// every quantity back to the deflection, independent geometric identities, and arcs from tangents and
// through three points (also at grid coordinates).
#include <gtest/gtest.h>

#include <cmath>

#include "curve_test_support.h"
#include "svymath/curves/curve_formulas.h"
#include "svymath/foundation/constants.h"

namespace {

using curve_test::kNaN;
using svy_math::units::kDegToRad;

// Published values (a one-degree curve on a 100 ft base: 5729.58 ft by the arc definition, 5729.65 ft by the
// chord one) and the deliberate edge values: no curve for tiny or negative degrees, tiny radii, half turns
// and beyond; NaN tangents and externals at a half turn; a chord of the diameter or a hair longer is a half
// turn, clearly longer gives -180 and with a negative radius +180.
TEST(CurveFormulas, PublishedAndEdgeValues) {
  const struct {
    double actual, expected, tolerance;
  } cases[] = {
      {GetRadiusFromDegOfCurve(1.0), 5729.5779513082325, 3.6e-12},
      {GetDegOfCurveFromRadius(5729.5779513082325), 1.0, 8.8e-16}, {GetRadiusFromDegOfChord(1.0), 5729.651, 5e-4},
      {GetRadiusFromDegOfChord(180.0), 50.0, 0.0}, {GetDegOfChordFromRadius(49.9999999999995), 180.0, 0.0},
      {GetDegOfChordFromRadius(40.0), 0.0, 0.0}, {isValidRadiusForDegOfChord(50.0 - 5e-13) ? 1.0 : 0.0, 1.0, 0.0},
      {isValidRadiusForDegOfChord(50.0 - 2e-12) ? 1.0 : 0.0, 0.0, 0.0}, {GetRadiusFromDegOfCurve(4e-7), 0.0, 0.0},
      {GetRadiusFromDegOfCurve(-2.0), 0.0, 0.0}, {GetRadiusFromDegOfCurve(kNaN), 0.0, 0.0},
      {GetDegOfCurveFromRadius(9e-6), 0.0, 0.0}, {GetDegOfCurveFromRadius(-300.0), 0.0, 0.0},
      {GetRadiusFromDegOfChord(200.0), 0.0, 0.0}, {GetRadiusFromDegOfChord(0.0), 0.0, 0.0},
      {GetTangentFromDelta(180.0, 100.0), kNaN, 0.0}, {GetTangentFromDelta(-180.000001, 100.0), kNaN, 0.0},
      {GetTangentFromDelta(90.0, 100.0), 100.0, 1e-12}, {GetExternalFromDelta(180.0, 100.0), kNaN, 0.0},
      {GetExternalFromDelta(179.999995, 100.0), kNaN, 0.0}, {GetDeltaFromLength(10.0, -100.0), 0.0, 0.0},
      {GetDeltaFromLength(10.0, 5e-6), 0.0, 0.0}, {GetDeltaFromChordLength(200.0, 100.0), 180.0, 0.0},
      {GetDeltaFromChordLength(200.0 * (1.0 + 5e-13), 100.0), 180.0, 0.0},
      {GetDeltaFromChordLength(250.0, 100.0), -180.0, 0.0}, {GetDeltaFromChordLength(250.0, -100.0), 180.0, 0.0},
      {GetDeltaFromChordLength(50.0, 0.0), 0.0, 0.0}, {GetDeltaFromChordLength(kNaN, 100.0), 0.0, 0.0},
      {GetDeltaFromExternal(10.0, 0.0), 0.0, 0.0}, {GetDeltaFromMidOrd(250.0, 100.0), 0.0, 0.0},
      {GetDeltaFromMidOrd(5.0, 0.0), 0.0, 0.0}, {GetDeltaFromTangent(0.0, 0.0), 0.0, 0.0},
      {GetSpiralLength(300.0, 5e-6), 0.0, 0.0},
  };
  for (std::size_t i = 0; i < sizeof cases / sizeof cases[0]; ++i) {
    const auto& c = cases[i];
    EXPECT_TRUE(std::isnan(c.expected) ? std::isnan(c.actual) : std::fabs(c.actual - c.expected) <= c.tolerance)
        << "row " << i << ": " << c.actual;
  }
  EXPECT_FALSE(std::isnan(GetExternalFromDelta(179.9999, 100.0)));
}

// Degree of curve both ways; the chord definition subtends a 100-unit chord, the arc definition a 100-unit
// arc. Spiral constant and length invert each other.
TEST(CurveFormulas, DegreeOfCurveAndSpiralConstantRoundTrip) {
  for (double radius : {50.0, 80.0, 1145.9155902616465, 1e5, -400.0}) {
    const double A = GetSpiralConstant(120.0, radius);
    EXPECT_NEAR(A * A, 120.0 * std::fabs(radius), 1e-9 * A * A);
    EXPECT_NEAR(GetSpiralLength(A, radius), 120.0, 1e-12 * 120.0);
    if (radius < 0.0) continue;
    EXPECT_NEAR(GetRadiusFromDegOfCurve(GetDegOfCurveFromRadius(radius)), radius, 1e-12 * radius);
    EXPECT_NEAR(GetRadiusFromDegOfChord(GetDegOfChordFromRadius(radius)), radius, 1e-9 * radius);
    EXPECT_NEAR(GetChordLenFromDelta(GetDegOfChordFromRadius(radius), radius), 100.0, 1e-9);
    EXPECT_NEAR(GetLengthFromDelta(GetDegOfCurveFromRadius(radius), radius), 100.0, 1e-9);
  }
}

// Every quantity gives delta and the length back; the PI, the centre and a tangent point form a right
// triangle; the chord is a chord of the circle.
TEST(CurveFormulas, EveryQuantityRoundTripsAndSatisfiesCircleGeometry) {
  const struct {
    double R, delta;
  } cases[] = {{100.0, 90.0}, {300.0, 12.5}, {1500.0, 0.8}, {50.0, 150.0}, {5729.58, 33.0}, {25.0, 179.0}};
  for (const auto& c : cases) {
    SCOPED_TRACE(c.delta);
    const double R = c.R, delta = c.delta, tol = 1e-9 * std::fmax(1.0, delta), L = GetLengthFromDelta(delta, R);
    const double T = GetTangentFromDelta(delta, R), E = GetExternalFromDelta(delta, R);
    const double C = GetChordLenFromDelta(delta, R), M = GetMidOrdFromDelta(delta, R);
    const double deltas[][2] = {{GetDeltaFromLength(L, R), tol}, {GetDeltaFromChordLength(C, R), 1e-7},
                                {GetDeltaFromTangent(T, R), tol}, {GetDeltaFromExternal(E, R), 1e-6},
                                {GetDeltaFromMidOrd(M, R), 1e-6}};
    for (const auto& d : deltas) EXPECT_NEAR(d[0], delta, d[1]);
    EXPECT_NEAR(GetChordLenFromLength(L, R), C, 1e-9 * R);
    EXPECT_NEAR(GetTangentFromLength(L, R), T, 1e-9 * R);
    EXPECT_NEAR(GetExternalFromLength(L, R), E, 1e-9 * R);
    EXPECT_NEAR(GetMidOrdFromLength(L, R), M, 1e-9 * R);
    const double lengths[][2] = {{GetLengthFromChordLength(C, R), 1e-6}, {GetLengthFromTangent(T, R), 1e-9},
                                 {GetLengthFromExternal(E, R), 1e-6}, {GetLengthFromMidOrd(M, R), 1e-6}};
    for (const auto& l : lengths) EXPECT_NEAR(l[0], L, l[1] * R);
    EXPECT_NEAR(T * T + R * R, (R + E) * (R + E), 1e-9 * R * R);
    EXPECT_NEAR(R - M, std::sqrt(R * R - C * C / 4.0), 1e-9 * R);
    EXPECT_NEAR(C, 2.0 * T * std::cos(delta * kDegToRad / 2.0), 1e-9 * R);
  }
}

// The arc from two tangents touches both, T from the PI and R from the centre square to the tangent.
TEST(ArcFromTangents, TouchesBothTangents) {
  const struct {
    double north, east, azIn, azOut, radius;
  } cases[] = {{0.0, 0.0, 0.0, 90.0, 100.0},
               {0.0, 0.0, 45.0, 10.0, -250.0},
               {5000000.0, 500000.0, 350.0, 20.0, 800.0},
               {5000000.0, 500000.0, 200.0, 61.0, 35.0},
               {-120.0, 33.0, 720.5, -3.0, 1200.0}};
  for (const auto& c : cases) {
    SCOPED_TRACE(c.radius);
    const C2dPos pi(c.north, c.east);
    TArcParams arc;
    ASSERT_TRUE(GetArcTangentParams(pi, c.azIn, c.azOut, c.radius, arc));
    const double R = std::fabs(c.radius), tolPos = 1e-9 * (1.0 + std::fabs(c.north));
    EXPECT_EQ(std::fabs(arc.radius), R);
    EXPECT_EQ(arc.radius > 0.0, arc.delta > 0.0);
    for (const C2dPos& p : {arc.start, arc.end}) {
      EXPECT_NEAR(curve_test::dist(pi, p), arc.tangent, tolPos);
      EXPECT_NEAR(curve_test::dist(arc.centre, p), R, tolPos);
    }
    const CMathAngle in(c.azIn), out(c.azOut);
    EXPECT_NEAR(
        (arc.centre.north() - arc.start.north()) * in.getCos() + (arc.centre.east() - arc.start.east()) * in.getSin(),
        0.0, tolPos);
    EXPECT_NEAR((arc.end.north() - pi.north()) * out.getSin() - (arc.end.east() - pi.east()) * out.getCos(), 0.0,
                tolPos);
    EXPECT_NEAR(arc.length, R * std::fabs(arc.delta) * kDegToRad, 1e-9 * R);
  }
  TArcParams arc;
  arc.radius = 7.0;
  EXPECT_FALSE(GetArcTangentParams(C2dPos(0, 0), 30.0, 30.0, 100.0, arc) ||  // parallel
               GetArcTangentParams(C2dPos(0, 0), 30.0, 210.0, 100.0, arc) ||
               GetArcTangentParams(C2dPos(0, 0), 30.0, 60.0, 0.0, arc) ||
               GetArcTangentParams(C2dPos(0, 0), kNaN, 60.0, 100.0, arc) ||
               GetArcTangentParams(C2dPos(0, curve_test::kInf), 0.0, 60.0, 100.0, arc));
  EXPECT_EQ(arc.radius, 7.0);
}

// Points on a circle of radius 10 about (3, 4) at azimuths 0, 150 and 300 degrees, clockwise: the arc from
// the first to the third through the second turns right by 300 degrees, the other way round left.
TEST(ArcThroughThreePoints, MajorArcsSidesAndDegenerateInput) {
  auto at = [](double d) { return C2dPos(3.0 + 10.0 * std::cos(d * kDegToRad), 4.0 + 10.0 * std::sin(d * kDegToRad)); };
  TArcParams arc;
  ASSERT_TRUE(GetArc3PointsParams(at(0.0), at(150.0), at(300.0), arc));
  EXPECT_NEAR(arc.radius, 10.0, 1e-12);
  EXPECT_NEAR(arc.delta, 300.0, 1e-10);
  curve_test::expectPosNear(arc.centre, 3.0, 4.0, 1e-12);
  EXPECT_NEAR(arc.length, 10.0 * 300.0 * kDegToRad, 1e-10);
  EXPECT_NEAR(arc.midOrdinate, 10.0 * (1.0 - std::cos(150.0 * kDegToRad)), 1e-10);
  EXPECT_LT(arc.tangent, 0.0);
  ASSERT_TRUE(GetArc3PointsParams(at(300.0), at(150.0), at(0.0), arc));
  EXPECT_NEAR(arc.radius, -10.0, 1e-12);
  EXPECT_NEAR(arc.delta, -300.0, 1e-10);
  ASSERT_TRUE(GetArc3PointsParams(at(0.0), at(90.0), at(180.0), arc));  // a half circle: no tangent, no external
  EXPECT_NEAR(arc.delta, 180.0, 1e-10);
  EXPECT_TRUE(std::isnan(arc.tangent) && std::isnan(arc.external));
  arc.radius = 7.0;
  EXPECT_FALSE(GetArc3PointsParams(C2dPos(0, 0), C2dPos(1, 1), C2dPos(2, 2), arc) ||
               GetArc3PointsParams(C2dPos(0, 0), C2dPos(0, 0), C2dPos(2, 3), arc) ||
               GetArc3PointsParams(C2dPos(0, 0), C2dPos(1, 5), C2dPos(0, 0), arc) ||
               GetArc3PointsParams(C2dPos(0, 0), C2dPos(kNaN, 5), C2dPos(2, 3), arc));
  EXPECT_EQ(arc.radius, 7.0);
}

}  // namespace
