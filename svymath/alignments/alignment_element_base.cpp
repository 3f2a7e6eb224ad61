#include "svymath/alignments/alignment_element_base.h"

#include "svymath/foundation/constants.h"

CAlntElBase::~CAlntElBase() = default;

bool CAlntElBase::getFinalChainageInM(double& chainage) const {
  double start = 0.0;
  double length = 0.0;
  if (!getStartChainageInM(start) || !getHLengthInM(length)) return false;
  chainage = start + length;
  return true;
}

bool CAlntElBase::distance2Chainage(double distance, double& chainage) const {
  double start = 0.0;
  if (!getStartChainageInM(start)) return false;
  chainage = start + distance;
  return true;
}

bool CAlntElBase::chainage2Distance(double chainage, double& distance) const {
  double start = 0.0;
  if (!getStartChainageInM(start)) return false;
  distance = chainage - start;
  return true;
}

CAlntElemImpl::CAlntElemImpl() : m_startChainage(svy_math::undefinedValue()) {}

CAlntElemImpl::~CAlntElemImpl() = default;

bool CAlntElemImpl::isok() const { return !svy_math::isUndefined(m_startChainage); }

bool CAlntElemImpl::readStartChainage(double& chainage) const {
  if (svy_math::isUndefined(m_startChainage)) return false;
  chainage = m_startChainage;
  return true;
}
