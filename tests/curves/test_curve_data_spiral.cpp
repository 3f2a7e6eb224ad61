// Spiral curve data in the element frame: every combination of law, direction of travel, side and partial
// or full spiral checked against its own heading (positions integrate it, curvature is its derivative),
// chord steps within the deviation; partial spirals from a tangent radius or a start offset; copies.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <string>

#include "curve_test_support.h"
#include "svymath/curves/curve_data_spiral.h"
#include "svymath/curves/spiral_cubic.h"
#include "svymath/foundation/constants.h"

namespace {

using svy_math::units::kDegToRad;

struct SpiralCase {
  AlntMathSpiralType type;
  bool tssc;
  bool right;
  double length;
  double r1;  // full spiral: the radius; partial: the radius at one end
  double r2;  // 0 for a full spiral
};

std::string describe(const SpiralCase& c) {
  return std::string(c.type == eMathSpiralEuler ? "clothoid" : "cubic") + (c.tssc ? "TSSC" : "CSST") +
         (c.right ? "Right" : "Left") + "L" + std::to_string(static_cast<int>(c.length)) + "R" +
         std::to_string(static_cast<int>(c.r1)) + (c.r2 == 0.0 ? "" : "to" + std::to_string(static_cast<int>(c.r2)));
}

bool define(const SpiralCase& c, CCurveDataSpiral& data) {
  data.resetType(c.type);
  if (c.r2 == 0.0) return data.setLenAndR(c.length, c.r1, c.right, c.tssc);
  return data.setLenAndTwoR(c.length, c.r1, c.r2, c.right, c.tssc);
}

// The clothoid is exact to the Fresnel integrals; the cubic's series and its coefficient search leave it
// about 1e-7 m from its own heading for these flat cases.
double positionTol(const SpiralCase& c) { return c.type == eMathSpiralEuler ? 1e-9 : 2e-7; }

class SpiralData : public ::testing::TestWithParam<SpiralCase> {
 protected:
  void SetUp() override { ASSERT_TRUE(define(GetParam(), data_)) << describe(GetParam()); }
  double headingRad(double s) const { return data_.GetAzimuth(s) * kDegToRad; }
  CCurveDataSpiral data_;
};

TEST_P(SpiralData, PositionsIntegrateHeading) {
  const SpiralCase c = GetParam();
  EXPECT_NEAR(data_.getTotalLength(), c.length, 1e-9);
  double n = 1.0, e = 1.0;
  ASSERT_TRUE(data_.getPosAtLength(0.0, n, e));
  EXPECT_NEAR(n, 0.0, 1e-12);
  EXPECT_NEAR(e, 0.0, 1e-12);
  EXPECT_NEAR(data_.GetAzimuth(0.0), 0.0, 1e-12);
  for (double f : {0.2, 0.5, 0.77, 1.0}) {
    const double s = f * c.length;
    double refN = 0.0, refE = 0.0;
    curve_test::integrateHeading([&](double u) { return headingRad(u); }, s, 1e-12, refN, refE);
    ASSERT_TRUE(data_.getPosAtLength(s, n, e));
    EXPECT_NEAR(n, refN, positionTol(c)) << describe(c) << " s " << s;
    EXPECT_NEAR(e, refE, positionTol(c)) << describe(c) << " s " << s;
    // The element turns to its side all along.
    EXPECT_EQ(e > 0.0, c.right) << describe(c);
    EXPECT_EQ(data_.GetAzimuth(s) > 0.0, c.right) << describe(c);
  }
  EXPECT_NEAR(data_.getFinalNorthing(), n, 1e-12);
  EXPECT_NEAR(data_.getFinalEasting(), e, 1e-12);
  EXPECT_NEAR(data_.getFinalAzimutInRad(), headingRad(c.length), 1e-12);
  // Turning to the other side mirrors the element about its start tangent.
  CCurveDataSpiral mirrored(data_);
  ASSERT_TRUE(mirrored.setTurnRight(!c.right));
  double nm = 0.0, em = 0.0;
  ASSERT_TRUE(mirrored.getPosAtLength(c.length, nm, em));
  EXPECT_NEAR(nm, n, 1e-6);
  EXPECT_NEAR(em, -e, 1e-6);
  // The clothoid's length at a turn is the inverse of its heading (the cubic's is a deliberate half tangent).
  if (c.type == eMathSpiralEuler) {
    const double s = 0.3 * c.length;
    EXPECT_NEAR(data_.getLengthAtAzimuth(CMathAngle(data_.GetAzimuth(s))), s, 1e-8) << describe(c);
  }
}

TEST_P(SpiralData, CurvatureIsDerivativeOfHeading) {
  const SpiralCase c = GetParam();
  const double h = 1e-3;
  for (double f : {0.1, 0.5, 0.9}) {
    const double s = f * c.length;
    const double numeric = (headingRad(s + h) - headingRad(s - h)) / (2.0 * h);
    const double k = data_.getCurvatureAtLength(s);
    EXPECT_NEAR(k, numeric, 1e-8 * std::fabs(k) + 1e-11) << describe(c) << " s " << s;
  }
  // The ends: the radii the element reports are those of its curvature there.
  const double kStart = data_.getCurvatureAtLength(0.0);
  const double kEnd = data_.getCurvatureAtLength(c.length);
  const double rStart = data_.getStartRadius();
  const double rEnd = data_.getFinalRadius();
  EXPECT_NEAR(rStart == 0.0 ? 0.0 : 1.0 / rStart, kStart, 1e-9 * std::fabs(kStart) + 1e-12) << describe(c);
  EXPECT_NEAR(rEnd == 0.0 ? 0.0 : 1.0 / rEnd, kEnd, 1e-9 * std::fabs(kEnd) + 1e-12) << describe(c);
  // Curvature grows towards the curve: along a TS-SC element, against a CS-ST one.
  EXPECT_EQ(std::fabs(kEnd) > std::fabs(kStart), c.tssc) << describe(c);
  EXPECT_EQ(data_.getRadius() > 0.0, c.right);
  EXPECT_EQ(data_.isCompoundSpiral(), c.r2 != 0.0);
  if (c.r2 != 0.0) {
    const double flat = std::fmax(c.r1, c.r2);
    const double sharp = std::fmin(c.r1, c.r2);
    EXPECT_NEAR(std::fabs(c.tssc ? rStart : rEnd), flat, 1e-5 * flat) << describe(c);
    EXPECT_NEAR(std::fabs(c.tssc ? rEnd : rStart), sharp, 1e-6 * sharp) << describe(c);
  }
}

TEST_P(SpiralData, StepKeepsChordWithinDeviation) {
  const SpiralCase c = GetParam();
  for (double dev : {0.001, 0.05}) {
    double s = 0.0;
    int steps = 0;
    while (s < c.length && steps < 10000) {
      const double step = data_.getStepForDeviation(s, dev);
      ASSERT_GT(step, 0.0) << describe(c) << " s " << s;
      ASSERT_LE(s + step, c.length + 1e-9);
      // The largest distance of the element from the chord between s and s + step.
      double n0 = 0.0, e0 = 0.0, n1 = 0.0, e1 = 0.0;
      ASSERT_TRUE(data_.getPosAtLength(s, n0, e0));
      ASSERT_TRUE(data_.getPosAtLength(s + step, n1, e1));
      const double chord = std::hypot(n1 - n0, e1 - e0);
      double worst = 0.0;
      for (int i = 1; i < 16; ++i) {
        double n = 0.0, e = 0.0;
        ASSERT_TRUE(data_.getPosAtLength(s + step * i / 16.0, n, e));
        worst = std::fmax(worst, std::fabs((n1 - n0) * (e - e0) - (e1 - e0) * (n - n0)) / chord);
      }
      EXPECT_LE(worst, dev) << describe(c) << " s " << s;
      s += step;
      ++steps;
    }
    EXPECT_GE(s, c.length - 1e-9);
    EXPECT_GT(steps, 1) << describe(c) << " dev " << dev;
  }
  // No deviation given: the rest of the element.
  EXPECT_NEAR(data_.getStepForDeviation(0.25 * c.length, 0.0), 0.75 * c.length, 1e-9);
}

INSTANTIATE_TEST_SUITE_P(
    Cases, SpiralData,
    ::testing::Values(SpiralCase{eMathSpiralEuler, true, true, 100.0, 300.0, 0.0},
                      SpiralCase{eMathSpiralEuler, false, true, 100.0, 300.0, 0.0},
                      SpiralCase{eMathSpiralEuler, true, false, 80.0, 450.0, 0.0},
                      SpiralCase{eMathSpiralEuler, false, false, 80.0, 450.0, 0.0},
                      SpiralCase{eMathSpiralEuler, true, true, 100.0, 1000.0, 300.0},
                      SpiralCase{eMathSpiralEuler, false, false, 100.0, 1000.0, 300.0},
                      SpiralCase{eMathSpiralEuler, false, true, 60.0, 250.0, 900.0},
                      SpiralCase{eMathSpiralCubic, true, true, 100.0, 400.0, 0.0},
                      SpiralCase{eMathSpiralCubic, false, false, 100.0, 400.0, 0.0},
                      SpiralCase{eMathSpiralCubic, true, false, 60.0, 1000.0, 350.0},
                      SpiralCase{eMathSpiralCubic, false, true, 60.0, 1000.0, 350.0}),
    [](const ::testing::TestParamInfo<SpiralCase>& caseInfo) { return describe(caseInfo.param); });

TEST(SpiralDataTangentEnd, TwoRadiiWithTangentGiveFullSpiral) {
  CCurveDataSpiral part;
  ASSERT_TRUE(part.setLenAndTwoR(100.0, std::numeric_limits<double>::infinity(), 300.0, true, true));
  EXPECT_FALSE(part.isCompoundSpiral());
  CCurveDataSpiral1R full;
  ASSERT_TRUE(full.setLenAndR(100.0, 300.0, true, true));
  EXPECT_EQ(part.getFinalNorthing(), full.getFinalNorthing());
  EXPECT_EQ(part.getFinalEasting(), full.getFinalEasting());
  EXPECT_EQ(part.getStartRadius(), 0.0);
  EXPECT_EQ(part.getFinalRadius(), 300.0);
  // An explicit start offset cuts the same part as the radii would.
  CCurveDataSpiral byRadii;
  ASSERT_TRUE(byRadii.setLenAndTwoR(60.0, 500.0, 300.0, true, true));
  CCurveDataSpiral byOffset;
  ASSERT_TRUE(byOffset.setLenAndR(byRadii.getSimpleSpiral()->getLength(), 300.0, true, true));
  ASSERT_TRUE(byOffset.setStartOffset(byRadii.getStartOffset()));
  EXPECT_FALSE(byOffset.setStartOffset(1e6));
  EXPECT_NEAR(byOffset.getFinalNorthing(), byRadii.getFinalNorthing(), 1e-12);
  EXPECT_NEAR(byOffset.getFinalEasting(), byRadii.getFinalEasting(), 1e-12);
  // Defining a part anew by length and radius makes it the full spiral again.
  ASSERT_TRUE(byRadii.setLenAndR(70.0, 300.0, true, true));
  EXPECT_FALSE(byRadii.isCompoundSpiral());
  EXPECT_EQ(byRadii.getTotalLength(), 70.0);
}

TEST(SpiralDataCopy, CopiesOwnTheirLaw) {
  CCurveDataSpiral a(eMathSpiralCubic);
  ASSERT_TRUE(a.setLenAndR(100.0, 300.0, true, true));
  CCurveDataSpiral b(a);
  CCurveDataSpiral c;
  c = a;
  ASSERT_TRUE(a.setLenAndR(50.0, 600.0, false, false));
  EXPECT_NE(b.getSimpleSpiral(), a.getSimpleSpiral());
  EXPECT_EQ(b.getTotalLength(), 100.0);
  EXPECT_EQ(c.getTotalLength(), 100.0);
  EXPECT_EQ(c.getSpiralMathType(), eMathSpiralCubic);
  const CCurveDataSpiral& same = c;
  c = same;  // self-assignment keeps the law
  EXPECT_EQ(c.getTotalLength(), 100.0);
  // A new law keeps the definition.
  ASSERT_TRUE(b.recreateSimpleSpiral(eMathSpiralEuler));
  EXPECT_EQ(b.getSpiralMathType(), eMathSpiralEuler);
  EXPECT_EQ(b.getTotalLength(), 100.0);
  EXPECT_EQ(b.getRadius(), 300.0);
  EXPECT_TRUE(b.isTSSC());
}

}  // namespace
