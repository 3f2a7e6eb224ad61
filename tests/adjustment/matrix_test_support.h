#pragma once
// Helpers shared by the adjustment tests: products written out plainly (the oracle the library's products
// are checked against) and seeded random matrices.
#include <gtest/gtest.h>

#include <cmath>
#include <random>

#include "svymath/adjustment/matr3_3.h"
#include "svymath/adjustment/matrix_storage.h"

namespace adj_test {

inline svy_math::TMatrix randomMatrix(int rows, int cols, std::mt19937& rng) {
  std::uniform_real_distribution<double> value(-2.0, 2.0);
  svy_math::TMatrix m(rows, cols);
  for (int j = 1; j <= cols; ++j)
    for (int i = 1; i <= rows; ++i) m(i, j) = value(rng);
  return m;
}

// A random symmetric positive-definite matrix: b^T b + n I.
inline svy_math::TSMatrix randomPositiveDefinite(int n, std::mt19937& rng) {
  const svy_math::TMatrix b = randomMatrix(n, n, rng);
  svy_math::TSMatrix s(n);
  for (int i = 1; i <= n; ++i)
    for (int j = 1; j <= i; ++j) {
      double sum = i == j ? n : 0.0;
      for (int k = 1; k <= n; ++k) sum += b(k, i) * b(k, j);
      s(i, j) = sum;
    }
  return s;
}

// The full product of two symmetric matrices, element (i, j).
inline double symmetricProductElement(const svy_math::TSMatrix& a, const svy_math::TSMatrix& b, int i, int j) {
  double sum = 0.0;
  for (int k = 1; k <= a.order(); ++k) sum += a(i, k) * b(k, j);
  return sum;
}

inline void expectIdentity(const svy_math::matr3_3& m, double tolerance) {
  for (int i = 0; i < 3; ++i)
    for (int j = 0; j < 3; ++j) EXPECT_NEAR(m(i, j), i == j ? 1.0 : 0.0, tolerance) << "element " << i << "," << j;
}

}  // namespace adj_test
