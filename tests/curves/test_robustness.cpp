// Ranges and robustness shared by every curve kind: lengths within a millimetre of an end snap to it
// silently and beyond it fail with one log entry; no query may hang, crash or invent a result on NaN,
// infinite, huge or zero input, and a true result must come with finite outputs.
#include <gtest/gtest.h>

#include <chrono>
#include <cmath>
#include <functional>
#include <memory>
#include <vector>

#include "curve_test_support.h"
#include "svymath/curves/generic_line_impl.h"
#include "svymath/curves/spiral_cubic.h"
#include "svymath/curves/spiral_euler.h"
#include "svymath/curves/spiral_factory.h"
#include "svymath/curves/tline.h"
#include "svyutils/svy_err_log.h"

namespace {

using curve_test::kInf;
using curve_test::kNaN;
using PosFn = std::function<bool(double, double&, double&)>;

template <class T>
PosFn localPos(const T& curve) {
  return [&curve](double s, double& n, double& e) { return curve.getPosAtLength(s, n, e); };
}

TEST(CurveRange, SnapsWithinAMillimetreAndLogsBeyond) {
  CEulerSpiralTStoSC clothoid;
  CCubicSpiralTStoSC cubic;
  CCurveDataSpiral part;
  CCurveDataSegment tangent;
  CCurveDataArc arcData;
  ASSERT_TRUE(clothoid.setLenAndR(80.0, 250.0, true) && cubic.setLenAndR(100.0, 300.0, true) &&
              part.setLenAndTwoR(100.0, 1000.0, 300.0, true, true) && tangent.setLen(20.0) &&
              arcData.SetElement(100.0, 50.0, true));
  tangent.setAzDeg(90.0);
  const CCurveArc arc = curve_test::makeArc(0.0, 0.0, 0.0, 100.0, 300.0, true);
  const struct {
    double total;
    PosFn pos;
  } cases[] = {{80.0, localPos(clothoid)}, {100.0, localPos(cubic)}, {100.0, localPos(part)},
               {20.0, localPos(tangent)},  {100.0, localPos(arc)}};
  for (const auto& c : cases) {
    SCOPED_TRACE(c.total);
    double endN = 0.0, endE = 0.0, startN = 0.0, startE = 0.0, n = 0.0, e = 0.0;
    ASSERT_TRUE(c.pos(c.total, endN, endE) && c.pos(0.0, startN, startE));
    svy_logging::CScopedErrLogCapture capture;
    EXPECT_TRUE(c.pos(c.total + 0.0009, n, e) && C2dPos(n, e) == C2dPos(endN, endE));
    EXPECT_TRUE(c.pos(-0.0009, n, e) && C2dPos(n, e) == C2dPos(startN, startE));
    EXPECT_EQ(capture.count(), 0u);
    n = 7.0;
    EXPECT_FALSE(c.pos(c.total + 0.0011, n, e) || c.pos(-0.0011, n, e) || c.pos(kNaN, n, e));
    EXPECT_EQ(n, 7.0);
    ASSERT_EQ(capture.count(), 3u);
    for (const auto& entry : capture.entries()) EXPECT_EQ(entry.file, "mathCurves");
  }
  svy_logging::CScopedErrLogCapture capture;  // a chord step from beyond the end is zero, logged
  EXPECT_EQ(arcData.getStepForDeviation(100.002, 0.01), 0.0);
  EXPECT_EQ(part.getStepForDeviation(100.0011, 0.01), 0.0);
  EXPECT_EQ(capture.count(), 2u);
}

TEST(CurveRange, UndefinedCurvesFailWithALogEntryAndZeroValues) {
  const CEulerSpiralTStoSC clothoid;
  const CCubicSpiralTStoSC cubic;
  const CCurveDataSpiral spiral;
  CCurveDataSegment tangent;
  svy_logging::CScopedErrLogCapture capture;
  double n = 0.0, e = 0.0, dist = 0.0, len = 0.0;
  for (const PosFn& pos : {localPos(clothoid), localPos(cubic), localPos(spiral), localPos(tangent)}) {
    EXPECT_FALSE(pos(0.0, n, e));
  }
  EXPECT_FALSE(!tangent.setLen(20.0) || tangent.getPosAtLength(1.0, n, e));  // a length without an azimuth
  EXPECT_EQ(capture.count(), 5u);
  for (const double zero : {clothoid.GetAzimuth(10.0), clothoid.getCurvatureAtLength(10.0),
                            clothoid.getLengthAtAzimuth(CMathAngle(10.0)), spiral.getCurvatureAtLength(1.0),
                            spiral.getRadius(), spiral.getSpiralParam()}) {
    EXPECT_EQ(zero, 0.0);
  }
  EXPECT_TRUE(clothoid.checkStepForDeviation(10.0, 0.0, 0.01) && std::isnan(spiral.getFinalNorthing()));
  EXPECT_FALSE(spiral.getShortestDistAndCurveLen(1.0, 1.0, dist, len));
}

// Definitions and queries of the laws and the spiral record with absurd numbers end; the radius searches
// take microseconds, a runaway loop would take hours.
TEST(CurveRobustness, LawsAndSpiralDataEndOnAbsurdInput) {
  svy_logging::CScopedErrLogCapture capture;
  const auto start = std::chrono::steady_clock::now();
  CCurveDataSpiral data;
  double n = 0.0, e = 0.0, dist = 0.0, len = 0.0;
  for (const AlntMathSpiralType type : {eMathSpiralEuler, eMathSpiralCubic}) {
    const std::unique_ptr<CCurveSpiralTStoSCBase> law(svy_math::createSpiralLaw(type));
    for (const double x : {kNaN, kInf, -kInf, 1e300, -1e300, 1e-300, 0.0}) {
      SCOPED_TRACE(x);
      int index = 0;
      for (const std::function<bool()>& define : std::vector<std::function<bool()>>{
               [&] { return law->setLenAndR(x, 300.0, true); }, [&] { return law->setLenAndR(100.0, x, true); },
               [&] { return law->setLenAndTwoR(x, 1000.0, 300.0, true); },
               [&] { return law->setLenAndTwoR(60.0, x, 300.0, true); },
               [&] { return law->setLenAndTwoR(60.0, 1000.0, x, true); },
               [&] { return law->setLenAndSpPrm(x, 30000.0); }, [&] { return law->setLenAndSpPrm(100.0, x); }}) {
        // A cubic defined by length and radius is usable when the definition says so (the clothoid takes any).
        const bool defined = define();
        EXPECT_FALSE(type == eMathSpiralCubic && index++ < 2 && defined && !law->isok());
        law->getPosAtLength(x, n, e), law->getPosAtLength(50.0, n, e), law->GetAzimuth(x), law->getFinalNorthing();
        law->getCurvatureAtLength(x), law->getLengthAtAzimuth(CMathAngle(x));
      }
      data.resetType(type);
      data.setLenAndTwoR(x, 1000.0, 300.0, true, true);
      data.setLenAndTwoR(100.0, x, 300.0, false, false);
      data.getShortestDistAndCurveLen(x, 1.0, dist, len), data.getStepForDeviation(x, 0.01);
      ASSERT_TRUE(data.setLenAndR(100.0, 300.0, true, true));
      data.getStepForDeviation(50.0, x), data.getShortestDistAndCurveLen(x, x, dist, len), data.getPosAtLength(x, n, e);
    }
  }
  // The cubic refuses what it cannot reach; a tangent at both ends is no spiral.
  CCubicSpiralTStoSC cubic;
  EXPECT_FALSE(cubic.setLenAndR(kNaN, 300.0, true) || cubic.setLenAndR(100.0, kInf, true) ||
               cubic.setLenAndTwoR(60.0, kInf, 300.0, true) || data.setLenAndTwoR(50.0, 0.0, kInf, true, true));
  EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(20));
}

bool finite(const C2dPos& p) { return std::isfinite(p.north()) && std::isfinite(p.east()); }

// Every segment query returns on absurd input; undefined pieces cross nothing; the placed elements refuse
// to project non-finite points (leaving the outputs alone) and clamp far finite ones to the element.
TEST(CurveRobustness, EverySegmentQueryReturnsOnAbsurdInput) {
  svy_logging::CScopedErrLogCapture capture;  // rejected lengths are logged; keep them out of the output
  const CCurveSpiral spiral = curve_test::makeSpiral(0.0, 0.0, 30.0, 60.0, 200.0, true, true);
  const CCurveArc arc = curve_test::makeArc(0.0, 0.0, 30.0, 50.0, 80.0, true);
  const CCurveSegment tangent = curve_test::makeSegment(0.0, 0.0, 30.0, 50.0);
  using curve_test::makeArc;
  const std::shared_ptr<CGenericSegment> segments[] = {
      std::make_shared<CGenericLineImpl>(C2dPos(0.0, 0.0), C2dPos(10.0, 10.0)),
      std::make_shared<svy_math::TLine>(C2dPos(1.0, 1.0), C2dPos(1.0, 1.0)),  // zero length
      std::make_shared<CCurveSegment>(tangent), std::make_shared<CCurveArc>(arc),
      std::make_shared<CCurveArc>(makeArc(0.0, 0.0, 30.0, 0.0, 80.0, false)),
      std::make_shared<CCurveArc>(makeArc(0.0, 0.0, 30.0, 10.0, 0.0, true)), std::make_shared<CCurveSpiral>(spiral),
      std::make_shared<CCurveSpiral>(curve_test::makeSpiral(0.0, 0.0, 30.0, 60.0, 200.0, false, false)),
      std::make_shared<CCurveSegment>(), std::make_shared<CCurveArc>(), std::make_shared<CCurveSpiral>(),
      std::make_shared<svy_math::TLine>(), std::make_shared<CCurveArc>(kNaN, 0.0, CMathAngle(0.0), CCurveDataArc())};
  for (const auto& segment : segments) {
    SCOPED_TRACE(segment->get_rtti_name());
    segment->getBoundary();
    for (const double v : {kNaN, kInf, -kInf, 1e300, -1e300, 0.0, -0.0, 1e-300}) {
      for (const double w : {kNaN, 0.0, 1.0, 1e300}) {
        C2dPos pos;
        double length = 0.0, offset = 0.0, distance = 0.0;
        EXPECT_TRUE(!segment->getPosAtLength(v, pos) || finite(pos) || !std::isfinite(v));
        EXPECT_TRUE(!segment->getPosAtLengthAndOffset(v, w, pos) || finite(pos) || !std::isfinite(v * w));
        if (segment->getLengthAndOffset(C2dPos(v, w), length, offset) && std::isfinite(v) && std::isfinite(w)) {
          EXPECT_FALSE(std::isnan(length) || std::isnan(offset));
        }
        segment->getShortestDistanceToPoint(C2dPos(w, v), distance), segment->getStepForDeviation(v, w);
        segment->getNextPosForDeviation(v, w, pos);
      }
      CMathAngle azimuth;
      segment->getAzimuthAtLength(v, azimuth), segment->getAzimuthAtLength(v), segment->getCurvatureAtLength(v);
      segment->checkDistanceAlongIsOnLine(v);
    }
    for (const auto& other : segments) {
      svy_vector<C2dPos> out;
      const bool found = segment->calcIntersections(*other, out);
      for (const C2dPos& p : out) EXPECT_TRUE(finite(p));
      EXPECT_FALSE(found && (!segment->isok() || !other->isok()));
    }
  }
  svy_vector<CCurveArc> cache;
  EXPECT_FALSE(CCurveSpiral().createCache(cache));
  for (const double v : {kNaN, kInf, -kInf}) {
    double dist = 3.0, len = 4.0;
    EXPECT_FALSE(spiral.getShortestDistAndCurveLen(v, 1.0, dist, len) ||
                 arc.getShortestDistAndCurveLen(1.0, v, dist, len) ||
                 tangent.getShortestDistAndCurveLen(v, v, dist, len));
    EXPECT_TRUE(dist == 3.0 && len == 4.0);
  }
  double dist = 0.0, len = 0.0;
  ASSERT_TRUE(spiral.getShortestDistAndCurveLen(1e12, -1e12, dist, len));
  EXPECT_TRUE(len >= 0.0 && len <= 60.0);
}

}  // namespace
