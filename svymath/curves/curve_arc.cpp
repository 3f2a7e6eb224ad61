#include "svymath/curves/curve_arc.h"

#include <cmath>

#include "svymath/foundation/constants.h"

SVY_RTTI_DEFINE(CCurveArc, CGenericArc)

CCurveArc::CCurveArc(const C2dPos& start, const C2dPos& middle, const C2dPos& end) {
  // Work relative to the start so that survey coordinates keep their digits.
  const double uN = middle.north() - start.north();
  const double uE = middle.east() - start.east();
  const double wN = end.north() - start.north();
  const double wE = end.east() - start.east();
  // Twice the signed area of the triangle: positive when start -> middle -> end turns right (clockwise).
  const double cross = uN * wE - uE * wN;
  const double uSq = uN * uN + uE * uE;
  const double wSq = wN * wN + wE * wE;
  const double vSq = (wN - uN) * (wN - uN) + (wE - uE) * (wE - uE);
  // The circumradius abc / (4 area), signed by the turn; collinear points (zero area) have none.
  const double radius = std::sqrt(uSq * vSq * wSq) / (2.0 * cross);
  if (!std::isfinite(radius) || std::fabs(radius) < svy_math::tol::kZero) return;
  const C2dPos centre(start.north() + (wE * uSq - uE * wSq) / (2.0 * cross),
                      start.east() + (uN * wSq - wN * uSq) / (2.0 * cross));
  CMathAngle toStart;
  CMathAngle toEnd;
  if (!toStart.setAz(centre, start) || !toEnd.setAz(centre, end)) return;
  // The arc turns about the centre the way the three points turn: its sweep runs from the start direction
  // to the end direction in that sense, and its start tangent is square to the start radius.
  const bool toTheRight = radius > 0.0;
  double sweep = toTheRight ? toEnd.getRad() - toStart.getRad() : toStart.getRad() - toEnd.getRad();
  if (sweep < 0.0) sweep += svy_math::units::kTwoPi;
  CMathAngle startTangent;
  startTangent.setRad(toStart.getRad() + (toTheRight ? svy_math::units::kHalfPi : -svy_math::units::kHalfPi));
  CCurveDataArc data;
  if (!data.SetElement(sweep * std::fabs(radius), radius, toTheRight)) return;
  setCurve(data);
  setOrgAz(start.north(), start.east(), startTangent);
}

CCurveArc::~CCurveArc() = default;

CGenericSegment* CCurveArc::clone() const { return new CCurveArc(*this); }

double CCurveArc::getRadius() const { return m_data.getRadius(); }
