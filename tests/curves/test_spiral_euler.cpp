// The clothoid law: positions against its integrated heading and the unit-clothoid table, the side rule and the deliberate radius quirk of setLenAndSpPrm.
#include <gtest/gtest.h>

#include <cmath>

#include "curve_test_support.h"
#include "support/refdata.h"
#include "svymath/curves/spiral_euler.h"
#include "svymath/foundation/constants.h"

namespace {

struct ClothoidCase {
  double length;
  double radius;
  bool right;
};

class ClothoidPosition : public ::testing::TestWithParam<ClothoidCase> {};

TEST_P(ClothoidPosition, MatchesIntegratedHeading) {
  const ClothoidCase c = GetParam();
  CEulerSpiralTStoSC law;
  ASSERT_TRUE(law.setLenAndR(c.length, c.radius, c.right));
  const double signedR = c.right ? std::fabs(c.radius) : -std::fabs(c.radius);
  // Heading of a clothoid: the integral of the curvature s / (R L).
  auto heading = [&](double u) { return u * u / (2.0 * signedR * c.length); };
  for (double f : {0.1, 0.37, 0.5, 0.81, 1.0}) {
    const double s = f * c.length;
    double n = 0.0, e = 0.0, refN = 0.0, refE = 0.0;
    ASSERT_TRUE(law.getPosAtLength(s, n, e));
    curve_test::integrateHeading(heading, s, 1e-12, refN, refE);
    EXPECT_NEAR(n, refN, 1e-9) << "s = " << s;
    EXPECT_NEAR(e, refE, 1e-9) << "s = " << s;
    EXPECT_NEAR(law.GetAzimuth(s), heading(s) * svy_math::units::kRadToDeg, 1e-12);
    EXPECT_NEAR(law.getCurvatureAtLength(s), s / (signedR * c.length), 1e-15);
  }
  // The stored angle is reduced to [-pi, pi]; the 500 m case turns beyond a half turn (its Fresnel
  // arguments pass the series limit of 1.5), so compare directions.
  const double theta = c.length / (2.0 * signedR);
  EXPECT_NEAR(law.getSpiralAngle().getSin(), std::sin(theta), 1e-15);
  EXPECT_NEAR(law.getSpiralAngle().getCos(), std::cos(theta), 1e-15);
  double n = 0.0, e = 0.0;
  ASSERT_TRUE(law.getPosAtLength(c.length, n, e));
  EXPECT_DOUBLE_EQ(law.getFinalNorthing(), n);
  EXPECT_DOUBLE_EQ(law.getFinalEasting(), e);
}

// Sharp and flat spirals, both sides, arguments s/k on both sides of the Fresnel switch at 1.5.
INSTANTIATE_TEST_SUITE_P(Cases, ClothoidPosition,
                         ::testing::Values(ClothoidCase{100.0, 300.0, true}, ClothoidCase{100.0, 300.0, false},
                                           ClothoidCase{60.0, 1000.0, true}, ClothoidCase{250.0, 120.0, true},
                                           ClothoidCase{500.0, 60.0, false}, ClothoidCase{5.0, 25.0, true}));

TEST(ClothoidPosition, MatchesUnitClothoidTable) {
  const auto rows = curve_test::readNumericTable(svy_test::testdataPath("curves/unit_clothoid_A1_table.csv"));
  ASSERT_GT(rows.size(), 100u);
  // A = sqrt(R L) = 200 with L = 400 reaches l = s / A = 2, the end of the table.
  const double A = 200.0;
  CEulerSpiralTStoSC law;
  ASSERT_TRUE(law.setLenAndR(400.0, A * A / 400.0, true));
  for (const auto& row : rows) {
    double n = 0.0, e = 0.0;
    ASSERT_TRUE(law.getPosAtLength(A * row[0], n, e));
    EXPECT_NEAR(n, A * row[2], 2e-9) << "l = " << row[0];
    EXPECT_NEAR(e, A * row[3], 2e-9) << "l = " << row[0];
    EXPECT_NEAR(law.GetAzimuth(A * row[0]) * svy_math::units::kDegToRad, row[1], 1e-13);
  }
}

TEST(ClothoidSide, SignFollowsTheFlagNotTheRadius) {
  CEulerSpiralTStoSC right;
  CEulerSpiralTStoSC left;
  ASSERT_TRUE(right.setLenAndR(120.0, -450.0, true));
  ASSERT_TRUE(left.setLenAndR(120.0, 450.0, false));
  EXPECT_EQ(right.getRadius(), 450.0);
  EXPECT_EQ(left.getRadius(), -450.0);
  EXPECT_GT(right.getFinalEasting(), 0.0);
  EXPECT_EQ(right.getFinalNorthing(), left.getFinalNorthing());
  EXPECT_EQ(right.getFinalEasting(), -left.getFinalEasting());
}

TEST(ClothoidInverse, LengthAtAzimuthRoundTrip) {
  for (bool toRight : {true, false}) {
    CEulerSpiralTStoSC law;
    ASSERT_TRUE(law.setLenAndR(150.0, 500.0, toRight));
    for (double s : {0.0, 1.0, 75.0, 149.0, 150.0}) {
      CMathAngle turned(law.GetAzimuth(s));
      EXPECT_NEAR(law.getLengthAtAzimuth(turned), s, 1e-9) << "s = " << s;
    }
    // A turn to the wrong side has no length.
    EXPECT_EQ(law.getLengthAtAzimuth(CMathAngle(toRight ? -1.0 : 1.0)), 0.0);
  }
}

TEST(ClothoidTwoRadii, FullSpiralEndsAtSharperRadius) {
  CEulerSpiralTStoSC law;
  ASSERT_TRUE(law.setLenAndTwoR(100.0, 1000.0, 300.0, true));
  const double full = 100.0 * 1000.0 / 700.0;
  EXPECT_NEAR(law.getLength(), full, 1e-12);
  EXPECT_EQ(law.getRadius(), 300.0);
  EXPECT_NEAR(1.0 / law.getCurvatureAtLength(full - 100.0), 1000.0, 1e-9);
  // Equal radii bound no transition.
  EXPECT_FALSE(law.setLenAndTwoR(100.0, 300.0, 300.0, true));
}

TEST(ClothoidQuirk, SpiralParameterDefinitionLeavesZeroRadius) {
  CEulerSpiralTStoSC law;
  ASSERT_TRUE(law.setLenAndSpPrm(100.0, 30000.0));
  EXPECT_EQ(law.getRadius(), 0.0);
  EXPECT_NEAR(law.getSpiralAngle().getRad(), 100.0 * 100.0 / 60000.0, 1e-15);
  for (double s : {0.0, 50.0, 100.0}) {
    double n = 1.0, e = 1.0;
    ASSERT_TRUE(law.getPosAtLength(s, n, e));
    EXPECT_EQ(n, 0.0);
    EXPECT_EQ(e, 0.0);
  }
  EXPECT_EQ(law.GetAzimuth(50.0), 0.0);
  EXPECT_EQ(law.getCurvatureAtLength(50.0), 0.0);
  // Only a zero length takes the radius K / L (here infinite: the quirk is kept as it is).
  ASSERT_TRUE(law.setLenAndSpPrm(0.0, 30000.0));
  EXPECT_TRUE(std::isinf(law.getRadius()));
}

}  // namespace
