// The chainage iterator on a mixed pair: the transition points of both alignments with their kinds, the
// high and low points, the regular stations, sorting and the 1 mm merge.
#include <gtest/gtest.h>

#include <cmath>
#include <vector>

#include "alignment_test_support.h"
#include "svymath/alignments/alnt_pair.h"
#include "svymath/alignments/chainage_iterator.h"
#include "svymath/alignments/vertical_arc.h"
#include "svymath/alignments/vertical_element.h"

namespace {

// Tangent 100.0004 m, entry spiral 60, arc 120, exit spiral 60, tangent 150 from chainage 1000; a profile of
// +3 %, a crest parabola to -2 % (190 m), -2 %, a sag circle to +1 % (R 4000), +1 %.
CHorzAndVertAlnt mixedPair() {
  CHorzAndVertAlnt pair;
  pair.setStartPos(alnt_test::kNorth0, alnt_test::kEast0, 120.0);
  pair.setStartChainageInM(1000.0);
  pair.setChainageIntervalInM(50.0);
  EXPECT_TRUE(pair.appendElement(alnt_test::tangent(100.0004, 45.0)));
  EXPECT_TRUE(pair.appendElement(alnt_test::spiral(60.0, 400.0, false, true)));
  EXPECT_TRUE(pair.appendElement(alnt_test::arc(120.0, 400.0, false)));
  EXPECT_TRUE(pair.appendElement(alnt_test::spiral(60.0, 400.0, false, false)));
  EXPECT_TRUE(pair.appendElement(alnt_test::tangent(150.0)));
  CVerticalElement e;
  e.setStraight(80.0, 3.0);
  EXPECT_TRUE(pair.appendElement(e));
  e.setParabola(190.0, 3.0, -2.0);
  EXPECT_TRUE(pair.appendElement(e));
  e.setStraight(50.0, -2.0);
  EXPECT_TRUE(pair.appendElement(e));
  CAlntVeArc sag;
  sag.setGradesAndR(-2.0, 1.0, 4000.0);
  EXPECT_TRUE(pair.appendElement(sag));
  e.setStraight(100.0, 1.0);
  EXPECT_TRUE(pair.appendElement(e));
  return pair;
}

const TChainagePoint* pointWith(const std::vector<TChainagePoint>& points, unsigned kind, int occurrence = 0) {
  for (const TChainagePoint& p : points) {
    if ((p.kinds & kind) != 0u && occurrence-- == 0) return &p;
  }
  return nullptr;
}

TEST(ChainageIterator, YieldsTheTransitionPointsOfAMixedPair) {
  const CHorzAndVertAlnt pair = mixedPair();
  std::vector<TChainagePoint> points;
  for (CChainageIteratorBase it(pair); !it.isDone(); it.next()) points.push_back(it.current());
  ASSERT_GT(points.size(), 10u);
  for (std::size_t i = 1; i < points.size(); ++i) EXPECT_GE(points[i].chainage - points[i - 1].chainage, 0.001);
  double end = 0.0;
  ASSERT_TRUE(pair.getFinalChainageInM(end));
  EXPECT_TRUE(points.front().chainage == 1000.0 && (points.front().kinds & eChainageRangeStart));
  EXPECT_TRUE(points.back().chainage == end && (points.back().kinds & eChainageRangeEnd));
  // Each transition at its element's start (the horizontal elements' own chainages).
  const struct {
    unsigned kind;
    int element;
  } transitions[] = {{eChainageTS, 1}, {eChainageSC, 2}, {eChainageCS, 3}, {eChainageST, 4}};
  for (const auto& t : transitions) {
    const TChainagePoint* p = pointWith(points, t.kind);
    double start = 0.0;
    ASSERT_TRUE(p != nullptr && pair.getHe(t.element)->getStartChainageInM(start));
    EXPECT_EQ(p->chainage, start);
    EXPECT_NE(p->kinds & eChainageHorzJoint, 0u);
  }
  // The vertical curves: crest parabola 1080-1270 with its high point, the sag circle from 1320.
  const TChainagePoint* curveStart = pointWith(points, eChainageVertCurveStart);
  const TChainagePoint* curveEnd = pointWith(points, eChainageVertCurveEnd);
  ASSERT_TRUE(curveStart && curveEnd);
  EXPECT_NEAR(curveStart->chainage, 1080.0, 1e-9);
  EXPECT_NEAR(curveEnd->chainage, 1270.0, 1e-9);
  ASSERT_TRUE(pointWith(points, eChainageVertCurveStart, 1));
  EXPECT_NEAR(pointWith(points, eChainageVertCurveStart, 1)->chainage, 1320.0, 1e-9);
  const TChainagePoint* high = pointWith(points, eChainageHighPoint);
  const TChainagePoint* low = pointWith(points, eChainageLowPoint);
  ASSERT_TRUE(high && low);
  EXPECT_NEAR(high->chainage, 1080.0 + 190.0 * 3.0 / 5.0, 1e-9);  // where the grade is zero
  double g = 1.0;
  ASSERT_TRUE(pair.getGradeAtChainage(low->chainage, g));
  EXPECT_NEAR(g, 0.0, 1e-9);
  // Every 50 m station; the one at 1100 merged with the TS 0.4 mm after it, keeping the TS chainage.
  for (double s = 1000.0; s <= end; s += 50.0) {
    bool found = false;
    for (const TChainagePoint& p : points) found = found || ((p.kinds & eChainageStation) && std::fabs(p.chainage - s) < 0.001);
    EXPECT_TRUE(found) << s;
  }
  const TChainagePoint* ts = pointWith(points, eChainageTS);
  EXPECT_TRUE(ts->chainage == 1100.0004 && (ts->kinds & eChainageStation));
}

TEST(ChainageIterator, RangesAndAbsurdInput) {
  const CHorzAndVertAlnt pair = mixedPair();
  const CChainageIteratorBase part(pair, 1105.0, 1170.0);
  std::vector<double> chainages;
  for (const TChainagePoint& p : part.getPoints()) chainages.push_back(p.chainage);
  ASSERT_EQ(chainages.size(), 4u);  // the ends, the station at 1150 and the SC
  EXPECT_EQ(chainages[1], 1150.0);
  EXPECT_TRUE(CChainageIteratorBase(pair, 10.0, 5.0).isDone());
  EXPECT_TRUE(CChainageIteratorBase(pair, NAN, 5.0).isDone());
  CHorzAndVertAlnt noInterval = pair;
  noInterval.setChainageIntervalInM(0.0);
  const CChainageIteratorBase withoutStations(noInterval);
  EXPECT_FALSE(withoutStations.isDone());
  for (const TChainagePoint& p : withoutStations.getPoints()) EXPECT_EQ(p.kinds & eChainageStation, 0u);
}

}  // namespace
