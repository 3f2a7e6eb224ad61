// Arc data and the arc element: definitions, the deliberate quirks (signed shortest distance, the centre
// query, the undefined-radius fallback), chord steps, round trips, projections and boxes against sampling,
// the three-point construction and the optional published arc tables.
#include <gtest/gtest.h>

#include <cmath>
#include <string>

#include "curve_test_support.h"
#include "support/refdata.h"
#include "svymath/curves/curve_arc.h"
#include "svyutils/svy_err_log.h"

namespace {

using curve_test::makeArc;
using svy_math::units::kPi;

TEST(ArcData, NegativeCentreAngleTurnsLeft) {
  CCurveDataArc data;
  CMathAngle angle;
  angle.setRad(-0.5);
  data.setCAngleR(angle, 100.0);
  EXPECT_EQ(data.getRadius(), -100.0);
  EXPECT_NEAR(data.getTotalLength(), 50.0, 1e-12);
  EXPECT_TRUE(data.isToTheLeft());
  EXPECT_FALSE(data.isToTheRight());
  data.setCAngleR(angle, 100.0, true);  // the side given overrides the angle's sign
  EXPECT_EQ(data.getRadius(), 100.0);
  EXPECT_NEAR(data.getCenterAngle().getRad(), 0.5, 1e-15);
}

TEST(ArcData, RadiusFallbackIsTinyLoggedAndCached) {
  CCurveDataArc data;
  svy_logging::CScopedErrLogCapture capture;
  EXPECT_EQ(data.getRadius(), 1e-6);
  ASSERT_EQ(capture.count(), 1u);
  EXPECT_EQ(capture.entries()[0].file, "mathCurves");
  EXPECT_EQ(data.getRadius(), 1e-6);  // cached: no second entry
  EXPECT_EQ(capture.count(), 1u);
}

TEST(ArcData, CircleAndDisplayFlags) {
  CCurveDataArc data;
  ASSERT_TRUE(data.setCircle(10.0, false));
  EXPECT_TRUE(data.isCircle());
  EXPECT_NEAR(data.getTotalLength(), 2.0 * kPi * 10.0, 1e-12);
  // The forms of entry go to bits 4-9 of the flags; the other bits belong to the host and survive.
  data.setFlags(0xFFFF0001u);
  ASSERT_TRUE(data.SetElement(30.0, eLengthDisplayChord, 200.0, eRadiusDisplayDegreeOfCurveChord, true));
  EXPECT_FALSE(data.isCircle());
  double length = 0.0, radius = 0.0;
  bool right = false;
  AlntElementLengthDisplay lengthDisplay = eLengthDisplayArc;
  AlntElementRadiusDisplay radiusDisplay = eRadiusDisplayRadius;
  ASSERT_TRUE(data.GetElement(length, lengthDisplay, radius, radiusDisplay, right));
  EXPECT_EQ(lengthDisplay, eLengthDisplayChord);
  EXPECT_EQ(radiusDisplay, eRadiusDisplayDegreeOfCurveChord);
  EXPECT_EQ(data.getFlags() & ~0x3F0u, 0xFFFF0001u & ~0x3F0u);
}

struct StepCase {
  double radius;
  double length;
  double start;
  double deviation;
  double expected;
};

class ArcStepTest : public ::testing::TestWithParam<StepCase> {};

TEST_P(ArcStepTest, ChordRuleCappedAtSixteenthOfHalfTurnAndAtTheEnd) {
  const StepCase& c = GetParam();
  CCurveDataArc data;
  ASSERT_TRUE(data.SetElement(c.length, c.radius, true));
  const double step = data.getStepForDeviation(c.start, c.deviation);
  EXPECT_NEAR(step, c.expected, 1e-9);
  if (c.deviation > 0.0) {
    EXPECT_LE(step, std::fabs(c.radius) * kPi / 16.0 + 1e-12);
  }
  EXPECT_LE(c.start + step, c.length + svy_math::tol::kSnap);  // a start within the snap counts as the end
  if (c.deviation > 0.0 && step > 0.0 && step < c.length - c.start) {
    // The chord of the step stays within the deviation: sagitta R (1 - cos(step / 2R)).
    EXPECT_LE(c.radius * (1.0 - std::cos(step / (2.0 * c.radius))), c.deviation + 1e-12);
  }
}

INSTANTIATE_TEST_SUITE_P(Table, ArcStepTest,
                         ::testing::Values(StepCase{1000.0, 500.0, 0.0, 0.01, 2000.0 * std::acos(0.99999)},
                                           StepCase{1.0, 3.0, 0.0, 5.0, kPi / 16.0},  // deviation cut to the radius
                                           StepCase{1000.0, 500.0, 0.0, 100.0, 1000.0 * kPi / 16.0},
                                           StepCase{1000.0, 500.0, 495.0, 0.01, 5.0},  // not past the end
                                           StepCase{50.0, 20.0, 3.0, 0.0, 17.0},       // no deviation: the rest
                                           StepCase{1000.0, 500.0, 500.0005, 0.01, 0.0}));

// Walking the element by deviation steps reaches its end, each chord within the deviation of the arc.
TEST(ArcElement, DeviationStepsWalkToTheEndWithinTheDeviation) {
  const CCurveArc arc = makeArc(300.0, 400.0, 200.0, 180.0, 250.0, false);
  double s = 0.0;
  C2dPos previous = arc.getStartPos();
  for (int steps = 0; s < arc.getTotalLength() && steps < 1000; ++steps) {
    C2dPos next;
    const double reached = arc.getNextPosForDeviation(s, 0.02, next);
    ASSERT_GT(reached, s);
    // Sagitta of the chord: distance from its midpoint to the arc point halfway along.
    const C2dPos mid(0.5 * (previous.north() + next.north()), 0.5 * (previous.east() + next.east()));
    EXPECT_LE(curve_test::distance(mid, curve_test::posAt(arc, 0.5 * (s + reached))), 0.02 + 1e-9);
    s = reached;
    previous = next;
  }
  EXPECT_NEAR(s, 180.0, 1e-12);
  EXPECT_EQ(previous, arc.getEndPos());
}

// Closed-form oracle of the placed arc: centre on the right for a right turn, points at R from it.
TEST(ArcElement, PositionsLieOnTheCircleAboutTheStatedCentre) {
  for (const bool right : {true, false}) {
    const CCurveArc arc = makeArc(5000000.0, 500000.0, 63.0, 250.0, 120.0, right);
    C2dPos centre;
    ASSERT_TRUE(arc.getArcCenterPos(centre));
    const double a = 63.0 * svy_math::units::kDegToRad;
    const double side = right ? 1.0 : -1.0;
    curve_test::expectPosNear(centre, 5000000.0 - std::sin(a) * 120.0 * side, 500000.0 + std::cos(a) * 120.0 * side,
                              1e-8);
    for (double s = 0.0; s <= 250.0; s += 12.5) {
      const C2dPos pos = curve_test::posAt(arc, s);
      EXPECT_NEAR(curve_test::distance(pos, centre), 120.0, 1e-8);
      // The chord from the start subtends s / R at the centre: chord = 2 R sin(s / 2R).
      EXPECT_NEAR(curve_test::distance(pos, arc.getStartPos()), 240.0 * std::sin(s / 240.0), 1e-8);
      EXPECT_NEAR(arc.getAzimuthAtLength(s), CMathAngle(63.0 + side * s / 120.0 * 57.29577951308232).getDeg(), 1e-9);
    }
    EXPECT_NEAR(arc.getCurvatureAtLength(10.0), side / 120.0, 1e-15);
  }
}

struct ArcRoundTrip {
  double radius;
  bool right;
  double length;  // of the arc
  double at;
  double offset;
};

class ArcRoundTripTest : public ::testing::TestWithParam<ArcRoundTrip> {};

TEST_P(ArcRoundTripTest, PositionThenLengthAndOffsetGivesThemBack) {
  const ArcRoundTrip& c = GetParam();
  const CCurveArc arc = makeArc(1000.0, -2000.0, 311.0, c.length, c.radius, c.right);
  C2dPos pos;
  ASSERT_TRUE(arc.getPosAtLengthAndOffset(c.at, c.offset, pos));
  double length = -1.0, offset = -1.0, dist = 0.0, len = 0.0;
  ASSERT_TRUE(arc.getLengthAndOffset(pos, length, offset));
  EXPECT_NEAR(length, c.at, 1e-8);
  EXPECT_NEAR(offset, c.offset, 1e-8);
  // The projection finds the same foot and the distance with the side's sign.
  ASSERT_TRUE(arc.getShortestDistAndCurveLen(pos.north(), pos.east(), dist, len));
  EXPECT_NEAR(len, c.at, 1e-8);
  EXPECT_NEAR(dist, c.offset, 1e-8);
}

INSTANTIATE_TEST_SUITE_P(
    Table, ArcRoundTripTest,
    ::testing::Values(ArcRoundTrip{100.0, true, 50.0, 0.0, 3.0}, ArcRoundTrip{100.0, true, 50.0, 50.0, -3.0},
                      ArcRoundTrip{100.0, false, 50.0, 20.0, 3.0}, ArcRoundTrip{100.0, false, 50.0, 20.0, -60.0},
                      ArcRoundTrip{30.0, true, 150.0, 140.0, 10.0},  // more than a half turn
                      ArcRoundTrip{30.0, false, 180.0, 100.0, -5.0}, ArcRoundTrip{5000.0, true, 400.0, 399.0, 0.25}));

TEST(ArcElement, CentreQueryAndSignedDistanceToTheCircle) {
  for (const bool right : {true, false}) {
    const CCurveArc arc = makeArc(0.0, 0.0, 0.0, 30.0, 25.0, right);
    C2dPos centre;
    ASSERT_TRUE(arc.getArcCenterPos(centre));
    double length = -1.0, offset = 0.0;
    ASSERT_TRUE(arc.getLengthAndOffset(C2dPos(centre.north() + 0.0009, centre.east() - 0.0009), length, offset));
    EXPECT_EQ(length, 0.0);
    EXPECT_EQ(offset, right ? 25.0 : -25.0);
  }
  // The shortest distance is to the whole circle, signed: negative inside.
  const CCurveArc arc = makeArc(0.0, 0.0, 0.0, 10.0, 100.0, true);  // centre (0, 100)
  double distance = 0.0, length = 0.0, offset = 0.0;
  ASSERT_TRUE(arc.getShortestDistanceToPoint(C2dPos(0.0, 60.0), distance));
  EXPECT_NEAR(distance, -60.0, 1e-12);  // inside the circle
  ASSERT_TRUE(arc.getShortestDistanceToPoint(C2dPos(0.0, 230.0), distance));
  EXPECT_NEAR(distance, 30.0, 1e-12);  // beyond the circle, far outside the sweep
  EXPECT_FALSE(arc.getLengthAndOffset(C2dPos(0.0, 230.0), length, offset));
}

TEST(ArcElement, ProjectionMatchesDenseSamplingInsideAndOutsideTheSweep) {
  const CCurveArc arc = makeArc(10.0, 10.0, 120.0, 200.0, 70.0, false);
  for (double n = -250.0; n <= 250.0; n += 83.0) {
    for (double e = -250.0; e <= 250.0; e += 71.0) {
      double dist = 0.0, len = 0.0;
      ASSERT_TRUE(arc.getShortestDistAndCurveLen(n, e, dist, len));
      const double sampled = curve_test::sampledDistance(arc, C2dPos(n, e), 20000);
      EXPECT_LE(std::fabs(dist), sampled + 1e-9);
      EXPECT_NEAR(std::fabs(dist), sampled, 1e-3) << n << " " << e;  // sampling step 0.01 m
      EXPECT_NEAR(curve_test::distance(curve_test::posAt(arc, len), C2dPos(n, e)), std::fabs(dist), 1e-9);
    }
  }
}

TEST(ArcElement, BoundaryHoldsDenseSamplesAndTouchesThem) {
  for (const double az : {0.0, 45.0, 100.0, 200.0, 300.0}) {
    for (const double length : {5.0, 100.0, 250.0, 2.0 * kPi * 40.0}) {
      for (const bool right : {true, false}) {
        const CCurveArc arc = makeArc(-20.0, 35.0, az, length, 40.0, right);
        const C2dMinMax box = arc.getBoundary();
        C2dMinMax sampled;
        for (int i = 0; i <= 4000; ++i) sampled.include(curve_test::posAt(arc, length * i / 4000));
        EXPECT_LE(box.minNorth, sampled.minNorth + 1e-9);
        EXPECT_LE(box.minEast, sampled.minEast + 1e-9);
        EXPECT_GE(box.maxNorth, sampled.maxNorth - 1e-9);
        EXPECT_GE(box.maxEast, sampled.maxEast - 1e-9);
        // Tight: the sampling misses an extreme by at most the sagitta of a sample step.
        EXPECT_NEAR(box.minNorth, sampled.minNorth, 1e-3);
        EXPECT_NEAR(box.maxEast, sampled.maxEast, 1e-3);
      }
    }
  }
}

TEST(ArcElement, ThreePointArcReproducesTheArc) {
  for (const double length : {30.0, 150.0, 230.0}) {  // the last more than a half turn of R 60
    for (const bool right : {true, false}) {
      const CCurveArc original = makeArc(700.0, -300.0, 222.0, length, 60.0, right);
      const CCurveArc rebuilt(curve_test::posAt(original, 0.0), curve_test::posAt(original, 0.3 * length),
                              curve_test::posAt(original, length));
      ASSERT_TRUE(rebuilt.isok());
      EXPECT_NEAR(rebuilt.getRadius(), right ? 60.0 : -60.0, 1e-9);
      EXPECT_NEAR(rebuilt.getTotalLength(), length, 1e-9);
      EXPECT_NEAR(rebuilt.getAzimuthAtLength(0.0), original.getAzimuthAtLength(0.0), 1e-9);
      const C2dPos expected = curve_test::posAt(original, 0.7 * length);
      curve_test::expectPosNear(curve_test::posAt(rebuilt, 0.7 * length), expected.north(), expected.east(), 1e-8);
    }
  }
  EXPECT_FALSE(CCurveArc(C2dPos(0.0, 0.0), C2dPos(1.0, 1.0), C2dPos(2.0, 2.0)).isok());  // collinear
  EXPECT_FALSE(CCurveArc(C2dPos(0.0, 0.0), C2dPos(0.0, 0.0), C2dPos(2.0, 2.0)).isok());  // coincident
}

// The tangents' intersection of an arc lies R tan(delta / 2) from both ends.
TEST(ArcElement, CurveIpAtTangentLength) {
  const CCurveArc arc = makeArc(50.0, 60.0, 17.0, 90.0, 150.0, false);
  C2dPos ip;
  ASSERT_TRUE(arc.getCurveIp(ip));
  const double tangent = 150.0 * std::tan(0.5 * 90.0 / 150.0);
  EXPECT_NEAR(curve_test::distance(ip, arc.getStartPos()), tangent, 1e-9);
  EXPECT_NEAR(curve_test::distance(ip, arc.getEndPos()), tangent, 1e-9);
  EXPECT_FALSE(makeArc(0.0, 0.0, 0.0, kPi * 10.0, 10.0, true).getCurveIp(ip));  // half turn: parallel tangents
}

TEST(ArcAngleRange, SweepsThroughNorthAndPlain) {
  const auto deg = [](double d) { return CMathAngle(d); };
  EXPECT_TRUE(isAngleRadInRange(deg(350.0), deg(10.0), deg(0.0), 0.0));
  EXPECT_TRUE(isAngleRadInRange(deg(350.0), deg(10.0), deg(355.0), 0.0));
  EXPECT_FALSE(isAngleRadInRange(deg(350.0), deg(10.0), deg(180.0), 0.0));
  EXPECT_TRUE(isAngleRadInRange(deg(10.0), deg(20.0), deg(20.0), 0.0));
  EXPECT_FALSE(isAngleRadInRange(deg(10.0), deg(20.0), deg(20.001), 0.0));
  EXPECT_TRUE(isAngleRadInRange(deg(10.0), deg(20.0), deg(20.001), -0.001 * svy_math::units::kDegToRad * 2.0));
  CMathAngle unset;
  unset.reset();
  EXPECT_TRUE(isAngleRadInRange(deg(-10.0), deg(10.0), unset, 0.0));  // undefined counts as 0
}

// Published arc tables (start at the origin heading +X, radius positive to the LEFT, X east, Y north):
// N = Y, E = X, start azimuth 90 degrees, radius negated.
TEST(ArcElement, MatchesPublishedArcTables) {
  SVY_SKIP_WITHOUT_REFDATA();
  const std::string folder = "alignment/ifc-alignment-geometry-implementation-guide/HorizontalAlignment/CircularArc/";
  for (const double ifcRadius : {300.0, -300.0, 1000.0, -1000.0}) {
    const std::string name = "Horizontal_CircularArc_100.0_" + std::to_string(static_cast<int>(ifcRadius)) + "_" +
                             std::to_string(static_cast<int>(ifcRadius)) + "_Meter.csv";
    const auto rows = curve_test::readNumericTable(svy_test::refdataPath(folder + name));
    ASSERT_GT(rows.size(), 10u) << name;
    const CCurveArc arc = makeArc(0.0, 0.0, 90.0, 100.0, std::fabs(ifcRadius), ifcRadius < 0.0);
    for (const auto& row : rows) {
      SCOPED_TRACE(name + " s=" + std::to_string(row[0]));
      curve_test::expectPosNear(curve_test::posAt(arc, row[0]), row[2], row[1], 2e-6);
    }
  }
}

}  // namespace
