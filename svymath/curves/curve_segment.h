#pragma once
// A tangent element: straight segment data placed by origin and azimuth, answering every query through the
// line mathematics of CGenericLine.
#include "svymath/curves/curve_data_segment.h"
#include "svymath/curves/generic_line.h"
#include "svymath/curves/org_az_curve.h"

class SVYMATH_API CCurveSegment : public COrgAzCurveT<CCurveDataSegment, CGenericLine> {
  SVY_RTTI_DECLARE(CCurveSegment)

 public:
  SVY_CLASS_NEW_DELETE

  using COrgAzCurveT::COrgAzCurveT;
  ~CCurveSegment() override;

  CGenericSegment* clone() const override;
};
