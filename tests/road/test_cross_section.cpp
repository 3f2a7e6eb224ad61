// Cross-sections: point lookup by offset (with the two walks' asymmetry), heights and slope ratios on the
// chain, plan positions across the centre line, ownership of the points, and the cache version.
#include <gtest/gtest.h>

#include <cmath>
#include <memory>

#include "svymath/road/cross_section.h"

namespace {

// A crowned carriageway at elevation 100: edges at +-10 (99.5), lane lines at +-3.5 (99.93), the crown at 0.
std::unique_ptr<CEditableRoadCrossSection> crowned() {
  auto section = std::make_unique<CEditableRoadCrossSection>(1250.0, 100.0, false);
  const struct {
    double offset, elevation;
    const char* name;
  } points[] = {
      {3.5, 99.93, "LL"}, {-10.0, 99.5, "EDGE"}, {0.0, 100.0, "CL"}, {10.0, 99.5, "EDGE"}, {-3.5, 99.93, "LL"}};
  unsigned id = 1;
  for (const auto& p : points) EXPECT_TRUE(section->addPoint(p.offset, p.elevation, p.name, id++));
  return section;
}

double offsetOf(const CRoadCrossSectPoint* p) { return p != nullptr ? p->getOffset() : NAN; }

TEST(CrossSection, PointLookupByOffset) {
  const auto section = crowned();
  ASSERT_EQ(section->getNumOfPoints(), 5);
  // NaN stands for null. getLeftOfOffset finds a point exactly at the offset walking from the right end
  // (3.5, nearer the right) but passes it over walking from the left end (-3.5, -10); getRightOfOffset
  // mirrors it (3.5 passed over for 10).
  const struct {
    double offset, left, right;
  } cases[] = {{-12.0, NAN, -10.0}, {-10.0, NAN, -10.0}, {-3.5, -10.0, -3.5}, {-1.0, -3.5, 0.0},
               {0.0, 0.0, 0.0},     {3.5, 3.5, 10.0},    {10.0, 10.0, NAN},   {12.0, 10.0, NAN}};
  for (const auto& c : cases) {
    const double left = offsetOf(section->getLeftOfOffset(c.offset));
    const double right = offsetOf(section->getRightOfOffset(c.offset));
    EXPECT_TRUE(left == c.left || (std::isnan(left) && std::isnan(c.left))) << c.offset << " " << left;
    EXPECT_TRUE(right == c.right || (std::isnan(right) && std::isnan(c.right))) << c.offset << " " << right;
  }
  EXPECT_EQ(section->getLeftOfOffset(NAN), nullptr);
  EXPECT_EQ(offsetOf(section->findCenterPoint()), 0.0);
  EXPECT_EQ(offsetOf(section->findPointWithId(4)), 10.0);
  EXPECT_EQ(offsetOf(section->findPointFromNameAndOffs(L"EDGE", 4.0)), 10.0);
  EXPECT_EQ(offsetOf(section->findPointFromNameAndOffs(L"LL", -2.0)), -3.5);
  EXPECT_EQ(section->findPointFromNameAndOffs(L"KERB", 0.0), nullptr);
  EXPECT_EQ(offsetOf(section->getPointAtIndex(1)), -3.5);
  EXPECT_EQ(section->getPointAtIndex(5), nullptr);
}

TEST(CrossSection, HeightsAndSlopeRatiosOnTheChain) {
  const auto section = crowned();
  // Hand-computed: linear between the neighbours, rise over run of the segment holding the offset.
  const struct {
    double offset, elevation, ratio;
  } cases[] = {{-10.0 + 3.25, 99.715, 0.43 / 6.5},
               {-2.0, 99.96, 0.02},
               {0.0, 100.0, -0.02},
               {1.75, 99.965, -0.02},
               {9.0, 99.5 + 0.43 / 6.5, -0.43 / 6.5}};
  for (const auto& c : cases) {
    double z = 0.0, ratio = 0.0;
    ASSERT_TRUE(section->getElevationAtOffs(c.offset, z, &ratio)) << c.offset;
    EXPECT_NEAR(z, c.elevation, 1e-12) << c.offset;
    EXPECT_NEAR(ratio, c.ratio, 1e-12) << c.offset;
    EXPECT_TRUE(section->getSlopeRatioAtOffset(c.offset, ratio) && std::fabs(ratio - c.ratio) < 1e-12);
  }
  double z = -1.0;
  // The rightmost point has no right neighbour, so its own offset has no segment.
  EXPECT_FALSE(section->getElevationAtOffs(10.0, z));
  EXPECT_FALSE(section->getElevationAtOffs(-10.5, z));
  EXPECT_EQ(z, -1.0);
  // Beyond the chain, the outermost segment continued.
  double ratio = 0.0;
  ASSERT_TRUE(section->getElevationAtOffsSlope(12.0, z, ratio));
  EXPECT_NEAR(z, 99.5 - 2.0 * 0.43 / 6.5, 1e-12);
  EXPECT_NEAR(ratio, -0.43 / 6.5, 1e-14);
}

TEST(CrossSection, SlopeRatioOfPointPairs) {
  CRoadCrossSectOffsPoint a(2.0, 10.0);
  const struct {
    double offset, elevation, ratio;
  } cases[] = {{4.0, 10.5, 0.25},  {0.0, 10.5, -0.25}, {2.0, 11.0, 1.0e6},
               {2.0, 9.0, -1.0e6}, {7.0, 10.0, 0.0},   {2.0, 10.0 + 1e-13, 0.0}};
  for (const auto& c : cases) {
    CRoadCrossSectOffsPoint b(c.offset, c.elevation);
    EXPECT_DOUBLE_EQ(a.getSlopeRatio(b), c.ratio) << c.offset << " " << c.elevation;
  }
  // The line through two points, both ways.
  CRoadCrossSectOffsPoint b(6.0, 12.0);
  EXPECT_DOUBLE_EQ(a.getElevationFromSurface(4.0, b), 11.0);
  EXPECT_DOUBLE_EQ(a.calcOffsetFromSurface(11.0, b), 4.0);
  EXPECT_TRUE(std::isnan(a.calcOffsetFromSurface(11.0, CRoadCrossSectOffsPoint(6.0, 10.0))));
}

TEST(CrossSection, PlanPositionsAcrossTheCentreLine) {
  auto section = crowned();
  const double n0 = 5000000.0, e0 = 500000.0;
  const struct {
    double azimuth, offset, dn, de;
  } cases[] = {
      {0.0, 10.0, 0.0, 10.0}, {90.0, 10.0, -10.0, 0.0}, {90.0, -3.5, 3.5, 0.0}, {210.0, 2.0, 1.0, -std::sqrt(3.0)}};
  for (const auto& c : cases) {
    section->setCenterLinePos(C2dPos(n0, e0), false);
    section->setCenterLineAzimuth(CMathAngle(c.azimuth));
    const C2dPos p = section->getPosAtOffset(c.offset);
    EXPECT_NEAR(p.north() - n0, c.dn, 1e-9);
    EXPECT_NEAR(p.east() - e0, c.de, 1e-9);
    // The along vector is the direction of travel; the across vector is a quarter turn to the right of it.
    const C2dPos& along = section->getAlongVector();
    const C2dPos& across = section->getAcrossVector();
    EXPECT_NEAR(along.north() * across.north() + along.east() * across.east(), 0.0, 1e-15);
    EXPECT_NEAR(along.north() * across.east() - along.east() * across.north(), 1.0, 1e-15);
  }
  const C2dPos edge = section->getRightMostPoint()->getPosition();
  const C2dPos expected = section->getPosAtOffset(10.0);
  EXPECT_TRUE(edge.north() == expected.north() && edge.east() == expected.east());
}

TEST(CrossSection, OwnsItsPointsAndVersionsItsContent) {
  auto section = crowned();
  unsigned version = section->getCacheVersion();
  const auto changed = [&] {
    const bool moved = section->getCacheVersion() != version;
    version = section->getCacheVersion();
    return moved;
  };
  // Detaching the outermost points (by deleting them) keeps the end pointers on the chain.
  delete section->getLeftMostPointEditable();
  EXPECT_TRUE(changed());
  EXPECT_EQ(offsetOf(section->getLeftMostPoint()), -3.5);
  EXPECT_EQ(section->getLeftMostPoint()->getLeft(), nullptr);
  CRoadCrossSectPoint* right = section->getLeftMostPointEditable();
  while (right->getRightEditable() != nullptr) right = right->getRightEditable();
  delete right;
  EXPECT_EQ(offsetOf(section->getRightMostPoint()), 3.5);
  EXPECT_EQ(section->getRightMostPoint()->getRight(), nullptr);
  EXPECT_EQ(section->getNumOfPoints(), 3);
  // Out-of-order or foreign points are refused and stay the caller's.
  CRoadCrossSectOffsPoint stray(0.5, 1.0);
  EXPECT_FALSE(section->addToLeft(stray));
  EXPECT_FALSE(section->addToRight(stray));
  EXPECT_FALSE(section->addPoint(NAN, 1.0));
  EXPECT_TRUE(section->addToRight(*new CRoadCrossSectOffsPoint(6.0, 99.8)));
  EXPECT_TRUE(changed());
  section->setClElevation(101.0, true);
  EXPECT_TRUE(changed() && section->isClElevationExtrapolated());
  section->deleteAllPoints();
  EXPECT_TRUE(changed());
  EXPECT_FALSE(section->hasPoints());
  EXPECT_EQ(section->getRightMostPoint(), nullptr);
}

}  // namespace
