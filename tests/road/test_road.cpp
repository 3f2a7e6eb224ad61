// The road over an alignment pair and a template set: 3-D positions at chainage and offset against the
// pair's plan position and hand-computed section heights, slopes in percent, sections with their centre
// line and extrapolation flags, the pair rule for the end, copies that share their parts, roads on strings,
// generated strings, and parallel readers.
#include <gtest/gtest.h>

#include <cmath>
#include <future>
#include <memory>
#include <vector>

#include "alignments/alignment_test_support.h"
#include "svymath/alignments/alnt_pair.h"
#include "svymath/alignments/vertical_element.h"
#include "svymath/road/road_base_impl.h"

namespace {

// Horizontal: tangent 200 (azimuth 30), arc 100 (R 500 right), tangent 200 from chainage 1000 (ends at 1500);
// profile +2 % from height 300 for `profileLength` metres. The template: centre line, edges of pavement at
// +-4 m 0.1 m down (2.5 %), shoulders at +-6 m 0.18 m down (4 %); cut 2:1 and fill 3:1 on both sides.
struct TRoad {
  CHorzAndVertAlnt pair;
  CXsSf templates;
  CRoadBaseImpl road;

  explicit TRoad(double profileLength = 600.0) {
    pair.setStartChainageInM(1000.0);
    pair.setStartPos(alnt_test::kNorth0, alnt_test::kEast0, 300.0);
    const CAlntHeSegment first = alnt_test::tangent(200.0, 30.0), last = alnt_test::tangent(200.0);
    const CAlntHeArc curve = alnt_test::arc(100.0, 500.0, true);
    for (const CAlntHe* element : std::initializer_list<const CAlntHe*>{&first, &curve, &last}) {
      EXPECT_TRUE(pair.appendElement(*element));
    }
    EXPECT_TRUE(pair.appendElement(CVerticalElement(1000.0, 300.0, profileLength, 2.0)));
    CCrossSectTemplate t(L"rural");
    for (double side : {-1.0, 1.0}) {
      t.addPoint(L"EP", 4.0 * side, -0.1, 2);
      t.addPoint(L"SH", 6.0 * side, -0.18, 3);
      t.setSideSlopes(side > 0.0, 2.0, -3.0);
    }
    t.addPoint(L"CL", 0.0, 0.0, 1);
    EXPECT_TRUE(templates.assignTemplate(1000.0, t));
    road.setAlignments(pair);
    road.setXsSf(&templates);
  }
};

double clHeight(double chainage) { return 300.0 + 0.02 * (chainage - 1000.0); }

TEST(Road, PositionsAndHeightsAtChainageAndOffset) {
  const TRoad r;
  const struct {
    double chainage, offset, relHeight, slopePercent;
  } cases[] = {{1000.0, 0.0, 0.0, -2.5},   {1100.0, -2.0, -0.05, 2.5}, {1250.0, 3.0, -0.075, -2.5},
               {1350.0, 5.0, -0.14, -4.0}, {1499.0, -5.5, -0.16, 4.0}, {1200.0, 9.0, -0.18, 0.0},
               {1200.0, 6.0, -0.18, 0.0},  {1200.0, -6.0, -0.18, 0.0}, {1200.0, -30.0, -0.18, 0.0}};
  for (const auto& c : cases) {
    double n = 0.0, e = 0.0, h = 0.0, slope = 99.0;
    ASSERT_TRUE(r.road.get3DPosAtChainAndOffset(c.chainage, c.offset, n, e, h, true, &slope)) << c.chainage;
    double pn = 0.0, pe = 0.0;
    ASSERT_TRUE(r.pair.getPosAtChainAndOffset(c.chainage, c.offset, pn, pe));
    EXPECT_TRUE(n == pn && e == pe);
    EXPECT_NEAR(h, clHeight(c.chainage) + c.relHeight, 1e-9) << c.chainage << " " << c.offset;
    EXPECT_NEAR(slope, c.slopePercent, 1e-9) << c.chainage << " " << c.offset;
    // Round trip: the plan position maps back to the chainage and offset.
    double chainage = 0.0, offset = 0.0;
    ASSERT_TRUE(r.pair.FindChainageAndOffset(n, e, chainage, offset));
    EXPECT_NEAR(chainage, c.chainage, 1e-6);
    EXPECT_NEAR(offset, c.offset, 1e-6);
    // Without the cross-section: the centre-line height at any offset, level.
    ASSERT_TRUE(r.road.getHtAtChainAndOffset(c.chainage, c.offset, h, false, &slope));
    EXPECT_NEAR(h, clHeight(c.chainage), 1e-9);
    EXPECT_EQ(slope, 0.0);
  }
  double n = 0.0, e = 0.0, h = 0.0;
  EXPECT_FALSE(r.road.get3DPosAtChainAndOffset(1600.0, 0.0, n, e, h, true));  // off the horizontal alignment
  EXPECT_FALSE(r.road.getHtAtChainAndOffset(1200.0, NAN, h, true));
}

TEST(Road, SectionsCarryTheCentreLine) {
  const TRoad r;
  const struct {
    double chainage;
    bool planExtrapolated, heightExtrapolated;
  } cases[] = {
      {1000.0, false, false}, {1270.0, false, false}, {1550.0, true, false}, {1650.0, true, true}, {990.0, true, true}};
  for (const auto& c : cases) {
    CRoadCrossSection* raw = nullptr;
    const bool inside = !c.planExtrapolated && !c.heightExtrapolated;
    EXPECT_EQ(r.road.getCrossSectionAtChainage(c.chainage, raw, false), inside) << c.chainage;
    delete raw;
    ASSERT_TRUE(r.road.getCrossSectionAtChainage(c.chainage, raw, true));
    const std::unique_ptr<CRoadCrossSection> section(raw);
    EXPECT_EQ(section->getChainage(), c.chainage);
    EXPECT_EQ(section->isClPosExtrapolated(), c.planExtrapolated);
    EXPECT_EQ(section->isClElevationExtrapolated(), c.heightExtrapolated);
    EXPECT_NEAR(section->getClElevation(), clHeight(c.chainage), 1e-9);
    double n = 0.0, e = 0.0, azimuth = 0.0;
    ASSERT_TRUE(r.pair.getPosNeAtChainExtr(c.chainage, n, e) && r.pair.getAzimuthAtChainExtr(c.chainage, azimuth));
    EXPECT_TRUE(section->getCenterLinePos().north() == n && section->getCenterLinePos().east() == e);
    EXPECT_NEAR(section->getAzimuth().getDeg(), azimuth, 1e-12);
    EXPECT_EQ(section->getNumOfPoints(), 5);
    // A point's plan position is the pair's position at its offset.
    double pn = 0.0, pe = 0.0;
    ASSERT_TRUE(r.pair.getPosNeAtChainAndOffsetExtr(c.chainage, 6.0, pn, pe));
    const C2dPos shoulder = section->getRightMostPoint()->getPosition();
    EXPECT_LT(std::hypot(shoulder.north() - pn, shoulder.east() - pe), 1e-8);
  }
}

TEST(Road, EndsWithTheShorterAlignmentAndSharesItsParts) {
  TRoad r(400.0);
  double end = 0.0, length = 0.0;
  ASSERT_TRUE(r.road.getFinalChainageInM(end) && r.road.getHLengthInM(length));
  EXPECT_NEAR(end, 1400.0, 1e-9);
  EXPECT_NEAR(length, 500.0, 1e-9);
  EXPECT_EQ(r.road.getStartChainageInM(), 1000.0);
  EXPECT_EQ(r.road.distance2Chainage(25.0), 1025.0);
  r.road.setCorridorLeftOffset(-15.0);
  r.road.setChainageIntervalInM(20.0);
  const CRoadBaseImpl copy(r.road);
  CRoadBaseImpl assigned;
  EXPECT_FALSE(assigned.hasSurfaceDefinition() || assigned.hasCorridorLeftOffset());
  EXPECT_EQ(assigned.getChainageIntervalInM(), 100.0);
  assigned = r.road;
  for (const CRoadBaseImpl* road : {&copy, static_cast<const CRoadBaseImpl*>(&assigned)}) {
    EXPECT_EQ(road->getHAlnt(), &r.pair);
    EXPECT_EQ(road->getVAlnt(), &r.pair.getAlntVes());
    EXPECT_EQ(road->getXsSf(), &r.templates);
    EXPECT_EQ(&road->getHorzAlnt(), static_cast<const CHorzAlntBase*>(&r.pair));
    EXPECT_TRUE(road->hasCorridorLeftOffset() && road->getCorridorLeftOffset() == -15.0);
    EXPECT_FALSE(road->hasCorridorRightOffset());
    EXPECT_EQ(road->getChainageIntervalInM(), 20.0);
    EXPECT_EQ(road->getFirstHe(), r.pair.getFirstHe());
    EXPECT_EQ(road->getLastVe(), r.pair.getLastVe());
  }
  // An edit of the shared template set is seen by the copy.
  CCrossSectTemplate flat;
  flat.addPoint(L"CL", 0.0, 0.5);
  flat.addPoint(L"EP", 4.0, 0.5);
  r.templates.assignTemplate(1000.0, flat);
  double h = 0.0;
  ASSERT_TRUE(copy.getHtAtChainAndOffset(1100.0, 1.0, h, true));
  EXPECT_NEAR(h, clHeight(1100.0) + 0.5, 1e-9);
  r.road.clearCorridorLeftOffset();
  EXPECT_FALSE(r.road.hasCorridorLeftOffset());
  // Without a surface the road answers the centre-line height, and builds no section.
  r.road.setXsSf(nullptr);
  double slope = 1.0;
  CRoadCrossSection* section = nullptr;
  EXPECT_FALSE(r.road.getCrossSectionAtChainage(1100.0, section, true));
  EXPECT_TRUE(r.road.getHtAtChainAndOffset(1100.0, 3.0, h, true, &slope) && h == clHeight(1100.0) && slope == 0.0);
  // Without alignments every query fails quietly.
  const CRoadBaseImpl bare;
  double n = 0.0, e = 0.0;
  EXPECT_FALSE(bare.getFinalChainageInM(end) || bare.getHLengthInM(length) || bare.getPosNeAtChain(1.0, n, e) ||
               bare.getHtAtChain(1.0, h) || bare.get3DPosAtChainAndOffset(1.0, 0.0, n, e, h, true));
}

TEST(Road, StringsAsSurfaceAndGeneratedStrings) {
  TRoad r(500.0);
  r.road.setChainageIntervalInM(100.0);
  ASSERT_TRUE(r.road.generateStringCache());
  const CRoadStringSet& generated = r.road.getStringSetCache();
  // CL, and EP and SH on each side: a string keeps to its side.
  ASSERT_EQ(generated.getNumOfStrings(), 5);
  for (int i = 0; i < 5; ++i) {
    const CRoadString& line = *generated.getString(i);
    ASSERT_EQ(line.getNumOfVertices(), 6);  // 1000 to 1500 every 100
    for (int k = 0; k < 6; ++k) EXPECT_EQ(line.getVertex(k)->offset, line.getVertex(0)->offset);
  }
  // A road on the generated strings alone answers what the template road answers at the stations.
  CRoadBaseImpl onStrings;
  onStrings.setAlignments(r.pair);
  onStrings.setStringSet(&generated);
  EXPECT_TRUE(onStrings.hasSurfaceByStrings() && !onStrings.hasSurfaceByTemplates());
  for (double c : {1000.0, 1200.0, 1300.0, 1500.0}) {
    CRoadCrossSection* raw = nullptr;
    ASSERT_TRUE(onStrings.getCrossSectionAtChainage(c, raw, false)) << c;
    const std::unique_ptr<CRoadCrossSection> section(raw);
    const CRoadCrossSectPoint* cl = section->findCenterPoint();
    ASSERT_NE(cl, nullptr);
    EXPECT_NEAR(cl->getElevation(), clHeight(c), 1e-9);
  }
  r.road.clearStringSetCache();
  EXPECT_EQ(r.road.getStringSetCache().getNumOfStrings(), 0);
}

// Readers on several threads see what one reader sees (run under ThreadSanitizer in CI).
TEST(RoadConcurrency, ParallelReadersAgree) {
  const TRoad r;
  const auto heights = [&r] {
    std::vector<double> out;
    for (double c = 1000.0; c <= 1500.0; c += 3.7) {
      double h = NAN;
      r.road.getHtAtChainAndOffset(c, 2.5, h, true);
      out.push_back(h);
    }
    return out;
  };
  const std::vector<double> expected = heights();
  std::vector<std::future<std::vector<double>>> readers;
  for (int t = 0; t < 4; ++t) readers.push_back(std::async(std::launch::async, heights));
  for (auto& reader : readers) EXPECT_EQ(reader.get(), expected);
}

}  // namespace
