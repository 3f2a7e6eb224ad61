// Straight lines: the extent test, position and length-and-offset round trips, the prolonged-line distance;
// tangent data (by end point or by length and azimuth) and the placed tangent element; svy_math::TLine's
// construction forms; the run-time type identity and cloning through the segment hierarchy.
#include <gtest/gtest.h>

#include <cmath>
#include <memory>

#include "curve_test_support.h"
#include "svymath/curves/generic_line_impl.h"
#include "svymath/curves/tline.h"

namespace {

using svy_math::TLine;

// Lengths along an eastward line are accepted by intersection type; the same rule decides whether a point
// 3 m north of the line (its left) gets a length and offset.
TEST(GenericLine, ExtentByIntersectionType) {
  const struct {
    EIntersectionType type;
    double along;
    bool onLine;
  } cases[] = {{eIntersectOnSegment, -0.0005, false},    {eIntersectOnSegment, 100.0, true},
               {eIntersectOnSegmentTol, -0.0005, true},  {eIntersectOnSegmentTol, 100.0009, true},
               {eIntersectOnSegmentTol, 100.0011, false}, {eIntersectOnSegmentTol, -0.002, false},
               {eIntersectUnbounded, -1e6, true},        {eIntersectUnbounded, 1e9, true}};
  for (const auto& c : cases) {
    SCOPED_TRACE(c.along);
    const CGenericLineImpl line(C2dPos(0.0, 0.0), C2dPos(0.0, 100.0), c.type);
    EXPECT_EQ(line.checkDistanceAlongIsOnLine(c.along), c.onLine);
    double length = -7.0, offset = -7.0;
    EXPECT_EQ(line.getLengthAndOffset(C2dPos(3.0, c.along), length, offset), c.onLine);
    // The direction east is pi/2 rounded to a double: its cosine leaves 6e-17 of the along distance across.
    const double tolerance = 1e-12 + 1e-16 * std::fabs(c.along);
    EXPECT_NEAR(length, c.onLine ? c.along : -7.0, tolerance);
    EXPECT_NEAR(offset, c.onLine ? -3.0 : -7.0, tolerance);
  }
}

// Offset to the right of azimuth a is (-sin a, cos a); length and offset give the position back.
TEST(GenericLine, PositionAndLengthOffsetRoundTrip) {
  const struct {
    double north, east, azDeg, length, offset;
  } cases[] = {{0.0, 0.0, 90.0, 0.0, -4.0}, {10.0, -5.0, 180.0, 250.0, 1.0},
               {5000000.0, 500000.0, 37.25, 77.7, -12.3}, {-300.0, 42.0, 271.5, 200.0, 1000.0}};
  for (const auto& c : cases) {
    SCOPED_TRACE(c.azDeg);
    const CGenericLineImpl line(C2dPos(c.north, c.east), CMathAngle(c.azDeg), 250.0, eIntersectOnSegment);
    C2dPos pos;
    ASSERT_TRUE(line.getPosAtLengthAndOffset(c.length, c.offset, pos));
    const double a = c.azDeg * svy_math::units::kDegToRad;
    curve_test::expectPosNear(pos, c.north + c.length * std::cos(a) - c.offset * std::sin(a),
                              c.east + c.length * std::sin(a) + c.offset * std::cos(a), 1e-8);
    double length = 0.0, offset = 0.0, distance = 0.0;
    ASSERT_TRUE(line.getLengthAndOffset(pos, length, offset));
    curve_test::expectPosNear(C2dPos(length, offset), c.length, c.offset, 1e-8);
    ASSERT_TRUE(line.getShortestDistanceToPoint(pos, distance));
    EXPECT_NEAR(distance, std::fabs(c.offset), 1e-8);
  }
}

// A line from a point and an azimuth is 1000 long and unbounded; tiny lengths and offsets come back as an
// exact (positive) zero; the shortest distance is to the prolonged line, beyond the extent as well.
TEST(GenericLine, DefaultLengthExactZeroAndProlongedDistance) {
  const CGenericLineImpl fromAzimuth(C2dPos(100.0, 200.0), CMathAngle(90.0));
  EXPECT_TRUE(fromAzimuth.getIntersectionType() == eIntersectUnbounded &&
              std::fabs(fromAzimuth.getEndEasting() - 1200.0) <= 1e-9);
  double length = 1.0, offset = 1.0, distance = 0.0;
  EXPECT_TRUE(fromAzimuth.getLengthAndOffset(C2dPos(100.0, -5000.0), length, offset));
  EXPECT_NEAR(length, -5200.0, 1e-9);
  const CGenericLineImpl line(C2dPos(0.0, 0.0), C2dPos(100.0, 0.0));
  ASSERT_TRUE(line.getLengthAndOffset(C2dPos(1e-13, 5e-13), length, offset));
  EXPECT_TRUE(length == 0.0 && offset == 0.0 && !std::signbit(offset));
  ASSERT_TRUE(line.getShortestDistanceToPoint(C2dPos(500.0, -3.0), distance));
  EXPECT_NEAR(distance, 3.0, 1e-12);  // not the 400.01 m to the end point
  EXPECT_FALSE(line.getLengthAndOffset(C2dPos(500.0, -3.0), length, offset));
}

TEST(SegmentData, EndPointAndLengthWithAzimuthAgree) {
  CCurveDataSegment byEnd, byLength;
  byEnd.setFinalNE(30.0, -40.0);
  ASSERT_TRUE(byLength.setLen(50.0));
  byLength.setAzRad(std::atan2(-40.0, 30.0));
  for (const CCurveDataSegment* data : {&byEnd, &byLength}) {
    ASSERT_TRUE(data->isok());
    EXPECT_NEAR(data->getTotalLength(), 50.0, 1e-12);
    EXPECT_NEAR(data->GetAzimuth(17.0), std::atan2(-40.0, 30.0) * svy_math::units::kRadToDeg, 1e-12);
    double north = 0.0, east = 0.0;
    ASSERT_TRUE(data->getPosAtLength(10.0, north, east));
    curve_test::expectPosNear(C2dPos(north, east), 6.0, -8.0, 1e-12);
    EXPECT_NEAR(data->getStepForDeviation(12.5, 0.001), 37.5, 1e-12);
  }
  EXPECT_FALSE(byLength.setLen(-1.0));
}

TEST(SegmentElement, PlacedByOriginAndAzimuthOrUnplaced) {
  CCurveDataSegment data;
  data.setLen(100.0);
  data.setAzDeg(10.0);  // the tangent runs 10 degrees right of the frame
  CCurveSegment segment(1000.0, 2000.0, CMathAngle(80.0), data);
  EXPECT_NEAR(segment.getAzimuthAtLength(50.0), 90.0, 1e-12);
  CMathAngle frame;
  ASSERT_TRUE(segment.getStartAzWithoutCurveTurn(frame));
  EXPECT_NEAR(frame.getDeg(), 80.0, 1e-12);
  C2dPos pos(7.0, 8.0), ip;
  ASSERT_TRUE(segment.getPosAtLengthAndOffset(40.0, 5.0, pos));  // right of an eastward tangent is south
  curve_test::expectPosNear(pos, 995.0, 2040.0, 1e-9);
  double dist = 0.0, len = 0.0;
  ASSERT_TRUE(segment.getShortestDistAndCurveLen(1003.0, 2150.0, dist, len));  // beyond the end: clamped
  curve_test::expectPosNear(C2dPos(len, dist), 100.0, -std::hypot(3.0, 50.0), 1e-9);
  EXPECT_FALSE(segment.getCurveIp(ip));  // a straight has parallel end tangents
  CCurveSegment unplaced;
  EXPECT_FALSE(unplaced.getPosAtLength(0.0, pos));
  EXPECT_EQ(pos, C2dPos(995.0, 2040.0));
  unplaced.setStartValues(1.0, 2.0, CMathAngle(0.0));
  const bool placedWithoutData = unplaced.isok();
  unplaced.setCurve(data);
  const bool complete = unplaced.isok();
  unplaced.resetOrgAz();
  EXPECT_TRUE(!placedWithoutData && complete && !unplaced.isok());
}

TEST(TLine, AzimuthAndLengthFormMatchesTwoPointFormAndEmptyLineGivesNothing) {
  const TLine fromAzimuth(C2dPos(10.0, 20.0), svy_math::TAngle(0.75), 50.0);
  const TLine fromPoints(C2dPos(10.0, 20.0), C2dPos(10.0 + 50.0 * std::cos(0.75), 20.0 + 50.0 * std::sin(0.75)));
  EXPECT_NEAR(fromAzimuth.getTotalLength(), 50.0, 1e-12);
  EXPECT_NEAR(fromPoints.getAzimuth().getRad(), 0.75, 1e-12);
  double n1 = 0.0, e1 = 0.0, n2 = 0.0, e2 = 0.0;
  ASSERT_TRUE(fromAzimuth.getPosAtLengthAndOffset(20.0, -3.0, n1, e1));
  ASSERT_TRUE(fromPoints.getPosAtLengthAndOffset(20.0, -3.0, n2, e2));
  curve_test::expectPosNear(C2dPos(n1, e1), n2, e2, 1e-12);
  EXPECT_FALSE(TLine().isok() || TLine().getPosAtLength(1.0, n1, e1));
  EXPECT_EQ(n1, n2);  // untouched
}

// Identity by class: cast follows the hierarchy upward and refuses sideways; a clone keeps kind,
// placement and intersection type.
TEST(SegmentRtti, CastFollowsTheHierarchyAndClonesKeepTheirKind) {
  const struct {
    std::shared_ptr<CGenericSegment> segment;
    const char* name;
    char kind;
  } cases[] = {{std::make_shared<TLine>(C2dPos(0.0, 0.0), C2dPos(1.0, 1.0)), "TLine", 'L'},
               {std::make_shared<CGenericLineImpl>(C2dPos(0.0, 0.0), C2dPos(1.0, 1.0)), "CGenericLineImpl", 'L'},
               {std::make_shared<CCurveSegment>(curve_test::makeSegment(0.0, 0.0, 10.0, 5.0)), "CCurveSegment", 'L'},
               {std::make_shared<CCurveArc>(curve_test::makeArc(0.0, 0.0, 10.0, 5.0, 50.0, true)), "CCurveArc", 'A'},
               {std::make_shared<CCurveSpiral>(curve_test::makeSpiral(1.0, 2.0, 3.0, 60.0, 300.0, true, false)),
                "CCurveSpiral", 'S'}};
  for (const auto& c : cases) {
    CGenericSegment* segment = c.segment.get();
    SCOPED_TRACE(c.name);
    EXPECT_STREQ(segment->get_rtti_name(), c.name);
    EXPECT_EQ(CGenericSegment::cast(segment), segment);
    EXPECT_EQ(CGenericLine::cast(segment) != nullptr, c.kind == 'L');
    EXPECT_EQ(CGenericArc::cast(segment) != nullptr, c.kind == 'A');
    EXPECT_EQ(CGenericSpiral::cast(static_cast<const CRttiBase*>(segment)) != nullptr, c.kind == 'S');
    EXPECT_TRUE(segment->is_rtti_type(CRttiBase::static_rtti_id()));
  }
  CCurveArc arc = curve_test::makeArc(100.0, 200.0, 30.0, 40.0, 80.0, false);
  arc.setIntersectionType(eIntersectUnbounded);
  const std::unique_ptr<CGenericSegment> arcCopy(arc.clone());
  ASSERT_NE(CCurveArc::cast(arcCopy.get()), nullptr);
  EXPECT_TRUE(arcCopy->getIntersectionType() == eIntersectUnbounded && arcCopy->getEndPos() == arc.getEndPos());
  const std::unique_ptr<CGenericSegment> spiralCopy(
      curve_test::makeSpiral(1.0, 2.0, 3.0, 60.0, 300.0, true, false).clone());
  ASSERT_NE(CCurveSpiral::cast(spiralCopy.get()), nullptr);
  EXPECT_EQ(spiralCopy->getEndPos(), cases[4].segment->getEndPos());
  EXPECT_EQ(TLine::cast(cases[1].segment.get()), nullptr);
  EXPECT_EQ(CCurveArc::cast(cases[3].segment.get()), cases[3].segment.get());
  EXPECT_EQ(CGenericLine::cast(static_cast<CRttiBase*>(nullptr)), nullptr);
  // Identity is by address of the class's own name, not by the text of it.
  EXPECT_NE(TLine::static_rtti_id(), CGenericLineImpl::static_rtti_id());
}

}  // namespace
