#include <gtest/gtest.h>

#include <cmath>
#include <random>

#include "matrix_test_support.h"
#include "svymath/adjustment/symmetric_inversion.h"

using adj_test::full;
using adj_test::multiply;
using svy_math::TSMatrix;

namespace {

TSMatrix symmetric2(double s11, double s21, double s22) {
  TSMatrix s(2);
  s(1, 1) = s11;
  s(2, 1) = s21;
  s(2, 2) = s22;
  return s;
}

// A positive-definite matrix gives its factor: s = u^T u with u(k,k) = 1 / stored diagonal and u(k,i) the
// stored upper row. Indefinite, singular and non-finite matrices are refused, and so is a pivot whose
// 1/sqrt exceeds the bound (pivot 1e-4: 100 passes a bound of 100 and fails one of 99).
TEST(CanInvert, FactorOfPositiveDefiniteAndRefusals) {
  std::mt19937 rng(3);
  const TSMatrix s = adj_test::randomPositiveDefinite(5, rng);
  TSMatrix f(s);
  ASSERT_EQ(svy_math::CanInvert(f, 1e6), 1);
  svy_math::TMatrix u(5, 5);
  for (int k = 1; k <= 5; ++k)
    for (int i = k; i <= 5; ++i) u(k, i) = k == i ? 1.0 / f(k, k) : f(k, i);
  const svy_math::TMatrix product = multiply(adj_test::transpose(u), u);
  for (int i = 1; i <= 5; ++i)
    for (int j = 1; j <= 5; ++j) EXPECT_NEAR(product(i, j), s(i, j), 1e-12 * s(i, i));
  const struct {
    TSMatrix s;
    double bound;
    int expected;
  } cases[] = {{symmetric2(1, 2, 1), 1e6, 0},
               {symmetric2(1, 1, 1), 1e6, 0},
               {symmetric2(1, 0, 1e-4), 100, 1},
               {symmetric2(1, 0, 1e-4), 99, 0},
               {symmetric2(std::nan(""), 0, 1), 1e6, 0}};
  for (const auto& c : cases) {
    TSMatrix copy(c.s);
    EXPECT_EQ(svy_math::CanInvert(copy, c.bound), c.expected) << c.s(2, 1) << " " << c.s(2, 2) << " " << c.bound;
  }
}

// A 3x3 covariance: status and, when invertible, inverse times original is the identity; a singular one
// is left as it was. A covariance in square metres passes: the determinant test (1e-60) is far below its 1e-16.
TEST(InvertSMatr3, StatusAndInverse) {
  const struct {
    svy_math::covar c;
    int expected;
  } cases[] = {{svy_math::covar(4, 1, 5, 2, 3, 6), 0},    {svy_math::covar(4e-6, 1e-6, 9e-6, 0.0, 2e-6, 1e-5), 0},
               {svy_math::covar(1, 2, 1, 0, 0, 1), -2},    // indefinite: det < 0
               {svy_math::covar(-1, 0, -1, 0, 0, 1), -2},  // det > 0, diagonal negative
               {svy_math::covar(1, 1, 1, 1, 1, 1), -1},   {svy_math::covar(), -1}};
  for (const auto& c : cases) {
    SCOPED_TRACE(::testing::Message() << c.c.c[0] << " " << c.c.c[1] << " " << c.c.c[2]);
    svy_math::covar inverse(c.c);
    ASSERT_EQ(svy_math::InvertSMatr3(inverse), c.expected);
    if (c.expected == 0) adj_test::expectIdentity(svy_math::matr3_3(c.c) * svy_math::matr3_3(inverse), 1e-9);
    if (c.expected == -1) {
      for (int k = 0; k < 6; ++k) EXPECT_EQ(inverse.c[k], c.c.c[k]);
    }
  }
}

// Inverse times original is the identity for a banded matrix (with its profile: the first non-zero column
// of each row, counted back from the diagonal) and random dense ones; a singular matrix is refused untouched.
TEST(RareInversion, InverseTimesOriginalAndRefusal) {
  TSMatrix band(8);
  for (int i = 1; i <= 8; ++i) {
    band(i, i) = 4.0 + i;
    if (i > 1) band(i, i - 1) = -1.0;
    if (i > 3 && i % 2 == 0) band(i, i - 3) = 0.5;
  }
  TSMatrix inverse(band);
  int profile[8];
  ASSERT_EQ(svy_math::RareInversion(inverse, profile, 8), 0);
  adj_test::expectInverseOf(band, inverse, 1e-14);
  EXPECT_TRUE(profile[0] == 1 && profile[2] == 2 && profile[3] == 1 && profile[5] == 3);
  std::mt19937 rng(17);
  for (int n : {1, 2, 6, 12}) {
    const TSMatrix s = adj_test::randomPositiveDefinite(n, rng);
    TSMatrix dense(s);
    ASSERT_EQ(svy_math::RareInversion(dense, nullptr, 0), 0);
    adj_test::expectInverseOf(s, dense, 1e-12);
  }
  TSMatrix singular(3);
  singular = 2.0;
  EXPECT_EQ(svy_math::RareInversion(singular, nullptr, 0), -1);
  EXPECT_EQ(singular(3, 1), 2.0);
}

// A rank-2 matrix of order 4 (b^T b, b 2x4), with the defect found or given: the Penrose conditions
// s s+ s = s and s+ s s+ = s+. A regular matrix gets its inverse; a defect above the order is refused.
TEST(PseudoInversion, PenroseConditionsAndRegularInverse) {
  std::mt19937 rng(21);
  const svy_math::TMatrix b = adj_test::randomMatrix(2, 4, rng), bb = multiply(adj_test::transpose(b), b);
  TSMatrix s(4);
  for (int i = 1; i <= 4; ++i)
    for (int j = 1; j <= i; ++j) s(i, j) = bb(i, j);
  for (int defect : {-1, 2}) {
    TSMatrix pinv(s);
    ASSERT_EQ(svy_math::PseudoInversion(pinv, defect), 2);
    adj_test::expectNear(multiply(multiply(full(s), full(pinv)), full(s)), full(s), 1e-12);
    adj_test::expectNear(multiply(multiply(full(pinv), full(s)), full(pinv)), full(pinv), 1e-9);
  }
  const TSMatrix regular = adj_test::randomPositiveDefinite(3, rng);
  TSMatrix pinv(regular);
  ASSERT_EQ(svy_math::PseudoInversion(pinv, -1), 3);
  adj_test::expectInverseOf(regular, pinv, 1e-12);
  EXPECT_EQ(svy_math::PseudoInversion(pinv, 4), -1);
}

}  // namespace
