// Area segments, boundary areas against the shoelace formula, closed forms and a fine polyline, and the
// predicates the area computation relies on.
#include <gtest/gtest.h>

#include <cmath>
#include <random>
#include <vector>

#include "area_test_support.h"
#include "svymath/area/area_pieces.h"
#include "svymath/area/area_support.h"
#include "svymath/area/polygon_area.h"
#include "svymath/area/polygon_predicates.h"
#include "svyutils/svy_err_log.h"

using namespace svy_area_test;

namespace {

double areaOf(svy_list<AreaSegment> list, EAreaCalcStatus expected = eAreaCalcOk) {
  double area = -1.0;
  EXPECT_EQ(eComputePolygonArea(list, &area), expected);
  return area;
}

double dist(const TCoords& a, const TCoords& b) { return std::hypot(a.north - b.north, a.east - b.east); }

// A square of side s at (n0, e0), counter-clockwise on the map, its east side (N 0 -> s at E s) replaced by
// an arc of central angle `angle` bulging out (ccw) or in (cw).
svy_list<AreaSegment> squareWithArc(double n0, double e0, double s, double angle, bool outward) {
  svy_list<AreaSegment> list;
  list.emplace_back(ne(n0, e0), ne(n0, e0 + s));
  list.emplace_back(angle, ne(n0, e0 + s), ne(n0 + s, e0 + s), outward);
  list.emplace_back(ne(n0 + s, e0 + s), ne(n0 + s, e0));
  list.emplace_back(ne(n0 + s, e0), ne(n0, e0));
  return list;
}

}  // namespace

TEST(AreaSegment, ArcConstructorsAgreeOnCentreRadiusAndLength) {
  const TCoords a = ne(5000000.0, 500000.0);
  const TCoords b = ne(5000030.0, 500040.0);  // chord 50
  const AreaSegment half(kPi, a, b, false);
  EXPECT_NEAR(half.radius(), 25.0, 1e-12);
  EXPECT_NEAR(half.length, 25.0 * kPi, 1e-12);
  EXPECT_NEAR(dist(half.center, ne(5000015.0, 500020.0)), 0.0, 1e-8);
  for (const bool ccw : {false, true}) {
    for (const double angle : {0.3, 1.5, 2.9}) {
      const AreaSegment minor(angle, a, b, ccw);
      const AreaSegment major(2.0 * kPi - angle, a, b, ccw);
      // The same circle; the major arc's centre mirrored across the chord.
      EXPECT_NEAR(minor.radius(), major.radius(), 1e-9);
      EXPECT_NEAR(dist(minor.center, a), minor.radius(), 1e-8);
      EXPECT_NEAR(dist(major.center, b), major.radius(), 1e-8);
      EXPECT_NEAR(minor.center.north + major.center.north, a.north + b.north, 1e-8);
      const AreaSegment byRadius(a, b, minor.radius(), ccw);
      EXPECT_NEAR(dist(byRadius.center, minor.center), 0.0, 1e-8);
      EXPECT_NEAR(byRadius.length, minor.length, 1e-8);
      const AreaSegment byCentre(a, b, major.center, ccw);
      EXPECT_NEAR(byCentre.length, major.length, 1e-8);
      // The two ways round one circle make the whole circumference.
      EXPECT_NEAR(byCentre.length + AreaSegment(a, b, major.center, !ccw).length, 2.0 * kPi * major.radius(), 1e-8);
    }
  }
}

TEST(AreaSegment, ConstructorFailuresAreLoggedWithTheirLines) {
  const TCoords a = ne(10.0, 10.0);
  const TCoords far = ne(110.0, 10.0);
  struct Case {
    AreaSegment (*make)(const TCoords&, const TCoords&);
    std::vector<int> lines;
  } cases[] = {
      {[](const TCoords& p, const TCoords&) { return AreaSegment(p, p); }, {109}},
      {[](const TCoords& p, const TCoords&) { return AreaSegment(p, ne(NAN, 0.0)); }, {109, 111}},
      {[](const TCoords& p, const TCoords& q) { return AreaSegment(p, q, 10.0, false); }, {137}},
      {[](const TCoords& p, const TCoords& q) { return AreaSegment(p, q, p, true); }, {125}},
      {[](const TCoords& p, const TCoords&) { return AreaSegment(1.0, p, ne(NAN, 0.0), true); }, {152, 159}},
  };
  for (const Case& c : cases) {
    svy_logging::CScopedErrLogCapture capture;
    c.make(a, far);
    std::vector<int> lines;
    for (const auto& e : capture.entries()) {
      EXPECT_EQ(e.file, "AreaMath");
      EXPECT_EQ(e.message, "");
      lines.push_back(e.line);
    }
    EXPECT_EQ(lines, c.lines);
  }
}

TEST(AreaSegment, PointListsCloseOnce) {
  svy_list<AreaSegment> open;
  svy_list<AreaSegment> closed;
  svy_list<AreaSegment> single;
  getAreaSegmentListFromPointVector({C2dPos(0, 0), C2dPos(0, 10), C2dPos(10, 10)}, open);
  getAreaSegmentListFromPointVector({C2dPos(0, 0), C2dPos(0, 10), C2dPos(10, 10), C2dPos(1e-9, 0)}, closed);
  getAreaSegmentListFromPointVector({C2dPos(0, 0)}, single);
  EXPECT_EQ(open.size(), 3u);
  EXPECT_EQ(closed.size(), 3u);
  EXPECT_TRUE(single.empty());
  EXPECT_DOUBLE_EQ(areaOf(open), 50.0);
  EXPECT_FALSE(boDoesPolygonContainAnArc(open));
  EXPECT_TRUE(boDoesPolygonContainAnArc(squareWithArc(0, 0, 10, 1.0, true)));
}

TEST(AreaPieces, ClosedForms) {
  double a = 0.0;
  EXPECT_TRUE(AreaCircChord(10.0, kPi, &a));
  EXPECT_NEAR(a, 50.0 * kPi, 1e-12);  // half disc
  EXPECT_TRUE(AreaCircChord(10.0, 1.5 * kPi, &a));
  EXPECT_NEAR(a, 75.0 * kPi + 50.0, 1e-12);  // major segment: three-quarter disc plus the triangle
  const C2dPos p(0, 0), q(0, 1), r(1, 0);  // north, east: east then north-west turns left
  EXPECT_NEAR(triangle_area(p, q, r), -0.5, 1e-15);
  EXPECT_FALSE(clockwise(p, q, r));
  EXPECT_TRUE(clockwise(p, r, q));
}

TEST(PolygonArea, LinePolygonsMatchTheShoelaceBothWays) {
  const std::vector<std::vector<TCoords>> shapes = {
      {ne(0, 0), ne(0, 4), ne(3, 0)},
      {ne(5000000, 500000), ne(5000000, 500100), ne(5000050, 500100), ne(5000050, 500050), ne(5000100, 500050),
       ne(5000100, 500000)},
      {ne(1, 1), ne(7, 3), ne(4, 9), ne(2, 5), ne(-3, 6)},
  };
  for (const auto& shape : shapes) {
    const svy_list<AreaSegment> list = polygon(shape);
    const double oracle = polylineArea(list);
    EXPECT_NEAR(areaOf(list), oracle, 1e-9 * oracle);
    EXPECT_NEAR(areaOf(reversed(list)), oracle, 1e-9 * oracle);
    double signedArea = 0.0;
    EXPECT_EQ(eComputePolygonVertexArea(list, signedArea, true), eAreaCalcOk);
    double reverseSigned = 0.0;
    eComputePolygonVertexArea(reversed(list), reverseSigned, true);
    EXPECT_NEAR(signedArea, -reverseSigned, 1e-9 * oracle);
  }
  double signedArea = 0.0;
  eComputePolygonVertexArea(polygon({ne(0, 0), ne(0, 1), ne(1, 1)}), signedArea, true);
  EXPECT_GT(signedArea, 0.0);  // east, then north: counter-clockwise
  signedArea = 7.0;
  EXPECT_EQ(eComputePolygonVertexArea(polygon({ne(0, 0), ne(0, 1)}), signedArea, true), eAreaCalcTooFewSegments);
  EXPECT_EQ(signedArea, 0.0);
  areaOf(polygon({ne(0, 0), ne(1, 1), ne(2, 2)}), eAreaCalcZeroArea);
}

TEST(PolygonArea, ClosedFormsWithArcsInBothDirections) {
  const double r = 20.0;
  const TCoords c = ne(5000000.0, 500000.0);
  const TCoords north = ne(c.north + r, c.east), south = ne(c.north - r, c.east), east = ne(c.north, c.east + r);
  AreaSegment circle(north, north, c, false);
  circle.length = 2.0 * kPi * r;
  struct Case {
    const char* name;
    svy_list<AreaSegment> list;
    double expected;
  } cases[] = {
      {"disc", {circle}, kPi * r * r},
      {"half disc", {AreaSegment(kPi, north, south, false), AreaSegment(south, north)}, kPi * r * r / 2},
      {"two halves", {AreaSegment(kPi, north, south, false), AreaSegment(kPi, south, north, false)}, kPi * r * r},
      {"lens", {AreaSegment(north, south, 30.0, false), AreaSegment(south, north, 30.0, false)}, 0.0},
      {"quarter sector", {AreaSegment(c, north), AreaSegment(north, east, c, false), AreaSegment(east, c)},
       kPi * r * r / 4},
      {"three-quarter sector", {AreaSegment(c, north), AreaSegment(north, east, c, true), AreaSegment(east, c)},
       3 * kPi * r * r / 4},
      {"square, arc out", squareWithArc(c.north, c.east, 10, kPi / 2, true), 100 + 25 * (kPi / 2 - 1)},
      {"square, arc in", squareWithArc(c.north, c.east, 10, kPi / 2, false), 100 - 25 * (kPi / 2 - 1)},
      {"square, half disc out", squareWithArc(c.north, c.east, 10, kPi, true), 100 + 12.5 * kPi},
  };
  // The lens of two arcs of radius 30 on a 40 m chord: twice the circular segment.
  const double half = std::asin(20.0 / 30.0);
  cases[3].expected = 2 * 450.0 * (2 * half - std::sin(2 * half));
  for (const Case& k : cases) {
    SCOPED_TRACE(k.name);
    EXPECT_NEAR(areaOf(k.list), k.expected, 1e-7);
    if (k.list.size() == 1) continue;
    EXPECT_NEAR(areaOf(reversed(k.list)), k.expected, 1e-7);
    EXPECT_NEAR(polylineArea(k.list), k.expected, 1e-3);
  }
  circle.length += 0.001;
  areaOf({circle}, eAreaCalcNotACircle);
  areaOf({AreaSegment(north, south), AreaSegment(south, north)}, eAreaCalcGeometryFailed);
}

TEST(PolygonArea, TheOuterRimArcBecomesALineInTheCallersList) {
  const TCoords c = ne(0, 0), n = ne(20, 0), e = ne(0, 20);
  svy_list<AreaSegment> list{AreaSegment(c, n), AreaSegment(n, e, c, true), AreaSegment(e, c)};
  double area = 0.0;
  ASSERT_EQ(eComputePolygonArea(list, &area), eAreaCalcOk);
  const AreaSegment& rim = *std::next(list.begin());
  EXPECT_TRUE(rim.boIsLine());
  EXPECT_NEAR(rim.radiusOrAzimuth, 0.75 * kPi, 1e-12);  // azimuth north -> east point: south-east
  EXPECT_NEAR(rim.length, 30 * kPi, 1e-9);              // the arc's length stays
  // Computed again, the list is now a triangle.
  EXPECT_NEAR(areaOf(list), 200.0, 1e-9);
}

TEST(PolygonArea, RandomBoundariesWithArcsMatchAFinePolyline) {
  std::mt19937 rng(20261124);
  std::uniform_real_distribution<double> unit(0.0, 1.0);
  int tested = 0;
  for (int trial = 0; trial < 40; ++trial) {
    // Vertices on a circle at random angles (a convex polygon), some sides replaced by arcs out or in.
    const int n = 3 + trial % 6;
    std::vector<double> angles;
    for (int i = 0; i < n; ++i) angles.push_back(2 * kPi * unit(rng));
    std::sort(angles.begin(), angles.end());
    std::vector<TCoords> v;
    for (double a : angles) v.push_back(ne(5000000.0 + 100 * std::cos(a), 500000.0 - 100 * std::sin(a)));
    svy_list<AreaSegment> list;
    for (int i = 0; i < n; ++i) {
      const TCoords& p = v[i];
      const TCoords& q = v[(i + 1) % n];
      const double pick = unit(rng);
      if (pick < 0.4) list.emplace_back(p, q);
      else if (pick < 0.8) list.emplace_back(0.2 + 2.8 * unit(rng), p, q, true);   // outward
      else list.emplace_back(0.1 + 0.5 * unit(rng), p, q, false);                  // inward
    }
    if (eDoAreaSegmentsCross(list, false) != eAreaCalcOk) continue;
    ++tested;
    const double oracle = polylineArea(list);
    EXPECT_NEAR(areaOf(list), oracle, 2e-3) << trial;
    EXPECT_NEAR(areaOf(reversed(list)), oracle, 2e-3) << trial;
  }
  EXPECT_GT(tested, 25);
}

TEST(PolygonPredicates, InsideTestFollowsArcs) {
  const svy_list<AreaSegment> out = squareWithArc(0, 0, 10, kPi, true);  // half disc east of E 10
  const svy_list<AreaSegment> in = squareWithArc(0, 0, 10, kPi / 2, false);
  const struct {
    TCoords p;
    bool inOut, inIn;
  } cases[] = {{ne(5, 5), true, true},   {ne(5, 12), true, false}, {ne(5, 9), true, false},
               {ne(5, 16), false, false}, {ne(-1, 5), false, false}, {ne(0, 5), true, true}};
  for (const auto& c : cases) {
    EXPECT_EQ(boIsCoordinateInPolygon(c.p, out), c.inOut) << c.p.north << "," << c.p.east;
    EXPECT_EQ(boIsCoordinateInPolygon(c.p, in), c.inIn) << c.p.north << "," << c.p.east;
  }
  EXPECT_TRUE(boIsArcInPolygon(in, *std::next(in.begin())));
  EXPECT_FALSE(boIsArcInPolygon(out, *std::next(out.begin())));
  EXPECT_FALSE(boIsPolygonInArc(out, *std::next(out.begin())));
}

TEST(PolygonPredicates, CrossingCodes) {
  const TCoords a = ne(0, 0), b = ne(0, 10), c = ne(10, 10), d = ne(10, 0);
  // A spike from the north-west corner reaching under an arc that bulges east of E 10: it crosses the arc's
  // chord but not the arc.
  svy_list<AreaSegment> spike{AreaSegment(a, b), AreaSegment(b, c, 5.0, true), AreaSegment(c, d),
                              AreaSegment(d, ne(5, 12)), AreaSegment(ne(5, 12), a)};
  const struct {
    const char* name;
    svy_list<AreaSegment> list;
    EAreaCalcStatus strict, ignoringChords;
  } cases[] = {
      {"square", polygon({a, b, c, d}), eAreaCalcOk, eAreaCalcOk},
      {"bow tie", polygon({a, b, d, c}), eAreaCalcSegmentsCross, eAreaCalcSegmentsCross},
      {"pinched at a shared vertex", polygon({a, b, ne(5, 5), c, d, ne(5, 5)}), eAreaCalcOk, eAreaCalcOk},
      {"vertex on a side", polygon({a, b, c, d, ne(5, 10), ne(5, 5)}), eAreaCalcSegmentsCross, eAreaCalcSegmentsCross},
      {"sides overlap", polygon({a, b, ne(0, 5), ne(5, 5)}), eAreaCalcSegmentsCross, eAreaCalcSegmentsCross},
      {"chord crossed", spike, eAreaCalcChordCrosses, eAreaCalcOk},
      {"arc crossed",
       {AreaSegment(a, ne(0, 3)), AreaSegment(kPi, ne(0, 3), ne(10, 3), false), AreaSegment(ne(10, 3), d),
        AreaSegment(d, a)},
       eAreaCalcSegmentsCross, eAreaCalcSegmentsCross},
      {"retraced circle", {AreaSegment(b, c, 5.0, true), AreaSegment(c, b, ne(5, 10), false)},
       eAreaCalcSegmentsCross, eAreaCalcSegmentsCross},
      {"one segment", {AreaSegment(a, b)}, eAreaCalcOk, eAreaCalcOk},
      {"not finite", polygon({a, b, ne(NAN, 3)}), eAreaCalcGeometryFailed, eAreaCalcGeometryFailed},
  };
  for (const auto& k : cases) {
    EXPECT_EQ(eDoAreaSegmentsCross(k.list, false), k.strict) << k.name;
    EXPECT_EQ(eDoAreaSegmentsCross(k.list, true), k.ignoringChords) << k.name;
  }
  svy_logging::CScopedErrLogCapture capture;
  eDoAreaSegmentsCross({AreaSegment(b, c, 5.0, true), AreaSegment(ne(5, 15), b, ne(5, 10), false)}, true);
  ASSERT_EQ(capture.count(), 1u);
  EXPECT_EQ(capture.entries()[0].line, 1466);
}
