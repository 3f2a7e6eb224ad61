#pragma once
// A transition spiral element: spiral data (a full or partial clothoid or cubic parabola) placed by origin
// and azimuth. Boundary and intersections come from CGenericSpiral; the length and offset of a point come
// from a foot-point search on the spiral.
#include "svymath/curves/curve_data_spiral.h"
#include "svymath/curves/generic_spiral.h"
#include "svymath/curves/org_az_curve.h"

class SVYMATH_API CCurveSpiral : public COrgAzCurveT<CCurveDataSpiral, CGenericSpiral> {
  SVY_RTTI_DECLARE(CCurveSpiral)

 public:
  SVY_CLASS_NEW_DELETE

  using COrgAzCurveT::COrgAzCurveT;
  using COrgAzCurveT::getLengthAndOffset;
  using COrgAzCurveT::getShortestDistanceToPoint;
  ~CCurveSpiral() override;

  CGenericSegment* clone() const override;

  // The length of the foot of the perpendicular from the point, and its offset (positive to the right).
  // A point beside neither end's foot is measured along the prolonged end tangent (a negative length before
  // the start, beyond the total length after the end) and accepted by the extent test.
  bool getLengthAndOffset(double north, double east, double& length, double& offset) const override;
  // The distance to the nearest point of the element (never negative).
  bool getShortestDistanceToPoint(double north, double east, double& distance) const override;
  // The nearest point of the element, by a bracketed Newton search on the foot-point condition that
  // converges to tol::kProjectionLength and is clamped to the element.
  bool getShortestDistAndCurveLen(double north, double east, double& dist, double& len) const override;

  double getStartRadius() const override;
  double getEndRadius() const override;
  double getSpiralParam() const override;
  // The length at which the element's tangent has the given (world) azimuth.
  double getLengthAtAzimuth(const CMathAngle& azimuth) const override;
};
