#include <gtest/gtest.h>

#include <cmath>

#include "svymath/adjustment/coord_cov.h"
#include "svymath/adjustment/weighted_average.h"
#include "svymath/foundation/constants.h"

namespace {

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
