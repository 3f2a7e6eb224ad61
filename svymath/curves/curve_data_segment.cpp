#include "svymath/curves/curve_data_segment.h"

#include <algorithm>
#include <cmath>

#include "svymath/curves/curve_projection.h"
#include "svymath/curves/spiral_length_range.h"
#include "svymath/foundation/constants.h"

namespace {

// The kind code of segment data, shared with the alignment's tangent element.
constexpr int kSegmentDataType = 0;
}  // namespace

CCurveDataSegment::CCurveDataSegment() { reset(); }

int CCurveDataSegment::static_type() { return kSegmentDataType; }

void CCurveDataSegment::reset() {
  m_finalNorth = svy_math::undefinedValue();
  m_finalEast = svy_math::undefinedValue();
  m_length = svy_math::undefinedValue();
  m_azimuth = svy_math::undefinedValue();
  m_sin = svy_math::undefinedValue();
  m_cos = svy_math::undefinedValue();
}

bool CCurveDataSegment::isok() const {
  return (!std::isnan(m_length) && !std::isnan(m_azimuth)) ||
         (!std::isnan(m_finalNorth) && !std::isnan(m_finalEast));
}

void CCurveDataSegment::onDefinitionChanged() {
  m_sin = svy_math::undefinedValue();
  m_cos = svy_math::undefinedValue();
  if (!std::isnan(m_length) && !std::isnan(m_azimuth)) {
    m_finalNorth = m_length * cosAz();
    m_finalEast = m_length * sinAz();
  } else {
    m_finalNorth = svy_math::undefinedValue();
    m_finalEast = svy_math::undefinedValue();
  }
}

double CCurveDataSegment::cosAz() const {
  if (std::isnan(m_cos)) m_cos = std::cos(m_azimuth);
  return m_cos;
}

double CCurveDataSegment::sinAz() const {
  if (std::isnan(m_sin)) m_sin = std::sin(m_azimuth);
  return m_sin;
}

bool CCurveDataSegment::setLen(double length) {
  if (!(length >= 0.0) || std::isinf(length)) return false;
  m_length = length;
  onDefinitionChanged();
  return true;
}

void CCurveDataSegment::setAz(const CMathAngle& azimuth) {
  m_azimuth = azimuth.isNan() ? svy_math::undefinedValue() : azimuth.getRad();
  onDefinitionChanged();
}

void CCurveDataSegment::setAzDeg(double degrees) { setAz(CMathAngle(degrees)); }

void CCurveDataSegment::setAzRad(double radians) {
  CMathAngle azimuth;
  azimuth.setRad(radians);
  setAz(azimuth);
}

void CCurveDataSegment::setFinalNE(double north, double east) {
  CMathAngle azimuth;
  if (!azimuth.setTg(east, north)) {
    reset();
    return;
  }
  m_length = std::hypot(north, east);
  m_azimuth = azimuth.getRad();
  onDefinitionChanged();
  m_finalNorth = north;
  m_finalEast = east;
}

CMathAngle CCurveDataSegment::getAzimuth() const {
  CMathAngle azimuth;
  if (std::isnan(m_azimuth)) {
    azimuth.reset();
  } else {
    azimuth.setRad(m_azimuth);
  }
  return azimuth;
}

double CCurveDataSegment::GetAzimuth(double /*s*/) const {
  return std::isnan(m_azimuth) ? 0.0 : m_azimuth * svy_math::units::kRadToDeg;
}

bool CCurveDataSegment::getPosAtLength(double s, double& north, double& east) const {
  if (!svy_math::checkLengthOrLog(isok(), s, m_length, __LINE__)) return false;
  north = s * cosAz();
  east = s * sinAz();
  return true;
}

double CCurveDataSegment::getCurvatureAtLength(double /*s*/) const { return 0.0; }

double CCurveDataSegment::getStepForDeviation(double s, double /*deviation*/) const {
  return std::isnan(m_length) ? 0.0 : m_length - s;
}

bool CCurveDataSegment::getShortestDistAndCurveLen(double north, double east, double& dist, double& len) const {
  if (!isok() || !std::isfinite(north) || !std::isfinite(east)) return false;
  const double along = std::min(std::max(north * cosAz() + east * sinAz(), 0.0), m_length);
  dist = svy_math::detail::signedDistance(north, east, along * cosAz(), along * sinAz(), m_azimuth);
  len = along;
  return true;
}

double CCurveDataSegment::getFinalNorthing() const { return m_finalNorth; }

double CCurveDataSegment::getFinalEasting() const { return m_finalEast; }

bool CCurveDataSegment::getFinalAzimut(CMathAngle& azimuth) const {
  if (std::isnan(m_azimuth)) return false;
  azimuth.setRad(m_azimuth);
  return true;
}

double CCurveDataSegment::getFinalAzimutInRad() const { return std::isnan(m_azimuth) ? 0.0 : m_azimuth; }
