#include <gtest/gtest.h>

#include <cmath>

#include "matrix_test_support.h"
#include "svymath/adjustment/covar.h"
#include "svymath/adjustment/matr2_2.h"
#include "svymath/adjustment/matr3_3.h"

using svy_math::covar;
using svy_math::matr2_2;
using svy_math::matr3_3;

namespace {

struct InverseCase {
  const char* name;
  matr3_3 m;
  double tolerance;  // of m * m^-1 against the identity
};

class Matr3InverseTest : public ::testing::TestWithParam<InverseCase> {};

TEST_P(Matr3InverseTest, ProductWithInverseIsIdentity) {
  const InverseCase& c = GetParam();
  const matr3_3 inverse(c.m, matr3_3::kInverse);
  adj_test::expectIdentity(c.m * inverse, c.tolerance);
  adj_test::expectIdentity(inverse * c.m, c.tolerance);
  // Inverting twice gives the matrix back.
  const matr3_3 back(inverse, matr3_3::kInverse);
  for (int k = 0; k < 9; ++k) EXPECT_NEAR(back.m[k], c.m.m[k], c.tolerance * (1.0 + std::fabs(c.m.m[k])));
  EXPECT_NEAR(c.m.det() * inverse.det(), 1.0, c.tolerance);
}

const InverseCase kInverseCases[] = {
    {"identity", matr3_3::identity(), 1e-15},
    {"rotation", matr3_3(0.36, 0.48, -0.8, -0.8, 0.6, 0.0, 0.48, 0.64, 0.6), 1e-14},
    {"general", matr3_3(2.0, -1.0, 0.5, 4.0, 3.0, -2.0, 1.0, 7.0, 9.0), 1e-14},
    {"zero first column entry", matr3_3(0.0, 1.0, 2.0, 1.0, 0.0, 3.0, 4.0, -3.0, 8.0), 1e-14},
    {"ill conditioned", matr3_3(1.0, 1.0, 1.0, 1.0, 1.0 + 1e-3, 1.0, 1.0, 1.0, 1.0 + 2e-3), 1e-9},
};

INSTANTIATE_TEST_SUITE_P(Table, Matr3InverseTest, ::testing::ValuesIn(kInverseCases),
                         [](const ::testing::TestParamInfo<InverseCase>& param) {
                           std::string name = param.param.name;
                           for (char& ch : name)
                             if (!std::isalnum(static_cast<unsigned char>(ch))) ch = '_';
                           return name;
                         });

// The determinant test is absolute (strictly within +-1e-12): a regular matrix of small elements, such as a
// covariance in square metres, counts as singular too.
TEST(Matr3Inverse, SingularOrNearlySingularGivesZeroMatrix) {
  const matr3_3 singular[] = {matr3_3(), matr3_3(1, 2, 3, 2, 4, 6, 0, 1, 5), matr3_3(1, 2, 3, 4, 5, 6, 7, 8, 9),
                              matr3_3(1e-5, 0, 0, 0, 1e-5, 0, 0, 0, 5e-3),
                              matr3_3(4e-6, 1e-6, 0.0, 1e-6, 9e-6, 2e-6, 0.0, 2e-6, 1e-5)};
  for (const matr3_3& m : singular) {
    const matr3_3 inverse(m, matr3_3::kInverse);
    for (double element : inverse.m) EXPECT_EQ(element, 0.0);
  }
}

TEST(Matr3Construction, TransposeUnknownOpAndBlocks) {
  const matr3_3 m(1, 2, 3, 4, 5, 6, 7, 8, 9);
  const matr3_3 t(m, matr3_3::kTranspose);
  EXPECT_EQ(t(0, 2), 7.0);
  EXPECT_EQ(t(2, 0), 3.0);
  const matr3_3 unset(m, 'x');
  for (double element : unset.m) EXPECT_TRUE(std::isnan(element));

  svy_math::TMatrix r(4, 4);
  for (int i = 1; i <= 4; ++i)
    for (int j = 1; j <= 4; ++j) r(i, j) = 10 * i + j;
  const matr3_3 block(r, 2, 2);
  EXPECT_EQ(block(0, 0), 22.0);
  EXPECT_EQ(block(2, 1), 43.0);
  const matr3_3 outside(r, 3, 3);
  EXPECT_EQ(outside(1, 1), 44.0);
  EXPECT_TRUE(std::isnan(outside(2, 2)));
}

TEST(Matr3Products, DeterminantIsMultiplicativeAndPointProduct) {
  const matr3_3 a(2.0, -1.0, 0.5, 4.0, 3.0, -2.0, 1.0, 7.0, 9.0);
  const matr3_3 b(0.36, 0.48, -0.8, -0.8, 0.6, 0.0, 0.48, 0.64, 0.6);
  EXPECT_NEAR((a * b).det(), a.det() * b.det(), 1e-12);
  EXPECT_NEAR(b.det(), 1.0, 1e-15);
  const svy_math::TAbstractPoint3<double> p = a * svy_math::TAbstractPoint3<double>(1.0, 2.0, 3.0);
  EXPECT_DOUBLE_EQ(p[0], 1.5);
  EXPECT_DOUBLE_EQ(p[1], 4.0);
  EXPECT_DOUBLE_EQ(p[2], 42.0);
}

TEST(Matr2, InverseTransposeAndProducts) {
  const matr2_2 m(3.0, 1.0, -2.0, 4.0);
  const matr2_2 inverse(m, matr2_2::kInverse);
  const matr2_2 i = m * inverse;
  EXPECT_NEAR(i(0, 0), 1.0, 1e-15);
  EXPECT_NEAR(i(0, 1), 0.0, 1e-15);
  EXPECT_NEAR(i(1, 0), 0.0, 1e-15);
  EXPECT_NEAR(i(1, 1), 1.0, 1e-15);
  EXPECT_EQ(matr2_2(m, matr2_2::kTranspose)(0, 1), -2.0);
  const matr2_2 singular(matr2_2(1.0, 2.0, 2.0, 4.0), matr2_2::kInverse);
  for (double element : singular.m) EXPECT_EQ(element, 0.0);
  const svy_math::TAbstractPoint2<double> p = m * svy_math::TAbstractPoint2<double>(1.0, 1.0);
  EXPECT_EQ(p[0], 4.0);
  EXPECT_EQ(p[1], 2.0);
  svy_math::TSMatrix s(2);
  s(1, 1) = 5.0;
  s(2, 1) = 6.0;
  s(2, 2) = 7.0;
  const matr2_2 fromSymmetric(s, 1, 1);
  EXPECT_EQ(fromSymmetric(0, 1), 6.0);
  EXPECT_EQ(fromSymmetric(1, 0), 6.0);
}

// The constructor from a 3x3 matrix adds each element to its mirror without halving.
TEST(Covar, ConstructorFromMatrixDoublesASymmetricInput) {
  const matr3_3 symmetric(4, 1, 2, 1, 5, 3, 2, 3, 6);
  const covar doubled(symmetric);
  const double expected[6] = {8, 2, 10, 4, 6, 12};
  for (int k = 0; k < 6; ++k) EXPECT_EQ(doubled.c[k], expected[k]);
  // A matrix holding each off-diagonal term once, in either triangle, gives it once.
  const covar once(matr3_3(2, 0, 0, 1, 2.5, 0, 0, 3, 3));
  EXPECT_EQ(once(0, 1), 1.0);
  EXPECT_EQ(once(2, 1), 3.0);
  EXPECT_EQ(once(1, 1), 5.0);
  const matr3_3 full(once);
  EXPECT_EQ(full(0, 1), 1.0);
  EXPECT_EQ(full(1, 0), 1.0);
}

TEST(Covar, PropagationAndAccumulation) {
  const covar c(4, 1, 5, 2, 3, 6);
  const matr3_3 m(0.36, 0.48, -0.8, -0.8, 0.6, 0.0, 0.48, 0.64, 0.6);
  const covar propagated = m & c;
  const matr3_3 explicitProduct = m * matr3_3(c) * matr3_3(m, matr3_3::kTranspose);
  for (int i = 0; i < 3; ++i)
    for (int j = 0; j < 3; ++j) EXPECT_NEAR(propagated(i, j), explicitProduct(i, j), 1e-14);

  covar sum(c);
  sum += matr3_3(c);
  for (int k = 0; k < 6; ++k) EXPECT_EQ(sum.c[k], 2.0 * c.c[k]);
  sum -= matr3_3(1, 2, 0, 0, 0, 0, 0, 0, 0);  // symmetric part: 1 at (0,1) and (1,0)
  EXPECT_EQ(sum(1, 0), 2.0 * c(1, 0) - 1.0);
  const svy_math::TAbstractPoint3<double> p = c * svy_math::TAbstractPoint3<double>(1, 0, 0);
  EXPECT_EQ(p[0], 4.0);
  EXPECT_EQ(p[1], 1.0);
  EXPECT_EQ(p[2], 2.0);
}

}  // namespace
