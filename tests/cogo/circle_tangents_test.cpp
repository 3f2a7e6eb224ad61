// Common tangents of two circles, tangents from a point, the crossing line of two circles and the fillet
// between two lines, checked by tangency: every tangent line lies one radius from each centre, within
// 1e-9 m at grid coordinates.
#include <gtest/gtest.h>

#include <cmath>

#include "support/geometry.h"
#include "svymath/cogo/circle_tangents.h"
#include "svymath/foundation/constants.h"

namespace {

using namespace CogoFunctions;
using svy_math::TTangentToCircles;
using svy_test::dist;

const C2dPos kGrid(5000000.0, 500000.0);

C2dPos offsetBy(const C2dPos& p, double azimuthDeg, double distance) {
  C2dPos out;
  CMathAngle(azimuthDeg).getPosAlong(distance, p, out);
  return out;
}

// Signed distance of p from the line a -> b, positive to the right.
double sideOf(const C2dPos& a, const C2dPos& b, const C2dPos& p) {
  const double dN = b.north() - a.north(), dE = b.east() - a.east();
  return (dN * (p.east() - a.east()) - dE * (p.north() - a.north())) / std::hypot(dN, dE);
}

// The tangent line at a touching point runs perpendicular to the radius there.
C2dPos alongTangent(const C2dPos& centre, const C2dPos& touch) {
  return C2dPos(touch.north() - (touch.east() - centre.east()), touch.east() + (touch.north() - centre.north()));
}

TEST(TangentToCircles, EveryTangentTouchesBothCirclesInTheDocumentedOrder) {
  const double r1 = 30;
  struct { double apart, r2; int count; } const cases[] = {
      {100, 20, 4}, {50, 20, 3}, {40, 20, 2}, {10, 20, 1}, {60, 55, 2}, {1000, 1, 4}, {100, 30, 4}};
  for (const auto& c : cases) {
    SCOPED_TRACE(::testing::Message() << c.apart << " " << c.r2);
    const C2dPos c2 = offsetBy(kGrid, 63, c.apart);
    TTangentToCircles tangents;
    ASSERT_EQ(tangents.solve(kGrid, r1, c2, c.r2), eCogoOk);
    ASSERT_EQ(tangents.count(), c.count);
    for (int i = 0; i < tangents.count(); ++i) {
      const TTangentToCircles::TTangent& t = tangents.tangent(i);
      EXPECT_NEAR(dist(t.onFirst, kGrid), r1, 1e-9);
      EXPECT_NEAR(dist(t.onSecond, c2), c.r2, 1e-9);
      // The line through the touching points (or the tangent at a single touching point) keeps one radius
      // from each centre: on the same side for an outer tangent, on opposite sides for an inner one.
      const C2dPos other = dist(t.onFirst, t.onSecond) > 1e-6 ? t.onSecond : alongTangent(kGrid, t.onFirst);
      const double s1 = sideOf(t.onFirst, other, kGrid), s2 = sideOf(t.onFirst, other, c2);
      EXPECT_NEAR(std::fabs(s1), r1, 1e-9);
      EXPECT_NEAR(std::fabs(s2), c.r2, 1e-9);
      if (dist(t.onFirst, t.onSecond) > 1e-6) {
        EXPECT_EQ(s1 * s2 > 0, t.outer);
      }
    }
    // Pairs come right of centre1 -> centre2 first.
    if (c.count >= 2) {
      EXPECT_GT(sideOf(kGrid, c2, tangents.tangent(0).onFirst), 0);
      EXPECT_LT(sideOf(kGrid, c2, tangents.tangent(1).onFirst), 0);
    }
    if (c.count == 4) {
      EXPECT_GT(sideOf(kGrid, c2, tangents.tangent(2).onFirst), 0);
      EXPECT_LT(sideOf(kGrid, c2, tangents.tangent(2).onSecond), 0);
    }
  }
  TTangentToCircles tangents;
  EXPECT_EQ(tangents.solve(kGrid, 30, offsetBy(kGrid, 10, 5), 20), eCogoNoSolution);
  EXPECT_EQ(tangents.solve(kGrid, 30, kGrid, 20), eCogoConcentric);
  EXPECT_EQ(tangents.solve(kGrid, -1, offsetBy(kGrid, 10, 50), 20), eCogoInvalidInput);
  EXPECT_EQ(tangents.count(), 0);
}

// From a point: tangent length sqrt(d^2 - r^2), the radius perpendicular to the tangent; on the circle one
// tangent, inside none.
TEST(TangentToCircles, FromAPoint) {
  const C2dPos centre = offsetBy(kGrid, 200, 130);
  TTangentToCircles tangents;
  ASSERT_EQ(tangents.solveFromPoint(kGrid, centre, 50), eCogoOk);
  ASSERT_EQ(tangents.count(), 2);
  for (int i = 0; i < 2; ++i) {
    const TTangentToCircles::TTangent& t = tangents.tangent(i);
    EXPECT_EQ(t.onFirst, kGrid);
    EXPECT_NEAR(dist(kGrid, t.onSecond), 120, 1e-9);
    EXPECT_NEAR(std::fabs(sideOf(kGrid, t.onSecond, centre)), 50, 1e-9);
  }
  ASSERT_EQ(tangents.solveFromPoint(offsetBy(centre, 33, 50), centre, 50), eCogoOk);
  EXPECT_EQ(tangents.count(), 1);
  EXPECT_EQ(tangents.solveFromPoint(offsetBy(centre, 33, 49.99), centre, 50), eCogoNoSolution);
}

TEST(TwoCirclesIntersectionLine, CrossingPointsOrTheCommonTangent) {
  const C2dPos c2 = offsetBy(kGrid, 300, 100);
  C2dPos a, b;
  ASSERT_EQ(TwoCirclesIntersectionLine(kGrid, 80, c2, 60, a, b), 2);
  EXPECT_NEAR(dist(a, kGrid), 80, 1e-9);
  EXPECT_NEAR(dist(b, c2), 60, 1e-9);
  EXPECT_NEAR(sideOf(kGrid, c2, a), 48, 1e-9);
  ASSERT_EQ(TwoCirclesIntersectionLine(kGrid, 40, c2, 60, a, b), 1);
  EXPECT_NEAR(dist(a, offsetBy(kGrid, 300, 40)), 0.0, 1e-9);
  EXPECT_NEAR(dist(b, offsetBy(a, 30, 40)), 0.0, 1e-9);
  C2dPos untouched(1, 1);
  EXPECT_EQ(TwoCirclesIntersectionLine(kGrid, 30, c2, 60, untouched, b), 0);
  EXPECT_EQ(untouched, C2dPos(1, 1));
}

// The fillet leaves line 1 along its azimuth, joins line 2 along its azimuth, and its centre lies one radius
// from both lines, on the side the road turns to.
TEST(FilletTwoLines, TangentToBothLinesTurningTheRightWay) {
  struct { double az1, az2; } const cases[] = {{0, 90}, {0, -90}, {45, 46}, {10, 179}, {350, 20}};
  for (const auto& c : cases) {
    SCOPED_TRACE(c.az2);
    const C2dPos crossing = offsetBy(kGrid, 77, 500);
    const C2dPos p1 = offsetBy(crossing, c.az1, -400), p2 = offsetBy(crossing, c.az2, 300);
    CArc arc;
    ASSERT_EQ(eFilletTwoLines(p1, CMathAngle(c.az1), p2, CMathAngle(c.az2), 25, arc), eCogoOk);
    C2dPos end;
    ASSERT_TRUE(arc.get_end_pos(end));
    EXPECT_NEAR(sideOf(p1, crossing, arc.start), 0.0, 1e-9);
    EXPECT_NEAR(sideOf(crossing, p2, end), 0.0, 1e-9);
    EXPECT_NEAR(arc.getRadius(), 25, 1e-9);
    EXPECT_NEAR(std::fabs(sideOf(p1, crossing, arc.center)), 25, 1e-9);
    EXPECT_NEAR(std::fabs(sideOf(crossing, p2, arc.center)), 25, 1e-9);
    CMathAngle startTangent, endTangent;
    ASSERT_TRUE(arc.get_start_tgdir(startTangent));
    ASSERT_TRUE(arc.get_end_tgdir(endTangent));
    EXPECT_TRUE(startTangent.isEqual(CMathAngle(c.az1), 1e-9));
    EXPECT_TRUE(endTangent.isEqual(CMathAngle(c.az2), 1e-9));
    EXPECT_EQ(arc.clockwise, std::sin((c.az2 - c.az1) * svy_math::units::kDegToRad) > 0);
  }
  CArc arc;
  EXPECT_EQ(eFilletTwoLines(kGrid, CMathAngle(30), offsetBy(kGrid, 90, 10), CMathAngle(30), 25, arc), eCogoParallel);
  EXPECT_EQ(eFilletTwoLines(kGrid, CMathAngle(30), offsetBy(kGrid, 90, 10), CMathAngle(80), 0, arc), eCogoInvalidInput);
}

}  // namespace
