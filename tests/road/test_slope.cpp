// Side slopes: stored values and their reciprocals, the hinge and local offsets, catch points against level
// ground (with the flat-slope quirk of isCatchPointAvailable) and against sloping ground lines and
// polylines, on both sides, in cut and in fill, and the failures.
#include <gtest/gtest.h>

#include <cmath>
#include <vector>

#include "svymath/road/catch_point.h"

namespace {

// A section whose outermost points, the default hinges, are (-10, 100) and (10, 100).
struct TSection {
  CEditableRoadCrossSection section{500.0, 100.2, false};
  TSection() {
    section.addPoint(-10.0, 100.0);
    section.addPoint(0.0, 100.2);
    section.addPoint(10.0, 100.0);
  }
};

TEST(SideSlope, StoredValuesAndReciprocals) {
  TSection s;
  CRoadCrossSectionSlope slope(s.section, true);
  EXPECT_FALSE(slope.hasCut() || slope.hasFill() || slope.hasFlatCutSlope());
  EXPECT_TRUE(std::isnan(slope.getCutSlopeRiseRun()));
  slope.setCutSlopeRiseRun(0.5);
  slope.setFillSlopeRiseRun(1e-13);  // inside the zero tolerance: flat
  EXPECT_DOUBLE_EQ(slope.getCutSlopeRunRise(), 2.0);
  EXPECT_DOUBLE_EQ(slope.getCutSlopeRiseRun(), 0.5);
  EXPECT_TRUE(slope.hasFlatFillSlope() && slope.getFillSlopeRunRise() == 0.0 && slope.getFillSlopeRiseRun() == 0.0);
  slope.setFillSlopeRunRise(-3.0);
  EXPECT_DOUBLE_EQ(slope.getFillSlopeRiseRun(), -1.0 / 3.0);
  slope.clearCut();
  EXPECT_FALSE(slope.hasCut());
  EXPECT_TRUE(slope.hasFill() && !slope.hasFlatFillSlope());
  const CRoadCrossSectionSlope copy(slope);
  EXPECT_TRUE(copy.isRightSide() && copy.getFillSlopeRunRise() == -3.0 && &copy.getSection() == &s.section);
}

TEST(SideSlope, HingeAndOffsetsAtTheSlope) {
  TSection s;
  const struct {
    bool right;
    double offset;
    bool atSlope;
  } cases[] = {{true, 10.0, true},     {true, 9.9995, true}, {true, 9.99, false},  {true, 25.0, true},
               {false, -9.9995, true}, {false, -9.0, false}, {false, -30.0, true}, {false, 10.0, false}};
  for (const auto& c : cases) {
    CRoadCrossSectionSlope slope(s.section, c.right, 2.0, NAN);
    EXPECT_EQ(slope.isOffsetAtSlope(c.offset), c.atSlope) << c.right << " " << c.offset;
  }
  CRoadCrossSectionSlope slope(s.section, false);
  EXPECT_FALSE(slope.isOffsetAtSlope(-20.0));  // no slope on the side
  double offset = 0.0, elevation = 0.0;
  ASSERT_TRUE(slope.getHingePoint(offset, elevation));
  EXPECT_TRUE(offset == -10.0 && elevation == 100.0 && slope.getDefaultHingePoint() == s.section.getLeftMostPoint());
  slope.setHingePoint(-11.5, 99.0);
  EXPECT_TRUE(slope.getHingePoint(offset, elevation) && offset == -11.5 && elevation == 99.0);
  slope.setHingePoint(s.section.findCenterPoint());
  EXPECT_TRUE(slope.getHingePoint(offset, elevation) && offset == 0.0 && elevation == 100.2);
  slope.resetHingePoint();
  EXPECT_TRUE(slope.getHingePointOffset(offset) && offset == -10.0);
  CEditableRoadCrossSection empty(0.0);
  CRoadCrossSectionSlope unhinged(empty, true, 2.0, -2.0);
  double z = 0.0;
  EXPECT_FALSE(unhinged.getHingePoint(offset, elevation) || unhinged.getCatchPointOffset(101.0, offset) ||
               unhinged.isCatchPointAvailable(101.0) || unhinged.getHeightFromCutSlope(20.0, z));
}

// Cut 2:1 (run over rise 2), fill 3:1 (run over rise -3), hinges at (+-10, 100).
TEST(SideSlope, CatchPointsOnLevelGround) {
  TSection s;
  const struct {
    bool right;
    double cut, fill, ground;
    bool found;
    double offset, runRise;
  } cases[] = {
      {true, 2.0, -3.0, 103.0, true, 16.0, 2.0},   {true, 2.0, -3.0, 98.0, true, 16.0, -3.0},
      {false, 2.0, -3.0, 103.0, true, -16.0, 2.0}, {false, 2.0, -3.0, 98.0, true, -16.0, -3.0},
      {true, 2.0, -3.0, 100.0, true, 10.0, 2.0},   {true, 2.0, NAN, 98.0, false, 0.0, 0.0},
      {true, NAN, -3.0, 101.0, false, 0.0, 0.0},   {true, 0.0, -3.0, 98.0, true, 16.0, -3.0},
      {true, 0.0, NAN, 101.0, false, 0.0, 0.0},    {true, NAN, NAN, 101.0, false, 0.0, 0.0},
  };
  for (const auto& c : cases) {
    const CRoadCrossSectionSlope slope(s.section, c.right, c.cut, c.fill);
    double offset = -999.0, runRise = 0.0;
    ASSERT_EQ(slope.getCatchPointOffset(c.ground, offset, &runRise), c.found) << c.right << " " << c.ground;
    if (!c.found) continue;
    EXPECT_NEAR(offset, c.offset, 1e-12);
    EXPECT_EQ(runRise, c.runRise);
    // Round trip: the slope the ground calls for reaches the ground elevation at the catch point.
    double height = 0.0, autoRunRise = 0.0;
    ASSERT_TRUE(slope.getHeightFromSlopeAuto(offset, c.ground, height, &autoRunRise));
    EXPECT_NEAR(height, c.ground, 1e-12);
    EXPECT_EQ(autoRunRise, runRise);
  }
  // A flat cut slope reports a catch point as available but yields none: kept as earlier releases had it.
  const CRoadCrossSectionSlope flatCut(s.section, true, 0.0, NAN);
  double offset = 0.0;
  EXPECT_TRUE(flatCut.isCatchPointAvailable(99.0));
  EXPECT_FALSE(flatCut.getCatchPointOffset(99.0, offset));
  const CRoadCrossSectionSlope steep(s.section, true, 2.0, -3.0);
  EXPECT_TRUE(steep.isCatchPointAvailable(100.0) && steep.isCatchPointAvailable(99.0));
  EXPECT_FALSE(CRoadCrossSectionSlope(s.section, true, 2.0, NAN).isCatchPointAvailable(99.0));
}

TEST(SideSlope, HeightsOnEachSlope) {
  TSection s;
  const CRoadCrossSectionSlope right(s.section, true, 2.0, -4.0);
  const CRoadCrossSectionSlope left(s.section, false, 2.0, -4.0);
  double z = 0.0;
  EXPECT_TRUE(right.getHeightFromCutSlope(14.0, z) && z == 102.0);
  EXPECT_TRUE(right.getHeightFromFillSlope(14.0, z) && z == 99.0);
  EXPECT_TRUE(left.getHeightFromCutSlope(-14.0, z) && z == 102.0);
  EXPECT_TRUE(left.getHeightFromFillSlope(-18.0, z) && z == 98.0);
  // Cut when the ground is at or above the hinge, fill below it.
  EXPECT_TRUE(right.getHeightFromSlopeAuto(14.0, 100.0, z) && z == 102.0);
  EXPECT_TRUE(right.getHeightFromSlopeAuto(14.0, 99.99, z) && z == 99.0);
}

// Ground elevation on the polyline at an offset, the outermost segments continued.
double groundAt(const std::vector<TXsGroundPoint>& g, double o) {
  std::size_t i = 0;
  while (i + 2 < g.size() && g[i + 1].offset < o) ++i;
  return g[i].elevation + (o - g[i].offset) * (g[i + 1].elevation - g[i].elevation) / (g[i + 1].offset - g[i].offset);
}

TEST(CatchPoint, SlopesAgainstSlopingGround) {
  TSection s;
  const struct {
    bool right;
    double cut, fill;
    std::vector<TXsGroundPoint> ground;
    bool extend;
    ECatchPointStatus status;
    double offset, elevation;  // hand-computed; NaN: checked by the oracle alone
  } cases[] = {
      // Cut 2:1 into ground rising 10 % outward: 100 + l/2 = 102 + l/10, l = 5.
      {true, 2.0, -3.0, {{0.0, 101.0}, {20.0, 103.0}}, true, eCatchPointFound, 15.0, 102.5},
      {false, 2.0, -3.0, {{-20.0, 103.0}, {0.0, 101.0}}, true, eCatchPointFound, -15.0, 102.5},
      // Fill 3:1 onto ground falling 5 % outward: 100 - l/3 = 99 - l/20.
      {true, 2.0, -3.0, {{10.0, 99.0}, {30.0, 98.0}}, false, eCatchPointFound, 10.0 + 60.0 / 17.0, 99.0 - 3.0 / 17.0},
      {false, 2.0, -3.0, {{-30.0, 98.0}, {-10.0, 99.0}}, false, eCatchPointFound, -10.0 - 60.0 / 17.0, NAN},
      // A polyline met exactly at a vertex, behind a dip the slope must not stop at.
      {true, NAN, -2.0, {{8.0, 99.0}, {12.0, 99.0}, {14.0, 96.0}, {30.0, 96.0}}, false, eCatchPointFound, 12.0, 99.0},
      // A fill slope running into a vertical face of the ground.
      {true, NAN, -2.0, {{0.0, 99.0}, {11.0, 99.0}, {11.0, 103.0}, {20.0, 103.0}}, false, eCatchPointFound, 11.0, 99.5},
      // The ground ends before the slope meets it, unless it is continued.
      {true, NAN, -2.0, {{0.0, 99.0}, {12.0, 98.5}}, false, eCatchPointNotMet, NAN, NAN},
      {true, NAN, -2.0, {{0.0, 99.0}, {12.0, 98.5}}, true, eCatchPointFound, NAN, NAN},
      // Ground rising faster than the cut slope never meets it.
      {true, 2.0, -3.0, {{0.0, 101.0}, {20.0, 113.0}}, true, eCatchPointNotMet, NAN, NAN},
      {true, NAN, NAN, {{0.0, 101.0}, {20.0, 103.0}}, true, eCatchPointNoSlope, NAN, NAN},
      // The only slope is a cut one: it is used, and rises away from ground below the hinge.
      {true, 2.0, NAN, {{0.0, 99.0}, {20.0, 99.0}}, true, eCatchPointNotMet, NAN, NAN},
      {true, 2.0, -3.0, {{12.0, 101.0}, {20.0, 103.0}}, false, eCatchPointNoGround, NAN, NAN},
      {true, 2.0, -3.0, {{20.0, 101.0}, {0.0, 103.0}}, true, eCatchPointNoGround, NAN, NAN},
      {true, 2.0, -3.0, {{0.0, NAN}, {20.0, 103.0}}, true, eCatchPointNoGround, NAN, NAN},
      {true, 2.0, -3.0, {{0.0, 101.0}}, true, eCatchPointNoGround, NAN, NAN},
  };
  for (const auto& c : cases) {
    const CRoadCrossSectionSlope slope(s.section, c.right, c.cut, c.fill);
    double offset = NAN, elevation = NAN, runRise = NAN;
    const ECatchPointStatus status = ComputeCatchPoint(slope, c.ground.data(), static_cast<int>(c.ground.size()),
                                                       c.extend, offset, elevation, &runRise);
    ASSERT_EQ(status, c.status) << c.right << " " << c.ground.size() << " " << c.offset;
    if (status != eCatchPointFound) continue;
    EXPECT_TRUE(std::isnan(c.offset) || std::fabs(offset - c.offset) < 1e-12) << offset;
    EXPECT_TRUE(std::isnan(c.elevation) || std::fabs(elevation - c.elevation) < 1e-12) << elevation;
    // Oracle: the point lies on the slope that was used, on the ground, and the slope stays on one side of
    // the ground from the hinge to it (the first meeting).
    double onSlope = 0.0;
    ASSERT_TRUE(slope.getHeightFromSlopeAuto(offset, groundAt(c.ground, slope.isRightSide() ? 10.0 : -10.0), onSlope));
    EXPECT_NEAR(onSlope, elevation, 1e-12);
    const bool vertical = c.ground.size() == 4 && c.ground[1].offset == c.ground[2].offset;
    EXPECT_TRUE(vertical || std::fabs(groundAt(c.ground, offset) - elevation) < 1e-12) << offset;
    const double sign = groundAt(c.ground, c.right ? 10.0 : -10.0) - 100.0;
    for (double t = 0.0; t < 0.999; t += 0.01) {
      const double o = (c.right ? 10.0 : -10.0) + t * (offset - (c.right ? 10.0 : -10.0));
      double z = 0.0;
      slope.getHeightFromSlopeAuto(o, sign + 100.0, z);
      EXPECT_GT((groundAt(c.ground, o) - z) * sign, -1e-12) << o;
    }
  }
  CEditableRoadCrossSection empty(0.0);
  const TXsGroundPoint line[] = {{0.0, 101.0}, {20.0, 103.0}};
  double offset = 0.0, elevation = 0.0;
  EXPECT_EQ(ComputeCatchPoint(CRoadCrossSectionSlope(empty, true, 2.0, -3.0), line, 2, true, offset, elevation),
            eCatchPointNoHinge);
  EXPECT_EQ(ComputeCatchPoint(CRoadCrossSectionSlope(s.section, true, 2.0, -3.0), nullptr, 2, true, offset, elevation),
            eCatchPointNoGround);
}

TEST(CatchPoint, EndOfASlopeAfterARun) {
  TSection s;
  const CRoadCrossSectionSlope right(s.section, true);
  const CRoadCrossSectionSlope left(s.section, false);
  double offset = 0.0, elevation = 0.0;
  EXPECT_TRUE(ComputeXYOffsetsForCutFillSlope(right, 2.0, 6.0, offset, elevation) && offset == 16.0 &&
              elevation == 103.0);
  EXPECT_TRUE(ComputeXYOffsetsForCutFillSlope(left, -4.0, 6.0, offset, elevation) && offset == -16.0 &&
              elevation == 98.5);
  EXPECT_TRUE(ComputeXYOffsetsForCutFillSlope(left, 0.0, 6.0, offset, elevation) && offset == -16.0 &&
              elevation == 100.0);
  EXPECT_FALSE(ComputeXYOffsetsForCutFillSlope(right, 2.0, -1.0, offset, elevation));
  EXPECT_FALSE(ComputeXYOffsetsForCutFillSlope(right, NAN, 1.0, offset, elevation));
}

}  // namespace
