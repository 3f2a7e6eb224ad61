#include <gtest/gtest.h>

#include <random>

#include "matrix_test_support.h"
#include "svymath/adjustment/matrix_products.h"
#include "svymath/adjustment/matrix_storage.h"

using svy_math::LOC1;
using svy_math::TMatrix;
using svy_math::TSMatrix;

namespace {

struct LocCase {
  int i, j, n, mode, expected;
};

class Loc1Test : public ::testing::TestWithParam<LocCase> {};

TEST_P(Loc1Test, GivesStoragePosition) {
  const LocCase& c = GetParam();
  EXPECT_EQ(LOC1(c.i, c.j, c.n, 0, c.mode), c.expected);
}

INSTANTIATE_TEST_SUITE_P(Modes, Loc1Test,
                         ::testing::Values(LocCase{2, 3, 4, 0, 10}, LocCase{1, 1, 4, 0, 1}, LocCase{4, 1, 4, -3, 4},
                                           LocCase{2, 3, 9, 1, 5}, LocCase{3, 2, 9, 1, 5}, LocCase{1, 1, 3, 1, 1},
                                           LocCase{3, 3, 3, 1, 6}, LocCase{3, 1, 3, 1, 4}, LocCase{2, 3, 3, 2, 0},
                                           LocCase{3, 3, 3, 2, 3}, LocCase{3, 3, 3, 7, 3}));

TEST(Loc1, SymmetricPackingMatchesRowWiseLowerTriangle) {
  int expected = 1;
  for (int i = 1; i <= 6; ++i)
    for (int j = 1; j <= i; ++j) {
      EXPECT_EQ(LOC1(i, j, 6, 6, 1), expected);
      EXPECT_EQ(LOC1(j, i, 6, 6, 1), expected);
      ++expected;
    }
}

TEST(TMatrixStorage, ZeroedColumnMajorCopiedAndFilled) {
  TMatrix m(2, 3);
  for (int k = 0; k < 6; ++k) EXPECT_EQ(m.data()[k], 0.0);
  m(2, 3) = 7.0;
  EXPECT_EQ(m.data()[LOC1(2, 3, 2, 3, 0) - 1], 7.0);
  TMatrix copy(m);
  m = 4;
  EXPECT_EQ(copy(2, 3), 7.0);
  EXPECT_EQ(m(1, 2), 4.0);
  copy = m;
  EXPECT_EQ(copy(2, 3), 4.0);
  const TMatrix empty(-3, 2);
  EXPECT_EQ(empty.rows(), 0);
  EXPECT_NE(empty.data(), nullptr);
}

TEST(TMatrixStorage, SubMatrixPadsOutsideWithZero) {
  TMatrix m(3, 3);
  for (int i = 1; i <= 3; ++i)
    for (int j = 1; j <= 3; ++j) m(i, j) = 10 * i + j;
  const TMatrix block = m.SubMatrix(2, 3, 2, 2);
  EXPECT_EQ(block(1, 1), 23.0);
  EXPECT_EQ(block(2, 1), 33.0);
  EXPECT_EQ(block(1, 2), 0.0);
  EXPECT_EQ(block(2, 2), 0.0);
}

TEST(TSMatrixStorage, BlockOperAppliesSymmetricBlockOnce) {
  TSMatrix s(3);
  TMatrix block(2, 2);
  block(1, 1) = 1.0;
  block(1, 2) = block(2, 1) = 2.0;
  block(2, 2) = 3.0;
  ASSERT_TRUE(s.BlockOper(2, 2, block, '+'));
  ASSERT_TRUE(s.BlockOper(2, 2, block, '+'));
  EXPECT_EQ(s(2, 2), 2.0);
  EXPECT_EQ(s(2, 3), 4.0);
  EXPECT_EQ(s(3, 3), 6.0);
  EXPECT_EQ(s(1, 1), 0.0);
  ASSERT_TRUE(s.BlockOper(3, 1, TMatrix(1, 1), '='));
  EXPECT_EQ(s(1, 3), 0.0);
  EXPECT_FALSE(s.BlockOper(3, 3, block, '+'));
  EXPECT_FALSE(s.BlockOper(1, 1, block, '*'));
}

// Every product against the plain triple loop on explicit transposes and full symmetric matrices.
TEST(MatrixProducts, AgreeWithExplicitProducts) {
  std::mt19937 rng(11);
  const TMatrix a = adj_test::randomMatrix(4, 3, rng);
  const TMatrix b = adj_test::randomMatrix(4, 3, rng);
  const TSMatrix s = adj_test::randomPositiveDefinite(3, rng);
  const TSMatrix q = adj_test::randomPositiveDefinite(4, rng);

  TMatrix full(3, 3);
  for (int i = 1; i <= 3; ++i)
    for (int j = 1; j <= 3; ++j) full(i, j) = s(i, j);
  auto transpose = [](const TMatrix& m) {
    TMatrix t(m.cols(), m.rows());
    for (int i = 1; i <= m.rows(); ++i)
      for (int j = 1; j <= m.cols(); ++j) t(j, i) = m(i, j);
    return t;
  };
  auto multiply = [](const TMatrix& x, const TMatrix& y) {
    TMatrix p(x.rows(), y.cols());
    for (int i = 1; i <= x.rows(); ++i)
      for (int j = 1; j <= y.cols(); ++j)
        for (int k = 1; k <= x.cols(); ++k) p(i, j) += x(i, k) * y(k, j);
    return p;
  };
  auto expectSame = [](const TMatrix& x, const TMatrix& y) {
    ASSERT_EQ(x.rows(), y.rows());
    ASSERT_EQ(x.cols(), y.cols());
    for (int i = 1; i <= x.rows(); ++i)
      for (int j = 1; j <= x.cols(); ++j) EXPECT_NEAR(x(i, j), y(i, j), 1e-12);
  };
  auto expectSameSymmetric = [](const TSMatrix& x, const TMatrix& y) {
    ASSERT_EQ(x.order(), y.rows());
    for (int i = 1; i <= x.order(); ++i)
      for (int j = 1; j <= x.order(); ++j) EXPECT_NEAR(x(i, j), y(i, j), 1e-12);
  };
  TMatrix fullQ(4, 4);
  for (int i = 1; i <= 4; ++i)
    for (int j = 1; j <= 4; ++j) fullQ(i, j) = q(i, j);

  TMatrix r(4, 4);
  ASSERT_EQ(svy_math::MATRopR1_R2t(r, a, b, '='), 0);
  expectSame(r, multiply(a, transpose(b)));
  TMatrix r33(3, 3);
  ASSERT_EQ(svy_math::MATRopR1t_R2(r33, a, b, '='), 0);
  expectSame(r33, multiply(transpose(a), b));
  ASSERT_EQ(svy_math::MATRopR1_R2(r, a, transpose(b), '='), 0);
  expectSame(r, multiply(a, transpose(b)));
  ASSERT_EQ(svy_math::MATRopR1_R2_R3t(r, a, full, b, '='), 0);
  expectSame(r, multiply(multiply(a, full), transpose(b)));
  ASSERT_EQ(svy_math::MATRopR1_S_R2t(r, a, s, b, '='), 0);
  expectSame(r, multiply(multiply(a, full), transpose(b)));
  TMatrix r43(4, 3);
  ASSERT_EQ(svy_math::MATRopR_S(r43, a, s, '='), 0);
  expectSame(r43, multiply(a, full));
  TMatrix r34(3, 4);
  ASSERT_EQ(svy_math::MATRopS_R(r34, s, transpose(a), '='), 0);
  expectSame(r34, multiply(full, transpose(a)));
  expectSame(s.MatrProduct(transpose(a)), multiply(full, transpose(a)));
  ASSERT_EQ(svy_math::MRAtQL(r33, a, q, b, '='), 0);
  expectSame(r33, multiply(multiply(transpose(a), fullQ), b));

  TSMatrix s4(4);
  ASSERT_EQ(svy_math::SMATRopR_S_Rt(s4, a, s, '='), 0);
  expectSameSymmetric(s4, multiply(multiply(a, full), transpose(a)));
  expectSameSymmetric(s.A_This_At(a), multiply(multiply(a, full), transpose(a)));
  TSMatrix s3(3);
  ASSERT_EQ(svy_math::SMATRopRt_R(s3, a, '='), 0);
  expectSameSymmetric(s3, multiply(transpose(a), a));
  ASSERT_EQ(svy_math::SMATRopRt_S_R(s4, transpose(a), s, '='), 0);
  expectSameSymmetric(s4, multiply(multiply(a, full), transpose(a)));
  const TMatrix as = multiply(a, full);
  ASSERT_EQ(svy_math::SMATRopABti(s4, a, as, '='), 0);
  expectSameSymmetric(s4, multiply(as, transpose(a)));
}

TEST(MatrixProducts, AccumulationOperatorsAndShapeChecks) {
  std::mt19937 rng(5);
  const TMatrix a = adj_test::randomMatrix(2, 2, rng);
  const TMatrix b = adj_test::randomMatrix(2, 2, rng);
  TMatrix once(2, 2);
  ASSERT_EQ(svy_math::MATRopR1_R2(once, a, b, '='), 0);
  TMatrix r(2, 2);
  ASSERT_EQ(svy_math::MATRopR1_R2(r, a, b, '+'), 0);
  ASSERT_EQ(svy_math::MATRopR1_R2(r, a, b, '+'), 0);
  ASSERT_EQ(svy_math::MATRopR1_R2(r, a, b, '-'), 0);
  for (int i = 1; i <= 2; ++i)
    for (int j = 1; j <= 2; ++j) EXPECT_NEAR(r(i, j), once(i, j), 1e-15);

  TMatrix wrong(3, 2);
  wrong = 9;
  EXPECT_EQ(svy_math::MATRopR1_R2(wrong, a, b, '='), -1);
  EXPECT_EQ(wrong(1, 1), 9.0);
  EXPECT_EQ(svy_math::MATRopR1_R2(r, a, TMatrix(3, 2), '='), -1);
  EXPECT_EQ(svy_math::MATRopR1_R2(r, a, b, '*'), -1);
}

TEST(MatrixProducts, SymmetricSumAndDifference) {
  std::mt19937 rng(8);
  const TSMatrix s1 = adj_test::randomPositiveDefinite(3, rng);
  const TSMatrix s2 = adj_test::randomPositiveDefinite(3, rng);
  TSMatrix sum(3);
  TSMatrix back(3);
  ASSERT_EQ(svy_math::SMATRopS1_S2(sum, s1, s2, '+'), 0);
  ASSERT_EQ(svy_math::SMATRopS1_S2(back, sum, s2, '-'), 0);
  for (int i = 1; i <= 3; ++i)
    for (int j = 1; j <= 3; ++j) EXPECT_NEAR(back(i, j), s1(i, j), 1e-13);
  TSMatrix other(2);
  EXPECT_EQ(svy_math::SMATRopS1_S2(other, s1, s2, '+'), -1);
  EXPECT_EQ(svy_math::SMATRopS1_S2(sum, s1, s2, '='), -1);
}

}  // namespace
