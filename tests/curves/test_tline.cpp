// svy_math::TLine construction forms, and the run-time type identity and cloning through the segment
// hierarchy.
#include <gtest/gtest.h>

#include <cmath>
#include <memory>

#include "curve_test_support.h"
#include "svymath/curves/generic_line_impl.h"
#include "svymath/curves/tline.h"

namespace {

using svy_math::TAngle;
using svy_math::TLine;

TEST(TLine, AzimuthAndLengthFormMatchesTwoPointFormAndEmptyLineGivesNothing) {
  const TLine fromAzimuth(C2dPos(10.0, 20.0), TAngle(0.75), 50.0);
  const TLine fromPoints(C2dPos(10.0, 20.0), C2dPos(10.0 + 50.0 * std::cos(0.75), 20.0 + 50.0 * std::sin(0.75)));
  ASSERT_TRUE(fromAzimuth.isok());
  EXPECT_NEAR(fromAzimuth.getTotalLength(), 50.0, 1e-12);
  EXPECT_NEAR(fromPoints.getAzimuth().getRad(), 0.75, 1e-12);
  double n1 = 0.0, e1 = 0.0, n2 = 0.0, e2 = 0.0;
  ASSERT_TRUE(fromAzimuth.getPosAtLengthAndOffset(20.0, -3.0, n1, e1));
  ASSERT_TRUE(fromPoints.getPosAtLengthAndOffset(20.0, -3.0, n2, e2));
  EXPECT_NEAR(n1, n2, 1e-12);
  EXPECT_NEAR(e1, e2, 1e-12);
  const TLine empty;
  EXPECT_FALSE(empty.isok());
  EXPECT_FALSE(empty.getPosAtLength(1.0, n1, e1));
  EXPECT_EQ(n1, n2);  // untouched
}

// Identity by class: cast follows the hierarchy upward and refuses sideways; a clone keeps kind,
// placement and intersection type.
TEST(SegmentRtti, CastFollowsTheHierarchyAndClonesKeepTheirKind) {
  std::unique_ptr<CGenericSegment> segments[] = {
      std::make_unique<TLine>(C2dPos(0.0, 0.0), C2dPos(1.0, 1.0)),
      std::make_unique<CGenericLineImpl>(C2dPos(0.0, 0.0), C2dPos(1.0, 1.0)),
      std::make_unique<CCurveSegment>(curve_test::makeSegment(0.0, 0.0, 10.0, 5.0)),
      std::make_unique<CCurveArc>(curve_test::makeArc(0.0, 0.0, 10.0, 5.0, 50.0, true)),
      std::make_unique<CCurveSpiral>(curve_test::makeSpiral(1.0, 2.0, 3.0, 60.0, 300.0, true, false)),
  };
  const char* names[] = {"TLine", "CGenericLineImpl", "CCurveSegment", "CCurveArc", "CCurveSpiral"};
  const char kinds[] = {'L', 'L', 'L', 'A', 'S'};
  for (int i = 0; i < 5; ++i) {
    CGenericSegment* segment = segments[i].get();
    SCOPED_TRACE(names[i]);
    EXPECT_STREQ(segment->get_rtti_name(), names[i]);
    EXPECT_EQ(CGenericSegment::cast(segment), segment);
    EXPECT_EQ(CGenericLine::cast(segment) != nullptr, kinds[i] == 'L');
    EXPECT_EQ(CGenericArc::cast(segment) != nullptr, kinds[i] == 'A');
    EXPECT_EQ(CGenericSpiral::cast(static_cast<const CRttiBase*>(segment)) != nullptr, kinds[i] == 'S');
    EXPECT_TRUE(segment->is_rtti_type(CRttiBase::static_rtti_id()));
  }
  CCurveArc arc = curve_test::makeArc(100.0, 200.0, 30.0, 40.0, 80.0, false);
  arc.setIntersectionType(eIntersectUnbounded);
  const std::unique_ptr<CGenericSegment> arcCopy(arc.clone());
  ASSERT_NE(CCurveArc::cast(arcCopy.get()), nullptr);
  EXPECT_EQ(arcCopy->getIntersectionType(), eIntersectUnbounded);
  EXPECT_EQ(arcCopy->getEndPos(), arc.getEndPos());
  const std::unique_ptr<CGenericSegment> spiralCopy(curve_test::makeSpiral(1.0, 2.0, 3.0, 60.0, 300.0, true, false).clone());
  ASSERT_NE(CCurveSpiral::cast(spiralCopy.get()), nullptr);
  EXPECT_EQ(spiralCopy->getEndPos(), segments[4]->getEndPos());
  EXPECT_EQ(TLine::cast(segments[1].get()), nullptr);
  EXPECT_EQ(CCurveArc::cast(segments[3].get()), segments[3].get());
  EXPECT_EQ(CGenericLine::cast(static_cast<CRttiBase*>(nullptr)), nullptr);
  // Identity is by address of the class's own name, not by the text of it.
  EXPECT_NE(TLine::static_rtti_id(), CGenericLineImpl::static_rtti_id());
}

}  // namespace
