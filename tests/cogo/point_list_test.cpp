// Point lists: area and perimeter of regular polygons (closed forms) at grid coordinates, orientation,
// clean-up of repeated and collinear vertices, nearest vertex and point.
#include <gtest/gtest.h>

#include <cmath>

#include "svymath/cogo/point_list.h"
#include "svymath/foundation/constants.h"

namespace {

using svy_math::units::kTwoPi;

const C2dPos kGrid(5000000.0, 500000.0);

// A regular polygon of n vertices on a circle of radius r about the centre, clockwise on the map when the
// azimuths increase.
svy_vector<C2dPos> regularPolygon(const C2dPos& centre, double r, int n, bool clockwise) {
  svy_vector<C2dPos> points;
  for (int i = 0; i < n; ++i) {
    const double az = (clockwise ? 1 : -1) * kTwoPi * i / n + 0.3;
    points.push_back(C2dPos(centre.north() + r * std::cos(az), centre.east() + r * std::sin(az)));
  }
  return points;
}

TEST(PointListArea, RegularPolygonsAgainstClosedForms) {
  for (const int n : {3, 4, 7, 360}) {
    for (const bool clockwise : {true, false}) {
      SCOPED_TRACE(::testing::Message() << n << " " << clockwise);
      const double r = 123.456;
      svy_vector<C2dPos> points = regularPolygon(kGrid, r, n, clockwise);
      const double area = 0.5 * n * r * r * std::sin(kTwoPi / n);
      // Relative to the first vertex the sum keeps its digits: 1e-9 m of coordinate rounding over the perimeter.
      EXPECT_NEAR(C2dPtListUt::getSignedArea(points), clockwise ? -area : area, 1e-6);
      EXPECT_NEAR(C2dPtListUt::getArea(points), area, 1e-6);
      EXPECT_NEAR(C2dPtListUt::getPerimeter(points, true), 2 * n * r * std::sin(kTwoPi / n / 2), 1e-8);
      EXPECT_EQ(C2dPtListUt::getOrientation(points),
                clockwise ? C2dPtListUt::eOrientationClockwise : C2dPtListUt::eOrientationCounterClockwise);
      // A repeated first vertex at the end changes nothing but the open length.
      points.push_back(points.front());
      EXPECT_NEAR(C2dPtListUt::getArea(points), area, 1e-6);
      EXPECT_TRUE(C2dPtListUt::setOrientation(points, C2dPtListUt::eOrientationClockwise) != clockwise);
      EXPECT_EQ(C2dPtListUt::getOrientation(points), C2dPtListUt::eOrientationClockwise);
    }
  }
  const svy_vector<C2dPos> line{kGrid, C2dPos(kGrid.north() + 1, kGrid.east() + 1), C2dPos(kGrid.north() + 2, kGrid.east() + 2)};
  EXPECT_EQ(C2dPtListUt::getOrientation(line), C2dPtListUt::eOrientationDegenerate);
  EXPECT_EQ(C2dPtListUt::getArea(svy_vector<C2dPos>{kGrid, kGrid}), 0.0);
}

// A square with repeats, midpoints of its sides and a spike: clean-up leaves the four corners and the spike
// (out and back to its base).
TEST(PointListCleanup, RepeatedAndCollinearVerticesGoSpikesStay) {
  auto at = [](double n, double e) { return C2dPos(kGrid.north() + n, kGrid.east() + e); };
  svy_vector<C2dPos> square{at(0, 0), at(0, 0.000001), at(0, 50), at(0, 100), at(50, 100.000002), at(100, 100),
                            at(100, 0), at(100, 0), at(60, 0), at(60, -20), at(60, 0), at(30, 0), at(0, 0)};
  svy_vector<C2dPos> repeated = square;
  EXPECT_EQ(C2dPtListUt::removeRepeatedPoints(repeated, true, 1e-5), 3);
  EXPECT_EQ(repeated.size(), 10u);
  EXPECT_EQ(C2dPtListUt::removeCollinearPoints(square, true, 1e-5), 6);
  const svy_vector<C2dPos> expected{at(0, 0), at(0, 100), at(100, 100), at(100, 0), at(60, 0), at(60, -20), at(60, 0)};
  EXPECT_EQ(square, expected);
  svy_vector<C2dPos> open{at(0, 0), at(10, 0), at(20, 0)};
  EXPECT_EQ(C2dPtListUt::removeCollinearPoints(open, false, 1e-5), 1);
  EXPECT_EQ(open.size(), 2u);
}

TEST(PointListNearest, VertexAndPointOnTheSides) {
  const svy_vector<C2dPos> square = regularPolygon(kGrid, 100, 4, true);
  double distance = -1;
  const C2dPos probe(kGrid.north() + 1, kGrid.east() + 2);
  const int nearest = C2dPtListUt::getNearestVertex(square, probe, distance);
  ASSERT_GE(nearest, 0);
  for (const C2dPos& p : square) EXPECT_LE(distance, std::hypot(p.north() - probe.north(), p.east() - probe.east()));
  EXPECT_EQ(C2dPtListUt::getNearestVertex(svy_vector<C2dPos>{}, probe, distance), -1);
  CogoFunctions::TElementInverse inverse;
  ASSERT_EQ(C2dPtListUt::getNearestPoint(square, true, kGrid, inverse), CogoFunctions::eCogoOk);
  // The centre of the square lies half a side from every side; clockwise, it is to the right.
  EXPECT_NEAR(inverse.offset, 100 / std::sqrt(2.0), 1e-9);
}

}  // namespace
