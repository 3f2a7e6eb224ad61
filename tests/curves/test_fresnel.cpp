// Fresnel integrals against a quadrature written here, a 20-digit table, and their symmetry and limits, on
// both sides of the switch from the power series to the continued fraction at 1.5.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "curve_test_support.h"
#include "support/refdata.h"
#include "svymath/curves/spiral_fresnel.h"
#include "svymath/foundation/constants.h"

namespace {

using svy_math::fresnelCS;
using svy_math::units::kPi;

// The continued fraction is capped at 25 steps; just above the switch that leaves it short of full
// convergence (measured 2.4e-12 at 1.5, 1e-14 from 1.8 on). Everywhere else the error is a few ulps.
double toleranceFor(double t) {
  const double x = std::fabs(t);
  if (x >= 1.5 && x < 1.8) return 5e-12;
  return 2e-14 * std::fmax(1.0, x);
}

class FresnelQuadrature : public ::testing::TestWithParam<double> {};

TEST_P(FresnelQuadrature, MatchesAdaptiveSimpson) {
  const double t = GetParam();
  const double c = curve_test::integrate([](double u) { return std::cos(kPi * u * u / 2.0); }, 0.0, t, 1e-13);
  const double s = curve_test::integrate([](double u) { return std::sin(kPi * u * u / 2.0); }, 0.0, t, 1e-13);
  double S = 0.0;
  double C = 0.0;
  fresnelCS(t, S, C);
  EXPECT_NEAR(C, c, toleranceFor(t) + 1e-13) << "t = " << t;
  EXPECT_NEAR(S, s, toleranceFor(t) + 1e-13) << "t = " << t;
}

INSTANTIATE_TEST_SUITE_P(BothRegimes, FresnelQuadrature,
                         ::testing::Values(1e-6, 0.01, 0.3, 0.75, 1.0, 1.2, 1.4999, 1.5, 1.5001, 1.7, 2.0, 2.5, 3.3,
                                           4.0, 5.5, -0.6, -1.5, -2.2));

TEST(FresnelTable, MatchesTwentyDigitValues) {
  const auto rows = curve_test::readNumericTable(svy_test::testdataPath("curves/fresnel_CS_table.csv"));
  ASSERT_GT(rows.size(), 150u);
  int belowSwitch = 0;
  int aboveSwitch = 0;
  for (const auto& row : rows) {
    ASSERT_EQ(row.size(), 3u);
    const double t = row[0];
    double S = 0.0;
    double C = 0.0;
    fresnelCS(t, S, C);
    EXPECT_NEAR(C, row[1], toleranceFor(t)) << "t = " << t;
    EXPECT_NEAR(S, row[2], toleranceFor(t)) << "t = " << t;
    if (t > 1.4 && t < 1.5) ++belowSwitch;
    if (t >= 1.5 && t < 1.6) ++aboveSwitch;
  }
  EXPECT_GT(belowSwitch, 0);
  EXPECT_GT(aboveSwitch, 0);
}

TEST(FresnelSymmetry, OddFunctionsWithHalfLimitsContinuousAtTheSwitch) {
  for (double t : {0.2, 1.4999, 1.5, 3.0, 40.0}) {
    double S1 = 0.0, C1 = 0.0, S2 = 0.0, C2 = 0.0;
    fresnelCS(t, S1, C1);
    fresnelCS(-t, S2, C2);
    EXPECT_EQ(S1, -S2);
    EXPECT_EQ(C1, -C2);
  }
  double S = 0.0, C = 0.0;
  fresnelCS(1e6, S, C);
  EXPECT_NEAR(C, 0.5, 1e-6);
  EXPECT_NEAR(S, 0.5, 1e-6);
  fresnelCS(-std::numeric_limits<double>::infinity(), S, C);
  EXPECT_EQ(C, -0.5);
  EXPECT_EQ(S, -0.5);
  fresnelCS(0.0, S, C);
  EXPECT_EQ(C, 0.0);
  EXPECT_EQ(S, 0.0);
  fresnelCS(std::nan(""), S, C);
  EXPECT_TRUE(std::isnan(S));
  EXPECT_TRUE(std::isnan(C));
  // The power series and the continued fraction meet at 1.5: neighbours differ by the derivative times the gap.
  double Sb = 0.0, Cb = 0.0;
  fresnelCS(std::nextafter(1.5, 0.0), Sb, Cb);
  fresnelCS(1.5, S, C);
  EXPECT_NEAR(Cb, C, 5e-12);
  EXPECT_NEAR(Sb, S, 5e-12);
}

}  // namespace
