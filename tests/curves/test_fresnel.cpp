// Fresnel integrals against a 20-digit table (the quadrature oracle integrates them inside the spiral tests),
// their symmetry and limits, on both sides of the switch from the power series to the continued fraction at 1.5.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "curve_test_support.h"
#include "support/refdata.h"
#include "svymath/curves/spiral_fresnel.h"

namespace {

using svy_math::fresnelCS;
using curve_test::kNaN;

// The continued fraction is capped at 25 steps; just above the switch that leaves it short of full
// convergence (measured 2.4e-12 at 1.5, 1e-14 from 1.8 on). Everywhere else the error is a few ulps.
double toleranceFor(double t) {
  const double x = std::fabs(t);
  return x >= 1.5 && x < 1.8 ? 5e-12 : 2e-14 * std::fmax(1.0, x);
}

TEST(Fresnel, MatchesTwentyDigitTable) {
  double S = 0.0, C = 0.0;
  const auto rows = curve_test::readNumericTable(svy_test::testdataPath("curves/fresnel_CS_table.csv"));
  ASSERT_GT(rows.size(), 150u);
  int belowSwitch = 0, aboveSwitch = 0;
  for (const auto& row : rows) {
    ASSERT_EQ(row.size(), 3u);
    fresnelCS(row[0], S, C);
    EXPECT_NEAR(C, row[1], toleranceFor(row[0])) << row[0];
    EXPECT_NEAR(S, row[2], toleranceFor(row[0])) << row[0];
    belowSwitch += row[0] > 1.4 && row[0] < 1.5;
    aboveSwitch += row[0] >= 1.5 && row[0] < 1.6;
  }
  EXPECT_GT(belowSwitch, 0);
  EXPECT_GT(aboveSwitch, 0);
}

TEST(Fresnel, OddFunctionsWithHalfLimitsContinuousAtTheSwitch) {
  double S = 0.0, C = 0.0, S2 = 0.0, C2 = 0.0;
  for (double t : {0.2, 1.4999, 1.5, 3.0, 40.0}) {
    fresnelCS(t, S, C);
    fresnelCS(-t, S2, C2);
    EXPECT_EQ(S, -S2);
    EXPECT_EQ(C, -C2);
  }
  const struct {
    double t, expected, tol;
  } limits[] = {{1e6, 0.5, 1e-6}, {-curve_test::kInf, -0.5, 0.0}, {0.0, 0.0, 0.0}, {kNaN, kNaN, 0.0}};
  for (const auto& l : limits) {
    fresnelCS(l.t, S, C);
    EXPECT_TRUE(std::isnan(l.expected) ? std::isnan(S) && std::isnan(C)
                                       : std::fabs(S - l.expected) <= l.tol && std::fabs(C - l.expected) <= l.tol)
        << l.t;
  }
  // The power series and the continued fraction meet at 1.5: neighbours differ by the derivative times the gap.
  fresnelCS(std::nextafter(1.5, 0.0), S2, C2);
  fresnelCS(1.5, S, C);
  EXPECT_NEAR(C2, C, 5e-12);
  EXPECT_NEAR(S2, S, 5e-12);
}

}  // namespace
