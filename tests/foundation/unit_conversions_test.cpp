// Unit conversions against the definitions of the units, the deliberate asymmetries, and the packed
// feet-inches-eighths form both ways.
#include <gtest/gtest.h>

#include <cmath>

#include "svymath/foundation/unit_conversions.h"

namespace {

constexpr double kUsFoot = 1200.0 / 3937.0;
constexpr double kIntFoot = 0.3048;

// 66 ft to the chain, 27 cubic feet to the yard; 10 square chains to the acre only for the international foot.
TEST(FootBasedUnits, AgreeWithTheUnitDefinitions) {
  for (const bool us : {true, false}) {
    SCOPED_TRACE(us);
    const double foot = us ? kUsFoot : kIntFoot, chain = 66 * foot;
    EXPECT_NEAR(Chain2Meter(Meter2Chain(123.456, us), us), 123.456, 1e-11);
    EXPECT_NEAR(SqrMeter2SqrFeet(foot * foot, us), 1, 1e-6);
    EXPECT_NEAR(SqureChains2SqureMeters(1, us), chain * chain, 1e-9);
    EXPECT_NEAR(SqureChains2SqureMeters(SqureMeter2SqureChain(1e4, us), us), 1e4, 1e-8);
    EXPECT_NEAR(CubicMeter2CubicFeets(1, us), 1 / (foot * foot * foot), 1e-4);
    EXPECT_NEAR(CubicMeter2CubicYards(1, us) * 27, CubicMeter2CubicFeets(1, us), 1e-9);
    EXPECT_NEAR(CubicMeter2CubicChain(1, us) * 66 * 66 * 66, CubicMeter2CubicFeets(1, us), 1e-9);
  }
  EXPECT_TRUE(SqureChains2Acres(10, false) == 1 && IFeet2Meter(1) == 0.3048);
  EXPECT_NEAR(SqureChains2Acres(10, true), 1.000004000012, 1e-15);
  EXPECT_NEAR(Meter2USFeet(1200), 3937, 1e-9);
  EXPECT_NEAR(USFeet2Meter(Meter2USFeet(1234.5678)), 1234.5678, 1e-9);
  EXPECT_NEAR(Meter2IFeet(IFeet2Meter(987.65)), 987.65, 1e-12);
}

TEST(PressureAndTemperature, PairsAndTheirDeliberateAsymmetry) {
  EXPECT_NEAR(hPaTommHg(mmHgTohPa(760)), 760, 1e-9);
  EXPECT_NEAR(mmHgTohPa(760), 1013.25, 1e-3);  // standard atmosphere
  const double roundTrip = inHgTohPa(hPaToinHg(1000));
  EXPECT_NEAR(roundTrip, 1000, 1e-3);
  EXPECT_GT(std::fabs(roundTrip - 1000), 1e-6);  // two independently rounded factors
  EXPECT_TRUE(CelsiusToFahrenheit(-40) == -40 && CelsiusToFahrenheit(100) == 212);
  for (double t : {-60.0, 15.5, 37.0}) EXPECT_NEAR(FahrenheitToCelsius(CelsiusToFahrenheit(t)), t, 1e-12);
}

// Packed feet.inches-eighths (FFF.IIE) unpacks with carries of 12 inches and 8 eighths, and every packed
// value and every length round-trips.
TEST(PackedFeet, UnpacksWithCarriesAndRoundTrips) {
  const double cases[][2] = {{3.033, 3 + 27.0 / 96},           {0.120, 1},               {0.128, 1 + 1.0 / 12},
                             {5.089, 5 + 9.0 / 12 + 1.0 / 96}, {-1.06, -(1 + 6.0 / 12)}, {0.001, 1.0 / 96}};
  for (const auto& c : cases) {
    EXPECT_NEAR(FFFII2Meter(c[0], false), c[1] * kIntFoot, 1e-12) << c[0];
    EXPECT_NEAR(FFFII2Meter(c[0], true), c[1] * kUsFoot, 1e-12) << c[0];
  }
  EXPECT_NEAR(Meter2FFFII(-1.0, false), -3.033, 1e-12);
  for (bool us : {false, true}) {
    for (int feet : {0, 7, 5280})
      for (int ie = 0; ie < 96; ++ie) {
        const double packed = feet + (10 * (ie / 8) + ie % 8) / 1000.0;
        EXPECT_NEAR(Meter2FFFII(FFFII2Meter(packed, us), us), packed, 1e-9) << packed << " us " << us;
      }
    for (double m = -50.0; m <= 50.0; m += 0.731)
      EXPECT_NEAR(FFFII2Meter(Meter2FFFII(m, us), us), m, (us ? kUsFoot : kIntFoot) / 192 + 1e-12) << m;
  }
}

}  // namespace
