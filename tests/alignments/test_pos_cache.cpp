// Position caches: every chord within the deviation of the curve (checked at the chord midpoints against the
// alignment), every sample on the alignment, the transition points present, a rebuild after an edit, and the
// failures (no positive deviation, a deviation too small to sample, chainages outside the range).
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "alignment_test_support.h"
#include "svymath/alignments/alnt_pair.h"
#include "svymath/alignments/pos_cache.h"
#include "svymath/alignments/vertical_element.h"

namespace {

// Grade +2 % for 100 m, a crest parabola to -3 % over 400 m, then -3 % on past the horizontal's end.
void appendProfile(CHorzAndVertAlnt& pair) {
  CVerticalElement grade, crest, fall;
  grade.setStraight(100.0, 2.0);
  crest.setParabola(400.0, 2.0, -3.0);
  fall.setStraight(5000.0, -3.0);
  EXPECT_TRUE(pair.appendElement(grade) && pair.appendElement(crest) && pair.appendElement(fall));
}

CHorzAndVertAlnt makePair(const CAlntH& horizontal) {
  CHorzAndVertAlnt pair;
  pair.setStartPos(horizontal.getStartPosN(), horizontal.getStartPosE(), 300.0);
  pair.setStartChainageInM(horizontal.getStartChainageInM());
  for (int i = 0; i < horizontal.getNumOfHes(); ++i) EXPECT_TRUE(pair.appendElement(*horizontal.getHe(i)));
  appendProfile(pair);
  return pair;
}

// Rounding of survey coordinates and of the chord arithmetic.
constexpr double kSlack = 1e-8;

class PosCacheDeviation : public ::testing::TestWithParam<double> {};

TEST_P(PosCacheDeviation, ChordsStayWithinTheDeviationOfThePlanCurve) {
  const double deviation = GetParam();
  const CAlntH alignment = alnt_test::mixedAlignment(7, 4);
  CAlnt2dPosCache cache(alignment, deviation);
  const auto& positions = cache.getPositions();
  ASSERT_GT(positions.size(), 10u);
  double worst = 0.0;
  for (std::size_t i = 0; i < positions.size(); ++i) {
    const TAlntCachePos& p = positions[i];
    double north = 0.0, east = 0.0;
    ASSERT_TRUE(alignment.getPosNeAtChain(p.chainage, north, east));
    EXPECT_LT(alnt_test::dist(C2dPos(north, east), C2dPos(p.north, p.east)), kSlack) << p.chainage;
    if (i == 0) continue;
    const TAlntCachePos& q = positions[i - 1];
    ASSERT_GT(p.chainage, q.chainage);
    double chainage = 0.0, offset = 0.0;
    ASSERT_TRUE(alignment.FindChainageAndOffset(0.5 * (p.north + q.north), 0.5 * (p.east + q.east), chainage, offset));
    worst = std::max(worst, std::fabs(offset));
  }
  EXPECT_LE(worst, deviation + kSlack);
  // The sampling is not wastefully fine: some chord uses a good part of the allowance.
  EXPECT_GT(worst, 0.25 * deviation);
}

TEST_P(PosCacheDeviation, ChordsStayWithinTheDeviationOfTheProfile) {
  const double deviation = GetParam();
  const CHorzAndVertAlnt pair = makePair(alnt_test::mixedAlignment(3, 2));
  CAlntHtPosCache cache(pair.getAlntVes(), deviation);
  const auto& heights = cache.getPositions();
  ASSERT_GT(heights.size(), 3u);
  for (std::size_t i = 1; i < heights.size(); ++i) {
    const double middle = 0.5 * (heights[i].chainage + heights[i - 1].chainage);
    double height = 0.0, cached = 0.0;
    ASSERT_TRUE(pair.getAlntVes().getHeightAtChain(middle, height) && cache.getHeightAtChain(middle, cached));
    EXPECT_LE(std::fabs(height - cached), deviation + kSlack) << middle;
  }
}

INSTANTIATE_TEST_SUITE_P(Deviations, PosCacheDeviation, ::testing::Values(0.001, 0.01, 0.25));

TEST(PosCache, EveryElementStartAndEndIsASampleMarkedAsAJoint) {
  const CAlntH alignment = alnt_test::mixedAlignment(11, 3);
  CAlnt2dPosCache cache(alignment, 0.005);
  const auto& positions = cache.getPositions();
  for (int i = 0; i < alignment.getNumOfHes(); ++i) {
    double start = 0.0, end = 0.0;
    ASSERT_TRUE(alignment.getHe(i)->getStartChainageInM(start) && alignment.getHe(i)->getFinalChainageInM(end));
    for (double chainage : {start, end}) {
      const auto at = std::find_if(positions.begin(), positions.end(),
                                   [&](const TAlntCachePos& p) { return p.chainage == chainage; });
      ASSERT_NE(at, positions.end()) << i << " " << chainage;
      EXPECT_TRUE(at->atJoint);
    }
  }
  const auto joints = std::count_if(positions.begin(), positions.end(), [](const TAlntCachePos& p) { return p.atJoint; });
  EXPECT_EQ(joints, alignment.getNumOfHes() + 1);
}

TEST(PosCache, RebuildsAfterAnEdit) {
  CAlntH alignment = alnt_test::mixedAlignment(5, 1);
  CAlnt2dPosCache cache(alignment, 0.01);
  double endBefore = 0.0, north = 0.0, east = 0.0;
  ASSERT_TRUE(alignment.getFinalChainageInM(endBefore) && cache.getPosNeAtChain(endBefore, north, east));
  EXPECT_TRUE(cache.isCurrent());
  ASSERT_TRUE(alignment.appendElement(alnt_test::arc(200.0, 400.0, false)));
  EXPECT_FALSE(cache.isCurrent());
  double end = 0.0, expectedN = 0.0, expectedE = 0.0;
  ASSERT_TRUE(alignment.getFinalChainageInM(end) && alignment.getPosNeAtChain(end, expectedN, expectedE));
  ASSERT_TRUE(cache.getPosNeAtChain(end, north, east));
  EXPECT_LT(alnt_test::dist(C2dPos(north, east), C2dPos(expectedN, expectedE)), kSlack);
  // Moving the start moves every sample; a changed deviation resamples too.
  const std::size_t count = cache.getNumOfPositions();
  alignment.setStartPos(alnt_test::kNorth0 + 10.0, alnt_test::kEast0, 0.0);
  ASSERT_TRUE(cache.getPosNeAtChain(alignment.getStartChainageInM(), north, east));
  EXPECT_NEAR(north, alnt_test::kNorth0 + 10.0, kSlack);
  cache.setDeviation(0.0001);
  EXPECT_GT(cache.getNumOfPositions(), 3 * count);
}

TEST(PosCache, ThreeDimensionalSamplesJoinBothSamplings) {
  const CHorzAndVertAlnt pair = makePair(alnt_test::mixedAlignment(9, 2));
  const double deviation = 0.002;
  CAlnt3dPosCache cache3d(pair, deviation);
  CAlnt2dPosCache plan(pair, deviation);
  CAlntHtPosCache heights(pair.getAlntVes(), deviation);
  const auto& positions = cache3d.getPositions();
  double end = 0.0;
  ASSERT_TRUE(pair.getFinalChainageInM(end));
  EXPECT_EQ(positions.front().chainage, pair.getStartChainageInM());
  EXPECT_NEAR(positions.back().chainage, end, 1e-9);
  // Every plan sample and every profile sample of the range is a 3-D sample.
  for (const auto* source : {&plan.getPositions(), &heights.getPositions()}) {
    for (const TAlntCachePos& s : *source) {
      if (s.chainage > end + 1e-9) continue;
      EXPECT_TRUE(std::any_of(positions.begin(), positions.end(),
                              [&](const TAlntCachePos& p) { return p.chainage == s.chainage; }))
          << s.chainage;
    }
  }
  for (const TAlntCachePos& p : positions) {
    TCoords exact;
    ASSERT_TRUE(pair.getPosAtChain(p.chainage, exact));
    EXPECT_LT(alnt_test::dist(C2dPos(exact.north, exact.east), C2dPos(p.north, p.east)), kSlack);
    EXPECT_NEAR(exact.height, p.height, kSlack);
  }
  double north = 0.0, east = 0.0, height = 0.0;
  EXPECT_TRUE(cache3d.getPosAtChain(0.5 * (positions[3].chainage + positions[4].chainage), north, east, height));
}

TEST(PosCache, FailsWithoutAUsableDeviationOrOutsideItsRange) {
  const CAlntH alignment = alnt_test::mixedAlignment(1, 2);
  double north = 0.0, east = 0.0;
  const double nan = std::numeric_limits<double>::quiet_NaN();
  for (double deviation : {0.0, -0.01, nan, std::numeric_limits<double>::infinity(), 1e-15}) {
    CAlnt2dPosCache cache(alignment, deviation);
    EXPECT_FALSE(cache.getPosNeAtChain(alignment.getStartChainageInM(), north, east)) << deviation;
    EXPECT_TRUE(cache.getPositions().empty());
  }
  CAlnt2dPosCache cache(alignment, 0.01);
  double end = 0.0;
  ASSERT_TRUE(alignment.getFinalChainageInM(end));
  for (double chainage : {alignment.getStartChainageInM() - 0.01, end + 0.01, nan}) {
    north = east = -1.0;
    EXPECT_FALSE(cache.getPosNeAtChain(chainage, north, east));
    EXPECT_EQ(north, -1.0);
  }
  CAlntH empty;
  CAlnt2dPosCache none(empty, 0.01);
  EXPECT_FALSE(none.update());
}

}  // namespace
