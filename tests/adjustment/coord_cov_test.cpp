#include <gtest/gtest.h>

#include <cmath>

#include "svymath/adjustment/coord_cov.h"
#include "svymath/adjustment/weighted_average.h"
#include "svymath/foundation/constants.h"

namespace {

void expectSameCov(const TCoordCov& a, const TCoordCov& b, double tolerance) {
  for (int i = 0; i < 3; ++i)
    for (int j = 0; j < 3; ++j) EXPECT_NEAR(a.element(i, j), b.element(i, j), tolerance) << i << "," << j;
}

TEST(TCoordCov, InverseTimesCovarianceIsIdentity) {
  const TCoordCov covariances[] = {TCoordCov(4, 5, 6, 1, 2, 3), TCoordCov(4e-6, 9e-6, 1e-5, 1e-6, 0.0, 2e-6),
                                   TCoordCov(1e-8, 1e-8, 4e-8, 0.0, 0.0, 0.0)};
  for (const TCoordCov& c : covariances) {
    TCoordCov inverse;
    ASSERT_TRUE(c.getInverse(inverse));
    for (int i = 0; i < 3; ++i)
      for (int j = 0; j < 3; ++j) {
        double sum = 0.0;
        for (int k = 0; k < 3; ++k) sum += c.element(i, k) * inverse.element(k, j);
        EXPECT_NEAR(sum, i == j ? 1.0 : 0.0, 1e-12);
      }
  }
}

TEST(TCoordCov, SingularInverseRefusedAndOutputUntouched) {
  TCoordCov out(7, 7, 7, 0, 0, 0);
  EXPECT_FALSE(TCoordCov().getInverse(out));
  EXPECT_FALSE(TCoordCov(1, 1, 1, 1, 1, 1).getInverse(out));
  EXPECT_FALSE(TCoordCov(std::nan(""), 1, 1, 0, 0, 0).getInverse(out));
  EXPECT_EQ(out.s11, 7.0);
}

TEST(TCoordCov, ScaleMultipliesByFactorProducts) {
  TCoordCov c(4, 5, 6, 1, 2, 3);
  c.scale(2.0, 3.0, -1.0);
  expectSameCov(c, TCoordCov(16, 45, 6, 6, -4, -9), 0.0);
}

// At latitude 0, longitude 0 the local north is +Z, east +Y and up +X.
TEST(TCoordCov, TopocentricAxesAtTheEquator) {
  TCoordCov c(1.0, 2.0, 3.0, 0.1, 0.2, 0.3);  // X, Y, Z
  c.geocentric2topocentric(0.0, 0.0);
  expectSameCov(c, TCoordCov(3.0, 2.0, 1.0, 0.3, 0.2, 0.1), 1e-15);
}

TEST(TCoordCov, GeocentricTopocentricRoundTrip) {
  const TCoordCov original(4e-6, 9e-6, 1e-5, 1e-6, -5e-7, 2e-6);
  for (double latDeg : {-89.9, -45.0, 0.0, 33.3, 60.0, 90.0})
    for (double lonDeg : {-179.0, -30.0, 0.0, 100.0}) {
      TCoordCov c(original);
      c.geocentric2topocentric(latDeg * svy_math::units::kDegToRad, lonDeg * svy_math::units::kDegToRad);
      // A rotation keeps the trace.
      EXPECT_NEAR(c.s11 + c.s22 + c.s33, original.s11 + original.s22 + original.s33, 1e-20);
      c.topocentric2geocentric(latDeg * svy_math::units::kDegToRad, lonDeg * svy_math::units::kDegToRad);
      expectSameCov(c, original, 1e-20);
    }
}

TEST(CWaCoords, WeightsByInverseVariance) {
  CWaCoords average;
  TCoords a;
  a.north = 5000000.010;
  a.east = 500000.020;
  a.height = 100.0;
  TCoords b = a;
  b.north += 0.030;
  b.east -= 0.060;
  b.height += 0.5;
  // b has a quarter of a's variance in north and east, the same in height.
  ASSERT_TRUE(average.add(a, TCoordCov(4e-6, 4e-6, 1e-4, 0, 0, 0)));
  ASSERT_TRUE(average.add(b, TCoordCov(1e-6, 1e-6, 1e-4, 0, 0, 0)));
  TCoords mean;
  ASSERT_TRUE(average.getResult(mean));
  EXPECT_NEAR(mean.north - a.north, 0.8 * 0.030, 1e-9);
  EXPECT_NEAR(mean.east - a.east, -0.8 * 0.060, 1e-9);
  EXPECT_NEAR(mean.height, 100.25, 1e-12);
  EXPECT_EQ(mean.mask, TCoords::kAllValid);
}

// With correlated errors the average is the generalised least-squares mean, not the per-component one.
TEST(CWaCoords, CorrelatedCovarianceMatchesClosedForm) {
  CWaCoords average;
  TCoords a;
  a.north = 10.0;
  a.east = 20.0;
  a.mask = TCoords::kNorthValid | TCoords::kEastValid;
  TCoords b = a;
  b.north = 11.0;
  ASSERT_TRUE(average.add(a, TCoordCov(1.0, 1.0, 0.0, 0.5, 0.0, 0.0)));
  ASSERT_TRUE(average.add(b, TCoordCov(1.0, 1.0, 0.0, 0.0, 0.0, 0.0)));
  TCoords mean;
  mean.height = -7.0;
  ASSERT_TRUE(average.getResult(mean));
  // W_a = [[4/3, -2/3], [-2/3, 4/3]], W_b = I: mean = (W_a + I)^-1 (W_a a + b) = (157/15, 302/15): the east
  // moves although both east values agree, through the correlation of a.
  EXPECT_NEAR(mean.north, 157.0 / 15.0, 1e-12);
  EXPECT_NEAR(mean.east, 302.0 / 15.0, 1e-12);
  EXPECT_EQ(mean.height, -7.0);
  EXPECT_EQ(mean.mask, static_cast<unsigned>(TCoords::kNorthValid | TCoords::kEastValid));
}

TEST(CWaCoords, RefusesBadInput) {
  CWaCoords average;
  TCoords p;
  TCoords out;
  EXPECT_FALSE(average.getResult(out));
  EXPECT_FALSE(average.add(p, TCoordCov()));
  EXPECT_FALSE(average.add(p, TCoordCov(1, -1, 1, 0, 0, 0)));
  p.north = std::nan("");
  EXPECT_FALSE(average.add(p, TCoordCov(1, 1, 1, 0, 0, 0)));
  p.mask = 0;
  EXPECT_FALSE(average.add(p, TCoordCov(1, 1, 1, 0, 0, 0)));
  EXPECT_EQ(average.count(), 0);
}

}  // namespace
