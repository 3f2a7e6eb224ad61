// Unit conversions against the definitions of the units (66 ft chain, 10 square chains to the acre,
// 27 cubic feet to the yard, 1200/3937 m US survey foot), the deliberate asymmetries, and the packed
// feet-inches-eighths form both ways.
#include <gtest/gtest.h>

#include <cmath>

#include "svymath/foundation/unit_conversions.h"

namespace {

constexpr double kUsFoot = 1200.0 / 3937.0;
constexpr double kIntFoot = 0.3048;

struct FootCase {
  bool us;
  double foot;
};

class FootBasedUnits : public ::testing::TestWithParam<FootCase> {};

TEST_P(FootBasedUnits, AgreeWithTheUnitDefinitions) {
  const bool us = GetParam().us;
  const double foot = GetParam().foot;
  const double chain = 66 * foot;
  EXPECT_NEAR(Chain2Meter(1, us), chain, 1e-13);
  EXPECT_NEAR(Meter2Chain(chain, us), 1, 1e-13);
  EXPECT_NEAR(Chain2Meter(Meter2Chain(123.456, us), us), 123.456, 1e-11);
  EXPECT_NEAR(SqrMeter2SqrFeet(foot * foot, us), 1, 1e-6);
  EXPECT_NEAR(SqureMeter2SqureChain(chain * chain, us), 1, 1e-13);
  EXPECT_NEAR(SqureChains2SqureMeters(1, us), chain * chain, 1e-9);
  EXPECT_NEAR(SqureChains2SqureMeters(SqureMeter2SqureChain(1e4, us), us), 1e4, 1e-8);
  EXPECT_NEAR(CubicMeter2CubicFeets(1, us), 1 / (foot * foot * foot), 1e-4);
  EXPECT_NEAR(CubicMeter2CubicYards(1, us) * 27, CubicMeter2CubicFeets(1, us), 1e-9);
  EXPECT_NEAR(CubicMeter2CubicChain(1, us) * 66 * 66 * 66, CubicMeter2CubicFeets(1, us), 1e-9);
}

INSTANTIATE_TEST_SUITE_P(Feet, FootBasedUnits, ::testing::Values(FootCase{true, kUsFoot}, FootCase{false, kIntFoot}));

TEST(FootBasedUnits, AcresPerSquareChainDifferByFoot) {
  EXPECT_EQ(SqureChains2Acres(10, false), 1);
  EXPECT_NEAR(SqureChains2Acres(10, true), 1.000004000012, 1e-15);
  EXPECT_NE(SqureChains2Acres(10, true), SqureChains2Acres(10, false));
}

TEST(Feet, SurveyAndInternationalFeet) {
  EXPECT_NEAR(USFeet2Meter(3937), 1200, 1e-9);
  EXPECT_NEAR(Meter2USFeet(1200), 3937, 1e-9);
  EXPECT_NEAR(USFeet2Meter(Meter2USFeet(1234.5678)), 1234.5678, 1e-9);
  EXPECT_EQ(IFeet2Meter(1), 0.3048);
  EXPECT_NEAR(Meter2IFeet(IFeet2Meter(987.65)), 987.65, 1e-12);
  // Two parts in a million: the difference that matters on a state-plane grid.
  EXPECT_NEAR(USFeet2Meter(1e6) - IFeet2Meter(1e6), 1e6 * (1200.0 / 3937.0 - 0.3048), 1e-9);
}

TEST(PressureAndTemperature, PairsAndTheirDeliberateAsymmetry) {
  EXPECT_NEAR(hPaTommHg(mmHgTohPa(760)), 760, 1e-9);
  EXPECT_NEAR(mmHgTohPa(760), 1013.25, 1e-3);  // standard atmosphere
  const double roundTrip = inHgTohPa(hPaToinHg(1000));
  EXPECT_NEAR(roundTrip, 1000, 1e-3);
  EXPECT_GT(std::fabs(roundTrip - 1000), 1e-6);  // two independently rounded factors
  EXPECT_EQ(CelsiusToFahrenheit(-40), -40);
  EXPECT_EQ(CelsiusToFahrenheit(100), 212);
  for (double t : {-60.0, -40.0, 0.0, 15.5, 37.0, 100.0}) {
    EXPECT_NEAR(FahrenheitToCelsius(CelsiusToFahrenheit(t)), t, 1e-12);
  }
}

struct PackedFeetCase {
  double packed;
  double feet;
};

class PackedFeet : public ::testing::TestWithParam<PackedFeetCase> {};

TEST_P(PackedFeet, UnpacksWithCarries) {
  const PackedFeetCase& c = GetParam();
  EXPECT_NEAR(FFFII2Meter(c.packed, false), c.feet * kIntFoot, 1e-12) << c.packed;
  EXPECT_NEAR(FFFII2Meter(c.packed, true), c.feet * kUsFoot, 1e-12) << c.packed;
}

INSTANTIATE_TEST_SUITE_P(Cases, PackedFeet,
                         ::testing::Values(PackedFeetCase{3.033, 3 + 27.0 / 96}, PackedFeetCase{5.073, 5 + 59.0 / 96},
                                           PackedFeetCase{0.120, 1}, PackedFeetCase{0.128, 1 + 1.0 / 12},
                                           PackedFeetCase{5.089, 5 + 9.0 / 12 + 1.0 / 96},
                                           PackedFeetCase{-1.06, -(1 + 6.0 / 12)}, PackedFeetCase{0, 0},
                                           PackedFeetCase{0.001, 1.0 / 96}));

TEST(PackedFeet, PacksToTheNearestEighth) {
  EXPECT_NEAR(Meter2FFFII(1.0, false), 3.033, 1e-12);
  EXPECT_NEAR(Meter2FFFII(-1.0, false), -3.033, 1e-12);
  EXPECT_NEAR(Meter2FFFII(0.3048, false), 1.0, 1e-12);
  EXPECT_NEAR(Meter2FFFII(1200.0 / 3937.0 * 12, true), 12.0, 1e-12);
  EXPECT_LT(FFFII2Meter(-1.06, true), 0);
}

TEST(PackedFeet, EveryPackedValueRoundTrips) {
  for (bool us : {false, true}) {
    for (int feet : {0, 1, 7, 99, 5280}) {
      for (int inches = 0; inches < 12; ++inches) {
        for (int eighths = 0; eighths < 8; ++eighths) {
          const double packed = feet + (10 * inches + eighths) / 1000.0;
          EXPECT_NEAR(Meter2FFFII(FFFII2Meter(packed, us), us), packed, 1e-9) << packed << " us " << us;
        }
      }
    }
  }
}

TEST(PackedFeet, MetresRoundTripWithinHalfAnEighth) {
  for (bool us : {false, true}) {
    const double foot = us ? kUsFoot : kIntFoot;
    for (double m = -50.0; m <= 50.0; m += 0.731) {
      EXPECT_NEAR(FFFII2Meter(Meter2FFFII(m, us), us), m, foot / 96 / 2 + 1e-12) << m;
    }
  }
}

}  // namespace
