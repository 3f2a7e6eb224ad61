#include <gtest/gtest.h>

#include <cmath>
#include <random>
#include <vector>

#include "matrix_test_support.h"
#include "svymath/adjustment/covar.h"
#include "svymath/adjustment/matr2_2.h"
#include "svymath/adjustment/matr3_3.h"

using svy_math::covar;
using svy_math::matr2_2;
using svy_math::matr3_3;
using Vec3 = svy_math::TAbstractPoint3<double>;

namespace {

// The inverse times the original is the identity (both ways) and inverting twice gives the matrix back. The
// determinant test is absolute (strictly within +-1e-12), so a regular matrix of small elements, such as a
// covariance in square metres, counts as singular like the truly singular ones: the inverse is all zero.
TEST(Matr3Inverse, InverseTimesOriginalIsIdentityOrZeroWhenSingular) {
  const struct {
    matr3_3 m;
    double tolerance;
  } cases[] = {{matr3_3::identity(), 1e-15},
               {matr3_3(0.36, 0.48, -0.8, -0.8, 0.6, 0.0, 0.48, 0.64, 0.6), 1e-14},
               {matr3_3(2.0, -1.0, 0.5, 4.0, 3.0, -2.0, 1.0, 7.0, 9.0), 1e-14},
               {matr3_3(0.0, 1.0, 2.0, 1.0, 0.0, 3.0, 4.0, -3.0, 8.0), 1e-14},  // zero first column entry
               {matr3_3(1.0, 1.0, 1.0, 1.0, 1.0 + 1e-3, 1.0, 1.0, 1.0, 1.0 + 2e-3), 1e-9}};
  for (const auto& c : cases) {
    SCOPED_TRACE(::testing::Message() << "det " << c.m.det());
    const matr3_3 inverse(c.m, matr3_3::kInverse), back(inverse, matr3_3::kInverse);
    adj_test::expectIdentity(c.m * inverse, c.tolerance);
    adj_test::expectIdentity(inverse * c.m, c.tolerance);
    for (int k = 0; k < 9; ++k) EXPECT_NEAR(back.m[k], c.m.m[k], c.tolerance * (1.0 + std::fabs(c.m.m[k])));
  }
  for (const matr3_3& m :
       {matr3_3(), matr3_3(1, 2, 3, 2, 4, 6, 0, 1, 5), matr3_3(1, 2, 3, 4, 5, 6, 7, 8, 9),
        matr3_3(1e-5, 0, 0, 0, 1e-5, 0, 0, 0, 5e-3), matr3_3(4e-6, 1e-6, 0.0, 1e-6, 9e-6, 2e-6, 0.0, 2e-6, 1e-5)})
    for (double element : matr3_3(m, matr3_3::kInverse).m) EXPECT_EQ(element, 0.0) << m.det();
}

// Transpose, an unknown operation (all NaN), blocks of a dense matrix (NaN outside it), the multiplicative
// determinant, the point product, and the same for the 2x2 matrix.
TEST(FixedMatrices, ConstructionAndProducts) {
  const matr3_3 m(1, 2, 3, 4, 5, 6, 7, 8, 9), t(m, matr3_3::kTranspose);
  EXPECT_TRUE(t(0, 2) == 7.0 && t(2, 0) == 3.0);
  for (double element : matr3_3(m, 'x').m) EXPECT_TRUE(std::isnan(element));
  svy_math::TMatrix r(4, 4);
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
  svy_math::TSMatrix s(2);
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
    adj_test::expectIdentity(matr3_3(vectors, matr3_3::kTranspose) * vectors, 1e-13);
    for (double offDiagonal : {d(1, 0), d(2, 0), d(2, 1)}) ASSERT_NEAR(offDiagonal, 0.0, 1e-11 * scale);
  }
  covar diagonal(inputs[1]);
  adj_test::expectIdentity(diagonal.eigen(), 0.0);
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

}  // namespace
