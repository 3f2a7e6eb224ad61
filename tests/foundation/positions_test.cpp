// Point templates, positions, coordinate records, extents and segment distance.
#include <gtest/gtest.h>

#include <cmath>
#include <cstring>
#include <limits>
#include <vector>

#include "svymath/foundation/abstract_point.h"
#include "svymath/foundation/math_angle.h"
#include "svymath/foundation/positions.h"

namespace {

using P2 = svy_math::TAbstractPoint2<double>;
using P3 = svy_math::TAbstractPoint3<double>;
const double kNaN = std::numeric_limits<double>::quiet_NaN();

TEST(AbstractPoint, ArraysOfPointsAreArraysOfDoubles) {
  std::vector<C2dPos> points = {C2dPos(1, 2), C2dPos(3, 4), C2dPos(5, 6)};
  const double* raw = points[0];
  for (int i = 0; i < 6; ++i) EXPECT_EQ(raw[i], i + 1);
  const double values[3] = {7, 8, 9};
  const P3 p = P3::CreateFromPointer(values);
  EXPECT_EQ(p, P3(7, 8, 9));
  P3 copy;
  std::memcpy(static_cast<void*>(&copy), &p, sizeof p);
  EXPECT_EQ(copy, p);
  EXPECT_EQ(P2::CreateFromPointer(values), P2(7, 8));
}

TEST(AbstractPoint, ProductsQuotientsAndExtremes) {
  const P3 a(1, -2, 3), b(4, 5, -6);
  EXPECT_EQ(a * b, 4 - 10 - 18);  // dot product
  EXPECT_EQ(b / a, P3(4, -2.5, -2));
  P3 c = a;
  c *= b;
  EXPECT_EQ(c, P3(4, -10, -18));
  c /= b;
  EXPECT_EQ(c, a);
  EXPECT_EQ(a.abs(), P3(1, 2, 3));
  EXPECT_EQ(a.maximum(b), P3(4, 5, 3));
  EXPECT_EQ(a.minimum(b), P3(1, -2, -6));
  EXPECT_EQ(P3(4, 9, 16).sqrt().sum(), 9);
}

TEST(AbstractPoint, CrossProductIsOrthogonalWithLagrangeLength) {
  const std::vector<P3> vs = {P3(1, 0, 0), P3(1, 2, 3), P3(-4, 0.5, 2), P3(1e3, -1e-3, 7)};
  for (const P3& u : vs) {
    for (const P3& v : vs) {
      const P3 w = u.VectorProduct(v);
      const double scale = u.Module() * v.Module();
      EXPECT_NEAR(w * u, 0, 1e-12 * scale * u.Module());
      EXPECT_NEAR(w * v, 0, 1e-12 * scale * v.Module());
      EXPECT_NEAR(w.ModuleSq(), u.ModuleSq() * v.ModuleSq() - (u * v) * (u * v), 1e-9 * scale * scale);
    }
  }
  EXPECT_EQ(P3(1, 0, 0).VectorProduct(P3(0, 1, 0)), P3(0, 0, 1));
}

TEST(AbstractPoint, ExactComparisonAndScalarForms) {
  const P2 withNan(kNaN, 1);
  EXPECT_FALSE(withNan == withNan);
  EXPECT_TRUE(withNan != withNan);
  EXPECT_FALSE(P2(1, 1) == P2(1, 1 + 1e-15));
  P3 p(1, 2, 3);
  p = 4.5;
  EXPECT_TRUE(p == 4.5);
  EXPECT_FALSE(P3(4.5, 4.5, 4.6) == 4.5);
  EXPECT_TRUE(P3(4.5, 4.5, 4.6) != 4.5);
  EXPECT_EQ(P2(2.5), P2(2.5, 2.5));
}

// To POINT: truncation toward zero, saturation at the ends of long, NaN as 0; and back.
TEST(PointConversion, TruncatesTowardZeroAndSaturates) {
  const double cases[][4] = {{2.9, -2.9, 2, -2}, {-0.99, 0.99, 0, 0}, {1e20, -1e20, 2147483647.0, -2147483648.0},
                             {kNaN, 7.0, 0, 7}};
  for (const auto& c : cases) {
    const POINT pt = static_cast<POINT>(P2(c[0], c[1]));
    EXPECT_EQ(pt.x, static_cast<long>(c[2])) << c[0];
    EXPECT_EQ(pt.y, static_cast<long>(c[3])) << c[1];
  }
  POINT pt;
  pt.x = 3;
  pt.y = -4;
  EXPECT_EQ(P2(pt), P2(3, -4));
  Coord c(1, 2, 3);
  c = 7.0;
  EXPECT_EQ(c, Coord(7, 7, 7));
}

TEST(Coords, RotateAroundZKeepsDistanceAndHeight) {
  TCoords t;
  EXPECT_EQ(t.mask, 7u);
  t.north = 10;
  t.east = 0;
  t.height = 5;
  t.rotateAroundZ(CMathAngle(90.0));
  EXPECT_NEAR(t.north, 0, 1e-12);
  EXPECT_NEAR(t.east, 10, 1e-12);
  EXPECT_EQ(t.height, 5);
  const C2dPos centre(3, -7);
  TCoords u;
  u.north = 123.4;
  u.east = -56.7;
  const double before = (u.pos() - centre).Module();
  u.rotateAroundZ(CMathAngle(33.0), centre);
  EXPECT_NEAR((u.pos() - centre).Module(), before, 1e-10);
  u.rotateAroundZ(CMathAngle(-33.0), centre);
  EXPECT_NEAR(u.north, 123.4, 1e-10);
  EXPECT_NEAR(u.east, -56.7, 1e-10);
  u.east = kNaN;
  EXPECT_FALSE(u.hasFinitePlanPosition());
}

TEST(Extents, IncludeGrowsFromEmpty) {
  C2dMinMax box;
  EXPECT_TRUE(box.empty);
  EXPECT_FALSE(box.contains(C2dPos(0, 0)));
  box.include(C2dPos(5, -3));
  EXPECT_FALSE(box.empty);
  box.include(C2dPos(-1, 8));
  box.include(C2dPos(kNaN, 100));
  EXPECT_EQ(box.minNorth, -1);
  EXPECT_EQ(box.maxNorth, 5);
  EXPECT_EQ(box.minEast, -3);
  EXPECT_EQ(box.maxEast, 8);
  EXPECT_TRUE(box.contains(C2dPos(0, 0)));
  EXPECT_FALSE(box.contains(C2dPos(5.5, 0)));
  EXPECT_TRUE(box.contains(C2dPos(5.5, 0), 0.5));
  C2dMinMax other(C2dPos(20, 20), C2dPos(10, 9));
  EXPECT_FALSE(other.empty);
  EXPECT_EQ(other.minNorth, 10);
  EXPECT_FALSE(box.intersects(other));
  EXPECT_TRUE(box.intersects(other, 2.5));
  box.include(other);
  EXPECT_EQ(box.maxNorth, 20);
  EXPECT_EQ(box.maxEast, 20);
  box.include(C2dMinMax());
  EXPECT_EQ(box.maxEast, 20);
}

// The perpendicular distance inside the segment, the distance to the nearest end outside it; either way round.
TEST(SegmentDistance, PerpendicularInsideNearestEndOutside) {
  struct {
    const char* name;
    C2dPos start, end, p;
    double distance;
  } const cases[] = {{"inside", C2dPos(0, 0), C2dPos(0, 10), C2dPos(3, 4), 3},
                     {"at end", C2dPos(0, 0), C2dPos(0, 10), C2dPos(2, 10), 2},
                     {"beyond end", C2dPos(0, 0), C2dPos(0, 10), C2dPos(4, 13), 5},
                     {"before start", C2dPos(0, 0), C2dPos(0, 10), C2dPos(-3, -4), 5},
                     {"on the line", C2dPos(1, 1), C2dPos(4, 5), C2dPos(2.5, 3), 0},
                     {"coincident ends", C2dPos(1, 1), C2dPos(1, 1), C2dPos(4, 5), 5},
                     {"skew", C2dPos(0, 0), C2dPos(10, 10), C2dPos(0, 10), std::sqrt(50.0)}};
  for (const auto& c : cases) {
    EXPECT_NEAR(C2dSegment(c.start, c.end).getDistance(c.p), c.distance, 1e-12) << c.name;
    EXPECT_NEAR(C2dSegment(c.end, c.start).getDistance(c.p), c.distance, 1e-12) << c.name << " reversed";
  }
}

}  // namespace
