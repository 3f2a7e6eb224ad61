// Crossings of every pair of segment kinds through the double dispatch: each found point must lie on both
// pieces (checked with their own distance queries), the dispatch must not depend on the order of the pair,
// and misses, tangencies, parallels and extents must behave.
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <initializer_list>
#include <memory>
#include <string>
#include <tuple>
#include <vector>

#include "curve_test_support.h"
#include "svymath/curves/generic_line_impl.h"
#include "svymath/curves/generic_segment_visitor.h"
#include "svymath/curves/tline.h"

namespace {

using curve_test::makeArc;
using curve_test::makeSegment;
using curve_test::makeSpiral;

svy_vector<C2dPos> crossings(const CGenericSegment& a, const CGenericSegment& b) {
  svy_vector<C2dPos> out;
  a.calcIntersections(b, out);
  return out;
}

// Same points, in any order.
void expectSamePoints(svy_vector<C2dPos> a, svy_vector<C2dPos> b, double tolerance) {
  ASSERT_EQ(a.size(), b.size());
  const auto byNorth = [](const C2dPos& p, const C2dPos& q) { return p.north() < q.north(); };
  std::sort(a.begin(), a.end(), byNorth);
  std::sort(b.begin(), b.end(), byNorth);
  for (std::size_t i = 0; i < a.size(); ++i) curve_test::expectPosNear(a[i], b[i].north(), b[i].east(), tolerance);
}

// Line with line: general, axis-parallel, slanted, parallel, prolonged only, touching at an end or within
// the tolerance of it; a pair crosses the same way in either order.
TEST(LineLineIntersection, CrossingsByCase) {
  const struct {
    C2dPos a0, a1, b0, b1;
    EIntersectionType type;
    int hits;
    C2dPos expected;
  } cases[] = {
      {{0, 0}, {10, 10}, {0, 10}, {10, 0}, eIntersectOnSegment, 1, {5, 5}},
      {{-5, 2}, {5, 2}, {1, -3}, {1, 3}, eIntersectOnSegment, 1, {1, 2}},
      {{0, 4}, {10, 4}, {0, 0}, {8, 8}, eIntersectOnSegment, 1, {4, 4}},
      {{0, 0}, {10, 0}, {0, 5}, {10, 5}, eIntersectOnSegment, 0, {}},
      {{0, 0}, {1, 1}, {0, 10}, {10, 0}, eIntersectOnSegment, 0, {}},
      {{0, 0}, {1, 1}, {0, 10}, {10, 0}, eIntersectUnbounded, 1, {5, 5}},
      {{0, 0}, {5, 5}, {0, 10}, {10, 0}, eIntersectOnSegment, 1, {5, 5}},
      {{0, 0}, {4.9995, 4.9995}, {0, 10}, {10, 0}, eIntersectOnSegmentTol, 1, {5, 5}},
      {{5e6, 5e5}, {5000100, 500100}, {5e6, 500100}, {5000100, 5e5}, eIntersectOnSegment, 1, {5000050, 500050}}};
  for (const auto& c : cases) {
    SCOPED_TRACE(std::to_string(c.a1.north()) + " " + std::to_string(c.b0.east()));
    const CGenericLineImpl a(c.a0, c.a1, c.type);
    const svy_math::TLine b(c.b0, c.b1);
    svy_vector<C2dPos> out(1, C2dPos(-9.0, -9.0));  // results are appended
    EXPECT_EQ(a.calcIntersections(b, out), c.hits > 0);
    ASSERT_EQ(out.size(), static_cast<std::size_t>(1 + c.hits));
    if (c.hits == 1) curve_test::expectPosNear(out[1], c.expected.north(), c.expected.east(), 1e-9);
    if (c.type == eIntersectOnSegment) expectSamePoints(crossings(a, b), crossings(b, a), 1e-9);
  }
}

TEST(LineArcIntersection, TwoCrossingsTangencyMissAndSweep) {
  const CCurveArc circleArc = makeArc(0.0, 0.0, 0.0, 100.0, 50.0, true);  // centre (0, 50)
  // A north-south line through the centre meets the circle at (50, 50) and (-50, 50); only (50, 50) is in
  // the arc's sweep, which runs clockwise from west of the centre (the start) to 24.6 degrees.
  const CGenericLineImpl through(C2dPos(-100.0, 50.0), C2dPos(100.0, 50.0));
  const svy_vector<C2dPos> hits = crossings(through, circleArc);
  ASSERT_EQ(hits.size(), 1u);
  curve_test::expectPosNear(hits[0], 50.0, 50.0, 1e-9);
  expectSamePoints(hits, crossings(circleArc, through), 1e-12);
  CCurveArc unbounded = circleArc;
  unbounded.setIntersectionType(eIntersectUnbounded);
  EXPECT_EQ(crossings(through, unbounded).size(), 2u);
  // The tangent at the start touches once; a line beside it misses.
  const svy_vector<C2dPos> touch = crossings(CGenericLineImpl(C2dPos(-10.0, 0.0), C2dPos(10.0, 0.0)), circleArc);
  ASSERT_EQ(touch.size(), 1u);
  EXPECT_TRUE(std::fabs(touch[0].north()) < 1e-6 && std::fabs(touch[0].east()) < 1e-9);
  EXPECT_TRUE(crossings(CGenericLineImpl(C2dPos(-10.0, -0.01), C2dPos(10.0, -0.01)), circleArc).empty());
}

// Every crossing lies on both pieces (by their own distance queries, to the accuracy of the 20-arc
// approximation where a spiral takes part) and the order of the pair does not matter.
TEST(SegmentIntersection, EveryCrossingLiesOnBothPieces) {
  const CCurveSpiral spiral = makeSpiral(0.0, 0.0, 0.0, 100.0, 200.0, true, true);
  const CCurveSpiral across = makeSpiral(60.0, -20.0, 80.0, 60.0, 100.0, true, true);
  const CCurveArc arc = makeArc(50.0, -30.0, 90.0, 80.0, 500.0, false);  // eastward, gently left
  std::vector<std::tuple<std::shared_ptr<CGenericSegment>, std::shared_ptr<CGenericSegment>, double>> pairs = {
      {std::make_shared<CCurveSpiral>(spiral), std::make_shared<CCurveArc>(arc), 1e-4},
      {std::make_shared<CCurveSpiral>(spiral), std::make_shared<CCurveSpiral>(across), 1e-4}};
  for (double az = 0.0; az < 360.0; az += 23.0) {
    for (double lineAz = 5.0; lineAz < 180.0; lineAz += 31.0) {
      pairs.emplace_back(
          std::make_shared<CGenericLineImpl>(C2dPos(5000020.0, 500030.0), CMathAngle(lineAz), 400.0,
                                             eIntersectUnbounded),
          std::make_shared<CCurveArc>(makeArc(5000000.0, 500000.0, az, 180.0, 75.0, static_cast<int>(az) % 2 == 0)),
          1e-7);
    }
  }
  for (const auto& pair : pairs) {
    const CGenericSegment& a = *std::get<0>(pair);
    const CGenericSegment& b = *std::get<1>(pair);
    const svy_vector<C2dPos> hits = crossings(a, b);
    expectSamePoints(hits, crossings(b, a), 1e-9);
    for (const C2dPos& p : hits) {
      for (const CGenericSegment* piece : {&a, &b}) {
        double distance = 1.0, length = 0.0, offset = 0.0;
        EXPECT_TRUE(piece->getLengthAndOffset(p, length, offset));  // within the sweep
        ASSERT_TRUE(piece->getShortestDistanceToPoint(p, distance));
        EXPECT_LT(std::fabs(distance), std::get<2>(pair)) << piece->get_rtti_name();
      }
    }
  }
  EXPECT_EQ(crossings(spiral, arc).size(), 1u);
  EXPECT_FALSE(crossings(spiral, across).empty());
}

TEST(ArcArcIntersection, TwoCrossingsTangencyAndMiss) {
  const double circle = 2.0 * svy_math::units::kPi * 50.0;
  // Two circles of radius 50 with centres 60 apart cross at 40 from the line of centres.
  const CCurveArc a = makeArc(0.0, -50.0, 0.0, circle, 50.0, true);    // centre (0, 0)
  const CCurveArc b = makeArc(0.0, 110.0, 180.0, circle, 50.0, true);  // centre (0, 60)
  const svy_vector<C2dPos> hits = crossings(a, b);
  ASSERT_EQ(hits.size(), 2u);
  for (const C2dPos& p : hits) curve_test::expectPosNear(p, p.north() > 0.0 ? 40.0 : -40.0, 30.0, 1e-9);
  expectSamePoints(hits, crossings(b, a), 1e-9);
  // Externally tangent circles (centres 100 apart) touch once; farther apart they miss.
  const svy_vector<C2dPos> touch = crossings(a, makeArc(0.0, 150.0, 180.0, circle, 50.0, true));
  ASSERT_EQ(touch.size(), 1u);
  EXPECT_NEAR(touch[0].east(), 50.0, 1e-6);
  EXPECT_TRUE(crossings(a, makeArc(0.0, 151.0, 180.0, circle, 50.0, true)).empty());
  // A short arc of a keeps only the crossing within its sweep: from west of the centre clockwise through
  // north to 47.5 degrees, (40, 30) lies at 36.9, (-40, 30) at 143.1.
  const svy_vector<C2dPos> one = crossings(makeArc(0.0, -50.0, 0.0, 120.0, 50.0, true), b);
  ASSERT_EQ(one.size(), 1u);
  EXPECT_NEAR(one[0].north(), 40.0, 1e-9);
}

// Spiral crossings come from the 20-arc approximation: a line square to the spiral crosses it once, on one
// of the cached arcs and, to the accuracy of that approximation, on the spiral. Where two approximating
// arcs meet (every 6 m here) the line crosses both, and it is still one crossing, at the shared point.
TEST(SpiralIntersection, SquareLinesCrossOnceOnTheApproximatingArcs) {
  const CCurveSpiral spiral = makeSpiral(100.0, 200.0, 30.0, 120.0, 150.0, true, true);
  svy_vector<CCurveArc> cache;
  ASSERT_TRUE(spiral.createCache(cache));
  ASSERT_EQ(cache.size(), static_cast<std::size_t>(CGenericSpiral::kCacheArcs));
  for (double across = 5.0; across < 120.0; across += 9.0) {
    for (const double at : {across, 6.0 * std::floor(across / 6.0 + 1.0)}) {
      SCOPED_TRACE(at);
      const C2dPos on = curve_test::posAt(spiral, at);
      const CMathAngle normal = CMathAngle(spiral.getAzimuthAtLength(at)) + CMathAngle(90.0);
      const CGenericLineImpl line(C2dPos(on.north() - 10.0 * normal.getCos(), on.east() - 10.0 * normal.getSin()),
                                  normal, 20.0, eIntersectOnSegment);
      const svy_vector<C2dPos> hits = crossings(spiral, line);
      ASSERT_EQ(hits.size(), 1u);
      expectSamePoints(hits, crossings(line, spiral), 1e-12);
      double nearestArc = 1e9, distance = 1.0, length = 0.0, offset = 0.0;
      for (const CCurveArc& arc : cache) {
        if (arc.getLengthAndOffset(hits[0], length, offset)) nearestArc = std::min(nearestArc, std::fabs(offset));
      }
      EXPECT_LT(nearestArc, 1e-8);
      ASSERT_TRUE(spiral.getShortestDistanceToPoint(hits[0], distance));
      EXPECT_LT(distance, 1e-4);  // the approximation's own error, far below a millimetre here
      EXPECT_TRUE(at == across || curve_test::dist(hits[0], on) < 1e-9);
    }
  }
}

// The visitors see each segment as its own kind.
struct KindCounter : CGenericSegmentVisitor_const {
  void Visit(const CGenericLine&) override { ++lines; }
  void Visit(const CGenericArc&) override { ++arcs; }
  void Visit(const CGenericSpiral&) override { ++spirals; }
  int lines = 0, arcs = 0, spirals = 0;
};

struct Retyper : CGenericSegmentVisitor {
  void Visit(CGenericLine& line) override { line.setIntersectionType(eIntersectUnbounded); }
  void Visit(CGenericArc& arc) override { arc.setIntersectionType(eIntersectOnSegment); }
  void Visit(CGenericSpiral& spiral) override { spiral.setIntersectionType(eIntersectOnSegmentTol); }
};

TEST(SegmentVisitor, AcceptDispatchesOnTheKind) {
  CCurveSegment segment = makeSegment(0.0, 0.0, 0.0, 10.0);
  CCurveArc arc = makeArc(0.0, 0.0, 0.0, 10.0, 20.0, true);
  CCurveSpiral spiral = makeSpiral(0.0, 0.0, 0.0, 10.0, 20.0, true, true);
  svy_math::TLine tline(C2dPos(0.0, 0.0), C2dPos(1.0, 0.0));
  KindCounter counter;
  Retyper retyper;
  for (CGenericSegment* s : std::initializer_list<CGenericSegment*>{&segment, &arc, &spiral, &tline}) {
    s->Accept(counter);
    s->Accept(retyper);
  }
  EXPECT_TRUE(counter.lines == 2 && counter.arcs == 1 && counter.spirals == 1);
  EXPECT_TRUE(tline.getIntersectionType() == eIntersectUnbounded && arc.getIntersectionType() == eIntersectOnSegment &&
              spiral.getIntersectionType() == eIntersectOnSegmentTol);
}

}  // namespace
