#include <gtest/gtest.h>

#include <random>

#include "matrix_test_support.h"
#include "svymath/adjustment/matrix_products.h"
#include "svymath/adjustment/matrix_storage.h"

using adj_test::full;
using adj_test::multiply;
using adj_test::transpose;
using svy_math::LOC1;
using svy_math::TMatrix;
using svy_math::TSMatrix;

namespace {

// Storage positions (i, j, n, mode, position) for column-major, packed symmetric and diagonal modes, and the
// packed symmetric mode against the row-wise lower triangle.
TEST(Loc1, GivesStoragePosition) {
  const int cases[][5] = {{2, 3, 4, 0, 10}, {1, 1, 4, 0, 1}, {4, 1, 4, -3, 4}, {2, 3, 9, 1, 5},
                          {3, 2, 9, 1, 5},  {1, 1, 3, 1, 1}, {3, 3, 3, 1, 6},  {3, 1, 3, 1, 4},
                          {2, 3, 3, 2, 0},  {3, 3, 3, 2, 3}, {3, 3, 3, 7, 3}};
  for (const auto& c : cases) EXPECT_EQ(LOC1(c[0], c[1], c[2], 0, c[3]), c[4]) << c[0] << c[1] << c[2] << " " << c[3];
  int expected = 1;
  for (int i = 1; i <= 6; ++i)
    for (int j = 1; j <= i; ++j, ++expected)
      EXPECT_TRUE(LOC1(i, j, 6, 6, 1) == expected && LOC1(j, i, 6, 6, 1) == expected);
}

TEST(MatrixStorage, ZeroedColumnMajorCopiesBlocks) {
  TMatrix m(3, 3);
  for (int k = 0; k < 9; ++k) EXPECT_EQ(m.data()[k], 0.0);
  for (int i = 1; i <= 3; ++i)
    for (int j = 1; j <= 3; ++j) m(i, j) = 10 * i + j;
  EXPECT_EQ(m.data()[LOC1(2, 3, 3, 3, 0) - 1], 23.0);
  const TMatrix copy(m), block = m.SubMatrix(2, 3, 2, 2);  // padded outside with zero
  m = 4;
  EXPECT_TRUE(copy(2, 3) == 23.0 && m(1, 2) == 4.0);
  EXPECT_TRUE(block(1, 1) == 23.0 && block(2, 1) == 33.0 && block(1, 2) == 0.0 && block(2, 2) == 0.0);
  const TMatrix empty(-3, 2);
  EXPECT_EQ(empty.rows(), 0);
  EXPECT_NE(empty.data(), nullptr);

  TSMatrix s(3);  // a symmetric block is applied once, not to both triangles
  TMatrix sym(2, 2);
  sym(1, 1) = 1.0;
  sym(1, 2) = sym(2, 1) = 2.0;
  sym(2, 2) = 3.0;
  ASSERT_TRUE(s.BlockOper(2, 2, sym, '+') && s.BlockOper(2, 2, sym, '+'));
  EXPECT_TRUE(s(2, 2) == 2.0 && s(2, 3) == 4.0 && s(3, 3) == 6.0 && s(1, 1) == 0.0);
  ASSERT_TRUE(s.BlockOper(3, 1, TMatrix(1, 1), '='));
  EXPECT_EQ(s(1, 3), 0.0);
  EXPECT_FALSE(s.BlockOper(3, 3, sym, '+'));
  EXPECT_FALSE(s.BlockOper(1, 1, sym, '*'));
}

// Every product against the plain triple loop on explicit transposes and full symmetric matrices.
TEST(MatrixProducts, AgreeWithExplicitProducts) {
  std::mt19937 rng(11);
  const TMatrix a = adj_test::randomMatrix(4, 3, rng), b = adj_test::randomMatrix(4, 3, rng);
  const TSMatrix s = adj_test::randomPositiveDefinite(3, rng), q = adj_test::randomPositiveDefinite(4, rng);
  const TMatrix fs = full(s), at = transpose(a), asat = multiply(multiply(a, fs), at);
  TMatrix r(4, 4), r33(3, 3), r43(4, 3), r34(3, 4);
  TSMatrix s4(4), s3(3);
  const auto check = [](int status, const auto& result, const TMatrix& expected) {
    ASSERT_EQ(status, 0);
    adj_test::expectNear(full(result), expected, 1e-12);
  };
  check(svy_math::MATRopR1_R2t(r, a, b, '='), r, multiply(a, transpose(b)));
  check(svy_math::MATRopR1t_R2(r33, a, b, '='), r33, multiply(at, b));
  check(svy_math::MATRopR1_R2(r, a, transpose(b), '='), r, multiply(a, transpose(b)));
  check(svy_math::MATRopR1_R2_R3t(r, a, fs, b, '='), r, multiply(multiply(a, fs), transpose(b)));
  check(svy_math::MATRopR1_S_R2t(r, a, s, b, '='), r, multiply(multiply(a, fs), transpose(b)));
  check(svy_math::MATRopR_S(r43, a, s, '='), r43, multiply(a, fs));
  check(svy_math::MATRopS_R(r34, s, at, '='), r34, multiply(fs, at));
  check(0, s.MatrProduct(at), multiply(fs, at));
  check(svy_math::MRAtQL(r33, a, q, b, '='), r33, multiply(multiply(at, full(q)), b));
  check(svy_math::SMATRopR_S_Rt(s4, a, s, '='), s4, asat);
  check(0, s.A_This_At(a), asat);
  check(svy_math::SMATRopRt_R(s3, a, '='), s3, multiply(at, a));
  check(svy_math::SMATRopRt_S_R(s4, at, s, '='), s4, asat);
  check(svy_math::SMATRopABti(s4, a, multiply(a, fs), '='), s4, asat);
}

// '+' and '-' accumulate into the result (twice plus once minus is once); a sum less a term gives the other
// back; wrong shapes or operators are refused and leave the result alone.
TEST(MatrixProducts, AccumulationAndRefusals) {
  std::mt19937 rng(5);
  const TMatrix a = adj_test::randomMatrix(2, 2, rng), b = adj_test::randomMatrix(2, 2, rng);
  TMatrix once(2, 2), r(2, 2), wrong(3, 2);
  ASSERT_EQ(svy_math::MATRopR1_R2(once, a, b, '='), 0);
  for (char op : {'+', '+', '-'}) ASSERT_EQ(svy_math::MATRopR1_R2(r, a, b, op), 0);
  adj_test::expectNear(r, once, 1e-15);
  wrong = 9;
  EXPECT_EQ(svy_math::MATRopR1_R2(wrong, a, b, '='), -1);
  EXPECT_EQ(wrong(1, 1), 9.0);
  EXPECT_EQ(svy_math::MATRopR1_R2(r, a, TMatrix(3, 2), '='), -1);
  EXPECT_EQ(svy_math::MATRopR1_R2(r, a, b, '*'), -1);

  const TSMatrix s1 = adj_test::randomPositiveDefinite(3, rng), s2 = adj_test::randomPositiveDefinite(3, rng);
  TSMatrix sum(3), back(3), other(2);
  ASSERT_EQ(svy_math::SMATRopS1_S2(sum, s1, s2, '+'), 0);
  ASSERT_EQ(svy_math::SMATRopS1_S2(back, sum, s2, '-'), 0);
  adj_test::expectNear(full(back), full(s1), 1e-13);
  EXPECT_EQ(svy_math::SMATRopS1_S2(other, s1, s2, '+'), -1);
  EXPECT_EQ(svy_math::SMATRopS1_S2(sum, s1, s2, '='), -1);
}

}  // namespace
