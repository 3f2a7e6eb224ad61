#include "svymath/curves/generic_arc.h"

#include <cmath>

#include "svymath/cogo/circle_solvers.h"
#include "svymath/curves/generic_intersections.h"
#include "svymath/curves/generic_segment_visitor.h"
#include "svymath/foundation/angle_functions.h"
#include "svymath/foundation/constants.h"

SVY_RTTI_DEFINE(CGenericArc, CGenericSegment)

namespace {

using svy_math::tol::kZero;
using svy_math::units::kTwoPi;

bool within(double a, double b, double tol) { return std::fabs(a - b) <= tol; }

}  // namespace

bool isAngleRadInRange(const CMathAngle& start, const CMathAngle& end, const CMathAngle& test, double tolerance) {
  const double s = Normalize0ToLt2Pi(start.getRad());
  const double e = Normalize0ToLt2Pi(end.getRad());
  const double t = Normalize0ToLt2Pi(test.getRad());
  const double tol = std::fabs(tolerance);
  if (s > e) {  // the sweep passes north
    return within(t, s, tol) || within(t, kTwoPi, tol) || (t > s && t < kTwoPi) || within(t, 0.0, tol) ||
           within(t, e, tol) || (t > 0.0 && t < e);
  }
  return within(t, s, tol) || within(t, e, tol) || (t > s && t < e);
}

CGenericArc::CGenericArc(EIntersectionType type) : CGenericSegment(type) {}
CGenericArc::CGenericArc(const CGenericArc& other) = default;
CGenericArc& CGenericArc::operator=(const CGenericArc& other) = default;
CGenericArc::~CGenericArc() = default;

bool CGenericArc::isToTheRight() const { return getRadius() >= 0.0; }

bool CGenericArc::getArcCenterPos(C2dPos& centre) const {
  CMathAngle startAz;
  const double radius = getRadius();
  const C2dPos start = getStartPos();
  if (!getStartAzimut(startAz) || startAz.isNan() || !std::isfinite(radius) || !std::isfinite(start.north()) ||
      !std::isfinite(start.east())) {
    return false;
  }
  centre = C2dPos(start.north() - startAz.getSin() * radius, start.east() + startAz.getCos() * radius);
  return true;
}

CMathAngle CGenericArc::getAzimuthFromCenter(const C2dPos& pos) const {
  CMathAngle azimuth;
  C2dPos centre;
  if (!getArcCenterPos(centre) || !azimuth.setAz(centre, pos)) azimuth.reset();
  return azimuth;
}

CMathAngle CGenericArc::getAzimuthCenterToStart() const { return getAzimuthFromCenter(getStartPos()); }

CMathAngle CGenericArc::getAzimuthCenterToEnd() const { return getAzimuthFromCenter(getEndPos()); }

bool CGenericArc::isFullCircle() const {
  const double radius = std::fabs(getRadius());
  return radius >= kZero && getTotalLength() >= kTwoPi * radius - kZero;
}

bool CGenericArc::checkValidAzimuthToIntersectionPoint(const CMathAngle& start, const CMathAngle& end,
                                                       const CMathAngle& test) const {
  const EIntersectionType type = getIntersectionType();
  if (type == eIntersectUnbounded || isFullCircle()) return true;
  const double tolerance = type == eIntersectOnSegmentTol ? kZero : 0.0;
  return isToTheRight() ? isAngleRadInRange(start, end, test, tolerance)
                        : isAngleRadInRange(end, start, test, tolerance);
}

bool CGenericArc::getSweepFrame(C2dPos& centre, CMathAngle& toStart, CMathAngle& toEnd) const {
  if (!getArcCenterPos(centre) || !toStart.setAz(centre, getStartPos()) || !toEnd.setAz(centre, getEndPos())) {
    return false;
  }
  return true;
}

bool CGenericArc::checkValidIntersectionPoint(const C2dPos& pos) const {
  C2dPos centre;
  CMathAngle toStart;
  CMathAngle toEnd;
  CMathAngle toPos;
  return getSweepFrame(centre, toStart, toEnd) && toPos.setAz(centre, pos) &&
         checkValidAzimuthToIntersectionPoint(toStart, toEnd, toPos);
}

bool CGenericArc::getLengthAndOffset(double north, double east, double& length, double& offset) const {
  C2dPos centre;
  CMathAngle toStart;
  CMathAngle toEnd;
  if (!getSweepFrame(centre, toStart, toEnd)) return false;
  const double radius = getRadius();
  if (within(north, centre.north(), svy_math::tol::kSnap) && within(east, centre.east(), svy_math::tol::kSnap)) {
    length = 0.0;
    offset = radius;
    return true;
  }
  CMathAngle toPos;
  if (!toPos.setAz(centre, C2dPos(north, east)) || !checkValidAzimuthToIntersectionPoint(toStart, toEnd, toPos)) {
    return false;
  }
  const double distance = std::hypot(north - centre.north(), east - centre.east());
  double sweep = 0.0;
  if (isToTheRight()) {
    sweep = toPos.getRad() - toStart.getRad();
    offset = radius - distance;
  } else {
    sweep = toStart.getRad() - toPos.getRad();
    offset = distance + radius;
  }
  if (within(sweep, 0.0, kZero) || within(std::fabs(sweep), kTwoPi, kZero)) {
    length = 0.0;
  } else {
    length = toRange(sweep, 0.0, kTwoPi) * std::fabs(radius);
  }
  return true;
}

bool CGenericArc::getShortestDistanceToPoint(double north, double east, double& distance) const {
  C2dPos centre;
  if (!getArcCenterPos(centre)) return false;
  distance = std::hypot(north - centre.north(), east - centre.east()) - std::fabs(getRadius());
  return true;
}

C2dMinMax CGenericArc::getBoundary() const {
  C2dMinMax box(getStartPos(), getEndPos());
  C2dPos centre;
  CMathAngle toStart;
  CMathAngle toEnd;
  if (!getSweepFrame(centre, toStart, toEnd)) return box;
  const double radius = std::fabs(getRadius());
  // The four points where the circle reaches its extreme northing or easting: north, east, south, west.
  const C2dPos extremes[] = {C2dPos(centre.north() + radius, centre.east()),
                             C2dPos(centre.north(), centre.east() + radius),
                             C2dPos(centre.north() - radius, centre.east()),
                             C2dPos(centre.north(), centre.east() - radius)};
  const bool full = isFullCircle();
  for (int quarter = 0; quarter < 4; ++quarter) {
    CMathAngle direction;
    direction.setRad(quarter * svy_math::units::kHalfPi);
    const bool inSweep = full || (isToTheRight() ? isAngleRadInRange(toStart, toEnd, direction, 0.0)
                                                 : isAngleRadInRange(toEnd, toStart, direction, 0.0));
    if (inSweep) box.include(extremes[quarter]);
  }
  return box;
}

bool CGenericArc::appendLineCrossings(const C2dPos& linePos1, const C2dPos& linePos2,
                                      svy_vector<C2dPos>& out) const {
  C2dPos centre;
  if (!getArcCenterPos(centre)) return false;
  C2dPos solutions[2];
  const int count = IntersectionCoordsOfLineAndCircle(linePos1, linePos2, centre, std::fabs(getRadius()),
                                                      solutions[0], solutions[1]);
  bool found = false;
  for (int i = 0; i < count; ++i) {
    if (checkValidIntersectionPoint(solutions[i])) {
      out.push_back(solutions[i]);
      found = true;
    }
  }
  return found;
}

bool CGenericArc::calcHorizontalIntersection(double north, svy_vector<C2dPos>& out) const {
  const double east = getStartEasting();
  return appendLineCrossings(C2dPos(north, east), C2dPos(north, east + 1.0), out);
}

bool CGenericArc::calcVerticalIntersection(double east, svy_vector<C2dPos>& out) const {
  const double north = getStartNorthing();
  return appendLineCrossings(C2dPos(north, east), C2dPos(north + 1.0, east), out);
}

void CGenericArc::Accept(CGenericSegmentVisitor_const& visitor) const { visitor.Visit(*this); }
void CGenericArc::Accept(CGenericSegmentVisitor& visitor) { visitor.Visit(*this); }

bool CGenericArc::doCalcIntersections(const CGenericSpiral& other, svy_vector<C2dPos>& out) const {
  return svy_math::detail::intersectSpiralWith(other, *this, out);
}

bool CGenericArc::doCalcIntersections(const CGenericArc& other, svy_vector<C2dPos>& out) const {
  return svy_math::detail::intersectArcs(*this, other, out);
}

bool CGenericArc::doCalcIntersections(const CGenericLine& other, svy_vector<C2dPos>& out) const {
  return svy_math::detail::intersectLineArc(other, *this, out);
}
