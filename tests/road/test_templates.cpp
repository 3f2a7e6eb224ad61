// Templates, template sets and road strings: sections built from them, interpolation between two
// templates, and the order and range rules.
#include <gtest/gtest.h>

#include <cmath>

#include "svymath/road/road_string.h"
#include "svymath/road/xs_sf.h"

namespace {

// Two lanes with 2 % crossfall and shoulders at 4 %, from the centre line.
CCrossSectTemplate twoLane(double laneWidth, double shoulderWidth) {
  CCrossSectTemplate t(L"two lane");
  const double lane = -0.02 * laneWidth;
  const double shoulder = lane - 0.04 * shoulderWidth;
  EXPECT_TRUE(t.addPoint(L"SH", laneWidth + shoulderWidth, shoulder, 3));
  EXPECT_TRUE(t.addPoint(L"CL", 0.0, 0.0, 1));
  EXPECT_TRUE(t.addPoint(L"EP", -laneWidth, lane, 2));
  EXPECT_TRUE(t.addPoint(L"EP", laneWidth, lane, 2));
  EXPECT_TRUE(t.addPoint(L"SH", -laneWidth - shoulderWidth, shoulder, 3));
  EXPECT_FALSE(t.addPoint(L"X", NAN, 0.0));
  t.setSideSlopes(true, 2.0, -3.0);
  t.setSideSlopes(false, 2.0, -3.0);
  return t;
}

TEST(CrossSectTemplate, SectionAtACentreLineElevation) {
  const CCrossSectTemplate t = twoLane(3.5, 1.5);
  ASSERT_EQ(t.getNumOfPoints(), 5);
  EXPECT_EQ(t.getPoint(0)->offset, -5.0);
  CEditableRoadCrossSection section(0.0, 250.0, false);
  ASSERT_TRUE(t.fillSection(250.0, section));
  const struct {
    double offset, elevation;
  } cases[] = {{0.0, 250.0}, {-1.75, 249.965}, {3.5, 249.93}, {4.25, 249.9}, {-4.999, 249.87004}};
  for (const auto& c : cases) {
    double z = 0.0;
    ASSERT_TRUE(section.getElevationAtOffs(c.offset, z)) << c.offset;
    EXPECT_NEAR(z, c.elevation, 1e-11) << c.offset;
  }
  const CRoadCrossSectionSlope right = t.getSlope(section, true);
  double offset = 0.0;
  // Fill 3:1 from the shoulder edge (5, 249.87) down to ground at 248.87.
  EXPECT_TRUE(right.getCatchPointOffset(248.87, offset) && std::fabs(offset - 8.0) < 1e-9);
  CEditableRoadCrossSection empty(0.0);
  EXPECT_FALSE(CCrossSectTemplate().fillSection(250.0, empty));
  EXPECT_FALSE(t.fillSection(NAN, empty));
}

TEST(TemplateSet, InterpolatesBetweenAssignments) {
  CXsSf set;
  CCrossSectTemplate wide = twoLane(5.5, 2.5);
  ASSERT_TRUE(wide.addPoint(L"KERB", 8.5, 0.1));  // only in the wide template
  wide.setSideSlopes(true, 4.0, NAN);
  ASSERT_TRUE(set.assignTemplate(200.0, wide));
  ASSERT_TRUE(set.assignTemplate(100.0, twoLane(3.5, 1.5)));
  EXPECT_FALSE(set.assignTemplate(NAN, wide));
  ASSERT_EQ(set.getNumOfAssignments(), 2);
  EXPECT_EQ(set.getAssignmentChainage(0), 100.0);
  // Chainage, then the right edge of pavement and shoulder (offset, relative height) and the right cut slope.
  const struct {
    double chainage, epOffset, epHeight, shOffset, shHeight, cut;
    int points;
  } cases[] = {
      {50.0, 3.5, -0.07, 5.0, -0.13, 2.0, 5},  {100.0, 3.5, -0.07, 5.0, -0.13, 2.0, 5},
      {150.0, 4.5, -0.09, 6.5, -0.17, 3.0, 5}, {175.0, 5.0, -0.10, 7.25, -0.19, 3.5, 5},
      {200.0, 5.5, -0.11, 8.0, -0.21, 4.0, 6}, {900.0, 5.5, -0.11, 8.0, -0.21, 4.0, 6},
  };
  for (const auto& c : cases) {
    CCrossSectTemplate at;
    ASSERT_TRUE(set.getTemplateAtChainage(c.chainage, at));
    ASSERT_EQ(at.getNumOfPoints(), c.points) << c.chainage;
    const TXsTemplatePoint& ep = *at.getPoint(3);
    const TXsTemplatePoint& sh = *at.getPoint(4);
    EXPECT_NEAR(ep.offset, c.epOffset, 1e-12);
    EXPECT_NEAR(ep.height, c.epHeight, 1e-12);
    EXPECT_NEAR(sh.offset, c.shOffset, 1e-12);
    EXPECT_NEAR(sh.height, c.shHeight, 1e-12);
    EXPECT_NEAR(at.getCutRunRise(true), c.cut, 1e-12) << c.chainage;
    // The section filled directly agrees with the interpolated template.
    CEditableRoadCrossSection section(c.chainage, 10.0, false);
    ASSERT_TRUE(set.fillSection(c.chainage, 10.0, section));
    EXPECT_EQ(section.getNumOfPoints(), c.points);
    EXPECT_NEAR(section.getPointAtIndex(4)->getElevation(), 10.0 + c.shHeight, 1e-12);
  }
  // The fill slope exists in only one of the two: the earlier one's holds.
  double cut = 0.0, fill = 0.0;
  ASSERT_TRUE(set.getSideSlopesAtChainage(150.0, true, cut, fill));
  EXPECT_EQ(fill, -3.0);
  // A second assignment at (nearly) the same chainage replaces the first.
  ASSERT_TRUE(set.assignTemplate(200.0004, twoLane(3.5, 1.5)));
  EXPECT_EQ(set.getNumOfAssignments(), 2);
  EXPECT_EQ(set.getTemplate(1)->getNumOfPoints(), 5);
  EXPECT_TRUE(set.removeAssignment(0) && !set.removeAssignment(5));
  set.removeAll();
  CCrossSectTemplate at;
  EXPECT_FALSE(set.getTemplateAtChainage(150.0, at));
}

TEST(RoadStrings, SectionsFromStrings) {
  CRoadString edge(L"EP", 2);
  ASSERT_TRUE(edge.addVertex(0.0, 3.5, 100.0));
  ASSERT_TRUE(edge.addVertex(100.0, 5.5, 101.0));
  EXPECT_FALSE(edge.addVertex(50.0, 4.0, 100.0));
  EXPECT_FALSE(edge.addVertex(150.0, NAN, 100.0));
  CRoadString centre(L"CL", 1);
  ASSERT_TRUE(centre.addVertex(20.0, 0.0, 100.2));
  ASSERT_TRUE(centre.addVertex(80.0, 0.0, 101.4));
  CRoadStringSet set;
  set.addString(edge);
  set.addString(centre);
  ASSERT_EQ(set.getNumOfStrings(), 2);
  const struct {
    double chainage;
    int points;
    double edgeOffset, edgeHeight;
  } cases[] = {{0.0, 1, 3.5, 100.0}, {50.0, 2, 4.5, 100.5}, {80.0, 2, 5.1, 100.8}, {100.0, 1, 5.5, 101.0}};
  for (const auto& c : cases) {
    CEditableRoadCrossSection section(c.chainage);
    ASSERT_TRUE(set.fillSection(c.chainage, section));
    ASSERT_EQ(section.getNumOfPoints(), c.points) << c.chainage;
    const CRoadCrossSectPoint& p = *section.getRightMostPoint();
    EXPECT_TRUE(p.getName() == L"EP" && p.getFeatureIndex() == 2u);
    EXPECT_NEAR(p.getOffset(), c.edgeOffset, 1e-12);
    EXPECT_NEAR(p.getElevation(), c.edgeHeight, 1e-12);
  }
  CEditableRoadCrossSection section(120.0);
  EXPECT_FALSE(set.fillSection(120.0, section));
  EXPECT_EQ(set.findString(L"CL")->getNumOfVertices(), 2);
}

}  // namespace
