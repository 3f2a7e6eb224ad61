#pragma once
// Helpers shared by the adjustment tests: seeded random matrices and products written out plainly (the
// oracle the library's products and inverses are checked against).
#include <gtest/gtest.h>

#include <random>

#include "svymath/adjustment/matr3_3.h"
#include "svymath/adjustment/matrix_storage.h"

namespace adj_test {

using svy_math::TMatrix;
using svy_math::TSMatrix;

inline TMatrix randomMatrix(int rows, int cols, std::mt19937& rng) {
  std::uniform_real_distribution<double> value(-2.0, 2.0);
  TMatrix m(rows, cols);
  for (int j = 1; j <= cols; ++j)
    for (int i = 1; i <= rows; ++i) m(i, j) = value(rng);
  return m;
}

inline TMatrix full(const TSMatrix& s) {
  TMatrix m(s.order(), s.order());
  for (int i = 1; i <= s.order(); ++i)
    for (int j = 1; j <= s.order(); ++j) m(i, j) = s(i, j);
  return m;
}

inline TMatrix full(const TMatrix& m) { return m; }

inline TMatrix transpose(const TMatrix& m) {
  TMatrix t(m.cols(), m.rows());
  for (int i = 1; i <= m.rows(); ++i)
    for (int j = 1; j <= m.cols(); ++j) t(j, i) = m(i, j);
  return t;
}

inline TMatrix multiply(const TMatrix& x, const TMatrix& y) {
  TMatrix p(x.rows(), y.cols());
  for (int i = 1; i <= x.rows(); ++i)
    for (int j = 1; j <= y.cols(); ++j)
      for (int k = 1; k <= x.cols(); ++k) p(i, j) += x(i, k) * y(k, j);
  return p;
}

// A random symmetric positive-definite matrix: b^T b + n I.
inline TSMatrix randomPositiveDefinite(int n, std::mt19937& rng) {
  const TMatrix b = randomMatrix(n, n, rng), p = multiply(transpose(b), b);
  TSMatrix s(n);
  for (int i = 1; i <= n; ++i)
    for (int j = 1; j <= i; ++j) s(i, j) = p(i, j) + (i == j ? n : 0.0);
  return s;
}

inline void expectNear(const TMatrix& x, const TMatrix& y, double tolerance) {
  ASSERT_TRUE(x.rows() == y.rows() && x.cols() == y.cols()) << x.rows() << "x" << x.cols();
  for (int i = 1; i <= x.rows(); ++i)
    for (int j = 1; j <= x.cols(); ++j) EXPECT_NEAR(x(i, j), y(i, j), tolerance) << "element " << i << "," << j;
}

// The product of a symmetric matrix and its claimed inverse is the identity.
inline void expectInverseOf(const TSMatrix& original, const TSMatrix& inverse, double tolerance) {
  TMatrix identity(original.order(), original.order());
  for (int i = 1; i <= original.order(); ++i) identity(i, i) = 1.0;
  expectNear(multiply(full(original), full(inverse)), identity, tolerance);
}

inline void expectIdentity(const svy_math::matr3_3& m, double tolerance) {
  for (int i = 0; i < 3; ++i)
    for (int j = 0; j < 3; ++j) EXPECT_NEAR(m(i, j), i == j ? 1.0 : 0.0, tolerance) << "element " << i << "," << j;
}

}  // namespace adj_test
