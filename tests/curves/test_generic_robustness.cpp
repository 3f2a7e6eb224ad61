// No query of any segment kind may hang, crash or invent a result on NaN, infinite, huge or zero input:
// every call must return, and a true result must come with finite outputs.
#include <gtest/gtest.h>

#include <cmath>
#include <functional>
#include <memory>
#include <vector>

#include "svymath/curves/generic_line_impl.h"
#include "svymath/curves/tline.h"
#include "svyutils/svy_err_log.h"
#include "test_generic_support.h"

namespace {

using curve_test::kInf;
using curve_test::kNaN;

std::vector<std::unique_ptr<CGenericSegment>> segmentsOfEveryKind() {
  std::vector<std::unique_ptr<CGenericSegment>> all;
  all.push_back(std::make_unique<CGenericLineImpl>(C2dPos(0.0, 0.0), C2dPos(10.0, 10.0)));
  all.push_back(std::make_unique<svy_math::TLine>(C2dPos(1.0, 1.0), C2dPos(1.0, 1.0)));  // zero length
  all.push_back(std::make_unique<CCurveSegment>(curve_test::makeSegment(0.0, 0.0, 30.0, 50.0)));
  all.push_back(std::make_unique<CCurveArc>(curve_test::makeArc(0.0, 0.0, 30.0, 50.0, 80.0, true)));
  all.push_back(std::make_unique<CCurveArc>(curve_test::makeArc(0.0, 0.0, 30.0, 0.0, 80.0, false)));  // zero length
  all.push_back(std::make_unique<CCurveArc>(curve_test::makeArc(0.0, 0.0, 30.0, 10.0, 0.0, true)));   // zero radius
  all.push_back(std::make_unique<CCurveSpiral>(curve_test::makeSpiral(0.0, 0.0, 30.0, 60.0, 200.0, true, true)));
  all.push_back(std::make_unique<CCurveSpiral>(curve_test::makeSpiral(0.0, 0.0, 30.0, 60.0, 200.0, false, false)));
  all.push_back(std::make_unique<CCurveSegment>());
  all.push_back(std::make_unique<CCurveArc>());
  all.push_back(std::make_unique<CCurveSpiral>());
  all.push_back(std::make_unique<svy_math::TLine>());
  all.push_back(std::make_unique<CCurveArc>(kNaN, 0.0, CMathAngle(0.0), CCurveDataArc()));
  return all;
}

bool finite(const C2dPos& p) { return std::isfinite(p.north()) && std::isfinite(p.east()); }

TEST(SegmentRobustness, EveryQueryReturnsOnAbsurdInput) {
  svy_logging::CScopedErrLogCapture capture;  // rejected lengths are logged; keep them out of the output
  const double values[] = {kNaN, kInf, -kInf, 1e300, -1e300, 0.0, -0.0, 1e-300};
  const auto segments = segmentsOfEveryKind();
  for (const auto& segment : segments) {
    SCOPED_TRACE(segment->get_rtti_name());
    segment->isok();
    segment->getBoundary();
    segment->getTotalLength();
    for (const double v : values) {
      for (const double w : {kNaN, 0.0, 1.0, 1e300}) {
        C2dPos pos;
        if (segment->getPosAtLength(v, pos)) {
          EXPECT_TRUE(finite(pos) || !std::isfinite(v));
        }
        if (segment->getPosAtLengthAndOffset(v, w, pos)) {
          EXPECT_TRUE(finite(pos) || !std::isfinite(v * w));
        }
        double length = 0.0;
        double offset = 0.0;
        if (segment->getLengthAndOffset(C2dPos(v, w), length, offset) && std::isfinite(v) && std::isfinite(w)) {
          EXPECT_FALSE(std::isnan(length));
          EXPECT_FALSE(std::isnan(offset));
        }
        double distance = 0.0;
        segment->getShortestDistanceToPoint(C2dPos(w, v), distance);
        segment->getStepForDeviation(v, w);
        segment->getNextPosForDeviation(v, w, pos);
      }
      CMathAngle azimuth;
      segment->getAzimuthAtLength(v, azimuth);
      segment->getAzimuthAtLength(v);
      segment->getCurvatureAtLength(v);
      segment->checkDistanceAlongIsOnLine(v);
    }
    for (const auto& other : segments) {
      svy_vector<C2dPos> out;
      segment->calcIntersections(*other, out);
      for (const C2dPos& p : out) EXPECT_TRUE(finite(p));
    }
  }
}

TEST(SegmentRobustness, ProjectionRefusesNonFinitePoints) {
  const CCurveSpiral spiral = curve_test::makeSpiral(0.0, 0.0, 0.0, 60.0, 200.0, true, true);
  const CCurveArc arc = curve_test::makeArc(0.0, 0.0, 0.0, 60.0, 200.0, true);
  const CCurveSegment segment = curve_test::makeSegment(0.0, 0.0, 0.0, 60.0);
  for (const double v : {kNaN, kInf, -kInf}) {
    double dist = 3.0;
    double len = 4.0;
    EXPECT_FALSE(spiral.getShortestDistAndCurveLen(v, 1.0, dist, len));
    EXPECT_FALSE(arc.getShortestDistAndCurveLen(1.0, v, dist, len));
    EXPECT_FALSE(segment.getShortestDistAndCurveLen(v, v, dist, len));
    EXPECT_EQ(dist, 3.0);
    EXPECT_EQ(len, 4.0);
  }
  // Far away but finite: an answer, clamped to the element.
  double dist = 0.0;
  double len = 0.0;
  ASSERT_TRUE(spiral.getShortestDistAndCurveLen(1e12, -1e12, dist, len));
  EXPECT_GE(len, 0.0);
  EXPECT_LE(len, 60.0);
}

}  // namespace
