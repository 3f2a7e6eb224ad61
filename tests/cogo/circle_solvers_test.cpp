#include "svymath/cogo/circle_solvers.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "support/geometry.h"
#include "svymath/foundation/constants.h"

namespace {

using svy_math::units::kDegToRad;
using svy_test::dist;

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

// The point of the circle at azimuth `azimuthDeg` from its centre.
C2dPos onCircle(const C2dPos& center, double radius, double azimuthDeg) {
  const double a = azimuthDeg * kDegToRad;
  return C2dPos(center.north() + radius * std::cos(a), center.east() + radius * std::sin(a));
}

C2dPos along(const C2dPos& from, const C2dPos& to, double t) {
  return C2dPos(from.north() + t * (to.north() - from.north()), from.east() + t * (to.east() - from.east()));
}

const C2dPos kOrigin(0.0, 0.0);
const C2dPos kGrid(5000000.0, 500000.0);         // N 5 000 000, E 500 000
const C2dPos kSouthGrid(9876543.21, 712345.67);  // near the southern false northing

// A chord through two chosen points of the circle, the line given by two other points on it: the solver
// finds exactly the chosen points, the one met first from the first line point first.
TEST(LineCircle, FindsBothChordEndsInTravelOrder) {
  // Azimuths (degrees) of the chord ends seen from the centre; the line points as parameters along end1 -> end2.
  struct { C2dPos center; double radius, az1, az2, t1, t2; } const cases[] = {
      {kOrigin, 10.0, 30.0, 150.0, 0.25, 0.75},  {kOrigin, 5.0, 10.0, -10.0, 0.0, 1.0},
      {kOrigin, 5.0, 89.99, 90.01, 0.0, 1.0},    {kGrid, 250.0, 100.0, 280.0, 1.0, -3.0},
      {kGrid, 1000.0, 300.0, 300.5, -2.0, 7.0},  {kSouthGrid, 3000.0, 135.0, 315.0, 4.0, 2.0}};
  for (const auto& c : cases) {
    SCOPED_TRACE(::testing::Message() << c.radius << " " << c.az1 << " " << c.az2 << " " << c.t1);
    const C2dPos end1 = onCircle(c.center, c.radius, c.az1), end2 = onCircle(c.center, c.radius, c.az2);
    C2dPos s1, s2;
    ASSERT_EQ(IntersectionCoordsOfLineAndCircle(along(end1, end2, c.t1), along(end1, end2, c.t2), c.center, c.radius,
                                                s1, s2), 2);
    // Input rounding (1e-9 m at grid coordinates) moves a crossing by that over the sine of the angle at
    // which line and circle cross (half the central angle of the chord).
    const double tol = 1e-9 * (1.0 + 2.0 / std::fabs(std::sin((c.az2 - c.az1) * kDegToRad / 2)));
    const bool forward = c.t2 > c.t1;
    EXPECT_NEAR(dist(s1, forward ? end1 : end2), 0.0, tol);
    EXPECT_NEAR(dist(s2, forward ? end2 : end1), 0.0, tol);
  }
}

// Lines of constant northing just outside the circle miss it, just inside cross it at the half chord, and
// within the tangency tolerance touch it once.
TEST(LineCircle, MissesBeyondTheToleranceAndCrossesJustInside) {
  const double radius = 100.0;
  C2dPos s1(-1, -1), s2(-2, -2);
  auto solve = [&](double north, double e1, double e2) {
    return IntersectionCoordsOfLineAndCircle(C2dPos(north, kGrid.east() + e1), C2dPos(north, kGrid.east() + e2),
                                             kGrid, radius, s1, s2);
  };
  EXPECT_EQ(solve(kGrid.north() + radius + 1e-6, -10, 10), 0);
  const double inside = kGrid.north() + radius - 1e-6;
  ASSERT_EQ(solve(inside, -10, 10), 2);
  // Half chord sqrt(2 R delta - delta^2) = 0.01414 m, westward first; delta as stored (exact difference).
  const double delta = (kGrid.north() + radius) - inside;
  const double halfChord = std::sqrt(2.0 * radius * delta - delta * delta);
  EXPECT_NEAR(s1.east() - kGrid.east(), -halfChord, 1e-9);
  EXPECT_NEAR(s2.east() - kGrid.east(), halfChord, 1e-9);
  // A chord shorter than 2 sqrt(2 R 1e-8) (2.8 mm here) is within the tangency tolerance: one point.
  const double touching = kGrid.north() + radius - 0.5e-8;
  ASSERT_EQ(solve(touching, 10, -10), 1);
  EXPECT_NEAR(dist(s1, C2dPos(touching, kGrid.east())), 0.0, 1e-9);
}

// Circles through two chosen points, centred on either side of (or on) their perpendicular bisector: the
// solver returns the chosen points, the one right of centre1 -> centre2 first.
TEST(TwoCircles, FindsBothPointsRightOfTheCentreLineFirst) {
  // The crossings p, q; signed distances of the centres from the chord middle along its right normal (one side,
  // a diameter chord, both sides).
  struct { C2dPos p, q; double off1, off2; } const cases[] = {{C2dPos(0, -3), C2dPos(0, 3), 1.0, 9.0},
                     {C2dPos(0, -3), C2dPos(0, 3), 0.0, 50.0},
                     {C2dPos(5000010.0, 500020.0), C2dPos(5000010.5, 500020.25), -800.0, 600.0},
                     {kSouthGrid, C2dPos(9876000.0, 712000.0), 3000.0, -10.0}};
  for (const auto& c : cases) {
    SCOPED_TRACE(::testing::Message() << c.p.north() << " " << c.off1 << " " << c.off2);
    const C2dPos middle = along(c.p, c.q, 0.5);
    const double chord = dist(c.p, c.q);
    const double nN = -(c.q.east() - c.p.east()) / chord, nE = (c.q.north() - c.p.north()) / chord;
    const C2dPos center1(middle.north() + c.off1 * nN, middle.east() + c.off1 * nE);
    const C2dPos center2(middle.north() + c.off2 * nN, middle.east() + c.off2 * nE);
    const double r1 = std::hypot(chord / 2, c.off1), r2 = std::hypot(chord / 2, c.off2);
    C2dPos s1, s2;
    ASSERT_EQ(IntersectionCoordsOfTwoCircles(center1, r1, center2, r2, s1, s2), 2);
    const bool pOnRight = c.off2 > c.off1;
    // Input rounding moves a crossing by that over the sine of the angle at which the circles cross.
    const double tol = 1e-9 * (1.0 + 4.0 * r1 * r2 / (std::fabs(c.off2 - c.off1) * (chord / 2)));
    EXPECT_NEAR(dist(s1, pOnRight ? c.p : c.q), 0.0, tol);
    EXPECT_NEAR(dist(s2, pOnRight ? c.q : c.p), 0.0, tol);
  }
}

// Tangent circles touch once on the centre line; a micrometre apart (or further inside) they do not meet,
// a micrometre the other way they cross.
TEST(TwoCircles, TangentCirclesTouchOnceOnTheCentreLine) {
  struct { C2dPos center1; double r1, r2, azimuthDeg; bool internal; } const cases[] = {
      {kGrid, 250.0, 40.0, 211.0, false}, {kGrid, 40.0, 250.0, 45.0, true},
      {kSouthGrid, 1500.0, 1499.0, 95.0, true}};
  for (const auto& c : cases) {
    SCOPED_TRACE(::testing::Message() << c.r1 << " " << c.r2 << " " << c.azimuthDeg);
    const double d = c.internal ? std::fabs(c.r1 - c.r2) : c.r1 + c.r2;
    const double toward = (c.internal && c.r2 > c.r1) ? -c.r1 : c.r1;
    C2dPos s1, s2;
    ASSERT_EQ(IntersectionCoordsOfTwoCircles(c.center1, c.r1, onCircle(c.center1, d, c.azimuthDeg), c.r2, s1, s2), 1);
    // Rounding of the centres (1e-9 m) turns the centre line by 2e-9 / d rad.
    EXPECT_NEAR(dist(s1, onCircle(c.center1, toward, c.azimuthDeg)), 0.0, 1e-8 + c.r1 * 2e-9 / d);
    EXPECT_EQ(s1, s2);
    const double step = c.internal ? -1e-6 : 1e-6;
    for (int k : {1, -1})
      EXPECT_EQ(IntersectionCoordsOfTwoCircles(c.center1, c.r1, onCircle(c.center1, d + k * step, c.azimuthDeg), c.r2,
                                               s1, s2), 1 - k);
  }
}

// Disjoint, nested, concentric or invalid circles, and input that defines no line or circle (also differences
// that overflow), give no solution and leave the outputs alone.
TEST(NoSolution, DisjointNestedConcentricAndInvalidInput) {
  C2dPos s1(-1, -1), s2(-2, -2);
  const C2dPos a(1.0, 2.0), b(3.0, 5.0), n(kNaN, 0.0), far(1e308, 0.0);
  struct { C2dPos p, q, center; double radius; } const lines[] = {
      {a, a, kOrigin, 10.0}, {a, b, kOrigin, 0.0}, {a, b, kOrigin, -10.0}, {a, b, kOrigin, kNaN},
      {a, b, n, 10.0},       {n, b, kOrigin, 10.0}, {far, C2dPos(1e308, 1.0), C2dPos(-1e308, 0.0), 1.0}};
  for (const auto& c : lines) EXPECT_EQ(IntersectionCoordsOfLineAndCircle(c.p, c.q, c.center, c.radius, s1, s2), 0);
  const C2dPos north30(kGrid.north() + 30.0, kGrid.east()), north3(kGrid.north() + 3.0, kGrid.east());
  struct { C2dPos c1; double r1; C2dPos c2; double r2; } const cases[] = {
      {kGrid, 10.0, north30, 10.0}, {kGrid, 50.0, north3, 10.0}, {kGrid, 50.0, kGrid, 20.0},
      {kGrid, 50.0, kGrid, 50.0}, {kGrid, 50.0, C2dPos(kGrid.north() + 1e-9, kGrid.east()), 50.0},
      {kGrid, 0.0, kOrigin, 10.0},   {kGrid, 10.0, kOrigin, -10.0}, {kGrid, kNaN, kOrigin, 10.0},
      {C2dPos(0.0, kNaN), 10.0, kOrigin, 10.0},
      {C2dPos(-1e308, 0.0), 1e308, C2dPos(1e308, 0.0), 1e308}};
  for (const auto& c : cases) EXPECT_EQ(IntersectionCoordsOfTwoCircles(c.c1, c.r1, c.c2, c.r2, s1, s2), 0);
  EXPECT_TRUE(s1 == C2dPos(-1, -1) && s2 == C2dPos(-2, -2));
}

TEST(TwoCircles, NearlyConcentricCircles) {
  // Centres 2e-8 apart, radii differing by 2.5e-8: touching within the tolerance. The point must lie on
  // both circles (the chord formula would put it 2.5 m off here), on the smaller one's far side.
  const C2dPos center2(0.0, 2e-8);
  for (const bool firstLarger : {true, false}) {
    SCOPED_TRACE(firstLarger);
    const double r1 = firstLarger ? 10.0 : 10.0 - 2.5e-8, r2 = firstLarger ? 10.0 - 2.5e-8 : 10.0;
    C2dPos s1, s2;
    ASSERT_EQ(IntersectionCoordsOfTwoCircles(kOrigin, r1, center2, r2, s1, s2), 1);
    EXPECT_TRUE(std::fabs(dist(s1, kOrigin) - r1) <= 1e-8 && std::fabs(dist(s1, center2) - r2) <= 1e-8);
    EXPECT_TRUE(std::fabs(s1.north()) <= 1e-12 && s1.east() * (firstLarger ? 1.0 : -1.0) > 0.0) << s1.east();
  }
  // Equal circles a little apart cross almost a diameter apart, across the centre line.
  C2dPos s1, s2;
  ASSERT_EQ(IntersectionCoordsOfTwoCircles(kOrigin, 10.0, C2dPos(1e-6, 0.0), 10.0, s1, s2), 2);
  EXPECT_NEAR(dist(s1, C2dPos(0.5e-6, std::sqrt(100.0 - 0.25e-12))), 0.0, 1e-12);
  EXPECT_NEAR(dist(s2, C2dPos(0.5e-6, -std::sqrt(100.0 - 0.25e-12))), 0.0, 1e-12);
}

}  // namespace
