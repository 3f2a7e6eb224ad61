// Straight-line mathematics: extent test, position and length-and-offset round trips, the prolonged-line
// distance, axis-parallel helpers.
#include <gtest/gtest.h>

#include <cmath>

#include "curve_test_support.h"
#include "svymath/curves/generic_line_impl.h"

namespace {

using curve_test::azimuthDeg;

struct ExtentCase {
  EIntersectionType type;
  double along;
  bool onLine;
};

class LineExtentTest : public ::testing::TestWithParam<ExtentCase> {};

TEST_P(LineExtentTest, AcceptsLengthsByIntersectionType) {
  const ExtentCase& c = GetParam();
  const CGenericLineImpl line(C2dPos(0.0, 0.0), C2dPos(0.0, 100.0), c.type);
  EXPECT_EQ(line.checkDistanceAlongIsOnLine(c.along), c.onLine) << "along " << c.along;
  // The same rule decides whether a point beside the line gets a length.
  double length = -7.0, offset = -7.0;
  EXPECT_EQ(line.getLengthAndOffset(C2dPos(3.0, c.along), length, offset), c.onLine);
  if (c.onLine) {
    // The direction east is pi/2 rounded to a double: its cosine leaves 6e-17 of the along distance across.
    const double tolerance = 1e-12 + 1e-16 * std::fabs(c.along);
    EXPECT_NEAR(length, c.along, tolerance);
    EXPECT_NEAR(offset, -3.0, tolerance);  // north of an eastward line is its left
  } else {
    EXPECT_EQ(length, -7.0);
    EXPECT_EQ(offset, -7.0);
  }
}

INSTANTIATE_TEST_SUITE_P(
    Table, LineExtentTest,
    ::testing::Values(ExtentCase{eIntersectOnSegment, -0.0005, false}, ExtentCase{eIntersectOnSegmentTol, -0.0005, true},
                      ExtentCase{eIntersectUnbounded, -0.0005, true}, ExtentCase{eIntersectOnSegment, 0.0, true},
                      ExtentCase{eIntersectOnSegment, 100.0, true}, ExtentCase{eIntersectOnSegmentTol, 100.0009, true},
                      ExtentCase{eIntersectOnSegmentTol, 100.0011, false}, ExtentCase{eIntersectOnSegmentTol, -0.002, false},
                      ExtentCase{eIntersectUnbounded, -1e6, true}, ExtentCase{eIntersectUnbounded, 1e9, true},
                      ExtentCase{eIntersectOnSegment, 50.0, true}));

struct RoundTripCase {
  double north;
  double east;
  double azDeg;
  double length;
  double offset;
};

class LineRoundTripTest : public ::testing::TestWithParam<RoundTripCase> {};

TEST_P(LineRoundTripTest, PositionThenLengthAndOffsetGivesThemBack) {
  const RoundTripCase& c = GetParam();
  const CGenericLineImpl line(C2dPos(c.north, c.east), azimuthDeg(c.azDeg), 250.0, eIntersectOnSegment);
  C2dPos pos;
  ASSERT_TRUE(line.getPosAtLengthAndOffset(c.length, c.offset, pos));
  // Independent check of the axis convention: offset to the right of azimuth a is (-sin a, cos a).
  const double a = c.azDeg * svy_math::units::kDegToRad;
  curve_test::expectPosNear(pos, c.north + c.length * std::cos(a) - c.offset * std::sin(a),
                            c.east + c.length * std::sin(a) + c.offset * std::cos(a), 1e-8);
  double length = 0.0, offset = 0.0, distance = 0.0;
  ASSERT_TRUE(line.getLengthAndOffset(pos, length, offset));
  EXPECT_NEAR(length, c.length, 1e-8);
  EXPECT_NEAR(offset, c.offset, 1e-8);
  ASSERT_TRUE(line.getShortestDistanceToPoint(pos, distance));
  EXPECT_NEAR(distance, std::fabs(c.offset), 1e-8);
}

INSTANTIATE_TEST_SUITE_P(Table, LineRoundTripTest,
                         ::testing::Values(RoundTripCase{0.0, 0.0, 0.0, 10.0, 2.5}, RoundTripCase{0.0, 0.0, 90.0, 0.0, -4.0},
                                           RoundTripCase{10.0, -5.0, 180.0, 250.0, 1.0},
                                           RoundTripCase{0.0, 0.0, -90.0, 125.0, 0.0},
                                           RoundTripCase{5000000.0, 500000.0, 37.25, 77.7, -12.3},
                                           RoundTripCase{-300.0, 42.0, 271.5, 200.0, 1000.0}));

// A line from a point and an azimuth is 1000 long and unbounded; tiny lengths and offsets come back as an
// exact (positive) zero; the shortest distance is to the prolonged line, beyond the extent as well.
TEST(GenericLine, DefaultLengthExactZeroAndProlongedDistance) {
  const CGenericLineImpl fromAzimuth(C2dPos(100.0, 200.0), azimuthDeg(90.0));
  EXPECT_EQ(fromAzimuth.getIntersectionType(), eIntersectUnbounded);
  EXPECT_NEAR(fromAzimuth.getEndEasting(), 1200.0, 1e-9);
  double length = 1.0, offset = 1.0, distance = 0.0;
  EXPECT_TRUE(fromAzimuth.getLengthAndOffset(C2dPos(100.0, -5000.0), length, offset));
  EXPECT_NEAR(length, -5200.0, 1e-9);
  const CGenericLineImpl line(C2dPos(0.0, 0.0), C2dPos(100.0, 0.0));
  ASSERT_TRUE(line.getLengthAndOffset(C2dPos(1e-13, 5e-13), length, offset));
  EXPECT_EQ(length, 0.0);
  EXPECT_EQ(offset, 0.0);
  EXPECT_FALSE(std::signbit(offset));
  ASSERT_TRUE(line.getShortestDistanceToPoint(C2dPos(500.0, -3.0), distance));
  EXPECT_NEAR(distance, 3.0, 1e-12);  // not the 400.01 m to the end point
  EXPECT_FALSE(line.getLengthAndOffset(C2dPos(500.0, -3.0), length, offset));
}

}  // namespace
