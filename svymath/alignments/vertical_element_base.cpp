#include "svymath/alignments/vertical_element_base.h"

#include <cmath>

#include "svymath/alignments/vertical_visitor.h"
#include "svymath/foundation/constants.h"

SVY_RTTI_DEFINE(CAlntVe, CRttiBase)

CAlntVeVisitor::~CAlntVeVisitor() = default;
CAlntVeVisitor_const::~CAlntVeVisitor_const() = default;

CVertAlntElemBase::~CVertAlntElemBase() = default;

bool CVertAlntElemBase::getHtAtChain(double chainage, double& height) const {
  double distance = 0.0;
  double h = 0.0;
  if (!chainage2Distance(chainage, distance) || getHtAtLen(distance, h) != eVeHtOk) return false;
  height = h;
  return true;
}

bool CVertAlntElemBase::getGradeAtChainage(double chainage, double& grade) const {
  double distance = 0.0;
  return chainage2Distance(chainage, distance) && getGradeAtLength(distance, grade);
}

CAlntVe::~CAlntVe() = default;

bool CAlntVe::getHLengthInM(double& length) const {
  const double len = getLen();
  if (svy_math::isUndefined(len)) return false;
  length = len;
  return true;
}

bool CAlntVe::getStartChainageInM(double& chainage) const { return readStartChainage(chainage); }

void CAlntVe::onNeighbourUpdate(const CAlntVe* previous, const CAlntVe* /*next*/) {
  double height = 0.0;
  double chainage = 0.0;
  if (previousEnd(previous, height, chainage)) setStartHtAndChain(height, chainage);
}

bool CAlntVe::previousEnd(const CAlntVe* previous, double& height, double& chainage) {
  if (previous == nullptr) return false;
  double end = 0.0;
  const double h = previous->getFinalHt();
  if (!previous->getFinalChainageInM(end) || svy_math::isUndefined(h)) return false;
  height = h;
  chainage = end;
  return true;
}

bool CAlntVe::sameValue(double a, double b) {
  return (svy_math::isUndefined(a) && svy_math::isUndefined(b)) || std::fabs(a - b) < svy_math::tol::kZero;
}

bool CAlntVe::sameStart(const CAlntVe& other) const {
  double a = svy_math::undefinedValue();
  double b = svy_math::undefinedValue();
  readStartChainage(a);
  other.readStartChainage(b);
  return sameValue(a, b);
}

double CAlntVe::chordStep(double deviation, double maxCurvature, double rest) {
  if (!(deviation > 0.0) || !(maxCurvature > svy_math::tol::kZero)) return rest;
  return std::fmin(std::sqrt(8.0 * deviation / maxCurvature), rest);
}
