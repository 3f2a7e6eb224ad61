// Fresnel integrals against 20-digit tables (the quadrature oracle integrates them inside the spiral tests) on
// both sides of every switch of their evaluation, their symmetry and limits.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "curve_test_support.h"
#include "support/refdata.h"
#include "svymath/curves/spiral_fresnel.h"

namespace {

using svy_math::fresnelCS;
using curve_test::kNaN;

// Within 4 units of the last place of the value itself, in every regime: relative, so that a wrong small
// term at t = 1e-8 (where S is 5e-25) shows as plainly as a wrong digit at t = 1000.
void expectFewUlps(double got, double expected, double t, const char* name) {
  EXPECT_LE(std::fabs(got - expected), 4.0 * std::numeric_limits<double>::epsilon() * std::fabs(expected))
      << name << "(" << t << ") = " << got << ", expected " << expected;
}

// The 20-digit table (0 to 8 by 0.05, 1e-8 to 1000) and the switches of the evaluation (series to
// auxiliary functions at 1.5, the pieces of their fit, the asymptotic series from 7), each approached from
// both sides, tiny arguments and arguments up to 1e17 (where the phase pi t^2 / 2 must be reduced exactly).
TEST(Fresnel, MatchesTwentyDigitTablesInEveryRegime) {
  double S = 0.0, C = 0.0;
  int rowsRead = 0;
  for (const char* file : {"curves/fresnel_CS_table.csv", "curves/fresnel_switch_table.csv"}) {
    const auto rows = curve_test::readNumericTable(svy_test::testdataPath(file));
    ASSERT_GT(rows.size(), 20u) << file;
    for (const auto& row : rows) {
      ASSERT_EQ(row.size(), 3u);
      fresnelCS(row[0], S, C);
      expectFewUlps(C, row[1], row[0], "C");
      expectFewUlps(S, row[2], row[0], "S");
      ++rowsRead;
    }
  }
  EXPECT_GT(rowsRead, 200);
}

TEST(Fresnel, OddFunctionsWithHalfLimits) {
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
}

}  // namespace
