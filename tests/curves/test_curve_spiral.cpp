// Spiral data and the spiral element over every combination of law, direction of travel, side and full or
// partial spiral: positions integrate the heading, curvature is its derivative, chord steps stay within the
// deviation, round trips, the foot-point search and boxes against dense sampling; ends and extensions; the
// published clothoid tables.
#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <utility>

#include "curve_test_support.h"
#include "support/refdata.h"

namespace {

using curve_test::kInf;
using curve_test::makeSpiral;
using svy_math::units::kDegToRad;

struct SpiralCase {
  AlntMathSpiralType type;
  bool tssc, right;
  double length;
  double r1;  // full spiral: the radius; partial: the radius at one end
  double r2;  // 0 for a full spiral
};

std::string describe(const SpiralCase& c) {
  const auto i = [](double v) { return std::to_string(static_cast<int>(v)); };
  return std::string(c.type == eMathSpiralEuler ? "clothoid" : "cubic") + (c.tssc ? "TSSC" : "CSST") +
         (c.right ? "Right" : "Left") + "L" + i(c.length) + "R" + i(c.r1) + (c.r2 == 0.0 ? "" : "to" + i(c.r2));
}

class SpiralData : public ::testing::TestWithParam<SpiralCase> {
 protected:
  void SetUp() override {
    const SpiralCase& c = GetParam();
    data_.resetType(c.type);
    ASSERT_TRUE(c.r2 == 0.0 ? data_.setLenAndR(c.length, c.r1, c.right, c.tssc)
                            : data_.setLenAndTwoR(c.length, c.r1, c.r2, c.right, c.tssc));
    element_ = CCurveSpiral(5000000.0, 500000.0, CMathAngle(123.0), data_);
  }
  double headingRad(double s) const { return data_.GetAzimuth(s) * kDegToRad; }
  CCurveDataSpiral data_;
  CCurveSpiral element_;
};

TEST_P(SpiralData, PositionsIntegrateHeadingAndCurvatureIsItsDerivative) {
  const SpiralCase c = GetParam();
  // The clothoid is exact to the Fresnel integrals; the cubic's series and its coefficient search leave it
  // about 1e-7 m from its own heading for these flat cases.
  const double tol = c.type == eMathSpiralEuler ? 1e-9 : 2e-7;
  double n = 1.0, e = 1.0;
  for (double f : {0.1, 0.5, 0.77, 1.0}) {
    const double s = f * c.length;
    double refN = 0.0, refE = 0.0;
    curve_test::integrateHeading([&](double u) { return headingRad(u); }, s, 1e-12, refN, refE);
    ASSERT_TRUE(data_.getPosAtLength(s, n, e));
    curve_test::expectPosNear(C2dPos(n, e), refN, refE, tol);
    EXPECT_EQ(e > 0.0, c.right);  // turns to its side all along
    const double k = data_.getCurvatureAtLength(s), numeric = (headingRad(s + 1e-3) - headingRad(s - 1e-3)) / 2e-3;
    EXPECT_TRUE(f == 1.0 || std::fabs(k - numeric) <= 1e-8 * std::fabs(k) + 1e-11) << s << ": " << k - numeric;
  }
  EXPECT_NEAR(data_.getFinalAzimutInRad(), headingRad(c.length), 1e-12);
  // Turning to the other side mirrors the element about its start tangent.
  CCurveDataSpiral mirrored(data_);
  ASSERT_TRUE(mirrored.setTurnRight(!c.right));
  double nm = 0.0, em = 0.0;
  EXPECT_TRUE(mirrored.getPosAtLength(c.length, nm, em) && std::fabs(nm - n) < 1e-6 && std::fabs(em + e) < 1e-6);
  // The clothoid's length at a world azimuth inverts its heading (the cubic's is a deliberate half tangent).
  if (c.type == eMathSpiralEuler) {
    EXPECT_NEAR(element_.getLengthAtAzimuth(CMathAngle(element_.getAzimuthAtLength(30.0))), 30.0, 1e-8);
  }
  // The end radii are those of the curvature there; it grows towards the curve (along TS-SC, against CS-ST).
  const double kStart = data_.getCurvatureAtLength(0.0), kEnd = data_.getCurvatureAtLength(c.length);
  const double rStart = data_.getStartRadius(), rEnd = data_.getFinalRadius();
  for (const auto& rk : {std::make_pair(rStart, kStart), std::make_pair(rEnd, kEnd)}) {
    EXPECT_NEAR(rk.first == 0.0 ? 0.0 : 1.0 / rk.first, rk.second, 1e-9 * std::fabs(rk.second) + 1e-12);
  }
  EXPECT_EQ(std::fabs(kEnd) > std::fabs(kStart), c.tssc);
  EXPECT_EQ(data_.isCompoundSpiral(), c.r2 != 0.0);
  if (c.r2 != 0.0) {
    const double flat = std::fmax(c.r1, c.r2), sharp = std::fmin(c.r1, c.r2);
    EXPECT_NEAR(std::fabs(c.tssc ? rStart : rEnd), flat, 1e-5 * flat);
    EXPECT_NEAR(std::fabs(c.tssc ? rEnd : rStart), sharp, 1e-6 * sharp);
  }
}

// Length and offset give their position back, and the projection finds the same foot with the distance
// signed by the side. Points around the element project onto the nearest point of a dense sampling, square
// to the tangent; the box holds the samples tightly; chord steps stay within the deviation.
TEST_P(SpiralData, RoundTripProjectionBoxAndSteps) {
  const CCurveSpiral& spiral = element_;
  const double total = spiral.getTotalLength();
  double length = 0.0, offset = 0.0, dist = 0.0, len = 0.0;
  for (int i = 0; i <= 10; ++i) {
    for (const double o : {-7.5, -0.2, 0.0, 0.2, 7.5}) {
      SCOPED_TRACE(std::to_string(i) + " " + std::to_string(o));
      C2dPos pos;
      ASSERT_TRUE(spiral.getPosAtLengthAndOffset(total * i / 10.0, o, pos));
      ASSERT_TRUE(spiral.getLengthAndOffset(pos, length, offset));
      curve_test::expectPosNear(C2dPos(length, offset), total * i / 10.0, o, 1e-8);
      ASSERT_TRUE(spiral.getShortestDistAndCurveLen(pos.north(), pos.east(), dist, len));
      EXPECT_NEAR(len, total * i / 10.0, 1e-6);
      EXPECT_NEAR(dist, o, 1e-9);
    }
  }
  const C2dPos start = spiral.getStartPos();
  for (double dn = -0.6 * total; dn <= 1.4 * total; dn += 0.23 * total) {
    for (double de = -0.5 * total; de <= 0.5 * total; de += 0.19 * total) {
      const C2dPos p(start.north() + dn, start.east() + de);
      ASSERT_TRUE(spiral.getShortestDistAndCurveLen(p.north(), p.east(), dist, len));
      ASSERT_TRUE(len >= 0.0 && len <= total);
      const double sampled = curve_test::sampledDistance(spiral, p, 4000);
      EXPECT_TRUE(std::fabs(dist) <= sampled + 1e-9 && std::fabs(dist) >= sampled - 1e-4) << dist << " " << sampled;
      const C2dPos foot = curve_test::posAt(spiral, len);
      EXPECT_NEAR(curve_test::dist(foot, p), std::fabs(dist), 1e-9);
      CMathAngle tangent;
      ASSERT_TRUE(spiral.getAzimuthAtLength(len, tangent));
      const double along = tangent.getCos() * (p.north() - foot.north()) + tangent.getSin() * (p.east() - foot.east());
      EXPECT_LT(len > 1e-6 && len < total - 1e-6 ? std::fabs(along) : 0.0, 1e-9);  // square to the tangent
    }
  }
  curve_test::expectBoxHoldsSamples(spiral, 5000, 1e-4);
  curve_test::expectStepsWithinDeviation(element_, 0.001);
  curve_test::expectStepsWithinDeviation(element_, 0.05);
  EXPECT_NEAR(data_.getStepForDeviation(0.25 * total, 0.0), 0.75 * total, 1e-9);  // no deviation: the rest
}

INSTANTIATE_TEST_SUITE_P(
    Cases, SpiralData,
    ::testing::Values(SpiralCase{eMathSpiralEuler, true, true, 100.0, 300.0, 0.0},
                      SpiralCase{eMathSpiralEuler, false, false, 80.0, 450.0, 0.0},
                      SpiralCase{eMathSpiralEuler, true, true, 150.0, 60.0, 0.0},
                      SpiralCase{eMathSpiralEuler, true, true, 100.0, 1000.0, 300.0},
                      SpiralCase{eMathSpiralEuler, false, true, 60.0, 250.0, 900.0},
                      SpiralCase{eMathSpiralCubic, true, true, 100.0, 400.0, 0.0},
                      SpiralCase{eMathSpiralCubic, false, false, 100.0, 400.0, 0.0},
                      SpiralCase{eMathSpiralCubic, true, false, 60.0, 1000.0, 350.0}),
    [](const ::testing::TestParamInfo<SpiralCase>& caseInfo) { return describe(caseInfo.param); });

TEST(SpiralElement, BeyondTheEndsAndLongTangent) {
  CCurveSpiral spiral = makeSpiral(0.0, 0.0, 0.0, 100.0, 300.0, true, true);
  CMathAngle endTangent;
  ASSERT_TRUE(spiral.getEndAzimut(endTangent));
  const C2dPos end = spiral.getEndPos();
  C2dPos beyond;
  endTangent.getPosAlong(0.0008, end, beyond);
  double length = 0.0, offset = 0.0, distance = 0.0;
  ASSERT_TRUE(spiral.getLengthAndOffset(beyond, length, offset));  // within the end tolerance
  curve_test::expectPosNear(C2dPos(length, offset), 100.0008, 0.0, 1e-9);
  endTangent.getPosAlong(5.0, end, beyond);
  EXPECT_FALSE(spiral.getLengthAndOffset(beyond, length, offset));
  // The long tangent of a clothoid: from the start to the tangents' intersection, x_end - y_end / tan(theta).
  C2dPos ip;
  ASSERT_TRUE(spiral.getCurveIp(ip));
  curve_test::expectPosNear(ip, end.north() - end.east() / std::tan(100.0 / 600.0), 0.0, 1e-9);
  spiral.setIntersectionType(eIntersectUnbounded);
  ASSERT_TRUE(spiral.getLengthAndOffset(beyond, length, offset));
  EXPECT_NEAR(length, 105.0, 1e-9);
  ASSERT_TRUE(spiral.getLengthAndOffset(C2dPos(-20.0, 3.0), length, offset));  // behind the start
  curve_test::expectPosNear(C2dPos(length, offset), -20.0, 3.0, 1e-12);
  ASSERT_TRUE(spiral.getShortestDistanceToPoint(C2dPos(-20.0, 3.0), distance));
  EXPECT_NEAR(distance, std::hypot(20.0, 3.0), 1e-12);  // to the start point, not the prolonged tangent
}

// A tangent radius makes the full spiral; an explicit start offset cuts the same part as the radii would;
// defining a part anew by length and radius makes it the full spiral again. Copies own their law.
TEST(SpiralDataPart, TangentRadiusStartOffsetRedefinitionAndCopies) {
  CCurveDataSpiral part, full, byRadii, byOffset;
  ASSERT_TRUE(part.setLenAndTwoR(100.0, kInf, 300.0, true, true));
  ASSERT_TRUE(full.setLenAndR(100.0, 300.0, true, true));
  EXPECT_TRUE(!part.isCompoundSpiral() && part.getStartRadius() == 0.0);
  EXPECT_EQ(C2dPos(part.getFinalNorthing(), part.getFinalEasting()),
            C2dPos(full.getFinalNorthing(), full.getFinalEasting()));
  ASSERT_TRUE(byRadii.setLenAndTwoR(60.0, 500.0, 300.0, true, true));
  ASSERT_TRUE(byOffset.setLenAndR(byRadii.getSimpleSpiral()->getLength(), 300.0, true, true));
  ASSERT_TRUE(byOffset.setStartOffset(byRadii.getStartOffset()));
  EXPECT_FALSE(byOffset.setStartOffset(1e6));
  curve_test::expectPosNear(C2dPos(byOffset.getFinalNorthing(), byOffset.getFinalEasting()),
                            byRadii.getFinalNorthing(), byRadii.getFinalEasting(), 1e-12);
  ASSERT_TRUE(byRadii.setLenAndR(70.0, 300.0, true, true));
  EXPECT_TRUE(!byRadii.isCompoundSpiral() && byRadii.getTotalLength() == 70.0);
  // A change of the original leaves copies alone, self-assignment keeps the law, a new law the definition.
  CCurveDataSpiral a(eMathSpiralCubic);
  ASSERT_TRUE(a.setLenAndR(100.0, 300.0, true, true));
  CCurveDataSpiral b(a), c;
  c = a;
  ASSERT_TRUE(a.setLenAndR(50.0, 600.0, false, false));
  const CCurveDataSpiral& same = c;
  c = same;
  EXPECT_TRUE(b.getTotalLength() == 100.0 && c.getTotalLength() == 100.0 && c.getSpiralMathType() == eMathSpiralCubic);
  ASSERT_TRUE(b.recreateSimpleSpiral(eMathSpiralEuler));
  EXPECT_TRUE(b.getSpiralMathType() == eMathSpiralEuler && b.getRadius() == 300.0);
}

// Published partial and full clothoids of 100 m from two sources, both with x along (or the start tangent
// heading) east, y to the left, positive radius turning left. The first gives local positions to 1e-9 m; the
// second world positions to its print precision, each of whose rows must come back by the foot-point search.
TEST(SpiralPublished, MatchesPublishedClothoidTables) {
  SVY_SKIP_WITHOUT_REFDATA();
  const std::string rail = "alignment/ifc-rail-unit-test-reference-code/DomainExpert/HorizontalAlignment/Clothoid/";
  const std::string guide = "alignment/ifc-alignment-geometry-implementation-guide/HorizontalAlignment/Clothoid/";
  const struct {
    const char* name;
    double r1, r2;
  } tables[] = {{"1000_300", 1000.0, 300.0},     {"300_1000", 300.0, 1000.0}, {"-1000_-300", -1000.0, -300.0},
                {"-300_-1000", -300.0, -1000.0}, {"inf_300", kInf, 300.0},    {"300_inf", 300.0, kInf},
                {"-inf_-300", -kInf, -300.0},    {"-300_-inf", -300.0, -kInf}};
  for (const auto& t : tables) {
    SCOPED_TRACE(t.name);
    CCurveDataSpiral data;
    ASSERT_TRUE(data.setLenAndTwoR(100.0, t.r1, t.r2, t.r1 < 0.0 || t.r2 < 0.0, std::fabs(t.r2) < std::fabs(t.r1)));
    const auto local =
        curve_test::readNumericTable(svy_test::refdataPath(rail + "Clothoid_100.0_" + t.name + "_1_Meter.txt"), 0);
    ASSERT_EQ(local.size(), 101u);
    for (const auto& row : local) {
      double n = 0.0, e = 0.0;
      ASSERT_TRUE(data.getPosAtLength(row[0], n, e));
      EXPECT_NEAR(n, row[1], 1e-9) << row[0];
      EXPECT_NEAR(e, -row[2], 1e-9) << row[0];
    }
    const CCurveSpiral spiral(0.0, 0.0, CMathAngle(90.0), data);
    const auto world = curve_test::readNumericTable(
        svy_test::refdataPath(guide + "Horizontal_Clothoid_100.0_" + t.name + "_Meter.csv"));
    ASSERT_GT(world.size(), 10u);
    for (const auto& row : world) {
      curve_test::expectPosNear(curve_test::posAt(spiral, row[0]), row[2], row[1], 2e-6);
      double length = 0.0, offset = 0.0;
      ASSERT_TRUE(spiral.getLengthAndOffset(C2dPos(row[2], row[1]), length, offset)) << row[0];
      curve_test::expectPosNear(C2dPos(length, offset), row[0], 0.0, 3e-6);
    }
  }
}

}  // namespace
