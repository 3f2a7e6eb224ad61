// Intersections, inverses to elements and point sets, each checked against a construction made
// independently in the test: the answer lies on both loci, or the point built from (along, offset) comes
// back to them.
#include <gtest/gtest.h>

#include <cmath>

#include "support/geometry.h"
#include "svymath/cogo/cogo_intersections.h"
#include "svymath/cogo/cogo_inverse.h"
#include "svymath/cogo/cogo_point_sets.h"
#include "svymath/foundation/constants.h"

namespace {

using namespace CogoFunctions;
using svy_test::dist;

const C2dPos kGrid(5000000.0, 500000.0);

C2dPos offsetBy(const C2dPos& p, double azimuthDeg, double distance) {
  const CMathAngle a(azimuthDeg);
  C2dPos out;
  a.getPosAlong(distance, p, out);
  return out;
}

// Signed offset of p from the line through `from` along the azimuth, positive to the right.
double offsetFromBearing(const C2dPos& from, double azimuthDeg, const C2dPos& p) {
  const CMathAngle a(azimuthDeg);
  return a.getCos() * (p.east() - from.east()) - a.getSin() * (p.north() - from.north());
}

double alongBearing(const C2dPos& from, double azimuthDeg, const C2dPos& p) {
  const CMathAngle a(azimuthDeg);
  return a.getCos() * (p.north() - from.north()) + a.getSin() * (p.east() - from.east());
}

// A crossing chosen first; the two bearings are taken through points placed on lines through it.
TEST(IntersectBearings, FindsTheChosenCrossingAndRefusesParallels) {
  struct { double az1, t1, az2, t2; } const cases[] = {
      {30, 120, 100, 80}, {0, -50, 90, 40}, {359.9, 1000, 10, 5}, {200, 3, 201, 2000}, {45, 0.5, 225.001, 10}};
  for (const auto& c : cases) {
    SCOPED_TRACE(c.az1);
    const C2dPos target = offsetBy(kGrid, 17.0, 321.5);
    const C2dPos p1 = offsetBy(target, c.az1, -c.t1), p2 = offsetBy(target, c.az2, -c.t2);
    C2dPos crossing;
    ASSERT_EQ(eIntersectBearings(p1, CMathAngle(c.az1), p2, CMathAngle(c.az2), crossing), eCogoOk);
    EXPECT_NEAR(offsetFromBearing(p1, c.az1, crossing), 0.0, 1e-8);
    EXPECT_NEAR(offsetFromBearing(p2, c.az2, crossing), 0.0, 1e-8);
  }
  C2dPos untouched(1, 2);
  for (double az2 : {30.0, 210.0})
    EXPECT_EQ(eIntersectBearings(kGrid, CMathAngle(30), offsetBy(kGrid, 120, 50), CMathAngle(az2), untouched),
              eCogoParallel);
  EXPECT_EQ(eIntersectBearings(C2dPos(NAN, 0), CMathAngle(0), kGrid, CMathAngle(90), untouched), eCogoInvalidInput);
  EXPECT_EQ(untouched, C2dPos(1, 2));
}

// Bearing from point 1, distance from point 2: both solutions on the line and on the circle, in travel
// order along the bearing; a line that just touches gives one, one that misses none.
TEST(IntersectBearingDistance, SolutionsOnBothLociInTravelOrder) {
  struct { double az1, lineOffset, radius; int count; } const cases[] = {
      {60, 10, 25, 2}, {250, -24.9, 25, 2}, {0, 0, 3, 2}, {123, 40, 40, 1}, {123, 40.0001, 40, 0}};
  for (const auto& c : cases) {
    SCOPED_TRACE(c.az1);
    const C2dPos p1 = offsetBy(kGrid, c.az1 + 180, 300);
    // Point 2 `lineOffset` to the right of the bearing line, 300 m ahead of point 1.
    const C2dPos p2 = offsetBy(kGrid, c.az1 + 90, c.lineOffset);
    C2dPos s1, s2;
    int count = 0;
    const ECogoMathErrorCode status = eIntersectBearingDistance(p1, CMathAngle(c.az1), p2, c.radius, s1, s2, count);
    if (c.count == 0) {
      EXPECT_EQ(status, eCogoNoSolution);
      continue;
    }
    ASSERT_EQ(status, eCogoOk);
    EXPECT_EQ(count, c.count);
    for (const C2dPos& s : {s1, s2}) {
      EXPECT_NEAR(offsetFromBearing(p1, c.az1, s), 0.0, 1e-8);
      EXPECT_NEAR(dist(s, p2), c.radius, 1e-8);
    }
    const double chordHalf = std::sqrt(std::fmax(0.0, c.radius * c.radius - c.lineOffset * c.lineOffset));
    EXPECT_NEAR(alongBearing(p1, c.az1, s1), 300 - chordHalf, 1e-6);
    EXPECT_NEAR(alongBearing(p1, c.az1, s2), 300 + chordHalf, 1e-6);
  }
  C2dPos s1, s2;
  int count = 0;
  EXPECT_EQ(eIntersectBearingDistance(kGrid, CMathAngle(0), kGrid, 0.0, s1, s2, count), eCogoInvalidInput);
}

// Distance from point 1 and from point 2: solution 1 right of 1 -> 2; touching, apart, nested, concentric.
TEST(IntersectDistances, SolutionOneRightOfTheBaseAndTheNoSolutionCodes) {
  const C2dPos p2 = offsetBy(kGrid, 75, 100);
  C2dPos s1, s2;
  int count = 0;
  ASSERT_EQ(eIntersectDistances(kGrid, 80, p2, 60, s1, s2, count), eCogoOk);
  EXPECT_EQ(count, 2);
  EXPECT_NEAR(dist(s1, kGrid), 80, 1e-9);
  EXPECT_NEAR(dist(s1, p2), 60, 1e-9);
  EXPECT_NEAR(dist(s2, kGrid), 80, 1e-9);
  EXPECT_NEAR(dist(s2, p2), 60, 1e-9);
  // The 3-4-5 triangle: the solutions lie 48 m either side of the base, 64 m along it.
  EXPECT_NEAR(offsetFromBearing(kGrid, 75, s1), 48, 1e-9);
  EXPECT_NEAR(offsetFromBearing(kGrid, 75, s2), -48, 1e-9);
  EXPECT_NEAR(alongBearing(kGrid, 75, s1), 64, 1e-9);
  ASSERT_EQ(eIntersectDistances(kGrid, 30, p2, 70, s1, s2, count), eCogoOk);
  EXPECT_EQ(count, 1);
  EXPECT_NEAR(dist(s1, offsetBy(kGrid, 75, 30)), 0.0, 1e-9);
  struct { double d1, d2; C2dPos centre2; ECogoMathErrorCode status; } const failures[] = {
      {30, 69.99, p2, eCogoNoSolution}, {10, 200, p2, eCogoNoSolution}, {10, 20, kGrid, eCogoConcentric},
      {-1, 20, p2, eCogoInvalidInput}};
  for (const auto& f : failures) EXPECT_EQ(eIntersectDistances(kGrid, f.d1, f.centre2, f.d2, s1, s2, count), f.status);
}

// Point at (along, offset) from a segment and back; the foot's position and the nearest point.
TEST(InverseToSegment, RoundTripWithPositionAndNearestPoint) {
  const C2dPos end = offsetBy(kGrid, 123.4, 250);
  struct { double along, offset; EFootPosition position; } const cases[] = {
      {100, 12.5, eFootOnElement}, {0, -3, eFootOnElement}, {250, 0, eFootOnElement},
      {-20, 7, eFootBeforeStart}, {300, -40, eFootAfterEnd}};
  for (const auto& c : cases) {
    SCOPED_TRACE(c.along);
    C2dPos p;
    ASSERT_EQ(ePointAtAlongOffset(kGrid, end, c.along, c.offset, p), eCogoOk);
    EXPECT_NEAR(offsetFromBearing(kGrid, 123.4, p), c.offset, 1e-9);
    TElementInverse inv;
    ASSERT_EQ(eInverseToSegment(kGrid, end, p, inv), eCogoOk);
    EXPECT_NEAR(inv.along, c.along, 1e-9);
    EXPECT_NEAR(inv.offset, c.offset, 1e-9);
    EXPECT_EQ(inv.position, c.position);
    EXPECT_NEAR(dist(inv.foot, offsetBy(kGrid, 123.4, c.along)), 0.0, 1e-9);
    const C2dPos nearest = c.position == eFootBeforeStart ? kGrid : c.position == eFootAfterEnd ? end : inv.foot;
    EXPECT_NEAR(dist(inv.nearest, nearest), 0.0, 1e-9);
    EXPECT_NEAR(inv.distance, dist(p, nearest), 1e-9);
  }
  TElementInverse inv;
  EXPECT_EQ(eInverseToSegment(kGrid, kGrid, end, inv), eCogoCoincidentPoints);
}

// A point built at an angle from the arc's start and a radial offset inverts back to R * angle and that
// offset; beyond the ends it goes to the nearer end.
TEST(InverseToArc, AlongTheArcAndOffsetTowardTheCentre) {
  for (const bool clockwise : {true, false}) {
    CArc arc;
    const C2dPos centre = offsetBy(kGrid, 200, 80);
    ASSERT_TRUE(arc.set_start_center_cAngle(kGrid, centre, CMathAngle(100), clockwise));
    const double radius = 80, startAz = 20;  // azimuth of the start seen from the centre
    struct { double turnedDeg, offset, along; EFootPosition position; } const cases[] = {
        {40, 5, 40, eFootOnElement}, {100, -12, 100, eFootOnElement}, {130, 2, 130, eFootAfterEnd},
        {-30, 2, -30, eFootBeforeStart}, {250, 1, -110, eFootBeforeStart}};
    for (const auto& c : cases) {
      SCOPED_TRACE(::testing::Message() << clockwise << " " << c.turnedDeg);
      const double az = startAz + (clockwise ? c.turnedDeg : -c.turnedDeg);
      const C2dPos p = offsetBy(centre, az, clockwise ? radius - c.offset : radius + c.offset);
      TElementInverse inv;
      ASSERT_EQ(eInverseToArc(arc, p, inv), eCogoOk);
      EXPECT_NEAR(inv.along, radius * c.along * svy_math::units::kDegToRad, 1e-9);
      EXPECT_NEAR(inv.offset, c.offset, 1e-9);
      EXPECT_EQ(inv.position, c.position);
      EXPECT_NEAR(dist(inv.foot, offsetBy(centre, az, radius)), 0.0, 1e-9);
      C2dPos end;
      arc.get_end_pos(end);
      const C2dPos nearest = c.position == eFootBeforeStart ? kGrid : c.position == eFootAfterEnd ? end : inv.foot;
      EXPECT_NEAR(dist(inv.nearest, nearest), 0.0, 1e-9);
    }
    TElementInverse inv;
    EXPECT_EQ(eInverseToArc(arc, centre, inv), eCogoCoincidentPoints);
  }
}

// An L-shaped polyline (north 100 m, then east 50 m, its last vertex repeated) open and closed into a
// triangle: the nearest segment, the distance along, and the corner rule.
TEST(InverseToPolyline, NearestSegmentAlongAndCorner) {
  const svy_vector<C2dPos> path{kGrid, C2dPos(kGrid.north() + 100, kGrid.east()), C2dPos(kGrid.north() + 100, kGrid.east() + 50),
                                C2dPos(kGrid.north() + 100, kGrid.east() + 50)};
  struct { double dN, dE; bool closed; double along, offset; int segment; EFootPosition position; } const cases[] = {
      {40, 3, false, 40, 3, 0, eFootOnElement},        {99, 20, false, 120, 1, 1, eFootOnElement},
      {103, -4, false, 100, -5, 0, eFootOnElement},    {-6, -1, false, -6, -1, 0, eFootBeforeStart},
      {100, 58, false, 158, 0, 1, eFootAfterEnd},       {-3, -4, true, 0, -5, 0, eFootOnElement},
      {40, 25, true, 150 + 7250 / std::sqrt(12500.0), -500 / std::sqrt(12500.0), 3, eFootOnElement}};
  for (const auto& c : cases) {
    SCOPED_TRACE(::testing::Message() << c.dN << " " << c.dE);
    TElementInverse inv;
    ASSERT_EQ(eInverseToPolyline(path, c.closed, C2dPos(kGrid.north() + c.dN, kGrid.east() + c.dE), inv), eCogoOk);
    EXPECT_NEAR(inv.along, c.along, 1e-9);
    EXPECT_NEAR(inv.offset, c.offset, 1e-9);
    EXPECT_EQ(inv.segment, c.segment);
    EXPECT_EQ(inv.position, c.position);
  }
  TElementInverse inv;
  EXPECT_EQ(eInverseToPolyline(svy_vector<C2dPos>{kGrid}, false, kGrid, inv), eCogoInvalidInput);
  EXPECT_EQ(eInverseToPolyline(svy_vector<C2dPos>{kGrid, kGrid}, false, kGrid, inv), eCogoCoincidentPoints);
}

// Rotation clockwise about the base, scaling from it, and the way back.
TEST(ScaleRotatePoints, ClockwiseAboutTheBaseAndBack) {
  svy_vector<C2dPos> points{offsetBy(kGrid, 0, 10), offsetBy(kGrid, 135, 7.5), kGrid};
  const svy_vector<C2dPos> original = points;
  ASSERT_EQ(eScaleRotatePoints(points, kGrid, 2.0, CMathAngle(90)), eCogoOk);
  EXPECT_NEAR(dist(points[0], offsetBy(kGrid, 90, 20)), 0.0, 1e-9);
  EXPECT_NEAR(dist(points[1], offsetBy(kGrid, 225, 15)), 0.0, 1e-9);
  EXPECT_EQ(points[2], kGrid);
  ASSERT_EQ(eScaleRotatePoints(points, kGrid, 0.5, CMathAngle(-90)), eCogoOk);
  for (int i = 0; i < 3; ++i) EXPECT_NEAR(dist(points[i], original[i]), 0.0, 1e-9);
  EXPECT_EQ(eScaleRotatePoints(points, kGrid, 0.0, CMathAngle(0)), eCogoInvalidInput);
}

// Plain and weighted means with their spread, at grid coordinates.
TEST(MeanPosition, WeightsAndSampleSpread) {
  const svy_vector<C2dPos> shots{C2dPos(kGrid.north() + 0.01, kGrid.east()), C2dPos(kGrid.north() - 0.01, kGrid.east() + 0.02)};
  TMeanPosition mean;
  ASSERT_EQ(eMeanPosition(shots, mean), eCogoOk);
  EXPECT_NEAR(dist(mean.mean, C2dPos(kGrid.north(), kGrid.east() + 0.01)), 0.0, 1e-9);
  EXPECT_NEAR(mean.sdNorth, 0.01 * std::sqrt(2.0), 1e-9);
  EXPECT_NEAR(mean.sdEast, 0.01 * std::sqrt(2.0), 1e-9);
  EXPECT_NEAR(mean.maxDistance, 0.01 * std::sqrt(2.0), 1e-9);
  ASSERT_EQ(eMeanPosition(shots, svy_vector<double>{1.0, 3.0}, mean), eCogoOk);
  EXPECT_NEAR(dist(mean.mean, C2dPos(kGrid.north() - 0.005, kGrid.east() + 0.015)), 0.0, 1e-9);
  EXPECT_EQ(eMeanPosition(shots, svy_vector<double>{1.0, 0.0}, mean), eCogoInvalidInput);
  EXPECT_EQ(eMeanPosition(svy_vector<C2dPos>{}, mean), eCogoInvalidInput);
}

}  // namespace
