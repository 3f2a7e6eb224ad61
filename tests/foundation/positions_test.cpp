// Point templates, positions, coordinate records, extents and segment distance.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <vector>

#include "svymath/foundation/abstract_point.h"
#include "svymath/foundation/math_angle.h"
#include "svymath/foundation/positions.h"

namespace {

using P2 = svy_math::TAbstractPoint2<double>;
using P3 = svy_math::TAbstractPoint3<double>;
const double kNaN = std::numeric_limits<double>::quiet_NaN();

// Arrays of points are arrays of doubles; element-wise products; comparison is exact (NaN unequal); the
// vector product is orthogonal with the length of Lagrange's identity. To POINT: truncation toward zero,
// saturation at the ends of long, NaN as 0.
TEST(AbstractPoint, LayoutProductsExactComparisonAndConversion) {
  std::vector<C2dPos> points = {C2dPos(1, 2), C2dPos(3, 4), C2dPos(5, 6)};
  const double* raw = points[0];
  for (int i = 0; i < 6; ++i) EXPECT_EQ(raw[i], i + 1);
  const double values[3] = {7, 8, 9};
  const P3 a(1, -2, 3), b(4, 5, -6);
  EXPECT_TRUE(P3::CreateFromPointer(values) == P3(7, 8, 9) && a * b == 4 - 10 - 18 && b / a == P3(4, -2.5, -2));
  EXPECT_TRUE(a.maximum(b) == P3(4, 5, 3) && a.minimum(b) == P3(1, -2, -6) && a.abs() == P3(1, 2, 3));
  EXPECT_TRUE(P3(4, 9, 16).sqrt().sum() == 9 && P2(2.5) == P2(2.5, 2.5));
  for (const P3& v : {b, P3(1e3, -1e-3, 7)}) {
    const P3 w = a.VectorProduct(v);
    EXPECT_NEAR(w * a, 0, 1e-12 * w.Module() * a.Module());
    EXPECT_NEAR(w * v, 0, 1e-12 * w.Module() * v.Module());
    EXPECT_NEAR(w.ModuleSq(), a.ModuleSq() * v.ModuleSq() - (a * v) * (a * v), 1e-12 * a.ModuleSq() * v.ModuleSq());
  }
  const P2 withNan(kNaN, 1);
  EXPECT_FALSE(withNan == withNan || P2(1, 1) == P2(1, 1 + 1e-15));
  EXPECT_TRUE(P3(4.5, 4.5, 4.6) != 4.5);
  const double cases[][4] = {{2.9, -2.9, 2, -2}, {1e20, -1e20, 2147483647.0, -2147483648.0}, {kNaN, 7.0, 0, 7}};
  for (const auto& c : cases) {
    const POINT pt = static_cast<POINT>(P2(c[0], c[1]));
    EXPECT_TRUE(pt.x == static_cast<long>(c[2]) && pt.y == static_cast<long>(c[3])) << c[0];
  }
  POINT pt;
  pt.x = 3;
  pt.y = -4;
  EXPECT_EQ(P2(pt), P2(3, -4));
}

// Rotation about Z turns north to east clockwise, keeps the height, and rotates back about a centre.
TEST(Coords, RotateAroundZKeepsDistanceAndHeight) {
  TCoords t;
  t.north = 10;
  t.east = 0;
  t.height = 5;
  t.rotateAroundZ(CMathAngle(90.0));
  EXPECT_TRUE(std::fabs(t.north) < 1e-12 && std::fabs(t.east - 10) < 1e-12 && t.height == 5);
  t.north = 123.4;
  t.east = -56.7;
  t.rotateAroundZ(CMathAngle(33.0), C2dPos(3, -7));
  t.rotateAroundZ(CMathAngle(-33.0), C2dPos(3, -7));
  EXPECT_TRUE(std::fabs(t.north - 123.4) < 1e-10 && std::fabs(t.east + 56.7) < 1e-10);
  t.east = kNaN;
  EXPECT_FALSE(t.hasFinitePlanPosition());
}

TEST(Extents, IncludeGrowsFromEmptyAndSkipsNaN) {
  C2dMinMax box;
  EXPECT_FALSE(box.contains(C2dPos(0, 0)));
  for (const C2dPos& p : {C2dPos(5, -3), C2dPos(-1, 8), C2dPos(kNaN, 100)}) box.include(p);
  EXPECT_TRUE(P2(box.minNorth, box.maxNorth) == P2(-1, 5) && P2(box.minEast, box.maxEast) == P2(-3, 8));
  EXPECT_TRUE(!box.contains(C2dPos(5.5, 0)) && box.contains(C2dPos(5.5, 0), 0.5));
  const C2dMinMax other(C2dPos(20, 20), C2dPos(10, 9));
  EXPECT_TRUE(other.minNorth == 10 && !box.intersects(other) && box.intersects(other, 2.5));
  box.include(other);
  box.include(C2dMinMax());
  EXPECT_EQ(P2(box.maxNorth, box.maxEast), P2(20, 20));
}

// The perpendicular distance inside the segment, the distance to the nearest end outside it; either way round.
TEST(SegmentDistance, PerpendicularInsideNearestEndOutside) {
  const C2dPos o(0, 0), n10(0, 10), a(1, 1), b(4, 5);
  const struct {
    C2dPos start, end, p;
    double distance;
  } cases[] = {{o, n10, C2dPos(3, 4), 3}, {o, n10, C2dPos(4, 13), 5}, {o, n10, C2dPos(-3, -4), 5},
               {a, b, C2dPos(2.5, 3), 0}, {a, a, b, 5}};
  for (const auto& c : cases) {
    EXPECT_NEAR(C2dSegment(c.start, c.end).getDistance(c.p), c.distance, 1e-12) << (&c - cases);
    EXPECT_NEAR(C2dSegment(c.end, c.start).getDistance(c.p), c.distance, 1e-12) << (&c - cases);
  }
}

}  // namespace
