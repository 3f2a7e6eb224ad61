#include "svymath/curves/curve_data_spiral.h"

#include <cmath>

#include "svymath/curves/spiral_length_range.h"
#include "svymath/foundation/constants.h"

using svy_math::tol::kZero;

CCurveDataSpiral::CCurveDataSpiral(AlntMathSpiralType type) : CCurveDataSpiral1R(type) {}

CCurveDataSpiral::CCurveDataSpiral(const CCurveDataSpiral1R& full) : CCurveDataSpiral1R(full) {}

CCurveDataSpiral::~CCurveDataSpiral() = default;

void CCurveDataSpiral::reset() {
  m_startOffset = 0.0;
  CCurveDataSpiral1R::reset();
}

bool CCurveDataSpiral::setLenAndTwoR(double L, double R1, double R2, bool toTheRight, bool isTSSC) {
  const bool ok = CCurveDataSpiral1R::setLenAndTwoR(L, R1, R2, toTheRight, isTSSC);
  // The part is the law's last L (TS to SC) or its first L run backwards (CS to ST): it begins at L_law - L.
  const double offset = ok ? m_law->getLength() - L : 0.0;
  m_startOffset = std::fabs(offset) < kZero ? 0.0 : offset;
  onDefinitionChanged();
  return ok;
}

bool CCurveDataSpiral::setTurnRight(bool toTheRight) {
  const double offset = m_startOffset;
  const bool ok = CCurveDataSpiral1R::setTurnRight(toTheRight);
  if (ok && offset < m_law->getLength()) {
    m_startOffset = offset;
    onDefinitionChanged();
  }
  return ok;
}

bool CCurveDataSpiral::setStartOffset(double offset) {
  if (!(offset >= 0.0 && offset < m_law->getLength())) return false;
  m_startOffset = offset;
  onDefinitionChanged();
  return true;
}

bool CCurveDataSpiral::isCompoundSpiral() const { return m_startOffset >= kZero; }

void CCurveDataSpiral::onDefinitionChanged() {
  if (!(m_startOffset >= 0.0 && m_startOffset < m_law->getLength())) m_startOffset = 0.0;
  m_shiftNorth = 0.0;
  m_shiftEast = 0.0;
  m_rotation.setRad(0.0);
  if (!m_isTSSC || !m_law->isok() || m_startOffset == 0.0) return;
  double n = 0.0;
  double e = 0.0;
  if (!fullPosAtLength(m_startOffset, n, e)) return;
  m_shiftNorth = n;
  m_shiftEast = e;
  m_rotation.setRad(-m_law->GetAzimuth(m_startOffset) * svy_math::units::kDegToRad);
}

double CCurveDataSpiral::getTotalLength() const { return m_law->getLength() - m_startOffset; }

double CCurveDataSpiral::GetAzimuth(double s) const {
  if (!m_isTSSC) return CCurveDataSpiral1R::GetAzimuth(s);
  return CCurveDataSpiral1R::GetAzimuth(s + m_startOffset) + m_rotation.getDeg();
}

bool CCurveDataSpiral::getPosAtLength(double s, double& north, double& east) const {
  if (!svy_math::checkLengthOrLog(m_law->isok(), s, getTotalLength(), __LINE__)) return false;
  if (!m_isTSSC) return fullPosAtLength(s, north, east);
  double n = 0.0;
  double e = 0.0;
  if (!fullPosAtLength(s + m_startOffset, n, e)) return false;
  n -= m_shiftNorth;
  e -= m_shiftEast;
  m_rotation.getRotated(n, e);
  north = n;
  east = e;
  return true;
}

double CCurveDataSpiral::getCurvatureAtLength(double s) const {
  return CCurveDataSpiral1R::getCurvatureAtLength(m_isTSSC ? s + m_startOffset : s);
}

double CCurveDataSpiral::getStepForDeviation(double s, double dev) const {
  const double total = getTotalLength();
  if (!svy_math::checkLengthOrLog(true, s, total, __LINE__)) return 0.0;
  if (!(dev > 0.0)) return total - s;
  if (m_isTSSC) return fullStepForDeviation(s + m_startOffset, dev, m_law->getLength());
  return fullStepForDeviation(s, dev, total);
}

double CCurveDataSpiral::getLengthAtAzimuth(const CMathAngle& angle) const {
  if (!m_isTSSC) return CCurveDataSpiral1R::getLengthAtAzimuth(angle);
  // The law's direction at the sought length is the part's turn plus the law's direction at the offset.
  const double lawLen = m_law->getLengthAtAzimuth(angle - m_rotation);
  return std::fmax(0.0, lawLen - m_startOffset);
}

double CCurveDataSpiral::radiusAtLawLength(double s) const {
  const double k = m_law->getCurvatureAtLength(s);
  if (!(std::fabs(k) >= kZero)) return 0.0;
  return m_isTSSC ? 1.0 / k : -1.0 / k;
}

double CCurveDataSpiral::getStartRadius() const {
  if (!m_law->isok()) return 0.0;
  return m_isTSSC ? radiusAtLawLength(m_startOffset) : getRadius();
}

double CCurveDataSpiral::getFinalRadius() const {
  if (!m_law->isok()) return 0.0;
  return m_isTSSC ? getRadius() : radiusAtLawLength(m_startOffset);
}
