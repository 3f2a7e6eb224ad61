// svy_math::TLine: construction forms, usability, the line mathematics it inherits, and the run-time type
// identity through the segment hierarchy.
#include <gtest/gtest.h>

#include <cmath>
#include <memory>

#include "curve_test_support.h"
#include "svymath/curves/generic_line_impl.h"
#include "svymath/curves/tline.h"

namespace {

using svy_math::TAngle;
using svy_math::TLine;

TEST(TLine, EmptyLineIsNotUsableAndGivesNoPosition) {
  const TLine line;
  EXPECT_FALSE(line.isok());
  double north = 1.0;
  double east = 2.0;
  EXPECT_FALSE(line.getPosAtLength(1.0, north, east));
  EXPECT_EQ(north, 1.0);
  EXPECT_EQ(east, 2.0);
  double length = 0.0;
  double offset = 0.0;
  EXPECT_FALSE(line.getLengthAndOffset(0.0, 0.0, length, offset));
}

TEST(TLine, AzimuthAndLengthFormMatchesTwoPointForm) {
  const TLine fromAzimuth(C2dPos(10.0, 20.0), TAngle(0.75), 50.0);
  const TLine fromPoints(C2dPos(10.0, 20.0), C2dPos(10.0 + 50.0 * std::cos(0.75), 20.0 + 50.0 * std::sin(0.75)));
  ASSERT_TRUE(fromAzimuth.isok());
  EXPECT_NEAR(fromAzimuth.getTotalLength(), 50.0, 1e-12);
  EXPECT_NEAR(fromAzimuth.getAzimuth().getRad(), 0.75, 1e-12);
  EXPECT_NEAR(fromPoints.getAzimuth().getRad(), 0.75, 1e-12);
  double n1 = 0.0;
  double e1 = 0.0;
  double n2 = 0.0;
  double e2 = 0.0;
  ASSERT_TRUE(fromAzimuth.getPosAtLengthAndOffset(20.0, -3.0, n1, e1));
  ASSERT_TRUE(fromPoints.getPosAtLengthAndOffset(20.0, -3.0, n2, e2));
  EXPECT_NEAR(n1, n2, 1e-12);
  EXPECT_NEAR(e1, e2, 1e-12);
  const C2dMinMax box = fromPoints.getBoundary();
  EXPECT_EQ(box.minNorth, 10.0);
  EXPECT_EQ(box.minEast, 20.0);
  EXPECT_FALSE(box.empty);
}

// Identity by class: cast follows the hierarchy upward and refuses sideways.
TEST(SegmentRtti, CastFollowsTheHierarchy) {
  std::unique_ptr<CGenericSegment> segments[] = {
      std::make_unique<TLine>(C2dPos(0.0, 0.0), C2dPos(1.0, 1.0)),
      std::make_unique<CGenericLineImpl>(C2dPos(0.0, 0.0), C2dPos(1.0, 1.0)),
      std::make_unique<CCurveSegment>(curve_test::makeSegment(0.0, 0.0, 10.0, 5.0)),
      std::make_unique<CCurveArc>(curve_test::makeArc(0.0, 0.0, 10.0, 5.0, 50.0, true)),
      std::make_unique<CCurveSpiral>(curve_test::makeSpiral(0.0, 0.0, 10.0, 50.0, 200.0, true, true)),
  };
  const char* names[] = {"TLine", "CGenericLineImpl", "CCurveSegment", "CCurveArc", "CCurveSpiral"};
  const bool isLine[] = {true, true, true, false, false};
  const bool isArc[] = {false, false, false, true, false};
  const bool isSpiral[] = {false, false, false, false, true};
  for (int i = 0; i < 5; ++i) {
    CGenericSegment* segment = segments[i].get();
    EXPECT_STREQ(segment->get_rtti_name(), names[i]);
    EXPECT_EQ(CGenericSegment::cast(segment), segment);
    EXPECT_EQ(CGenericLine::cast(segment) != nullptr, isLine[i]) << names[i];
    EXPECT_EQ(CGenericArc::cast(segment) != nullptr, isArc[i]) << names[i];
    EXPECT_EQ(CGenericSpiral::cast(static_cast<const CRttiBase*>(segment)) != nullptr, isSpiral[i]) << names[i];
    EXPECT_TRUE(segment->is_rtti_type(CRttiBase::static_rtti_id()));
  }
  EXPECT_EQ(TLine::cast(segments[1].get()), nullptr);
  EXPECT_EQ(CCurveArc::cast(segments[3].get()), segments[3].get());
  EXPECT_EQ(CGenericLine::cast(static_cast<CRttiBase*>(nullptr)), nullptr);
  // Identity is by address of the class's own name, not by the text of it.
  EXPECT_NE(TLine::static_rtti_id(), CGenericLineImpl::static_rtti_id());
  EXPECT_EQ(segments[0]->get_rtti_id(), TLine::static_rtti_id());
}

TEST(SegmentClone, CloneKeepsKindPlacementAndIntersectionType) {
  CCurveArc arc = curve_test::makeArc(100.0, 200.0, 30.0, 40.0, 80.0, false);
  arc.setIntersectionType(eIntersectUnbounded);
  std::unique_ptr<CGenericSegment> copy(arc.clone());
  ASSERT_NE(CCurveArc::cast(copy.get()), nullptr);
  EXPECT_EQ(copy->getIntersectionType(), eIntersectUnbounded);
  EXPECT_EQ(copy->getEndPos(), arc.getEndPos());
  std::unique_ptr<CGenericSegment> spiral(curve_test::makeSpiral(1.0, 2.0, 3.0, 60.0, 300.0, true, false).clone());
  ASSERT_NE(CCurveSpiral::cast(spiral.get()), nullptr);
  EXPECT_TRUE(spiral->isok());
}

}  // namespace
