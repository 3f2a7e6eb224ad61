// Plane localization: control generated from known transformations (survey coordinates, every quadrant of
// rotation, rigid and similar) comes back exactly; with noise the standard error estimates the noise and a
// blunder is flagged; failures are told apart.
#include <gtest/gtest.h>

#include <cmath>
#include <random>
#include <vector>

#include "svymath/cogo/localization_2d.h"
#include "svymath/foundation/constants.h"

namespace {

using svy_math::TSimilarity2d;
using svy_math::units::kDegToRad;

// Control in a local site system about (1000, 2000), up to ~300 m across.
std::vector<C2dPos> siteControl() {
  return {C2dPos(1000, 2000), C2dPos(1250.5, 2010), C2dPos(1120, 2310.25), C2dPos(870, 2150), C2dPos(990, 1801)};
}

TSimilarity2d makeTransform(double scale, double rotationDeg, double n, double e) {
  TSimilarity2d t;
  t.scale = scale;
  t.rotation = rotationDeg * kDegToRad;
  t.shift = C2dPos(n, e);
  return t;
}

// The fitted transformation carries every control point exactly (rounding at N 5 000 000 aside) and inverts.
TEST(Localization2d, RecoversKnownTransformationExactly) {
  const struct {
    TSimilarity2d t;
    bool rigid;
  } cases[] = {{makeTransform(1.0003, 12.5, 5.0e6, 5.0e5), false},    {makeTransform(0.9996, -179.9, 4.2e6, 3.1e5), false},
               {makeTransform(1.0, 91.0, 0.0, 0.0), true},             {makeTransform(1.0, -45.0, 5.9e6, 7.2e5), true},
               {makeTransform(2.5, 0.0, -100.0, 250.0), false}};
  for (const auto& c : cases) {
    SCOPED_TRACE(::testing::Message() << c.t.scale << " " << c.t.rotation);
    CLocalizationOn2dPlane loc;
    for (const C2dPos& p : siteControl()) ASSERT_TRUE(loc.addPoint(p, c.t.forward(p)));
    ASSERT_EQ(loc.solve(c.rigid), eLocOk);
    EXPECT_NEAR(loc.transformation().scale, c.t.scale, 1e-12);
    EXPECT_NEAR(std::remainder(loc.transformation().rotation - c.t.rotation, svy_math::units::kTwoPi), 0.0, 1e-12);
    EXPECT_LT(loc.getRms(), 1e-8);
    for (int i = 0; i < loc.count(); ++i) {
      TLocalizationResidual r;
      ASSERT_TRUE(loc.getResidual(i, r));
      EXPECT_FALSE(r.outlier);
    }
    const C2dPos stakeout(1500.25, 1700.75);
    C2dPos grid, back;
    ASSERT_TRUE(loc.toTarget(stakeout, grid));
    EXPECT_LT((grid - c.t.forward(stakeout)).Module(), 1e-8);
    ASSERT_TRUE(loc.toSource(grid, back));
    EXPECT_LT((back - stakeout).Module(), 1e-8);
  }
}

// Over many noisy trials the mean of sigma0^2 estimates the noise variance (unbiased), the fit stays within
// the noise, and one blunder of 30 cm among 1 cm noise is the only point flagged.
TEST(Localization2d, StandardErrorEstimatesNoiseAndBlunderIsFlagged) {
  const TSimilarity2d truth = makeTransform(1.0002, 33.0, 5.1e6, 4.9e5);
  std::mt19937_64 engine(1515);
  const double sigma = 0.01;
  std::normal_distribution<double> noise(0.0, sigma);
  double sumVariance = 0.0;
  int falseFlags = 0, blunderFlags = 0;
  constexpr int kTrials = 400;
  for (int trial = 0; trial < kTrials; ++trial) {
    CLocalizationOn2dPlane loc;
    const std::vector<C2dPos> control = siteControl();
    for (size_t i = 0; i < control.size(); ++i) {
      const C2dPos to = truth.forward(control[i]) + C2dPos(noise(engine), noise(engine));
      loc.addPoint(control[i], trial % 2 == 1 && i == 2 ? C2dPos(to + C2dPos(0.3, 0.0)) : to);
    }
    ASSERT_EQ(loc.solve(), eLocOk);
    if (trial % 2 == 1) {
      TLocalizationResidual r;
      for (int i = 0; i < loc.count(); ++i) {
        loc.getResidual(i, r);
        (i == 2 ? blunderFlags : falseFlags) += r.outlier ? 1 : 0;
      }
      continue;
    }
    sumVariance += loc.getStandardError() * loc.getStandardError();
    EXPECT_NEAR(loc.transformation().scale, truth.scale, 1e-4);
    EXPECT_LT((loc.transformation().shift - truth.shift).Module(), 0.5);
  }
  EXPECT_NEAR(sumVariance / (kTrials / 2), sigma * sigma, 0.15 * sigma * sigma);
  EXPECT_GT(blunderFlags, kTrials / 2 * 9 / 10);
  EXPECT_LT(falseFlags, kTrials / 2 / 10);
}

TEST(Localization2d, FailuresAreToldApart) {
  CLocalizationOn2dPlane loc;
  C2dPos out;
  EXPECT_FALSE(loc.toTarget(C2dPos(1, 1), out));
  EXPECT_FALSE(loc.addPoint(C2dPos(std::nan(""), 0), C2dPos(0, 0)));
  loc.addPoint(C2dPos(10, 10), C2dPos(5, 5));
  EXPECT_EQ(loc.solve(), eLocTooFewPoints);
  loc.addPoint(C2dPos(10, 10.0001), C2dPos(50, 50));
  EXPECT_EQ(loc.solve(), eLocCoincident);
  loc.reset();
  loc.addPoint(C2dPos(0, 0), C2dPos(7, 7));
  loc.addPoint(C2dPos(100, 0), C2dPos(7, 7));
  EXPECT_EQ(loc.solve(true), eLocCoincident);
  EXPECT_FALSE(loc.toSource(C2dPos(1, 1), out));
  // Two distinct points fix a similarity without redundancy: no standard error.
  loc.reset();
  loc.addPoint(C2dPos(0, 0), C2dPos(10, 10));
  loc.addPoint(C2dPos(100, 0), C2dPos(10, 110));
  ASSERT_EQ(loc.solve(), eLocOk);
  EXPECT_NEAR(loc.transformation().rotation, svy_math::units::kHalfPi, 1e-15);
  EXPECT_TRUE(std::isnan(loc.getStandardError()));
}

}  // namespace
