// Tangent data and the tangent element: the two ways of definition, placement by origin and azimuth, projection and the tangent element's line mathematics.
#include <gtest/gtest.h>

#include <cmath>

#include "curve_test_support.h"

namespace {

TEST(SegmentData, EndPointAndLengthWithAzimuthAgree) {
  CCurveDataSegment byEnd;
  byEnd.setFinalNE(30.0, -40.0);
  CCurveDataSegment byLength;
  ASSERT_TRUE(byLength.setLen(50.0));
  byLength.setAzRad(std::atan2(-40.0, 30.0));
  for (const CCurveDataSegment* data : {&byEnd, &byLength}) {
    ASSERT_TRUE(data->isok());
    EXPECT_NEAR(data->getTotalLength(), 50.0, 1e-12);
    EXPECT_NEAR(data->getFinalNorthing(), 30.0, 1e-12);
    EXPECT_NEAR(data->getFinalEasting(), -40.0, 1e-12);
    EXPECT_NEAR(data->GetAzimuth(17.0), std::atan2(-40.0, 30.0) * svy_math::units::kRadToDeg, 1e-12);
    double north = 0.0, east = 0.0;
    ASSERT_TRUE(data->getPosAtLength(10.0, north, east));
    EXPECT_NEAR(north, 6.0, 1e-12);
    EXPECT_NEAR(east, -8.0, 1e-12);
    EXPECT_NEAR(data->getStepForDeviation(12.5, 0.001), 37.5, 1e-12);
  }
  EXPECT_FALSE(byLength.setLen(-1.0));
}

TEST(SegmentElement, PlacedByOriginAndAzimuth) {
  CCurveDataSegment data;
  data.setLen(100.0);
  data.setAzDeg(10.0);  // the tangent runs 10 degrees right of the frame
  CCurveSegment segment(1000.0, 2000.0, CMathAngle(80.0), data);
  EXPECT_TRUE(segment.isok());
  EXPECT_NEAR(segment.getAzimuthAtLength(50.0), 90.0, 1e-12);
  CMathAngle frame;
  ASSERT_TRUE(segment.getStartAzWithoutCurveTurn(frame));
  EXPECT_NEAR(frame.getDeg(), 80.0, 1e-12);
  EXPECT_NEAR(segment.getEndNorthing(), 1000.0, 1e-9);
  EXPECT_NEAR(segment.getEndEasting(), 2100.0, 1e-9);
  C2dPos pos;
  ASSERT_TRUE(segment.getPosAtLengthAndOffset(40.0, 5.0, pos));  // right of an eastward tangent is south
  curve_test::expectPosNear(pos, 995.0, 2040.0, 1e-9);
  double length = 0.0, offset = 0.0, dist = 0.0, len = 0.0;
  ASSERT_TRUE(segment.getLengthAndOffset(pos, length, offset));
  EXPECT_NEAR(length, 40.0, 1e-9);
  EXPECT_NEAR(offset, 5.0, 1e-9);
  ASSERT_TRUE(segment.getShortestDistAndCurveLen(1003.0, 2150.0, dist, len));  // beyond the end: clamped
  EXPECT_NEAR(len, 100.0, 1e-9);
  EXPECT_NEAR(dist, -std::hypot(3.0, 50.0), 1e-9);
  C2dPos ip;
  EXPECT_FALSE(segment.getCurveIp(ip));  // a straight has parallel end tangents
}

TEST(SegmentElement, UnplacedElementAnswersNothing) {
  CCurveSegment segment;
  EXPECT_FALSE(segment.isok());
  EXPECT_FALSE(segment.isOrgAzOk());
  C2dPos pos(7.0, 8.0);
  EXPECT_FALSE(segment.getPosAtLength(0.0, pos));
  EXPECT_EQ(pos, C2dPos(7.0, 8.0));
  segment.setStartValues(1.0, 2.0, CMathAngle(0.0));
  EXPECT_TRUE(segment.isOrgAzOk());
  EXPECT_FALSE(segment.isok());  // the data is still undefined
  CCurveDataSegment data;
  data.setFinalNE(3.0, 4.0);
  segment.setCurve(data);
  EXPECT_TRUE(segment.isok());
  EXPECT_NEAR(segment.getEndNorthing(), 4.0, 1e-12);
  EXPECT_NEAR(segment.getEndEasting(), 6.0, 1e-12);
  segment.resetOrgAz();
  EXPECT_FALSE(segment.isok());
}

}  // namespace
