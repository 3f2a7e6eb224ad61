#include "svymath/alignments/vertical_two_part.h"

#include <cmath>

#include "svymath/foundation/constants.h"

using svy_math::tol::kSnap;

SVY_RTTI_DEFINE(CAlntVeTwoPart, CAlntVe)

CAlntVeTwoPart::CAlntVeTwoPart() : m_valid(false) {}

CAlntVeTwoPart::~CAlntVeTwoPart() = default;

bool CAlntVeTwoPart::isok() const { return m_valid && CAlntElemImpl::isok(); }

double CAlntVeTwoPart::getLen() const {
  return m_valid ? m_straight.getLen() + curvePart().getLen() : svy_math::undefinedValue();
}

double CAlntVeTwoPart::getStartHt() const { return m_valid ? m_straight.getStartHt() : svy_math::undefinedValue(); }

double CAlntVeTwoPart::getFinalHt() const { return m_valid ? curvePart().getFinalHt() : svy_math::undefinedValue(); }

int CAlntVeTwoPart::snapToElement(double& s) const {
  const double length = getLen();
  if (!m_valid || s != s) return eVeHtAfterEnd;
  if (std::fabs(s) < kSnap) s = 0.0;
  if (std::fabs(length - s) < kSnap) s = length;
  if (s < 0.0) return eVeHtBeforeStart;
  return s <= length ? eVeHtOk : eVeHtAfterEnd;
}

int CAlntVeTwoPart::getHtAtLen(double length, double& height) const {
  double s = length;
  const int code = snapToElement(s);
  if (code != eVeHtOk) return code;
  const double straight = m_straight.getLen();
  return s <= straight ? m_straight.getHtAtLen(s, height) : curvePart().getHtAtLen(s - straight, height);
}

bool CAlntVeTwoPart::getGradeAtLength(double length, double& grade) const {
  double s = length;
  if (snapToElement(s) != eVeHtOk) return false;
  const double straight = m_straight.getLen();
  return s < straight ? m_straight.getGradeAtLength(s, grade) : curvePart().getGradeAtLength(s - straight, grade);
}

double CAlntVeTwoPart::getStepForDeviation(double length, double deviation) const {
  double s = length;
  if (snapToElement(s) != eVeHtOk) return 0.0;
  const double straight = m_straight.getLen();
  if (s < straight) return straight - s;
  return curvePart().getStepForDeviation(s - straight, deviation);
}
