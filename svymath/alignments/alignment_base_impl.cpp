#include "svymath/alignments/alignment_base_impl.h"

#include "svymath/foundation/constants.h"

SVY_RTTI_DEFINE(CAlntBaseImpl, CRttiBase)

CAlntBaseImpl::CAlntBaseImpl()
    : m_startChainage(0.0),
      m_totalLength(svy_math::undefinedValue()),
      m_inBulkUpdate(false),
      m_stationEquations(nullptr) {}

CAlntBaseImpl::CAlntBaseImpl(const CAlntBaseImpl& other)
    : CRttiBase(),
      m_startChainage(other.m_startChainage),
      m_totalLength(other.m_totalLength),
      m_inBulkUpdate(false),
      m_stationEquations(other.m_stationEquations) {}

CAlntBaseImpl& CAlntBaseImpl::operator=(const CAlntBaseImpl& other) {
  copy(other);
  return *this;
}

CAlntBaseImpl::~CAlntBaseImpl() = default;

void CAlntBaseImpl::onBulkUpdateFinished() { m_inBulkUpdate = false; }

bool CAlntBaseImpl::HasStationEquations() const { return m_stationEquations != nullptr; }

const StationEquations* CAlntBaseImpl::GetStationEquations() const { return m_stationEquations; }

void CAlntBaseImpl::SetStationEquations(const StationEquations* equations) { m_stationEquations = equations; }

void CAlntBaseImpl::setStartChainageInM(double chainage) { m_startChainage = chainage; }

void CAlntBaseImpl::doInvalidateTotalLen() const { m_totalLength = svy_math::undefinedValue(); }

void CAlntBaseImpl::copy(const CAlntBaseImpl& other) {
  m_startChainage = other.m_startChainage;
  m_totalLength = other.m_totalLength;
  m_inBulkUpdate = false;
  m_stationEquations = other.m_stationEquations;
}

bool CAlntBaseImpl::getCachedTotalHLength(double& length) const {
  if (svy_math::isUndefined(m_totalLength) && !doObtainTotalHLength(m_totalLength)) return false;
  length = m_totalLength;
  return true;
}
