// Arc data and the arc element: definitions, the deliberate quirks (signed shortest distance, the centre
// query, the undefined-radius fallback), chord steps, round trips, projections and boxes against sampling,
// the three-point construction and the optional published arc tables.
#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <utility>

#include "curve_test_support.h"
#include "support/refdata.h"
#include "svymath/curves/curve_arc.h"
#include "svyutils/svy_err_log.h"

namespace {

using curve_test::dist;
using curve_test::makeArc;
using curve_test::posAt;
using svy_math::units::kPi;

TEST(ArcData, DefinitionsFallbackAndFlags) {
  CCurveDataArc data;
  {
    svy_logging::CScopedErrLogCapture capture;  // an undefined radius is tiny, logged once and cached
    EXPECT_EQ(data.getRadius(), 1e-6);
    EXPECT_EQ(data.getRadius(), 1e-6);
    EXPECT_TRUE(capture.count() == 1u && capture.entries()[0].file == "mathCurves");
  }
  CMathAngle angle;
  angle.setRad(-0.5);
  data.setCAngleR(angle, 100.0);  // a negative centre angle turns left
  EXPECT_TRUE(data.getRadius() == -100.0 && data.isToTheLeft());
  EXPECT_NEAR(data.getTotalLength(), 50.0, 1e-12);
  data.setCAngleR(angle, 100.0, true);  // the side given overrides the angle's sign
  EXPECT_EQ(data.getRadius(), 100.0);
  EXPECT_NEAR(data.getCenterAngle().getRad(), 0.5, 1e-15);
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
  EXPECT_TRUE(lengthDisplay == eLengthDisplayChord && radiusDisplay == eRadiusDisplayDegreeOfCurveChord);
  EXPECT_EQ(data.getFlags() & ~0x3F0u, 0xFFFF0001u & ~0x3F0u);
}

// The chord rule, capped at a sixteenth of a half turn and at the end (a start within the snap is the end).
TEST(ArcData, StepForDeviation) {
  const struct {
    double radius, length, start, deviation, expected;
  } cases[] = {{1000.0, 500.0, 0.0, 0.01, 2000.0 * std::acos(0.99999)},
               {1.0, 3.0, 0.0, 5.0, kPi / 16.0},  // deviation cut to the radius
               {1000.0, 500.0, 0.0, 100.0, 1000.0 * kPi / 16.0},
               {1000.0, 500.0, 495.0, 0.01, 5.0},  // not past the end
               {50.0, 20.0, 3.0, 0.0, 17.0},       // no deviation: the rest
               {1000.0, 500.0, 500.0005, 0.01, 0.0}};
  for (const auto& c : cases) {
    SCOPED_TRACE(c.start);
    CCurveDataArc data;
    ASSERT_TRUE(data.SetElement(c.length, c.radius, true));
    EXPECT_NEAR(data.getStepForDeviation(c.start, c.deviation), c.expected, 1e-9);
  }
  curve_test::expectStepsWithinDeviation(makeArc(300.0, 400.0, 200.0, 180.0, 250.0, false), 0.02);
}

// Closed-form oracle of the placed arc: centre on the right for a right turn, points at R from it, chords
// 2 R sin(s / 2R) from the start; the tangents' intersection R tan(delta / 2) from both ends.
TEST(ArcElement, ClosedFormCircleAndCurveIp) {
  for (const bool right : {true, false}) {
    const CCurveArc arc = makeArc(5000000.0, 500000.0, 63.0, 250.0, 120.0, right);
    C2dPos centre, ip;
    ASSERT_TRUE(arc.getArcCenterPos(centre));
    const double a = 63.0 * svy_math::units::kDegToRad, side = right ? 1.0 : -1.0;
    curve_test::expectPosNear(centre, 5e6 - std::sin(a) * 120.0 * side, 5e5 + std::cos(a) * 120.0 * side, 1e-8);
    for (double s = 0.0; s <= 250.0; s += 12.5) {
      const C2dPos pos = posAt(arc, s);
      EXPECT_NEAR(dist(pos, centre), 120.0, 1e-8);
      EXPECT_NEAR(dist(pos, arc.getStartPos()), 240.0 * std::sin(s / 240.0), 1e-8);
      EXPECT_NEAR(arc.getAzimuthAtLength(s), CMathAngle(63.0 + side * s / 120.0 * 57.29577951308232).getDeg(), 1e-9);
    }
    EXPECT_NEAR(arc.getCurvatureAtLength(10.0), side / 120.0, 1e-15);
    const CCurveArc shorter = makeArc(50.0, 60.0, 17.0, 90.0, 150.0, right);
    ASSERT_TRUE(shorter.getCurveIp(ip));
    for (const C2dPos& end : {shorter.getStartPos(), shorter.getEndPos()}) {
      EXPECT_NEAR(dist(ip, end), 150.0 * std::tan(0.3), 1e-9);
    }
  }
  C2dPos ip;
  EXPECT_FALSE(makeArc(0.0, 0.0, 0.0, kPi * 10.0, 10.0, true).getCurveIp(ip));  // half turn: parallel tangents
}

// Length and offset give their position back; the projection finds the same foot with the side's sign, and
// the nearest point of a dense sampling for points all around; the box holds the samples tightly.
TEST(ArcElement, RoundTripProjectionAndBoxAgainstSampling) {
  const struct {
    double az, length, radius;
    bool right;
    double at, offset;
  } cases[] = {{311.0, 50.0, 100.0, true, 0.0, 3.0},       {311.0, 50.0, 100.0, false, 20.0, -60.0},
               {311.0, 150.0, 30.0, true, 140.0, 10.0},     {311.0, 400.0, 5000.0, true, 399.0, 0.25},
               {200.0, 2.0 * kPi * 40.0, 40.0, false, 30.0, 2.0}};  // more than a half turn; a full circle
  for (const auto& c : cases) {
    SCOPED_TRACE(std::to_string(c.length) + " " + std::to_string(c.radius) + (c.right ? " right" : " left"));
    const CCurveArc arc = makeArc(1000.0, -2000.0, c.az, c.length, c.radius, c.right);
    C2dPos pos;
    ASSERT_TRUE(arc.getPosAtLengthAndOffset(c.at, c.offset, pos));
    double length = -1.0, offset = -1.0, dist = 0.0, len = 0.0;
    ASSERT_TRUE(arc.getLengthAndOffset(pos, length, offset));
    ASSERT_TRUE(arc.getShortestDistAndCurveLen(pos.north(), pos.east(), dist, len));
    for (const C2dPos& got : {C2dPos(length, offset), C2dPos(len, dist)}) {
      curve_test::expectPosNear(got, c.at, c.offset, 1e-8);
    }
    for (double n = 750.0; n <= 1250.0; n += 83.0) {
      for (double e = -2250.0; e <= -1750.0; e += 71.0) {
        ASSERT_TRUE(arc.getShortestDistAndCurveLen(n, e, dist, len));
        const double sampled = curve_test::sampledDistance(arc, C2dPos(n, e), static_cast<int>(c.length * 100.0));
        EXPECT_TRUE(std::fabs(dist) <= sampled + 1e-9 && std::fabs(dist) >= sampled - 1e-3) << n << " " << e;
        EXPECT_NEAR(curve_test::dist(posAt(arc, len), C2dPos(n, e)), std::fabs(dist), 1e-9);
      }
    }
    curve_test::expectBoxHoldsSamples(arc, 4000, 1e-3);
  }
}

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
  double dist = 0.0, length = 0.0, offset = 0.0;
  for (const auto& pd : {std::make_pair(60.0, -60.0), std::make_pair(230.0, 30.0)}) {  // inside; outside the sweep
    ASSERT_TRUE(arc.getShortestDistanceToPoint(C2dPos(0.0, pd.first), dist));
    EXPECT_NEAR(dist, pd.second, 1e-12);
  }
  EXPECT_FALSE(arc.getLengthAndOffset(C2dPos(0.0, 230.0), length, offset));
}

TEST(ArcElement, ThreePointArcReproducesTheArc) {
  for (const double length : {30.0, 230.0}) {  // the last more than a half turn of R 60
    for (const bool right : {true, false}) {
      const CCurveArc original = makeArc(700.0, -300.0, 222.0, length, 60.0, right);
      const CCurveArc rebuilt(posAt(original, 0.0), posAt(original, 0.3 * length), posAt(original, length));
      ASSERT_TRUE(rebuilt.isok());
      EXPECT_NEAR(rebuilt.getRadius(), right ? 60.0 : -60.0, 1e-9);
      EXPECT_NEAR(rebuilt.getTotalLength(), length, 1e-9);
      const C2dPos expected = posAt(original, 0.7 * length);
      curve_test::expectPosNear(posAt(rebuilt, 0.7 * length), expected.north(), expected.east(), 1e-8);
    }
  }
  EXPECT_FALSE(CCurveArc(C2dPos(0.0, 0.0), C2dPos(1.0, 1.0), C2dPos(2.0, 2.0)).isok());  // collinear
  EXPECT_FALSE(CCurveArc(C2dPos(0.0, 0.0), C2dPos(0.0, 0.0), C2dPos(2.0, 2.0)).isok());  // coincident
}

TEST(ArcAngleRange, SweepsThroughNorthAndPlain) {
  const auto in = [](double from, double to, const CMathAngle& angle, double tolerance) {
    return isAngleRadInRange(CMathAngle(from), CMathAngle(to), angle, tolerance);
  };
  CMathAngle unset;
  unset.reset();
  EXPECT_TRUE(in(350.0, 10.0, CMathAngle(0.0), 0.0) && in(350.0, 10.0, CMathAngle(355.0), 0.0));
  EXPECT_TRUE(in(10.0, 20.0, CMathAngle(20.0), 0.0) && in(-10.0, 10.0, unset, 0.0));  // undefined counts as 0
  EXPECT_FALSE(in(350.0, 10.0, CMathAngle(180.0), 0.0) || in(10.0, 20.0, CMathAngle(20.001), 0.0));
  EXPECT_TRUE(in(10.0, 20.0, CMathAngle(20.001), -0.002 * svy_math::units::kDegToRad));
}

// Published arc tables (start at the origin heading +X, radius positive to the LEFT, X east, Y north):
// N = Y, E = X, start azimuth 90 degrees, radius negated.
TEST(ArcElement, MatchesPublishedArcTables) {
  SVY_SKIP_WITHOUT_REFDATA();
  const std::string folder = "alignment/ifc-alignment-geometry-implementation-guide/HorizontalAlignment/CircularArc/";
  for (const int radius : {300, -300, 1000, -1000}) {
    const std::string name = "Horizontal_CircularArc_100.0_" + std::to_string(radius) + "_" +
                             std::to_string(radius) + "_Meter.csv";
    const auto rows = curve_test::readNumericTable(svy_test::refdataPath(folder + name));
    ASSERT_GT(rows.size(), 10u) << name;
    const CCurveArc arc = makeArc(0.0, 0.0, 90.0, 100.0, std::abs(radius), radius < 0);
    for (const auto& row : rows) {
      curve_test::expectPosNear(posAt(arc, row[0]), row[2], row[1], 2e-6);
    }
  }
}

}  // namespace
