#include <gtest/gtest.h>

#include <cmath>
#include <random>

#include "matrix_test_support.h"
#include "svymath/adjustment/covar.h"

using svy_math::covar;
using svy_math::matr3_3;

namespace {

// A v = lambda v for every column, and the columns orthonormal.
void expectEigenDecomposition(const covar& original, const covar& diagonal, const matr3_3& vectors) {
  double scale = 0.0;
  for (double element : original.c) scale = std::fmax(scale, std::fabs(element));
  for (int j = 0; j < 3; ++j) {
    const svy_math::TAbstractPoint3<double> v(vectors(0, j), vectors(1, j), vectors(2, j));
    const svy_math::TAbstractPoint3<double> av = original * v;
    for (int i = 0; i < 3; ++i) EXPECT_NEAR(av[i], diagonal(j, j) * v[i], 1e-12 * scale) << "column " << j;
  }
  adj_test::expectIdentity(matr3_3(vectors, matr3_3::kTranspose) * vectors, 1e-13);
}

class CovarEigenRandom : public ::testing::TestWithParam<double> {};

TEST_P(CovarEigenRandom, VectorsSatisfyDefinition) {
  const double scale = GetParam();
  std::mt19937 rng(2024);
  std::uniform_real_distribution<double> value(-1.0, 1.0);
  for (int trial = 0; trial < 200; ++trial) {
    covar c;
    for (double& element : c.c) element = value(rng) * scale;
    covar diagonal(c);
    const matr3_3 vectors = diagonal.eigen();
    expectEigenDecomposition(c, diagonal, vectors);
    // The eigenvalues keep the trace and the off-diagonal elements vanish.
    EXPECT_NEAR(diagonal.c[0] + diagonal.c[2] + diagonal.c[5], c.c[0] + c.c[2] + c.c[5], 1e-12 * scale);
    EXPECT_NEAR(diagonal(1, 0), 0.0, 1e-11 * scale);
    EXPECT_NEAR(diagonal(2, 0), 0.0, 1e-11 * scale);
    EXPECT_NEAR(diagonal(2, 1), 0.0, 1e-11 * scale);
  }
}

// Unit scale, millimetre-level covariances in square metres, and values near the double range.
INSTANTIATE_TEST_SUITE_P(Scales, CovarEigenRandom, ::testing::Values(1.0, 1e-6, 1e6, 1e300, 1e-300));

TEST(CovarEigen, DiagonalCovarianceGivesIdentityAtOnce) {
  covar c(4.0, 0.0, 9.0, 0.0, 0.0, 1.0);
  const matr3_3 vectors = c.eigen();
  adj_test::expectIdentity(vectors, 0.0);
  EXPECT_EQ(c.c[0], 4.0);
  EXPECT_EQ(c.c[2], 9.0);
  EXPECT_EQ(c.c[5], 1.0);
}

TEST(CovarEigen, RepeatedEigenvalues) {
  covar c(2.0, 1.0, 2.0, 1.0, 1.0, 2.0);  // eigenvalues 4, 1, 1
  covar diagonal(c);
  const matr3_3 vectors = diagonal.eigen();
  expectEigenDecomposition(c, diagonal, vectors);
  const svy_math::TAbstractPoint3<double> axes = c.GetEigen(1.0);
  EXPECT_NEAR(axes[0], 2.0, 1e-14);
  EXPECT_NEAR(axes[1], 1.0, 1e-14);
  EXPECT_NEAR(axes[2], 1.0, 1e-14);
}

TEST(CovarEigen, NonFiniteElementLeavesCovarianceAndGivesUndefined) {
  covar c(1.0, std::nan(""), 2.0, 0.0, 0.0, 3.0);
  const matr3_3 vectors = c.eigen();
  for (double element : vectors.m) EXPECT_TRUE(std::isnan(element));
  EXPECT_EQ(c.c[0], 1.0);
  covar infinite(1.0, INFINITY, 2.0, 0.0, 0.0, 3.0);
  const svy_math::TAbstractPoint3<double> axes = infinite.GetEigen(1.0);
  EXPECT_TRUE(std::isnan(axes[0]));
}

// The error ellipsoid: semi-axes sorted, and the rotation rebuilds the covariance: R diag(lambda) R^T = C.
TEST(CovarEigen, ErrorEllipsoidAxesAndFrame) {
  const covar c(9e-6, 2e-6, 4e-6, 1e-6, -1e-6, 1e-6);
  const svy_math::TAbstractPoint3<double> axes = c.GetEigen(2.0);
  EXPECT_GE(axes[0], axes[1]);
  EXPECT_GE(axes[1], axes[2]);
  const matr3_3 r = c.DuserDeigen();
  EXPECT_NEAR(r.det(), 1.0, 1e-14);
  matr3_3 lambda;
  for (int k = 0; k < 3; ++k) lambda(k, k) = (axes[k] / 2.0) * (axes[k] / 2.0);
  const matr3_3 rebuilt = r * lambda * matr3_3(r, matr3_3::kTranspose);
  for (int i = 0; i < 3; ++i)
    for (int j = 0; j < 3; ++j) EXPECT_NEAR(rebuilt(i, j), c(i, j), 1e-18);
  // A semi-definite covariance (rank 2) keeps a zero axis instead of a NaN.
  const covar flat(1.0, 1.0, 1.0, 0.0, 0.0, 2.0);
  const svy_math::TAbstractPoint3<double> flatAxes = flat.GetEigen(1.0);
  EXPECT_NEAR(flatAxes[2], 0.0, 1e-7);
  EXPECT_FALSE(std::isnan(flatAxes[2]));
}

}  // namespace
