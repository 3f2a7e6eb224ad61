// The alignment pair: it ends at the shorter alignment, answers 3-D centre-line positions with their
// validity flags, offsets that invert through the point-to-chainage search, one start for both parts,
// and plan positions that stay on the horizontal alignment past the end of the profile.
#include <gtest/gtest.h>

#include <cmath>

#include "alignment_test_support.h"
#include "svymath/alignments/alnt_pair.h"
#include "svymath/alignments/vertical_element.h"

namespace {

using alnt_test::kEast0;
using alnt_test::kNorth0;

// Horizontal: tangent 200, arc 100 (R 500 right), tangent 200 from chainage 1000. Profile: +2 % for
// `profileLength` metres from height 300.
CHorzAndVertAlnt makePair(double profileLength) {
  CHorzAndVertAlnt pair;
  pair.setStartPos(kNorth0, kEast0, 300.0);
  pair.setStartChainageInM(1000.0);
  EXPECT_TRUE(pair.appendElement(alnt_test::tangent(200.0, 30.0)));
  EXPECT_TRUE(pair.appendElement(alnt_test::arc(100.0, 500.0, true)));
  EXPECT_TRUE(pair.appendElement(alnt_test::tangent(200.0)));
  CVerticalElement grade;
  grade.setStraight(profileLength, 2.0);
  if (profileLength > 0.0) {
    EXPECT_TRUE(pair.appendElement(grade));
  }
  return pair;
}

TEST(AlignmentPair, EndsAtTheShorterAlignment) {
  const struct {
    double profile, end;
  } cases[] = {{400.0, 1400.0}, {650.0, 1500.0}, {0.0, 1500.0}};
  for (const auto& c : cases) {
    double end = 0.0;
    ASSERT_TRUE(makePair(c.profile).getFinalChainageInM(end));
    EXPECT_NEAR(end, c.end, 1e-9);
  }
  CHorzAndVertAlnt empty;
  double end = -1.0;
  EXPECT_FALSE(empty.getFinalChainageInM(end));
  // A pair of a profile alone ends with the profile.
  CVerticalElement grade(0.0, 0.0, 50.0, 1.0);
  ASSERT_TRUE(empty.appendElement(grade));
  EXPECT_TRUE(empty.getFinalChainageInM(end) && end == 50.0);
}

TEST(AlignmentPair, CentreLinePositionsAndFlags) {
  const CHorzAndVertAlnt pair = makePair(400.0);
  const struct {
    double chainage;
    unsigned mask;
  } cases[] = {{1250.0, 7u}, {1450.0, 3u}, {1600.0, 0u}};
  for (const auto& c : cases) {
    TCoords p;
    p.mask = 0;
    EXPECT_EQ(pair.getPosAtChain(c.chainage, p), c.mask != 0u);
    EXPECT_EQ(p.mask, c.mask) << c.chainage;
    double n = 0.0, e = 0.0, h = 0.0;
    EXPECT_TRUE(!(c.mask & 1u) || (pair.getPosNeAtChain(c.chainage, n, e) && p.north == n && p.east == e));
    EXPECT_TRUE(!(c.mask & 4u) || (pair.getHtAtChain(c.chainage, h) && std::fabs(h - 305.0) < 1e-9));
  }
  TCoords start;
  pair.getStartPos(start);
  EXPECT_TRUE(start.north == kNorth0 && start.east == kEast0 && start.height == 300.0 && start.mask == 7u);
  // Set bits are kept: the flags are added, not replaced.
  TCoords p;
  p.mask = TCoords::kHeightValid;
  EXPECT_TRUE(pair.getPosAtChain(1450.0, p) && p.mask == 7u);
}

// A point laid off at a chainage and offset is found again at that chainage and offset.
TEST(AlignmentPair, OffsetPointsInvertThroughTheSearch) {
  const CHorzAndVertAlnt pair = makePair(500.0);
  for (double c = 1010.0; c < 1500.0; c += 37.0) {
    for (const double offset : {-12.5, 0.0, 7.25}) {
      TCoords p;
      p.mask = 0;
      ASSERT_TRUE(pair.getPosAtChainAndOffset(c, offset, p));
      EXPECT_EQ(p.mask, 7u);
      EXPECT_NEAR(p.height, 300.0 + 0.02 * (c - 1000.0), 1e-9);
      double chainage = 0.0, found = 0.0;
      ASSERT_TRUE(pair.FindChainageAndOffset(p.north, p.east, chainage, found));
      EXPECT_NEAR(chainage, c, 1e-6);
      EXPECT_NEAR(found, offset, 1e-6);
    }
  }
  double n = 0.0, e = 0.0;
  EXPECT_FALSE(pair.getPosAtChainAndOffset(1600.0, 1.0, n, e));  // off the horizontal alignment
}

// Past the profile's end the plan queries still follow the horizontal alignment to its own end.
TEST(AlignmentPair, PlanQueriesKeepTheHorizontalEnd) {
  const CHorzAndVertAlnt pair = makePair(300.0);
  double n1 = 0.0, e1 = 0.0, n2 = 0.0, e2 = 0.0, end = 0.0;
  bool extrapolated = true;
  ASSERT_TRUE(pair.getPosNeAtChain(1450.0, n1, e1));
  ASSERT_TRUE(pair.getPosNeAtChainAndOffsetExtr(1450.0, 0.0, n2, e2, &extrapolated));
  EXPECT_FALSE(extrapolated);
  EXPECT_TRUE(n1 == n2 && e1 == e2);
  EXPECT_TRUE(pair.CAlntH::getFinalChainageInM(end) && std::fabs(end - 1500.0) < 1e-9);
  EXPECT_TRUE(pair.getFinalChainageInM(end) && std::fabs(end - 1300.0) < 1e-9);
}

TEST(AlignmentPair, OneStartForBothParts) {
  CHorzAndVertAlnt pair = makePair(400.0);
  pair.setStartChainageInM(0.0);
  pair.setStartPos(kNorth0 + 10.0, kEast0, 250.0);
  double h = 0.0, n = 0.0, e = 0.0;
  ASSERT_TRUE(pair.getHtAtChain(100.0, h) && pair.getPosNeAtChain(0.0, n, e));
  EXPECT_NEAR(h, 252.0, 1e-9);
  EXPECT_TRUE(n == kNorth0 + 10.0 && e == kEast0);
  EXPECT_EQ(pair.getAlntVes().getStartChainageInM(), 0.0);
  const CHorzAndVertAlnt copy(pair);
  EXPECT_TRUE(copy.getHtAtChain(100.0, h) && std::fabs(h - 252.0) < 1e-9 && copy.getNumOfVes() == 1);
  pair.removeAll();
  EXPECT_TRUE(pair.getNumOfHes() == 0 && pair.getNumOfVes() == 0);
}

}  // namespace
