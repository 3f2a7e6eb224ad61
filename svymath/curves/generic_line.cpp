#include "svymath/curves/generic_line.h"

#include <cmath>
#include <limits>

#include "svymath/curves/generic_intersections.h"
#include "svymath/curves/generic_segment_visitor.h"
#include "svymath/foundation/constants.h"
#include "svymath/foundation/math_angle.h"

SVY_RTTI_DEFINE(CGenericLine, CGenericSegment)

namespace {

// Ends closer than one machine epsilon in a coordinate make the line parallel to that axis: the value is the
// spacing of doubles near 1, so only ends with bit-identical (or near-zero) coordinates qualify.
constexpr double kSameCoordinate = std::numeric_limits<double>::epsilon();

double snapToZero(double value) { return std::fabs(value) < svy_math::tol::kZero ? 0.0 : value; }

}  // namespace

CGenericLine::CGenericLine(EIntersectionType type) : CGenericSegment(type) {}
CGenericLine::CGenericLine(const CGenericLine& other) = default;
CGenericLine& CGenericLine::operator=(const CGenericLine& other) = default;
CGenericLine::~CGenericLine() = default;

C2dMinMax CGenericLine::getBoundary() const { return C2dMinMax(getStartPos(), getEndPos()); }

double CGenericLine::getTotalLength() const {
  return std::hypot(getEndNorthing() - getStartNorthing(), getEndEasting() - getStartEasting());
}

bool CGenericLine::getStartAzimut(CMathAngle& azimuth) const {
  return azimuth.setTg(getEndEasting() - getStartEasting(), getEndNorthing() - getStartNorthing());
}

bool CGenericLine::getEndAzimut(CMathAngle& azimuth) const { return getStartAzimut(azimuth); }

bool CGenericLine::getAzimuthAtLength(double /*length*/, CMathAngle& azimuth) const {
  return getStartAzimut(azimuth);
}

double CGenericLine::getAzimuthAtLength(double length) const {
  CMathAngle azimuth;
  if (!getAzimuthAtLength(length, azimuth) || azimuth.isNan()) return 0.0;
  return azimuth.getRad() * svy_math::units::kRadToDeg;
}

double CGenericLine::getCurvatureAtLength(double /*length*/) const { return 0.0; }

double CGenericLine::getStepForDeviation(double length, double /*deviation*/) const {
  return getTotalLength() - length;
}

bool CGenericLine::getFrame(C2dPos& start, double& cosAz, double& sinAz) const {
  CMathAngle azimuth;
  if (!getStartAzimut(azimuth) || azimuth.isNan()) return false;
  start = getStartPos();
  cosAz = azimuth.getCos();
  sinAz = azimuth.getSin();
  return true;
}

bool CGenericLine::getPosAtLength(double length, double& north, double& east) const {
  return getPosAtLengthAndOffset(length, 0.0, north, east);
}

bool CGenericLine::getPosAtLengthAndOffset(double length, double offset, double& north, double& east) const {
  CMathAngle azimuth;
  if (!getStartAzimut(azimuth) || azimuth.isNan()) return false;
  C2dPos along;
  azimuth.getPosAlong(length, getStartPos(), along);
  azimuth.getPosAcross(offset, along.north(), along.east(), north, east);
  return true;
}

bool CGenericLine::getLengthAndOffset(double north, double east, double& length, double& offset) const {
  C2dPos start;
  double cosAz = 0.0;
  double sinAz = 0.0;
  if (!getFrame(start, cosAz, sinAz)) return false;
  const double dN = north - start.north();
  const double dE = east - start.east();
  const double along = snapToZero(cosAz * dN + sinAz * dE);
  if (!checkDistanceAlongIsOnLine(along)) return false;
  length = along;
  offset = snapToZero(-sinAz * dN + cosAz * dE);
  return true;
}

bool CGenericLine::getShortestDistanceToPoint(double north, double east, double& distance) const {
  C2dPos start;
  double cosAz = 0.0;
  double sinAz = 0.0;
  if (!getFrame(start, cosAz, sinAz)) return false;
  distance = std::fabs(snapToZero(-sinAz * (north - start.north()) + cosAz * (east - start.east())));
  return true;
}

void CGenericLine::Accept(CGenericSegmentVisitor_const& visitor) const { visitor.Visit(*this); }
void CGenericLine::Accept(CGenericSegmentVisitor& visitor) { visitor.Visit(*this); }

bool CGenericLine::calcHorizontalIntersection(double north, C2dPos& pos) const {
  C2dPos start;
  double cosAz = 0.0;
  double sinAz = 0.0;
  if (!getFrame(start, cosAz, sinAz) || std::fabs(cosAz) < svy_math::tol::kZero) return false;
  const double along = (north - start.north()) / cosAz;
  if (!std::isfinite(along) || !checkDistanceAlongIsOnLine(along)) return false;
  pos = C2dPos(north, start.east() + along * sinAz);
  return true;
}

bool CGenericLine::calcVerticalIntersection(double east, C2dPos& pos) const {
  C2dPos start;
  double cosAz = 0.0;
  double sinAz = 0.0;
  if (!getFrame(start, cosAz, sinAz) || std::fabs(sinAz) < svy_math::tol::kZero) return false;
  const double along = (east - start.east()) / sinAz;
  if (!std::isfinite(along) || !checkDistanceAlongIsOnLine(along)) return false;
  pos = C2dPos(start.north() + along * cosAz, east);
  return true;
}

bool CGenericLine::checkNorthIsOnLine(double north) const {
  C2dPos start;
  double cosAz = 0.0;
  double sinAz = 0.0;
  if (!getFrame(start, cosAz, sinAz)) return false;
  if (std::fabs(cosAz) < svy_math::tol::kZero) return std::fabs(north - start.north()) < svy_math::tol::kZero;
  return checkDistanceAlongIsOnLine((north - start.north()) / cosAz);
}

bool CGenericLine::checkEastIsOnLine(double east) const {
  C2dPos start;
  double cosAz = 0.0;
  double sinAz = 0.0;
  if (!getFrame(start, cosAz, sinAz)) return false;
  if (std::fabs(sinAz) < svy_math::tol::kZero) return std::fabs(east - start.east()) < svy_math::tol::kZero;
  return checkDistanceAlongIsOnLine((east - start.east()) / sinAz);
}

bool CGenericLine::interpolateNorthing(double east, double& north) const {
  C2dPos start;
  double cosAz = 0.0;
  double sinAz = 0.0;
  if (!getFrame(start, cosAz, sinAz) || std::fabs(sinAz) < svy_math::tol::kZero) return false;
  north = start.north() + (east - start.east()) / sinAz * cosAz;
  return true;
}

bool CGenericLine::interpolateEasting(double north, double& east) const {
  C2dPos start;
  double cosAz = 0.0;
  double sinAz = 0.0;
  if (!getFrame(start, cosAz, sinAz) || std::fabs(cosAz) < svy_math::tol::kZero) return false;
  east = start.east() + (north - start.north()) / cosAz * sinAz;
  return true;
}

bool CGenericLine::isLineWithSameNorthing() const {
  return std::fabs(getEndNorthing() - getStartNorthing()) < kSameCoordinate;
}

bool CGenericLine::isLineWithSameEasting() const {
  return std::fabs(getEndEasting() - getStartEasting()) < kSameCoordinate;
}

bool CGenericLine::checkValidIntersectionPoint(const C2dPos& pos) const {
  C2dPos start;
  double cosAz = 0.0;
  double sinAz = 0.0;
  if (!getFrame(start, cosAz, sinAz)) return false;
  const double along = snapToZero(cosAz * (pos.north() - start.north()) + sinAz * (pos.east() - start.east()));
  return checkDistanceAlongIsOnLine(along);
}

bool CGenericLine::doCalcIntersections(const CGenericSpiral& other, svy_vector<C2dPos>& out) const {
  return svy_math::detail::intersectSpiralWith(other, *this, out);
}

bool CGenericLine::doCalcIntersections(const CGenericArc& other, svy_vector<C2dPos>& out) const {
  return svy_math::detail::intersectLineArc(*this, other, out);
}

bool CGenericLine::doCalcIntersections(const CGenericLine& other, svy_vector<C2dPos>& out) const {
  return svy_math::detail::intersectLines(*this, other, out);
}
