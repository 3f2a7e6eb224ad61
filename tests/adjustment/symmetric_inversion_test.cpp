#include <gtest/gtest.h>

#include <cmath>
#include <random>

#include "matrix_test_support.h"
#include "svymath/adjustment/symmetric_inversion.h"

using svy_math::TSMatrix;

namespace {

void expectInverseOf(const TSMatrix& original, const TSMatrix& inverse, double tolerance) {
  for (int i = 1; i <= original.order(); ++i)
    for (int j = 1; j <= original.order(); ++j)
      EXPECT_NEAR(adj_test::symmetricProductElement(original, inverse, i, j), i == j ? 1.0 : 0.0, tolerance);
}

TEST(CanInvert, PositiveDefiniteGivesFactorOfTheMatrix) {
  std::mt19937 rng(3);
  const TSMatrix s = adj_test::randomPositiveDefinite(5, rng);
  TSMatrix factor(s);
  ASSERT_EQ(svy_math::CanInvert(factor, 1e6), 1);
  // s = u^T u with u(k,k) = 1 / stored diagonal and u(k,i) the stored upper row.
  auto u = [&factor](int k, int i) { return k == i ? 1.0 / factor(k, k) : (k < i ? factor(k, i) : 0.0); };
  for (int i = 1; i <= 5; ++i)
    for (int j = 1; j <= 5; ++j) {
      double sum = 0.0;
      for (int k = 1; k <= 5; ++k) sum += u(k, i) * u(k, j);
      EXPECT_NEAR(sum, s(i, j), 1e-12 * s(i, i));
    }
}

TEST(CanInvert, RefusesIndefiniteSingularAndWeakPivots) {
  TSMatrix indefinite(2);
  indefinite(1, 1) = 1.0;
  indefinite(2, 1) = 2.0;
  indefinite(2, 2) = 1.0;
  EXPECT_EQ(svy_math::CanInvert(indefinite, 1e6), 0);
  TSMatrix singular(2);
  singular = 1.0;
  EXPECT_EQ(svy_math::CanInvert(singular, 1e6), 0);
  // Pivot 1e-4: 1/sqrt(pivot) = 100 passes a bound of 100 and fails one of 99.
  TSMatrix weak(2);
  weak(1, 1) = 1.0;
  weak(2, 2) = 1e-4;
  TSMatrix copy(weak);
  EXPECT_EQ(svy_math::CanInvert(weak, 100.0), 1);
  EXPECT_EQ(svy_math::CanInvert(copy, 99.0), 0);
  TSMatrix notFinite(2);
  notFinite(1, 1) = std::nan("");
  EXPECT_EQ(svy_math::CanInvert(notFinite, 1e6), 0);
}

struct SMatr3Case {
  svy_math::covar c;
  int expected;
};

class InvertSMatr3Test : public ::testing::TestWithParam<SMatr3Case> {};

TEST_P(InvertSMatr3Test, StatusAndInverse) {
  const SMatr3Case& param = GetParam();
  svy_math::covar c(param.c);
  ASSERT_EQ(svy_math::InvertSMatr3(c), param.expected);
  if (param.expected == -1) {
    for (int k = 0; k < 6; ++k) EXPECT_EQ(c.c[k], param.c.c[k]);
    return;
  }
  const svy_math::matr3_3 product = svy_math::matr3_3(param.c) * svy_math::matr3_3(c);
  adj_test::expectIdentity(product, 1e-9);
}

INSTANTIATE_TEST_SUITE_P(
    Table, InvertSMatr3Test,
    ::testing::Values(SMatr3Case{svy_math::covar(4, 1, 5, 2, 3, 6), 0},
                      // A covariance in square metres: the determinant test (1e-60) is far below its 1e-16.
                      SMatr3Case{svy_math::covar(4e-6, 1e-6, 9e-6, 0.0, 2e-6, 1e-5), 0},
                      SMatr3Case{svy_math::covar(1, 2, 1, 0, 0, 1), -2},   // indefinite: det < 0
                      SMatr3Case{svy_math::covar(-1, 0, -1, 0, 0, 1), -2},  // det > 0, diagonal negative
                      SMatr3Case{svy_math::covar(1, 1, 1, 1, 1, 1), -1},
                      SMatr3Case{svy_math::covar(), -1}));

TEST(RareInversion, BandedMatrixAndProfile) {
  const int n = 8;
  TSMatrix s(n);
  for (int i = 1; i <= n; ++i) {
    s(i, i) = 4.0 + i;
    if (i > 1) s(i, i - 1) = -1.0;
    if (i > 3 && i % 2 == 0) s(i, i - 3) = 0.5;
  }
  TSMatrix inverse(s);
  int profile[n];
  ASSERT_EQ(svy_math::RareInversion(inverse, profile, n), 0);
  expectInverseOf(s, inverse, 1e-14);
  EXPECT_EQ(profile[0], 1);
  EXPECT_EQ(profile[2], 2);
  EXPECT_EQ(profile[3], 1);
  EXPECT_EQ(profile[5], 3);
}

TEST(RareInversion, RandomDenseAndRefusals) {
  std::mt19937 rng(17);
  for (int n : {1, 2, 6, 12}) {
    const TSMatrix s = adj_test::randomPositiveDefinite(n, rng);
    TSMatrix inverse(s);
    ASSERT_EQ(svy_math::RareInversion(inverse, nullptr, 0), 0);
    expectInverseOf(s, inverse, 1e-12);
  }
  TSMatrix singular(3);
  singular = 2.0;
  EXPECT_EQ(svy_math::RareInversion(singular, nullptr, 0), -1);
  EXPECT_EQ(singular(3, 1), 2.0);
}

TEST(PseudoInversion, RankDeficientMatrixSatisfiesPenroseConditions) {
  // s = b^T b for a 2 x 4 matrix b: rank 2 of order 4.
  std::mt19937 rng(21);
  const svy_math::TMatrix b = adj_test::randomMatrix(2, 4, rng);
  TSMatrix s(4);
  for (int i = 1; i <= 4; ++i)
    for (int j = 1; j <= i; ++j) s(i, j) = b(1, i) * b(1, j) + b(2, i) * b(2, j);
  for (int defect : {-1, 2}) {
    TSMatrix pinv(s);
    ASSERT_EQ(svy_math::PseudoInversion(pinv, defect), 2);
    // s s+ s = s and s+ s s+ = s+.
    for (int i = 1; i <= 4; ++i)
      for (int j = 1; j <= 4; ++j) {
        double sps = 0.0;
        double psp = 0.0;
        for (int k = 1; k <= 4; ++k) {
          sps += adj_test::symmetricProductElement(s, pinv, i, k) * s(k, j);
          psp += adj_test::symmetricProductElement(pinv, s, i, k) * pinv(k, j);
        }
        EXPECT_NEAR(sps, s(i, j), 1e-12);
        EXPECT_NEAR(psp, pinv(i, j), 1e-9);
      }
  }
  const TSMatrix regular = adj_test::randomPositiveDefinite(3, rng);
  TSMatrix pinv(regular);
  ASSERT_EQ(svy_math::PseudoInversion(pinv, -1), 3);
  expectInverseOf(regular, pinv, 1e-12);
  EXPECT_EQ(svy_math::PseudoInversion(pinv, 4), -1);
}

}  // namespace
