#pragma once
// A circular arc element: arc data placed by origin and azimuth, answering length-and-offset, boundary and
// intersection queries through the arc mathematics of CGenericArc.
#include "svymath/curves/curve_data_arc.h"
#include "svymath/curves/generic_arc.h"
#include "svymath/curves/org_az_curve.h"

class SVYMATH_API CCurveArc : public COrgAzCurveT<CCurveDataArc, CGenericArc> {
  SVY_RTTI_DECLARE(CCurveArc)

 public:
  SVY_CLASS_NEW_DELETE

  using COrgAzCurveT::COrgAzCurveT;
  // The arc from start through middle to end. Collinear or coincident points define no arc: the element is
  // then left undefined (isok() false).
  CCurveArc(const C2dPos& start, const C2dPos& middle, const C2dPos& end);
  ~CCurveArc() override;

  CGenericSegment* clone() const override;
  // The data's signed radius (positive turning right).
  double getRadius() const override;
};
