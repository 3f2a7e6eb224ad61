// The spiral element: round trips of position and length-and-offset over full, reversed and partial spirals
// of both laws, the foot-point search against dense sampling, ends and extensions, boundary boxes and the
// published clothoid tables.
#include <gtest/gtest.h>

#include <cmath>
#include <string>

#include "curve_test_support.h"
#include "support/refdata.h"

namespace {

using curve_test::makePartialSpiral;
using curve_test::makeSpiral;

struct SpiralCase {
  const char* name;
  AlntMathSpiralType law;
  double length;
  double radius;
  double radius2;  // 0: a full spiral; otherwise the part between radius and radius2
  bool right;
  bool isTSSC;
};

CCurveSpiral build(const SpiralCase& c) {
  if (c.radius2 != 0.0) {
    return makePartialSpiral(5000000.0, 500000.0, 123.0, c.length, c.radius, c.radius2, c.right, c.isTSSC);
  }
  return makeSpiral(5000000.0, 500000.0, 123.0, c.length, c.radius, c.right, c.isTSSC, c.law);
}

class SpiralElementTest : public ::testing::TestWithParam<SpiralCase> {};

TEST_P(SpiralElementTest, PositionThenLengthAndOffsetGivesThemBack) {
  const CCurveSpiral spiral = build(GetParam());
  ASSERT_TRUE(spiral.isok());
  const double total = spiral.getTotalLength();
  for (int i = 0; i <= 10; ++i) {
    const double s = total * i / 10.0;
    for (const double offset : {-7.5, -0.2, 0.0, 0.2, 7.5}) {
      C2dPos pos;
      ASSERT_TRUE(spiral.getPosAtLengthAndOffset(s, offset, pos));
      double length = -1.0, back = 99.0;
      ASSERT_TRUE(spiral.getLengthAndOffset(pos, length, back)) << "s=" << s << " o=" << offset;
      EXPECT_NEAR(length, s, 1e-8) << "s=" << s << " o=" << offset;
      EXPECT_NEAR(back, offset, 1e-8) << "s=" << s << " o=" << offset;
    }
    // The length at the world azimuth of the tangent there (the clothoid's; the cubic's is a half tangent).
    if (GetParam().law == eMathSpiralEuler && GetParam().radius2 == 0.0) {
      EXPECT_NEAR(spiral.getLengthAtAzimuth(CMathAngle(spiral.getAzimuthAtLength(s))), s, 1e-8);
    }
  }
}

TEST_P(SpiralElementTest, ProjectionIsTheNearestPointOfTheSampledSpiral) {
  const CCurveSpiral spiral = build(GetParam());
  const C2dPos start = spiral.getStartPos();
  const double total = spiral.getTotalLength();
  for (double dn = -0.6 * total; dn <= 1.4 * total; dn += 0.23 * total) {
    for (double de = -0.5 * total; de <= 0.5 * total; de += 0.19 * total) {
      const C2dPos p(start.north() + dn, start.east() + de);
      double dist = 0.0, len = 0.0;
      ASSERT_TRUE(spiral.getShortestDistAndCurveLen(p.north(), p.east(), dist, len));
      ASSERT_GE(len, 0.0);
      ASSERT_LE(len, total);
      double sampledAt = 0.0;
      const double sampled = curve_test::sampledDistance(spiral, p, 4000, &sampledAt);
      EXPECT_LE(std::fabs(dist), sampled + 1e-9);
      EXPECT_NEAR(std::fabs(dist), sampled, 1e-4);
      const C2dPos foot = curve_test::posAt(spiral, len);
      EXPECT_NEAR(curve_test::distance(foot, p), std::fabs(dist), 1e-9);
      // An interior foot is square to the tangent to well within 1e-9 m.
      if (len > 1e-6 && len < total - 1e-6) {
        CMathAngle tangent;
        ASSERT_TRUE(spiral.getAzimuthAtLength(len, tangent));
        const double along = tangent.getCos() * (p.north() - foot.north()) + tangent.getSin() * (p.east() - foot.east());
        EXPECT_LT(std::fabs(along), 1e-9);
      }
    }
  }
}

TEST_P(SpiralElementTest, BoundaryHoldsDenseSamples) {
  const CCurveSpiral spiral = build(GetParam());
  const C2dMinMax box = spiral.getBoundary();
  ASSERT_FALSE(box.empty);
  C2dMinMax sampled;
  const double total = spiral.getTotalLength();
  for (int i = 0; i <= 5000; ++i) sampled.include(curve_test::posAt(spiral, total * i / 5000));
  EXPECT_LE(box.minNorth, sampled.minNorth + 1e-9);
  EXPECT_LE(box.minEast, sampled.minEast + 1e-9);
  EXPECT_GE(box.maxNorth, sampled.maxNorth - 1e-9);
  EXPECT_GE(box.maxEast, sampled.maxEast - 1e-9);
  EXPECT_NEAR(box.maxNorth - box.minNorth, sampled.maxNorth - sampled.minNorth, 1e-4);
  EXPECT_NEAR(box.maxEast - box.minEast, sampled.maxEast - sampled.minEast, 1e-4);
}

INSTANTIATE_TEST_SUITE_P(
    Table, SpiralElementTest,
    ::testing::Values(SpiralCase{"clothoidRightTSSC", eMathSpiralEuler, 100.0, 300.0, 0.0, true, true},
                      SpiralCase{"clothoidLeftCSST", eMathSpiralEuler, 100.0, 300.0, 0.0, false, false},
                      SpiralCase{"clothoidTightRight", eMathSpiralEuler, 150.0, 60.0, 0.0, true, true},
                      SpiralCase{"cubicRightCSST", eMathSpiralCubic, 100.0, 300.0, 0.0, true, false},
                      SpiralCase{"cubicLeftTSSC", eMathSpiralCubic, 60.0, 250.0, 0.0, false, true},
                      SpiralCase{"partialRightTSSC", eMathSpiralEuler, 100.0, 1000.0, 300.0, true, true},
                      SpiralCase{"partialLeftCSST", eMathSpiralEuler, 100.0, 300.0, 1000.0, false, false}),
    [](const ::testing::TestParamInfo<SpiralCase>& caseInfo) { return std::string(caseInfo.param.name); });

TEST(SpiralElement, PointsBeyondTheEndsRunOnAlongTheEndTangents) {
  CCurveSpiral spiral = makeSpiral(0.0, 0.0, 0.0, 100.0, 300.0, true, true);
  CMathAngle endTangent;
  ASSERT_TRUE(spiral.getEndAzimut(endTangent));
  const C2dPos end = spiral.getEndPos();
  C2dPos beyond;
  endTangent.getPosAlong(0.0008, end, beyond);
  double length = 0.0, offset = 0.0, distance = 0.0;
  ASSERT_TRUE(spiral.getLengthAndOffset(beyond, length, offset));  // within the end tolerance
  EXPECT_NEAR(length, 100.0008, 1e-9);
  EXPECT_NEAR(offset, 0.0, 1e-9);
  endTangent.getPosAlong(5.0, end, beyond);
  EXPECT_FALSE(spiral.getLengthAndOffset(beyond, length, offset));
  spiral.setIntersectionType(eIntersectUnbounded);
  ASSERT_TRUE(spiral.getLengthAndOffset(beyond, length, offset));
  EXPECT_NEAR(length, 105.0, 1e-9);
  ASSERT_TRUE(spiral.getLengthAndOffset(C2dPos(-20.0, 3.0), length, offset));  // behind the start
  EXPECT_NEAR(length, -20.0, 1e-12);
  EXPECT_NEAR(offset, 3.0, 1e-12);
  ASSERT_TRUE(spiral.getShortestDistanceToPoint(C2dPos(-20.0, 3.0), distance));
  EXPECT_NEAR(distance, std::hypot(20.0, 3.0), 1e-12);  // to the start point, not the prolonged tangent
}

TEST(SpiralElement, CurveIpOfFullSpiralAtLongTangent) {
  // The long tangent of a clothoid: from the start to the tangents' intersection, x_end - y_end / tan(theta).
  const CCurveSpiral spiral = makeSpiral(0.0, 0.0, 0.0, 100.0, 300.0, true, true);
  C2dPos ip;
  ASSERT_TRUE(spiral.getCurveIp(ip));
  const C2dPos end = spiral.getEndPos();
  const double theta = 100.0 / 600.0;
  EXPECT_NEAR(ip.east(), 0.0, 1e-12);
  EXPECT_NEAR(ip.north(), end.north() - end.east() / std::tan(theta), 1e-9);
}

// Published clothoid tables (start at the origin heading +X, radius positive to the LEFT, X east, Y north),
// full and partial, into and out of the curve: N = Y, E = X, start azimuth 90 degrees, side negated. Each
// row's position must come back within the table's own accuracy, and its length and offset by the search.
TEST(SpiralElement, MatchesPublishedClothoidTables) {
  SVY_SKIP_WITHOUT_REFDATA();
  const std::string folder = "alignment/ifc-alignment-geometry-implementation-guide/HorizontalAlignment/Clothoid/";
  struct Table {
    const char* r1;
    const char* r2;
    double from;  // radius magnitudes, 0 for the tangent
    double to;
    bool left;
  };
  const Table tables[] = {{"inf", "300", 0.0, 300.0, true},        {"300", "inf", 300.0, 0.0, true},
                          {"-inf", "-300", 0.0, 300.0, false},     {"-300", "-inf", 300.0, 0.0, false},
                          {"1000", "300", 1000.0, 300.0, true},    {"300", "1000", 300.0, 1000.0, true},
                          {"-1000", "-300", 1000.0, 300.0, false}, {"-300", "-1000", 300.0, 1000.0, false}};
  for (const Table& t : tables) {
    const std::string name = std::string("Horizontal_Clothoid_100.0_") + t.r1 + "_" + t.r2 + "_Meter.csv";
    const auto rows = curve_test::readNumericTable(svy_test::refdataPath(folder + name));
    ASSERT_GT(rows.size(), 10u) << name;
    const bool intoCurve = t.from == 0.0 || (t.to != 0.0 && t.to < t.from);
    const CCurveSpiral spiral =
        t.from == 0.0 || t.to == 0.0
            ? makeSpiral(0.0, 0.0, 90.0, 100.0, t.from + t.to, !t.left, intoCurve)
            : makePartialSpiral(0.0, 0.0, 90.0, 100.0, t.from, t.to, !t.left, intoCurve);
    ASSERT_TRUE(spiral.isok()) << name;
    for (const auto& row : rows) {
      SCOPED_TRACE(name + " s=" + std::to_string(row[0]));
      curve_test::expectPosNear(curve_test::posAt(spiral, row[0]), row[2], row[1], 2e-6);
      double length = 0.0, offset = 0.0;
      ASSERT_TRUE(spiral.getLengthAndOffset(C2dPos(row[2], row[1]), length, offset));
      EXPECT_NEAR(length, row[0], 3e-6);
      EXPECT_NEAR(offset, 0.0, 3e-6);
    }
  }
}

}  // namespace
