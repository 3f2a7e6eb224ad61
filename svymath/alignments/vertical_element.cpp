#include "svymath/alignments/vertical_element.h"

#include <cmath>

#include "svymath/alignments/vertical_visitor.h"
#include "svymath/foundation/constants.h"

using svy_math::isUndefined;
using svy_math::tol::kSnap;
using svy_math::tol::kZero;
using svy_math::units::kPercent;

SVY_RTTI_DEFINE(CVerticalElement, CAlntVe)

CVerticalElement::CVerticalElement()
    : m_startHeight(svy_math::undefinedValue()),
      m_length(svy_math::undefinedValue()),
      m_startGrade(svy_math::undefinedValue()),
      m_endGrade(svy_math::undefinedValue()),
      m_jump(0.0) {}

CVerticalElement::CVerticalElement(double startChainage, double startHeight, double length, double grade)
    : CVerticalElement() {
  setStraight(startChainage, startHeight, length, grade);
}

CVerticalElement::CVerticalElement(double startChainage, double startHeight, double length, double startGrade,
                                   double endGrade)
    : CVerticalElement() {
  setParabola(length, startGrade, endGrade);
  setStartHtAndChain(startHeight, startChainage);
}

CVerticalElement::~CVerticalElement() = default;

void CVerticalElement::setStraight(double length, double grade) { setParabola(length, grade, grade); }

void CVerticalElement::setStraight(double startChainage, double startHeight, double length, double grade) {
  setStraight(length, grade);
  setStartHtAndChain(startHeight, startChainage);
}

void CVerticalElement::setParabola(double length, double startGrade, double endGrade) {
  m_length = length;
  m_startGrade = startGrade;
  m_endGrade = endGrade;
  m_jump = 0.0;
}

void CVerticalElement::setParabolaByCF(double length, double rise, double middleOrdinate) {
  const double g1 = 2.0 * rise / length * kPercent;
  setParabola(length, g1, g1 - 8.0 * middleOrdinate / length * kPercent);
}

void CVerticalElement::setParabolaByCR(double length, double rise, double vertexRadius) {
  const double g1 = 2.0 * rise / length * kPercent;
  setParabola(length, g1, g1 - length / vertexRadius * kPercent);
}

void CVerticalElement::setVerticalGap(double jump) {
  setParabola(0.0, 0.0, 0.0);
  m_jump = jump;
}

void CVerticalElement::setStartHtAndChain(double height, double chainage) {
  m_startHeight = height;
  onStartChainageUpdate(chainage);
}

bool CVerticalElement::isZeroLength() const { return std::fabs(m_length) < kZero; }

bool CVerticalElement::isVerticalGAP() const { return isZeroLength() && isStraight(); }

double CVerticalElement::getFinalChain() const {
  double chainage = svy_math::undefinedValue();
  getFinalChainageInM(chainage);
  return chainage;
}

double CVerticalElement::getParabolaCoefficientA() const {
  return (m_endGrade - m_startGrade) / (2.0 * kPercent * m_length);
}

double CVerticalElement::getParabolaCoefficientB() const { return m_startGrade / kPercent; }

double CVerticalElement::getParabolaCoefficientC() const { return m_startHeight; }

double CVerticalElement::getParabolaCoefficientDs() const { return -2.0 * m_length * getParabolaCoefficientA(); }

double CVerticalElement::getParabolaCoefficientKv() const {
  const double a = getParabolaCoefficientA();
  return std::fabs(a) < kZero ? svy_math::undefinedValue() : 1.0 / (2.0 * a);
}

bool CVerticalElement::getParabolaExtremum(double& chainage, double& height, bool& isMax) const {
  double start = 0.0;
  if (!isok() || isStraight() || isZeroLength() || !readStartChainage(start)) return false;
  const double a = getParabolaCoefficientA();
  const double b = getParabolaCoefficientB();
  // The vertex, where the grade 2 A s + B is zero: it lies on the element when the grade changes sign.
  double s = -b / (2.0 * a);
  if (s < -kSnap || s > m_length + kSnap) return false;
  s = std::fmin(std::fmax(s, 0.0), m_length);
  chainage = start + s;
  height = (a * s + b) * s + m_startHeight;
  isMax = a < 0.0;
  return true;
}

int CVerticalElement::getType() const { return isStraight() ? eAlntVeStraight : eAlntVeParabola; }

bool CVerticalElement::isok() const {
  return CAlntElemImpl::isok() && !isUndefined(m_startHeight) && !isUndefined(m_length) &&
         !isUndefined(m_startGrade) && !isUndefined(m_endGrade) && m_length >= 0.0;
}

int CVerticalElement::getHtAtLen(double length, double& height) const {
  double s = length;
  if (std::fabs(s) < kSnap) s = 0.0;
  if (std::fabs(m_length - s) < kSnap) s = m_length;
  if (s < 0.0) return eVeHtBeforeStart;
  if (!(s <= m_length) || isUndefined(m_startHeight) || isUndefined(m_startGrade)) return eVeHtAfterEnd;
  if (isStraight()) {
    height = isZeroLength() ? m_startHeight + m_jump : m_startHeight + m_startGrade / kPercent * s;
  } else if (isZeroLength()) {
    height = m_startHeight;
  } else {
    height = (getParabolaCoefficientA() * s + getParabolaCoefficientB()) * s + m_startHeight;
  }
  return eVeHtOk;
}

bool CVerticalElement::getGradeAtLength(double length, double& grade) const {
  double s = length;
  if (std::fabs(s) < kZero) s = 0.0;
  if (std::fabs(m_length - s) < kSnap) s = m_length;
  if (!(s >= 0.0 && s <= m_length) || isUndefined(m_startGrade)) return false;
  grade = isStraight() || isZeroLength()
              ? m_startGrade
              : (2.0 * getParabolaCoefficientA() * s + getParabolaCoefficientB()) * kPercent;
  return true;
}

double CVerticalElement::getFinalHt() const {
  double height = svy_math::undefinedValue();
  getHtAtLen(m_length, height);
  return height;
}

bool CVerticalElement::getAsLs(CLsInfo& info) const {
  double start = 0.0;
  if (!isok() || !readStartChainage(start)) return false;
  // A grade line is an intersection point at its end without a curve; a parabola is the point at its
  // middle where its two tangents meet.
  const double toIp = isStraight() ? m_length : 0.5 * m_length;
  const double ip = start + toIp;
  info = CLsInfo(ip, m_startHeight + m_startGrade * toIp / kPercent, isStraight() ? 0.0 : m_length,
                 ip - (isStraight() ? 0.0 : 0.5 * m_length), 0.0);
  return true;
}

double CVerticalElement::getStepForDeviation(double length, double deviation) const {
  double s = length;
  if (std::fabs(s) < kSnap) s = 0.0;
  if (std::fabs(m_length - s) < kSnap) s = m_length;
  if (!isok() || !(s >= 0.0 && s <= m_length)) return 0.0;
  const double rest = m_length - s;
  if (isStraight() || isZeroLength()) return rest;
  return chordStep(deviation, 2.0 * std::fabs(getParabolaCoefficientA()), rest);
}

CAlntVe* CVerticalElement::clone() const { return new CVerticalElement(*this); }

bool CVerticalElement::isEqual(const CAlntVe* other) const {
  const CVerticalElement* o = cast(other);
  return o != nullptr && sameStart(*o) && sameValue(m_startHeight, o->m_startHeight) &&
         sameValue(m_length, o->m_length) && sameValue(m_startGrade, o->m_startGrade) &&
         sameValue(m_endGrade, o->m_endGrade) && sameValue(m_jump, o->m_jump);
}

void CVerticalElement::Accept(CAlntVeVisitor& visitor) { visitor.Visit(*this); }

void CVerticalElement::Accept(CAlntVeVisitor_const& visitor) const { visitor.Visit(*this); }
