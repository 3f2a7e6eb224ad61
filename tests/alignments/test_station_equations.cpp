// Station equations: chainage to displayed station and back, overlaps resolved by region, gaps refused.
#include <gtest/gtest.h>

#include <cmath>

#include "alignment_test_support.h"
#include "svymath/alignments/station_equations.h"

namespace {

// Stationing of a road whose first re-alignment shortened it (back 1250 = ahead 1200: stations 1200..1250
// occur twice) and whose second lengthened it (back 1900 = ahead 2000: stations 1900..2000 never occur).
StationEquations roadEquations() {
  StationEquations equations;
  EXPECT_TRUE(equations.addEquation(1250.0, 1200.0));
  EXPECT_TRUE(equations.addEquation(1900.0, 2000.0));
  return equations;
}

}  // namespace

TEST(StationEquations, ChainageToStationAndBack) {
  const StationEquations equations = roadEquations();
  double back = 0.0, ahead = 0.0, at = 0.0;
  ASSERT_TRUE(equations.getEquation(1, back, ahead, at));
  EXPECT_EQ(at, 1950.0);  // 1250 m, then 700 m from station 1200 to 1900
  struct Case {
    double chainage;
    double station;
    int region;
  };
  for (const Case& c : {Case{-50.0, -50.0, 0}, Case{1249.5, 1249.5, 0}, Case{1250.0, 1200.0, 1},
                        Case{1300.0, 1250.0, 1}, Case{1949.9, 1899.9, 1}, Case{1950.0, 2000.0, 2},
                        Case{3000.0, 3050.0, 2}}) {
    double station = 0.0, chainage = 0.0;
    int region = -1;
    ASSERT_TRUE(equations.chainageToStation(c.chainage, station, &region));
    EXPECT_NEAR(station, c.station, 1e-9) << c.chainage;
    EXPECT_EQ(region, c.region) << c.chainage;
    ASSERT_EQ(equations.stationToChainage(station, region, chainage), eStationOk);
    EXPECT_NEAR(chainage, c.chainage, 1e-9);
  }
}

TEST(StationEquations, OverlapsGapsAndBadInput) {
  const StationEquations equations = roadEquations();
  double chainage = 0.0;
  int region = -1;
  // 1225 occurs before and after the first break: only its region names it.
  EXPECT_EQ(equations.stationToChainage(1225.0, chainage, &region), eStationAmbiguous);
  ASSERT_EQ(equations.stationToChainage(1225.0, 0, chainage), eStationOk);
  EXPECT_EQ(chainage, 1225.0);
  ASSERT_EQ(equations.stationToChainage(1225.0, 1, chainage), eStationOk);
  EXPECT_EQ(chainage, 1275.0);
  ASSERT_EQ(equations.stationToChainage(1500.0, chainage, &region), eStationOk);
  EXPECT_EQ(chainage, 1550.0);
  EXPECT_EQ(region, 1);
  // 1950 falls in the gap of the second break; 1300 is not in region 2.
  EXPECT_EQ(equations.stationToChainage(1950.0, chainage), eStationNotInRegion);
  EXPECT_EQ(equations.stationToChainage(1300.0, 2, chainage), eStationNotInRegion);
  EXPECT_EQ(equations.stationToChainage(1300.0, 3, chainage), eStationBadInput);
  EXPECT_EQ(equations.stationToChainage(std::nan(""), chainage), eStationBadInput);
  StationEquations ordered = roadEquations();
  EXPECT_FALSE(ordered.addEquation(1999.0, 2100.0));  // before the last ahead station
  EXPECT_FALSE(ordered.addEquation(HUGE_VAL, 0.0));
  EXPECT_EQ(ordered.getCount(), 2);
}

TEST(StationEquations, HeldByTheAlignmentAndItsCopies) {
  const StationEquations equations = roadEquations();
  CAlntH alignment = alnt_test::mixedAlignment(41, 1);
  EXPECT_FALSE(alignment.HasStationEquations());
  alignment.SetStationEquations(&equations);
  const CAlntH copy = alignment;
  EXPECT_EQ(copy.GetStationEquations(), &equations);
  // The equations do not enter the alignment's own chainage arithmetic.
  EXPECT_EQ(copy.distance2Chainage(300.0), 1300.0);
}
