// Traverse adjustment and line proportioning: a hand-sized closed traverse whose corrections the test works
// out from the rules' definitions, the unchanged error-free traverse, and the exact ends.
#include <gtest/gtest.h>

#include <cmath>

#include "svymath/adjustment/proportioning.h"
#include "svymath/foundation/constants.h"
#include "svyutils/svy_err_log.h"

namespace {

using svy_math::TProportioning;
using svy_math::TTraverseAdjustment;
using svy_math::TTraverseLeg;
using svy_math::units::kDegToRad;

const C2dPos kGrid(5000000.0, 500000.0);

// A square loop booked north 100.03, east 100, south 100, west 99.97: it misses its start by +0.03 N and
// +0.03 E over 400 m. The compass rule takes the misclosure back in proportion to the distance run; the
// transit rule takes northings back with the running sum of |dN| (200.03 in all) and eastings with |dE|
// (199.97), so an east leg leaves the northing correction where it was.
TEST(TraverseAdjustment, ClosedSquareByBothRules) {
  const svy_vector<TTraverseLeg> legs{{0, 100.03}, {90 * kDegToRad, 100}, {180 * kDegToRad, 100}, {270 * kDegToRad, 99.97}};
  const double measuredN[] = {100.03, 100.03, 0.03, 0.03}, measuredE[] = {0, 100, 100, 0.03};
  const double runLength[] = {100.03, 200.03, 300.03, 400}, runAbsN[] = {100.03, 100.03, 200.03, 200.03},
               runAbsE[] = {0, 100, 100, 199.97};
  for (const auto rule : {svy_math::eCompassRule, svy_math::eTransitRule}) {
    SCOPED_TRACE(rule);
    TTraverseAdjustment result;
    ASSERT_TRUE(TProportioning::adjustTraverse(kGrid, kGrid, legs, rule, result));
    EXPECT_NEAR(result.misclosureNorth, 0.03, 1e-9);
    EXPECT_NEAR(result.misclosureEast, 0.03, 1e-9);
    EXPECT_NEAR(result.linearMisclosure, 0.03 * std::sqrt(2.0), 1e-9);
    EXPECT_NEAR(result.precision, 400 / (0.03 * std::sqrt(2.0)), 1e-3);
    ASSERT_EQ(result.points.size(), 4u);
    for (int i = 0; i < 4; ++i) {
      const bool compass = rule == svy_math::eCompassRule;
      const double cN = -0.03 * (compass ? runLength[i] / 400 : runAbsN[i] / 200.03);
      const double cE = -0.03 * (compass ? runLength[i] / 400 : runAbsE[i] / 199.97);
      EXPECT_NEAR(result.corrections[i].north(), cN, 1e-9);
      EXPECT_NEAR(result.corrections[i].east(), cE, 1e-9);
      EXPECT_NEAR(result.points[i].north() - kGrid.north(), measuredN[i] + cN, 1e-9);
      EXPECT_NEAR(result.points[i].east() - kGrid.east(), measuredE[i] + cE, 1e-9);
    }
    EXPECT_EQ(result.points.back(), kGrid);
  }
  // A traverse due east has no northing extent: the transit rule takes its northing misclosure back by
  // distance, as the compass rule would.
  TTraverseAdjustment east;
  ASSERT_TRUE(TProportioning::adjustTraverse(kGrid, C2dPos(kGrid.north() + 0.01, kGrid.east() + 100),
                                             {{90 * kDegToRad, 60}, {90 * kDegToRad, 40}}, svy_math::eTransitRule, east));
  EXPECT_NEAR(east.corrections[0].north(), 0.006, 1e-9);
}

// Legs taken from known points by inverse: nothing to distribute, every point comes back.
TEST(TraverseAdjustment, ErrorFreeOpenTraverseIsUnchanged) {
  const svy_vector<C2dPos> known{kGrid, C2dPos(kGrid.north() + 87.412, kGrid.east() + 64.835),
                                 C2dPos(kGrid.north() + 61.207, kGrid.east() + 171.559),
                                 C2dPos(kGrid.north() - 31.056, kGrid.east() + 158.116)};
  svy_vector<TTraverseLeg> legs;
  for (std::size_t i = 1; i < known.size(); ++i) {
    const double dN = known[i].north() - known[i - 1].north(), dE = known[i].east() - known[i - 1].east();
    legs.push_back({std::atan2(dE, dN), std::hypot(dN, dE)});
  }
  for (const auto rule : {svy_math::eCompassRule, svy_math::eTransitRule}) {
    TTraverseAdjustment result;
    ASSERT_TRUE(TProportioning::adjustTraverse(known.front(), known.back(), legs, rule, result));
    EXPECT_NEAR(result.linearMisclosure, 0.0, 1e-9);
    for (std::size_t i = 0; i < result.points.size(); ++i) {
      EXPECT_NEAR(result.points[i].north(), known[i + 1].north(), 1e-9);
      EXPECT_NEAR(result.points[i].east(), known[i + 1].east(), 1e-9);
    }
  }
}

TEST(TraverseAdjustment, RefusedInputIsLoggedAndLeavesTheResult) {
  svy_logging::CScopedErrLogCapture log;
  TTraverseAdjustment result;
  result.totalLength = -1;
  EXPECT_FALSE(TProportioning::adjustTraverse(kGrid, kGrid, {}, svy_math::eCompassRule, result));
  EXPECT_FALSE(TProportioning::adjustTraverse(kGrid, kGrid, {{NAN, 10}}, svy_math::eCompassRule, result));
  EXPECT_FALSE(TProportioning::adjustTraverse(kGrid, kGrid, {{0, 0}}, svy_math::eTransitRule, result));
  EXPECT_EQ(result.totalLength, -1);
  ASSERT_EQ(log.count(), 3u);
  for (const auto& entry : log.entries()) EXPECT_EQ(entry.file, "TProportioning");
}

// A chain measured along a bent line and shifted: the ends land on the known points exactly and each point
// takes the shift in proportion to its distance along.
TEST(LineProportioning, EndsExactAndShiftInProportion) {
  const svy_vector<C2dPos> measured{kGrid, C2dPos(kGrid.north() + 30, kGrid.east()),
                                    C2dPos(kGrid.north() + 30, kGrid.east() + 40), C2dPos(kGrid.north() + 60, kGrid.east() + 40)};
  const C2dPos knownStart(kGrid.north() + 0.02, kGrid.east() - 0.01), knownEnd(kGrid.north() + 60.1, kGrid.east() + 40.05);
  svy_vector<C2dPos> adjusted;
  ASSERT_TRUE(TProportioning::proportionLine(knownStart, knownEnd, measured, adjusted));
  EXPECT_EQ(adjusted.front(), knownStart);
  EXPECT_EQ(adjusted.back(), knownEnd);
  const double share[] = {0, 0.3, 0.7, 1};
  for (int i = 1; i < 3; ++i) {
    EXPECT_NEAR(adjusted[i].north() - measured[i].north(), 0.02 + share[i] * (0.1 - 0.02), 1e-9);
    EXPECT_NEAR(adjusted[i].east() - measured[i].east(), -0.01 + share[i] * (0.05 + 0.01), 1e-9);
  }
  ASSERT_TRUE(TProportioning::proportionLine(measured.front(), measured.back(), measured, adjusted));
  EXPECT_EQ(adjusted, measured);
  EXPECT_FALSE(TProportioning::proportionLine(kGrid, kGrid, svy_vector<C2dPos>{kGrid, kGrid}, adjusted));
}

}  // namespace
