#include "svymath/curves/curve_segment.h"

SVY_RTTI_DEFINE(CCurveSegment, CGenericLine)

CCurveSegment::~CCurveSegment() = default;

CGenericSegment* CCurveSegment::clone() const { return new CCurveSegment(*this); }
