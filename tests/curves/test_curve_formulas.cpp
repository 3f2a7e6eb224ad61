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

TEST(DegreeOfCurve, PublishedAndEdgeValues) {
  // A one-degree curve on a 100 ft base: 5729.58 ft by the arc definition, 5729.65 ft by the chord one.
  EXPECT_DOUBLE_EQ(GetRadiusFromDegOfCurve(1.0), 5729.5779513082325);
  EXPECT_DOUBLE_EQ(GetDegOfCurveFromRadius(5729.5779513082325), 1.0);
  EXPECT_NEAR(GetRadiusFromDegOfChord(1.0), 5729.651, 5e-4);
  EXPECT_EQ(GetRadiusFromDegOfChord(180.0), 50.0);
  EXPECT_EQ(GetDegOfChordFromRadius(49.9999999999995), 180.0);
  EXPECT_EQ(GetDegOfChordFromRadius(40.0), 0.0);
  EXPECT_TRUE(isValidRadiusForDegOfChord(50.0 - 5e-13));
  EXPECT_FALSE(isValidRadiusForDegOfChord(50.0 - 2e-12));
  // No curve: tiny or negative degrees, tiny radii, half turns and beyond for the chord definition.
  EXPECT_EQ(GetRadiusFromDegOfCurve(4e-7), 0.0);
  EXPECT_EQ(GetRadiusFromDegOfCurve(-2.0), 0.0);
  EXPECT_EQ(GetRadiusFromDegOfCurve(kNaN), 0.0);
  EXPECT_EQ(GetDegOfCurveFromRadius(9e-6), 0.0);
  EXPECT_EQ(GetDegOfCurveFromRadius(-300.0), 0.0);
  EXPECT_EQ(GetRadiusFromDegOfChord(200.0), 0.0);
  EXPECT_EQ(GetRadiusFromDegOfChord(0.0), 0.0);
}

TEST(DegreeOfCurve, BothDefinitionsRoundTrip) {
  for (double radius : {50.0, 80.0, 250.0, 1145.9155902616465, 5729.58, 1e5}) {
    EXPECT_NEAR(GetRadiusFromDegOfCurve(GetDegOfCurveFromRadius(radius)), radius, 1e-12 * radius);
    EXPECT_NEAR(GetRadiusFromDegOfChord(GetDegOfChordFromRadius(radius)), radius, 1e-9 * radius);
    // The chord definition subtends a 100-unit chord, the arc definition a 100-unit arc.
    EXPECT_NEAR(GetChordLenFromDelta(GetDegOfChordFromRadius(radius), radius), 100.0, 1e-9);
    EXPECT_NEAR(GetLengthFromDelta(GetDegOfCurveFromRadius(radius), radius), 100.0, 1e-9);
  }
}

TEST(CurveQuantities, DeliberateEdgeValues) {
  EXPECT_TRUE(std::isnan(GetTangentFromDelta(180.0, 100.0)));
  EXPECT_TRUE(std::isnan(GetTangentFromDelta(-180.000001, 100.0)));
  EXPECT_NEAR(GetTangentFromDelta(90.0, 100.0), 100.0, 1e-12);
  EXPECT_TRUE(std::isnan(GetExternalFromDelta(180.0, 100.0)));
  EXPECT_TRUE(std::isnan(GetExternalFromDelta(179.999995, 100.0)));
  EXPECT_FALSE(std::isnan(GetExternalFromDelta(179.9999, 100.0)));
  EXPECT_EQ(GetDeltaFromLength(10.0, -100.0), 0.0);
  EXPECT_EQ(GetDeltaFromLength(10.0, 5e-6), 0.0);
  // A chord of the diameter or a hair longer is a half turn; clearly longer gives -180; a negative radius
  // with a chord beyond its diameter gives +180.
  EXPECT_EQ(GetDeltaFromChordLength(200.0, 100.0), 180.0);
  EXPECT_EQ(GetDeltaFromChordLength(200.0 * (1.0 + 5e-13), 100.0), 180.0);
  EXPECT_EQ(GetDeltaFromChordLength(250.0, 100.0), -180.0);
  EXPECT_EQ(GetDeltaFromChordLength(250.0, -100.0), 180.0);
  EXPECT_EQ(GetDeltaFromChordLength(50.0, 0.0), 0.0);
  EXPECT_EQ(GetDeltaFromChordLength(kNaN, 100.0), 0.0);
  EXPECT_EQ(GetDeltaFromExternal(10.0, 0.0), 0.0);
  EXPECT_EQ(GetDeltaFromMidOrd(250.0, 100.0), 0.0);
  EXPECT_EQ(GetDeltaFromMidOrd(5.0, 0.0), 0.0);
  EXPECT_EQ(GetDeltaFromTangent(0.0, 0.0), 0.0);
  EXPECT_EQ(GetSpiralLength(300.0, 5e-6), 0.0);
}

struct CurveCase {
  double radius;
  double delta;  // degrees
};

class CurveRoundTrip : public ::testing::TestWithParam<CurveCase> {};

TEST_P(CurveRoundTrip, EveryQuantityGivesDeltaBack) {
  const double R = GetParam().radius;
  const double delta = GetParam().delta;
  const double tol = 1e-9 * std::fmax(1.0, delta);
  const double L = GetLengthFromDelta(delta, R);
  EXPECT_NEAR(GetDeltaFromLength(L, R), delta, tol);
  EXPECT_NEAR(GetDeltaFromChordLength(GetChordLenFromDelta(delta, R), R), delta, 1e-7);
  EXPECT_NEAR(GetDeltaFromTangent(GetTangentFromDelta(delta, R), R), delta, tol);
  EXPECT_NEAR(GetDeltaFromExternal(GetExternalFromDelta(delta, R), R), delta, 1e-6);
  EXPECT_NEAR(GetDeltaFromMidOrd(GetMidOrdFromDelta(delta, R), R), delta, 1e-6);
  // The length forms agree with the delta forms.
  EXPECT_NEAR(GetChordLenFromLength(L, R), GetChordLenFromDelta(delta, R), 1e-9 * R);
  EXPECT_NEAR(GetTangentFromLength(L, R), GetTangentFromDelta(delta, R), 1e-9 * R);
  EXPECT_NEAR(GetExternalFromLength(L, R), GetExternalFromDelta(delta, R), 1e-9 * R);
  EXPECT_NEAR(GetMidOrdFromLength(L, R), GetMidOrdFromDelta(delta, R), 1e-9 * R);
  EXPECT_NEAR(GetLengthFromChordLength(GetChordLenFromDelta(delta, R), R), L, 1e-6 * R);
  EXPECT_NEAR(GetLengthFromTangent(GetTangentFromDelta(delta, R), R), L, 1e-9 * R);
  EXPECT_NEAR(GetLengthFromExternal(GetExternalFromDelta(delta, R), R), L, 1e-6 * R);
  EXPECT_NEAR(GetLengthFromMidOrd(GetMidOrdFromDelta(delta, R), R), L, 1e-6 * R);
}

TEST_P(CurveRoundTrip, QuantitiesSatisfyCircleGeometry) {
  const double R = GetParam().radius;
  const double delta = GetParam().delta;
  const double T = GetTangentFromDelta(delta, R);
  const double E = GetExternalFromDelta(delta, R);
  const double C = GetChordLenFromDelta(delta, R);
  const double M = GetMidOrdFromDelta(delta, R);
  // The PI, the centre and a tangent point form a right triangle; the chord is a chord of the circle.
  EXPECT_NEAR(T * T + R * R, (R + E) * (R + E), 1e-9 * R * R);
  EXPECT_NEAR(R - M, std::sqrt(R * R - C * C / 4.0), 1e-9 * R);
  EXPECT_NEAR(C, 2.0 * T * std::cos(delta * svy_math::units::kDegToRad / 2.0), 1e-9 * R);
}

INSTANTIATE_TEST_SUITE_P(Cases, CurveRoundTrip,
                         ::testing::Values(CurveCase{100.0, 90.0}, CurveCase{300.0, 12.5}, CurveCase{1500.0, 0.8},
                                           CurveCase{50.0, 150.0}, CurveCase{5729.58, 33.0}, CurveCase{25.0, 179.0}));

TEST(SpiralFormulas, LengthAndConstantRoundTrip) {
  for (double L : {20.0, 80.0, 150.0}) {
    for (double R : {150.0, -400.0, 2000.0}) {
      const double A = GetSpiralConstant(L, R);
      EXPECT_NEAR(A * A, L * std::fabs(R), 1e-9 * A * A);
      EXPECT_NEAR(GetSpiralLength(A, R), L, 1e-12 * L);
    }
  }
}

struct TangentCase {
  double north, east, azIn, azOut, radius;
};

class ArcFromTangents : public ::testing::TestWithParam<TangentCase> {};

TEST_P(ArcFromTangents, TouchesBothTangentsAndPassesThroughThreePoints) {
  const TangentCase c = GetParam();
  const C2dPos pi(c.north, c.east);
  TArcParams arc;
  ASSERT_TRUE(GetArcTangentParams(pi, c.azIn, c.azOut, c.radius, arc));
  const double R = std::fabs(c.radius);
  EXPECT_EQ(std::fabs(arc.radius), R);
  EXPECT_EQ(arc.radius > 0.0, arc.delta > 0.0);
  // Both tangent points lie T from the PI on their tangents, and R from the centre square to the tangent.
  const double tolPos = 1e-9 * (1.0 + std::fabs(c.north));
  EXPECT_NEAR(curve_test::distance(pi, arc.start), arc.tangent, tolPos);
  EXPECT_NEAR(curve_test::distance(pi, arc.end), arc.tangent, tolPos);
  EXPECT_NEAR(curve_test::distance(arc.centre, arc.start), R, tolPos);
  EXPECT_NEAR(curve_test::distance(arc.centre, arc.end), R, tolPos);
  const CMathAngle in(c.azIn), out(c.azOut);
  EXPECT_NEAR(
      (arc.centre.north() - arc.start.north()) * in.getCos() + (arc.centre.east() - arc.start.east()) * in.getSin(),
      0.0, tolPos);
  EXPECT_NEAR((arc.end.north() - pi.north()) * out.getSin() - (arc.end.east() - pi.east()) * out.getCos(), 0.0, tolPos);
  EXPECT_NEAR(arc.length, R * std::fabs(arc.delta) * svy_math::units::kDegToRad, 1e-9 * R);
  // The arc through its start, its midpoint and its end is the same arc.
  const double half = 0.5 * arc.delta * svy_math::units::kDegToRad;
  const double startFromCentre =
      std::atan2(arc.start.east() - arc.centre.east(), arc.start.north() - arc.centre.north());
  const C2dPos mid(arc.centre.north() + R * std::cos(startFromCentre + half),
                   arc.centre.east() + R * std::sin(startFromCentre + half));
  TArcParams again;
  ASSERT_TRUE(GetArc3PointsParams(arc.start, mid, arc.end, again));
  EXPECT_NEAR(again.radius, arc.radius, 1e-6);
  EXPECT_NEAR(again.delta, arc.delta, 1e-7);
  curve_test::expectPosNear(again.centre, arc.centre.north(), arc.centre.east(), 1e-6);
  EXPECT_NEAR(again.tangent, arc.tangent, 1e-6);
  EXPECT_NEAR(again.external, arc.external, 1e-6);
  EXPECT_NEAR(again.midOrdinate, arc.midOrdinate, 1e-6);
}

INSTANTIATE_TEST_SUITE_P(Cases, ArcFromTangents,
                         ::testing::Values(TangentCase{0.0, 0.0, 0.0, 90.0, 100.0},
                                           TangentCase{0.0, 0.0, 45.0, 10.0, -250.0},
                                           TangentCase{5000000.0, 500000.0, 350.0, 20.0, 800.0},
                                           TangentCase{5000000.0, 500000.0, 200.0, 61.0, 35.0},
                                           TangentCase{-120.0, 33.0, 720.5, -3.0, 1200.0}));

TEST(ArcFromTangents, RejectsParallelTangentsAndBadInput) {
  TArcParams arc;
  arc.radius = 7.0;
  EXPECT_FALSE(GetArcTangentParams(C2dPos(0, 0), 30.0, 30.0, 100.0, arc));
  EXPECT_FALSE(GetArcTangentParams(C2dPos(0, 0), 30.0, 210.0, 100.0, arc));
  EXPECT_FALSE(GetArcTangentParams(C2dPos(0, 0), 30.0, 60.0, 0.0, arc));
  EXPECT_FALSE(GetArcTangentParams(C2dPos(0, 0), kNaN, 60.0, 100.0, arc));
  EXPECT_FALSE(GetArcTangentParams(C2dPos(0, curve_test::kInf), 0.0, 60.0, 100.0, arc));
  EXPECT_EQ(arc.radius, 7.0);
}

TEST(ArcThroughThreePoints, MajorArcsSidesAndDegenerateInput) {
  // Points on a circle of radius 10 about (3, 4) at azimuths 0, 150 and 300 degrees, clockwise: the arc
  // from the first to the third through the second turns right by 300 degrees.
  auto at = [](double deg) {
    const double a = deg * svy_math::units::kDegToRad;
    return C2dPos(3.0 + 10.0 * std::cos(a), 4.0 + 10.0 * std::sin(a));
  };
  TArcParams arc;
  ASSERT_TRUE(GetArc3PointsParams(at(0.0), at(150.0), at(300.0), arc));
  EXPECT_NEAR(arc.radius, 10.0, 1e-12);
  EXPECT_NEAR(arc.delta, 300.0, 1e-10);
  curve_test::expectPosNear(arc.centre, 3.0, 4.0, 1e-12);
  EXPECT_NEAR(arc.length, 10.0 * 300.0 * svy_math::units::kDegToRad, 1e-10);
  EXPECT_NEAR(arc.midOrdinate, 10.0 * (1.0 - std::cos(150.0 * svy_math::units::kDegToRad)), 1e-10);
  EXPECT_LT(arc.tangent, 0.0);
  // The same points the other way round turn left.
  ASSERT_TRUE(GetArc3PointsParams(at(300.0), at(150.0), at(0.0), arc));
  EXPECT_NEAR(arc.radius, -10.0, 1e-12);
  EXPECT_NEAR(arc.delta, -300.0, 1e-10);
  // A half circle: tangent and external are infinite.
  ASSERT_TRUE(GetArc3PointsParams(at(0.0), at(90.0), at(180.0), arc));
  EXPECT_NEAR(arc.delta, 180.0, 1e-10);
  EXPECT_TRUE(std::isnan(arc.tangent));
  EXPECT_TRUE(std::isnan(arc.external));
  arc.radius = 7.0;
  EXPECT_FALSE(GetArc3PointsParams(C2dPos(0, 0), C2dPos(1, 1), C2dPos(2, 2), arc));
  EXPECT_FALSE(GetArc3PointsParams(C2dPos(0, 0), C2dPos(0, 0), C2dPos(2, 3), arc));
  EXPECT_FALSE(GetArc3PointsParams(C2dPos(0, 0), C2dPos(1, 5), C2dPos(0, 0), arc));
  EXPECT_FALSE(GetArc3PointsParams(C2dPos(0, 0), C2dPos(kNaN, 5), C2dPos(2, 3), arc));
  EXPECT_EQ(arc.radius, 7.0);
}

}  // namespace
