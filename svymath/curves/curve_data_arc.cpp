#include "svymath/curves/curve_data_arc.h"

#include <algorithm>
#include <cmath>

#include "svymath/curves/curve_projection.h"
#include "svymath/curves/spiral_length_range.h"
#include "svymath/foundation/constants.h"

using svy_math::tol::kZero;

namespace {

// The kind code of arc data, shared with the alignment's arc element.
constexpr int kArcDataType = 1;

bool isValidLength(double length) { return length >= 0.0 && std::isfinite(length); }

double withSide(double value, bool toTheRight) { return toTheRight ? std::fabs(value) : -std::fabs(value); }
}  // namespace

CCurveDataArc::CCurveDataArc() { reset(); }

int CCurveDataArc::static_type() { return kArcDataType; }

void CCurveDataArc::reset() {
  clearCache();
  m_length = svy_math::undefinedValue();
  m_radius = svy_math::undefinedValue();
  m_centerAngle.reset();
}

void CCurveDataArc::clearCache() {
  m_finalNorth = svy_math::undefinedValue();
  m_finalEast = svy_math::undefinedValue();
}

bool CCurveDataArc::knownRadius(double& radius) const {
  if (!std::isnan(m_radius)) {
    radius = m_radius;
    return true;
  }
  if (std::isnan(m_length) || m_centerAngle.isNan() || std::fabs(m_centerAngle.getRad()) < kZero) return false;
  m_radius = m_length / m_centerAngle.getRad();
  radius = m_radius;
  return true;
}

bool CCurveDataArc::isok() const {
  double radius = 0.0;
  return knownRadius(radius) && !std::isnan(getTotalLength());
}

bool CCurveDataArc::SetElement(double length, double radius, bool toTheRight) {
  if (!isValidLength(length) || !std::isfinite(radius)) return false;
  clearCache();
  m_length = length;
  m_radius = withSide(radius, toTheRight);
  m_centerAngle.setRad(turnAt(length));
  return true;
}

bool CCurveDataArc::SetElement(double length, AlntElementLengthDisplay lengthDisplay, double radius,
                               AlntElementRadiusDisplay radiusDisplay, bool toTheRight) {
  if (!SetElement(length, radius, toTheRight)) return false;
  m_flags = svy_math::withLengthDisplay(svy_math::withRadiusDisplay(m_flags, radiusDisplay), lengthDisplay);
  return true;
}

bool CCurveDataArc::GetElement(double& length, double& radius, bool& toTheRight) const {
  double signedRadius = 0.0;
  if (!knownRadius(signedRadius) || std::isnan(getTotalLength())) return false;
  length = getTotalLength();
  radius = std::fabs(signedRadius);
  toTheRight = signedRadius >= 0.0;
  return true;
}

bool CCurveDataArc::GetElement(double& length, AlntElementLengthDisplay& lengthDisplay, double& radius,
                               AlntElementRadiusDisplay& radiusDisplay, bool& toTheRight) const {
  if (!GetElement(length, radius, toTheRight)) return false;
  lengthDisplay = svy_math::getLengthDisplay(m_flags);
  radiusDisplay = svy_math::getRadiusDisplay(m_flags);
  return true;
}

void CCurveDataArc::setCAngleR(const CMathAngle& angle, double radius) {
  clearCache();
  const double turn = angle.getRad();  // an undefined angle reads as 0
  m_length = std::fabs(radius * turn);
  m_radius = withSide(radius, turn >= 0.0);
  m_centerAngle.setRad(turn);
}

void CCurveDataArc::setCAngleR(const CMathAngle& angle, double radius, bool toTheRight) {
  CMathAngle signedAngle;
  signedAngle.setRad(withSide(angle.getRad(), toTheRight));
  clearCache();
  m_length = std::fabs(radius * signedAngle.getRad());
  m_radius = withSide(radius, toTheRight);
  m_centerAngle = signedAngle;
}

bool CCurveDataArc::setCircle(double radius, bool toTheRight) {
  if (!std::isfinite(radius) || std::fabs(radius) < kZero) return false;
  clearCache();
  m_radius = withSide(radius, toTheRight);
  m_length = svy_math::units::kTwoPi * std::fabs(radius);
  m_centerAngle.setRad(0.0);
  return true;
}

bool CCurveDataArc::setLen(double length) {
  if (!isValidLength(length)) return false;
  clearCache();
  m_length = length;
  double radius = 0.0;
  if (knownRadius(radius)) m_centerAngle.setRad(turnAt(length));
  return true;
}

double CCurveDataArc::getTotalLength() const {
  if (std::isnan(m_length) && !std::isnan(m_radius) && m_centerAngle.isok()) {
    m_length = std::fabs(m_radius * m_centerAngle.getRad());
  }
  return m_length;
}

double CCurveDataArc::getRadius() const {
  double radius = 0.0;
  if (knownRadius(radius)) return radius;
  svy_math::logCurveFailure(__LINE__);
  m_radius = svy_math::tol::kUndefinedArcRadius;
  return m_radius;
}

bool CCurveDataArc::getCenterNE(double& north, double& east) const {
  double radius = 0.0;
  if (!knownRadius(radius)) return false;
  north = 0.0;
  east = radius;
  return true;
}

double CCurveDataArc::getChordLength() const {
  double radius = 0.0;
  const double length = getTotalLength();
  if (!knownRadius(radius) || std::isnan(length)) return 0.0;
  if (std::fabs(radius) < kZero) return length;
  return 2.0 * std::fabs(radius * std::sin(0.5 * length / radius));
}

bool CCurveDataArc::isCircle() const {
  double radius = 0.0;
  const double length = getTotalLength();
  if (!knownRadius(radius) || std::isnan(length) || std::fabs(radius) < kZero) return false;
  const double circumference = svy_math::units::kTwoPi * std::fabs(radius);
  return length >= circumference - kZero * std::max(1.0, circumference);
}

double CCurveDataArc::turnAt(double s) const {
  double radius = 0.0;
  if (!knownRadius(radius) || std::fabs(radius) < kZero) return 0.0;
  return s / radius;
}

double CCurveDataArc::GetAzimuth(double s) const { return turnAt(s) * svy_math::units::kRadToDeg; }

bool CCurveDataArc::getPosAtLength(double s, double& north, double& east) const {
  double radius = 0.0;
  const double length = getTotalLength();
  if (!knownRadius(radius) || std::isnan(length)) return false;
  if (!svy_math::checkLengthOrLog(true, s, length, __LINE__)) return false;
  const double turn = turnAt(s);
  north = radius * std::sin(turn);
  east = radius * (1.0 - std::cos(turn));
  return true;
}

double CCurveDataArc::getCurvatureAtLength(double /*s*/) const {
  double radius = 0.0;
  if (!knownRadius(radius) || std::fabs(radius) < kZero) return 0.0;
  return 1.0 / radius;
}

double CCurveDataArc::getStepForDeviation(double s, double dev) const {
  const double length = getTotalLength();
  if (!svy_math::checkLengthOrLog(true, s, length, __LINE__)) return 0.0;
  const double rest = length - s;
  double radius = 0.0;
  if (!knownRadius(radius) || std::fabs(radius) < kZero || !(dev > 0.0)) return rest;
  const double absRadius = std::fabs(radius);
  const double deviation = std::min(dev, absRadius);
  double step = 2.0 * absRadius * std::acos(1.0 - deviation / absRadius);
  const double cap = absRadius * svy_math::tol::kMaxChordStepTurn;
  if (std::fabs(cap) >= kZero) step = std::min(step, cap);
  return std::min(step, rest);
}

bool CCurveDataArc::getShortestDistAndCurveLen(double north, double east, double& dist, double& len) const {
  double radius = 0.0;
  const double length = getTotalLength();
  if (!knownRadius(radius) || std::isnan(length) || !std::isfinite(north) || !std::isfinite(east)) return false;
  const double absRadius = std::fabs(radius);
  const double fromCentreN = north;
  const double fromCentreE = east - radius;
  const double distance = std::hypot(fromCentreN, fromCentreE);
  if (absRadius < kZero || distance < kZero) {  // a point arc, or the point at the centre: all equally near
    len = 0.0;
    dist = absRadius < kZero ? distance : radius;
    return true;
  }
  // The arc point at length s lies at R (sin(s/R), -cos(s/R)) from the centre: the sweep to the point's
  // direction, measured the way the arc turns, brought into [0, 2 pi).
  const double side = radius > 0.0 ? 1.0 : -1.0;
  double sweep = std::atan2(fromCentreN, -side * fromCentreE);
  if (sweep < 0.0) sweep += svy_math::units::kTwoPi;
  const double foot = sweep * absRadius;
  if (foot <= length) {
    len = foot;
    dist = side * (absRadius - distance);
    return true;
  }
  // Outside the sweep: the nearer end.
  double endN = 0.0;
  double endE = 0.0;
  getPosAtLength(length, endN, endE);
  const double toStart = std::hypot(north, east);
  const double toEnd = std::hypot(north - endN, east - endE);
  if (toStart <= toEnd) {
    len = 0.0;
    dist = svy_math::detail::signedDistance(north, east, 0.0, 0.0, 0.0);
  } else {
    len = length;
    dist = svy_math::detail::signedDistance(north, east, endN, endE, turnAt(length));
  }
  return true;
}

double CCurveDataArc::getFinalNorthing() const {
  if (std::isnan(m_finalNorth) && isok()) getPosAtLength(getTotalLength(), m_finalNorth, m_finalEast);
  return m_finalNorth;
}

double CCurveDataArc::getFinalEasting() const {
  getFinalNorthing();
  return m_finalEast;
}

bool CCurveDataArc::getFinalAzimut(CMathAngle& azimuth) const {
  if (!isok()) return false;
  azimuth.setRad(turnAt(getTotalLength()));
  return true;
}

double CCurveDataArc::getFinalAzimutInRad() const { return isok() ? turnAt(getTotalLength()) : 0.0; }
