// Matrix storage, products and inversions, fixed-size matrices, covariances and weighted means, against
// products written out plainly (seeded random matrices, explicit loops) and inverses multiplied back.
#include <gtest/gtest.h>

#include <cmath>
#include <random>
#include <utility>
#include <vector>

#include "svymath/adjustment/coord_cov.h"
#include "svymath/adjustment/covar.h"
#include "svymath/adjustment/matr2_2.h"
#include "svymath/adjustment/matr3_3.h"
#include "svymath/adjustment/matrix_products.h"
#include "svymath/adjustment/matrix_storage.h"
#include "svymath/adjustment/symmetric_inversion.h"
#include "svymath/adjustment/weighted_average.h"
#include "svymath/foundation/constants.h"

namespace {

using svy_math::covar;
using svy_math::LOC1;
using svy_math::matr2_2;
using svy_math::matr3_3;
using svy_math::TMatrix;
using svy_math::TSMatrix;
using Vec3 = svy_math::TAbstractPoint3<double>;

TMatrix randomMatrix(int rows, int cols, std::mt19937& rng) {
  std::uniform_real_distribution<double> value(-2.0, 2.0);
  TMatrix m(rows, cols);
  for (int j = 1; j <= cols; ++j)
    for (int i = 1; i <= rows; ++i) m(i, j) = value(rng);
  return m;
}

TMatrix full(const TSMatrix& s) {
  TMatrix m(s.order(), s.order());
  for (int i = 1; i <= s.order(); ++i)
    for (int j = 1; j <= s.order(); ++j) m(i, j) = s(i, j);
  return m;
}

TMatrix full(const TMatrix& m) { return m; }

TMatrix transpose(const TMatrix& m) {
  TMatrix t(m.cols(), m.rows());
  for (int i = 1; i <= m.rows(); ++i)
    for (int j = 1; j <= m.cols(); ++j) t(j, i) = m(i, j);
  return t;
}

TMatrix multiply(const TMatrix& x, const TMatrix& y) {
  TMatrix p(x.rows(), y.cols());
  for (int i = 1; i <= x.rows(); ++i)
    for (int j = 1; j <= y.cols(); ++j)
      for (int k = 1; k <= x.cols(); ++k) p(i, j) += x(i, k) * y(k, j);
  return p;
}

// A random symmetric positive-definite matrix: b^T b + n I.
TSMatrix randomPositiveDefinite(int n, std::mt19937& rng) {
  const TMatrix b = randomMatrix(n, n, rng), p = multiply(transpose(b), b);
  TSMatrix s(n);
  for (int i = 1; i <= n; ++i)
    for (int j = 1; j <= i; ++j) s(i, j) = p(i, j) + (i == j ? n : 0.0);
  return s;
}

void expectNear(const TMatrix& x, const TMatrix& y, double tolerance) {
  ASSERT_TRUE(x.rows() == y.rows() && x.cols() == y.cols()) << x.rows() << "x" << x.cols();
  for (int i = 1; i <= x.rows(); ++i)
    for (int j = 1; j <= x.cols(); ++j) EXPECT_NEAR(x(i, j), y(i, j), tolerance) << "element " << i << "," << j;
}

// The product of a symmetric matrix and its claimed inverse is the identity.
void expectInverseOf(const TSMatrix& original, const TSMatrix& inverse, double tolerance) {
  TMatrix identity(original.order(), original.order());
  for (int i = 1; i <= original.order(); ++i) identity(i, i) = 1.0;
  expectNear(multiply(full(original), full(inverse)), identity, tolerance);
}

void expectIdentity(const svy_math::matr3_3& m, double tolerance) {
  for (int i = 0; i < 3; ++i)
    for (int j = 0; j < 3; ++j) EXPECT_NEAR(m(i, j), i == j ? 1.0 : 0.0, tolerance) << "element " << i << "," << j;
}

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
  const TMatrix a = randomMatrix(4, 3, rng), b = randomMatrix(4, 3, rng);
  const TSMatrix s = randomPositiveDefinite(3, rng), q = randomPositiveDefinite(4, rng);
  const TMatrix fs = full(s), at = transpose(a), asat = multiply(multiply(a, fs), at);
  TMatrix r(4, 4), r33(3, 3), r43(4, 3), r34(3, 4);
  TSMatrix s4(4), s3(3);
  const auto check = [](int status, const auto& result, const TMatrix& expected) {
    ASSERT_EQ(status, 0);
    expectNear(full(result), expected, 1e-12);
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
  const TMatrix a = randomMatrix(2, 2, rng), b = randomMatrix(2, 2, rng);
  TMatrix once(2, 2), r(2, 2), wrong(3, 2);
  ASSERT_EQ(svy_math::MATRopR1_R2(once, a, b, '='), 0);
  for (char op : {'+', '+', '-'}) ASSERT_EQ(svy_math::MATRopR1_R2(r, a, b, op), 0);
  expectNear(r, once, 1e-15);
  wrong = 9;
  EXPECT_EQ(svy_math::MATRopR1_R2(wrong, a, b, '='), -1);
  EXPECT_EQ(wrong(1, 1), 9.0);
  EXPECT_EQ(svy_math::MATRopR1_R2(r, a, TMatrix(3, 2), '='), -1);
  EXPECT_EQ(svy_math::MATRopR1_R2(r, a, b, '*'), -1);

  const TSMatrix s1 = randomPositiveDefinite(3, rng), s2 = randomPositiveDefinite(3, rng);
  TSMatrix sum(3), back(3), other(2);
  ASSERT_EQ(svy_math::SMATRopS1_S2(sum, s1, s2, '+'), 0);
  ASSERT_EQ(svy_math::SMATRopS1_S2(back, sum, s2, '-'), 0);
  expectNear(full(back), full(s1), 1e-13);
  EXPECT_EQ(svy_math::SMATRopS1_S2(other, s1, s2, '+'), -1);
  EXPECT_EQ(svy_math::SMATRopS1_S2(sum, s1, s2, '='), -1);
}

// The inverse times the original is the identity (both ways) and inverting twice gives the matrix back. The
// determinant test is absolute (strictly within +-1e-12), so a regular matrix of small elements, such as a
// covariance in square metres, counts as singular like the truly singular ones: the inverse is all zero.
TEST(Matr3Inverse, InverseTimesOriginalIsIdentityOrZeroWhenSingular) {
  const std::pair<matr3_3, double> cases[] = {
      {matr3_3(0.36, 0.48, -0.8, -0.8, 0.6, 0.0, 0.48, 0.64, 0.6), 1e-14},
      {matr3_3(2.0, -1.0, 0.5, 4.0, 3.0, -2.0, 1.0, 7.0, 9.0), 1e-14},
      {matr3_3(0.0, 1.0, 2.0, 1.0, 0.0, 3.0, 4.0, -3.0, 8.0), 1e-14},  // zero first column entry
      {matr3_3(1.0, 1.0, 1.0, 1.0, 1.0 + 1e-3, 1.0, 1.0, 1.0, 1.0 + 2e-3), 1e-9}};
  for (const auto& [m, tolerance] : cases) {
    SCOPED_TRACE(::testing::Message() << "det " << m.det());
    const matr3_3 inverse(m, matr3_3::kInverse), back(inverse, matr3_3::kInverse);
    expectIdentity(m * inverse, tolerance);
    for (int k = 0; k < 9; ++k) EXPECT_NEAR(back.m[k], m.m[k], tolerance * (1.0 + std::fabs(m.m[k])));
  }
  for (const matr3_3& m :
       {matr3_3(), matr3_3(1, 2, 3, 4, 5, 6, 7, 8, 9),
        matr3_3(1e-5, 0, 0, 0, 1e-5, 0, 0, 0, 5e-3), matr3_3(4e-6, 1e-6, 0.0, 1e-6, 9e-6, 2e-6, 0.0, 2e-6, 1e-5)})
    for (double element : matr3_3(m, matr3_3::kInverse).m) EXPECT_EQ(element, 0.0) << m.det();
}

// Transpose, an unknown operation (all NaN), blocks of a dense matrix (NaN outside it), the multiplicative
// determinant, the point product, and the same for the 2x2 matrix.
TEST(FixedMatrices, ConstructionAndProducts) {
  const matr3_3 m(1, 2, 3, 4, 5, 6, 7, 8, 9), t(m, matr3_3::kTranspose);
  EXPECT_TRUE(t(0, 2) == 7.0 && t(2, 0) == 3.0);
  for (double element : matr3_3(m, 'x').m) EXPECT_TRUE(std::isnan(element));
  TMatrix r(4, 4);
  for (int i = 1; i <= 4; ++i)
    for (int j = 1; j <= 4; ++j) r(i, j) = 10 * i + j;
  const matr3_3 block(r, 2, 2), outside(r, 3, 3);
  EXPECT_TRUE(block(0, 0) == 22.0 && block(2, 1) == 43.0 && outside(1, 1) == 44.0);
  EXPECT_TRUE(std::isnan(outside(2, 2)));
  const matr3_3 a(2.0, -1.0, 0.5, 4.0, 3.0, -2.0, 1.0, 7.0, 9.0), b(0.36, 0.48, -0.8, -0.8, 0.6, 0.0, 0.48, 0.64, 0.6);
  EXPECT_NEAR((a * b).det(), a.det() * b.det(), 1e-12);
  const Vec3 p = a * Vec3(1.0, 2.0, 3.0);
  EXPECT_TRUE(p[0] == 1.5 && p[1] == 4.0 && p[2] == 42.0);

  const matr2_2 m2(3.0, 1.0, -2.0, 4.0), i2 = m2 * matr2_2(m2, matr2_2::kInverse);
  for (int k = 0; k < 4; ++k) EXPECT_NEAR(i2.m[k], k == 0 || k == 3 ? 1.0 : 0.0, 1e-15);
  EXPECT_EQ(matr2_2(m2, matr2_2::kTranspose)(0, 1), -2.0);
  for (double element : matr2_2(matr2_2(1.0, 2.0, 2.0, 4.0), matr2_2::kInverse).m) EXPECT_EQ(element, 0.0);
  const svy_math::TAbstractPoint2<double> p2 = m2 * svy_math::TAbstractPoint2<double>(1.0, 1.0);
  EXPECT_TRUE(p2[0] == 4.0 && p2[1] == 2.0);
  TSMatrix s(2);
  s(2, 1) = 6.0;
  const matr2_2 fromSymmetric(s, 1, 1);
  EXPECT_TRUE(fromSymmetric(0, 1) == 6.0 && fromSymmetric(1, 0) == 6.0);
}

// The constructor from a 3x3 matrix adds each element to its mirror without halving: a symmetric input is
// doubled, a matrix holding each off-diagonal term once (either triangle) gives it once. Propagation
// M C M^T against the explicit product; accumulation of matrices.
TEST(Covar, ConstructionPropagationAndAccumulation) {
  const covar doubled(matr3_3(4, 1, 2, 1, 5, 3, 2, 3, 6));
  const double expected[6] = {8, 2, 10, 4, 6, 12};
  for (int k = 0; k < 6; ++k) EXPECT_EQ(doubled.c[k], expected[k]);
  const covar once(matr3_3(2, 0, 0, 1, 2.5, 0, 0, 3, 3));
  EXPECT_TRUE(once(0, 1) == 1.0 && once(2, 1) == 3.0 && once(1, 1) == 5.0);
  EXPECT_TRUE(matr3_3(once)(0, 1) == 1.0 && matr3_3(once)(1, 0) == 1.0);

  const covar c(4, 1, 5, 2, 3, 6);
  const matr3_3 m(0.36, 0.48, -0.8, -0.8, 0.6, 0.0, 0.48, 0.64, 0.6);
  const covar propagated = m & c;
  const matr3_3 explicitProduct = m * matr3_3(c) * matr3_3(m, matr3_3::kTranspose);
  for (int k = 0; k < 9; ++k) EXPECT_NEAR(propagated(k / 3, k % 3), explicitProduct.m[k], 1e-14);
  covar sum(c);
  sum += matr3_3(c);
  for (int k = 0; k < 6; ++k) EXPECT_EQ(sum.c[k], 2.0 * c.c[k]);
  sum -= matr3_3(1, 2, 0, 0, 0, 0, 0, 0, 0);  // symmetric part: 1 at (0,1) and (1,0)
  EXPECT_EQ(sum(1, 0), 2.0 * c(1, 0) - 1.0);
  const Vec3 p = c * Vec3(1, 0, 0);
  EXPECT_TRUE(p[0] == 4.0 && p[1] == 1.0 && p[2] == 2.0);
}

// The eigen-decomposition by its definition: A v = lambda v for every column, the columns orthonormal and
// the off-diagonal elements left zero; at unit scale, millimetre-level covariances in square metres, values
// near the double range, a repeated eigenvalue and a diagonal input (identity vectors at once).
TEST(CovarEigen, VectorsSatisfyTheDefinition) {
  std::vector<covar> inputs{covar(2.0, 1.0, 2.0, 1.0, 1.0, 2.0), covar(4.0, 0.0, 9.0, 0.0, 0.0, 1.0)};
  std::mt19937 rng(2024);
  std::uniform_real_distribution<double> value(-1.0, 1.0);
  for (double scale : {1.0, 1e-6, 1e6, 1e300, 1e-300})
    for (int trial = 0; trial < 200; ++trial) {
      inputs.emplace_back();
      for (double& element : inputs.back().c) element = value(rng) * scale;
    }
  for (const covar& original : inputs) {
    double scale = 0.0;
    for (double element : original.c) scale = std::fmax(scale, std::fabs(element));
    covar d(original);
    const matr3_3 vectors = d.eigen();
    for (int j = 0; j < 3; ++j) {
      const Vec3 v(vectors(0, j), vectors(1, j), vectors(2, j)), av = original * v;
      for (int i = 0; i < 3; ++i) ASSERT_NEAR(av[i], d(j, j) * v[i], 1e-12 * scale) << "column " << j;
    }
    expectIdentity(matr3_3(vectors, matr3_3::kTranspose) * vectors, 1e-13);
    for (double offDiagonal : {d(1, 0), d(2, 0), d(2, 1)}) ASSERT_NEAR(offDiagonal, 0.0, 1e-11 * scale);
  }
  covar diagonal(inputs[1]);
  expectIdentity(diagonal.eigen(), 0.0);
  EXPECT_TRUE(diagonal.c[0] == 4.0 && diagonal.c[2] == 9.0 && diagonal.c[5] == 1.0);
  const Vec3 axes = inputs[0].GetEigen(1.0);  // eigenvalues 4, 1, 1
  for (int k = 0; k < 3; ++k) EXPECT_NEAR(axes[k], k == 0 ? 2.0 : 1.0, 1e-14);
}

// The error ellipsoid: semi-axes sorted, and the rotation rebuilds the covariance (R diag(lambda) R^T = C); a
// semi-definite covariance keeps a zero axis instead of a NaN; a non-finite element leaves the covariance
// and gives undefined vectors and axes.
TEST(CovarEigen, ErrorEllipsoidAndNonFinite) {
  const covar c(9e-6, 2e-6, 4e-6, 1e-6, -1e-6, 1e-6);
  const Vec3 axes = c.GetEigen(2.0);
  EXPECT_TRUE(axes[0] >= axes[1] && axes[1] >= axes[2]);
  const matr3_3 r = c.DuserDeigen();
  EXPECT_NEAR(r.det(), 1.0, 1e-14);
  matr3_3 lambda;
  for (int k = 0; k < 3; ++k) lambda(k, k) = (axes[k] / 2.0) * (axes[k] / 2.0);
  const matr3_3 rebuilt = r * lambda * matr3_3(r, matr3_3::kTranspose);
  for (int k = 0; k < 9; ++k) EXPECT_NEAR(rebuilt.m[k], c(k / 3, k % 3), 1e-18);
  EXPECT_NEAR(covar(1.0, 1.0, 1.0, 0.0, 0.0, 2.0).GetEigen(1.0)[2], 0.0, 1e-7);

  covar nonFinite(1.0, std::nan(""), 2.0, 0.0, 0.0, 3.0);
  for (double element : nonFinite.eigen().m) EXPECT_TRUE(std::isnan(element));
  EXPECT_EQ(nonFinite.c[0], 1.0);
  EXPECT_TRUE(std::isnan(covar(1.0, INFINITY, 2.0, 0.0, 0.0, 3.0).GetEigen(1.0)[0]));
}

// Semi-definite covariances v v^T + w w^T of random vectors: the Jacobi sweeps leave the zero eigenvalue a
// rounding hair either side of 0, and the axis must stay 0 (not NaN); the squared axes sum to the trace.
TEST(CovarEigen, RankTwoCovariancesKeepAZeroAxis) {
  std::mt19937 rng(11);
  std::uniform_real_distribution<double> value(-0.01, 0.01);
  for (int trial = 0; trial < 200; ++trial) {
    double v[3], w[3];
    for (int k = 0; k < 3; ++k) v[k] = value(rng), w[k] = value(rng);
    const auto element = [&](int i, int j) { return v[i] * v[j] + w[i] * w[j]; };
    const covar c(element(0, 0), element(1, 0), element(1, 1), element(2, 0), element(2, 1), element(2, 2));
    const Vec3 axes = c.GetEigen(1.0);
    ASSERT_TRUE(std::isfinite(axes[0]) && std::isfinite(axes[1]) && std::isfinite(axes[2])) << trial;
    EXPECT_LE(axes[2], 1e-7 * axes[0]);
    const double trace = element(0, 0) + element(1, 1) + element(2, 2);
    EXPECT_NEAR(axes[0] * axes[0] + axes[1] * axes[1] + axes[2] * axes[2], trace, 1e-14 * trace);
  }
}

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
  const TSMatrix s = randomPositiveDefinite(5, rng);
  TSMatrix f(s);
  ASSERT_EQ(svy_math::CanInvert(f, 1e6), 1);
  TMatrix u(5, 5);
  for (int k = 1; k <= 5; ++k)
    for (int i = k; i <= 5; ++i) u(k, i) = k == i ? 1.0 / f(k, k) : f(k, i);
  const TMatrix product = multiply(transpose(u), u);
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
    if (c.expected == 0) expectIdentity(svy_math::matr3_3(c.c) * svy_math::matr3_3(inverse), 1e-9);
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
  expectInverseOf(band, inverse, 1e-14);
  EXPECT_TRUE(profile[0] == 1 && profile[2] == 2 && profile[3] == 1 && profile[5] == 3);
  std::mt19937 rng(17);
  for (int n : {1, 2, 6, 12}) {
    const TSMatrix s = randomPositiveDefinite(n, rng);
    TSMatrix dense(s);
    ASSERT_EQ(svy_math::RareInversion(dense, nullptr, 0), 0);
    expectInverseOf(s, dense, 1e-12);
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
  const TMatrix b = randomMatrix(2, 4, rng), bb = multiply(transpose(b), b);
  TSMatrix s(4);
  for (int i = 1; i <= 4; ++i)
    for (int j = 1; j <= i; ++j) s(i, j) = bb(i, j);
  for (int defect : {-1, 2}) {
    TSMatrix pinv(s);
    ASSERT_EQ(svy_math::PseudoInversion(pinv, defect), 2);
    expectNear(multiply(multiply(full(s), full(pinv)), full(s)), full(s), 1e-12);
    expectNear(multiply(multiply(full(pinv), full(s)), full(pinv)), full(pinv), 1e-9);
  }
  const TSMatrix regular = randomPositiveDefinite(3, rng);
  TSMatrix pinv(regular);
  ASSERT_EQ(svy_math::PseudoInversion(pinv, -1), 3);
  expectInverseOf(regular, pinv, 1e-12);
  EXPECT_EQ(svy_math::PseudoInversion(pinv, 4), -1);
}

void expectSameCov(const TCoordCov& a, const TCoordCov& b, double tolerance) {
  for (int k = 0; k < 9; ++k) EXPECT_NEAR(a.element(k / 3, k % 3), b.element(k / 3, k % 3), tolerance) << k;
}

// Inverse times covariance is the identity (unit scale, square metres, uncorrelated tiny variances); a
// singular or non-finite covariance is refused and the output left alone. Scaling multiplies element (i, j)
// by fi * fj.
TEST(TCoordCov, InverseTimesCovarianceAndScale) {
  for (const TCoordCov& c : {TCoordCov(4, 5, 6, 1, 2, 3), TCoordCov(4e-6, 9e-6, 1e-5, 1e-6, 0.0, 2e-6),
                             TCoordCov(1e-8, 1e-8, 4e-8, 0.0, 0.0, 0.0)}) {
    TCoordCov inverse;
    ASSERT_TRUE(c.getInverse(inverse));
    for (int i = 0; i < 3; ++i)
      for (int j = 0; j < 3; ++j) {
        double sum = 0.0;
        for (int k = 0; k < 3; ++k) sum += c.element(i, k) * inverse.element(k, j);
        EXPECT_NEAR(sum, i == j ? 1.0 : 0.0, 1e-12);
      }
  }
  TCoordCov out(7, 7, 7, 0, 0, 0);
  for (const TCoordCov& c : {TCoordCov(), TCoordCov(1, 1, 1, 1, 1, 1), TCoordCov(std::nan(""), 1, 1, 0, 0, 0)})
    EXPECT_FALSE(c.getInverse(out));
  EXPECT_EQ(out.s11, 7.0);
  TCoordCov c(4, 5, 6, 1, 2, 3);
  c.scale(2.0, 3.0, -1.0);
  expectSameCov(c, TCoordCov(16, 45, 6, 6, -4, -9), 0.0);
}

// At latitude 0, longitude 0 the local north is +Z, east +Y and up +X; elsewhere the rotation keeps the
// trace and the inverse rotation brings the covariance back.
TEST(TCoordCov, GeocentricTopocentricAxesAndRoundTrip) {
  TCoordCov equator(1.0, 2.0, 3.0, 0.1, 0.2, 0.3);  // X, Y, Z
  equator.geocentric2topocentric(0.0, 0.0);
  expectSameCov(equator, TCoordCov(3.0, 2.0, 1.0, 0.3, 0.2, 0.1), 1e-15);
  const TCoordCov original(4e-6, 9e-6, 1e-5, 1e-6, -5e-7, 2e-6);
  for (double latDeg : {-89.9, -45.0, 0.0, 33.3, 60.0, 90.0})
    for (double lonDeg : {-179.0, -30.0, 0.0, 100.0}) {
      const double lat = latDeg * svy_math::units::kDegToRad, lon = lonDeg * svy_math::units::kDegToRad;
      TCoordCov c(original);
      c.geocentric2topocentric(lat, lon);
      EXPECT_NEAR(c.s11 + c.s22 + c.s33, original.s11 + original.s22 + original.s33, 1e-20);
      c.topocentric2geocentric(lat, lon);
      expectSameCov(c, original, 1e-20);
    }
}

// Uncorrelated: weights by inverse variance per component (b has a quarter of a's variance in north and
// east, the same in height). Correlated: the generalised least-squares mean, W_a = [[4/3, -2/3], [-2/3, 4/3]],
// W_b = I, mean = (W_a + I)^-1 (W_a a + b) = (157/15, 302/15): the east moves although both east values agree.
// Components without weight keep the output's value. Bad input is refused and adds nothing.
TEST(CWaCoords, WeightedAverageAndRefusals) {
  CWaCoords average;
  TCoords mean;
  ASSERT_TRUE(
      average.add(TCoords{5000000.010, 500000.020, 100.0, TCoords::kAllValid}, TCoordCov(4e-6, 4e-6, 1e-4, 0, 0, 0)));
  ASSERT_TRUE(average.add(TCoords{5000000.010 + 0.030, 500000.020 - 0.060, 100.5, TCoords::kAllValid},
                          TCoordCov(1e-6, 1e-6, 1e-4, 0, 0, 0)));
  ASSERT_TRUE(average.getResult(mean));
  EXPECT_NEAR(mean.north - 5000000.010, 0.8 * 0.030, 1e-9);
  EXPECT_NEAR(mean.east - 500000.020, -0.8 * 0.060, 1e-9);
  EXPECT_NEAR(mean.height, 100.25, 1e-12);
  EXPECT_EQ(mean.mask, TCoords::kAllValid);

  const unsigned horizontal = TCoords::kNorthValid | TCoords::kEastValid;
  CWaCoords correlated;
  ASSERT_TRUE(correlated.add(TCoords{10.0, 20.0, 0.0, horizontal}, TCoordCov(1.0, 1.0, 0.0, 0.5, 0.0, 0.0)));
  ASSERT_TRUE(correlated.add(TCoords{11.0, 20.0, 0.0, horizontal}, TCoordCov(1.0, 1.0, 0.0, 0.0, 0.0, 0.0)));
  mean.height = -7.0;
  ASSERT_TRUE(correlated.getResult(mean));
  EXPECT_NEAR(mean.north, 157.0 / 15.0, 1e-12);
  EXPECT_NEAR(mean.east, 302.0 / 15.0, 1e-12);
  EXPECT_EQ(mean.height, -7.0);
  EXPECT_EQ(mean.mask, horizontal);

  CWaCoords empty;
  EXPECT_FALSE(empty.getResult(mean));
  EXPECT_FALSE(empty.add(TCoords(), TCoordCov()));
  EXPECT_FALSE(empty.add(TCoords(), TCoordCov(1, -1, 1, 0, 0, 0)));
  EXPECT_FALSE(empty.add(TCoords{std::nan(""), 0, 0, TCoords::kAllValid}, TCoordCov(1, 1, 1, 0, 0, 0)));
  EXPECT_FALSE(empty.add(TCoords{std::nan(""), 0, 0, 0}, TCoordCov(1, 1, 1, 0, 0, 0)));
  EXPECT_EQ(empty.count(), 0);
}

}  // namespace
