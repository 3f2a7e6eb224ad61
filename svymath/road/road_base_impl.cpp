#include "svymath/road/road_base_impl.h"

#include <cmath>

#include "svymath/foundation/constants.h"
#include "svymath/road/road_log.h"
#include "svyutils/svy_err_log.h"

SVY_RTTI_DEFINE2(CRoadBaseImpl, CRoadBase, CAlntBaseImpl)

CRoadBaseImpl::CRoadBaseImpl()
    : m_chainageInterval(100.0),
      m_corridorLeft(svy_math::undefinedValue()),
      m_corridorRight(svy_math::undefinedValue()),
      m_hal(nullptr),
      m_val(nullptr),
      m_stringSet(nullptr),
      m_xsSf(nullptr) {}

CRoadBaseImpl::CRoadBaseImpl(const CRoadBaseImpl& other)
    : CRttiBase(),
      CRoadBase(other),
      CAlntBaseImpl(other),
      m_chainageInterval(other.m_chainageInterval),
      m_corridorLeft(other.m_corridorLeft),
      m_corridorRight(other.m_corridorRight),
      m_hal(other.m_hal),
      m_val(other.m_val),
      m_stringSet(other.m_stringSet),
      m_xsSf(other.m_xsSf) {}

CRoadBaseImpl& CRoadBaseImpl::operator=(const CRoadBaseImpl& other) {
  if (this != &other) {
    CRoadBase::operator=(other);
    copy(other);
  }
  return *this;
}

CRoadBaseImpl::~CRoadBaseImpl() = default;

void CRoadBaseImpl::copy(const CRoadBaseImpl& other) {
  CAlntBaseImpl::copy(other);
  m_chainageInterval = other.m_chainageInterval;
  m_corridorLeft = other.m_corridorLeft;
  m_corridorRight = other.m_corridorRight;
  m_hal = other.m_hal;
  m_val = other.m_val;
  m_stringSet = other.m_stringSet;
  m_xsSf = other.m_xsSf;
}

void CRoadBaseImpl::setAlignments(const CHorzAndVertAlnt& pair) {
  m_hal = &pair;
  m_val = &pair.getAlntVes();
}

double CRoadBaseImpl::getStartChainageInM() const {
  if (m_hal != nullptr) return m_hal->getStartChainageInM();
  if (m_val != nullptr) return m_val->getStartChainageInM();
  return getStoredStartChainageInM();
}

bool CRoadBaseImpl::getHLengthInM(double& length) const {
  double total = 0.0;
  if (!doObtainTotalHLength(total)) return false;
  length = total;
  return true;
}

bool CRoadBaseImpl::doObtainTotalHLength(double& length) const {
  return m_hal != nullptr && m_hal->getHLengthInM(length);
}

const CHorzAlntBase& CRoadBaseImpl::getHorzAlnt() const {
  return m_hal != nullptr ? static_cast<const CHorzAlntBase&>(*m_hal) : m_noHal;
}

const CVertAlntBase& CRoadBaseImpl::getVertAlnt() const {
  return m_val != nullptr ? static_cast<const CVertAlntBase&>(*m_val) : m_noVal;
}

void CRoadBaseImpl::clearCorridorLeftOffset() { m_corridorLeft = svy_math::undefinedValue(); }
void CRoadBaseImpl::clearCorridorRightOffset() { m_corridorRight = svy_math::undefinedValue(); }

bool CRoadBaseImpl::getCrossSectionAtChainage(double chainage, CRoadCrossSection*& section, bool extrapolate) const {
  if (!hasSurfaceDefinition() || !std::isfinite(chainage)) return false;
  double north = 0.0;
  double east = 0.0;
  double azimuthDeg = 0.0;
  bool planExtrapolated = false;
  if (!getHorzAlnt().getPosNeAtChainExtr(chainage, north, east, planExtrapolated)) return false;
  if (!getHorzAlnt().getAzimuthAtChainExtr(chainage, azimuthDeg)) {
    // An alignment that places a chainage but gives no direction there is inconsistent.
    svy_logging::svy_err_log(svy_math::kRoadTemplLogSource, __LINE__, "");
    return false;
  }
  double height = 0.0;
  bool heightExtrapolated = false;
  const bool hasHeight = getVertAlnt().getHeightAtChainExtr(chainage, height, heightExtrapolated);
  // Templates hang from the centre-line height; strings carry their own heights and need none.
  if (!hasHeight && !hasSurfaceByStrings()) return false;
  if (!extrapolate && (planExtrapolated || (hasHeight && heightExtrapolated))) return false;

  CEditableRoadCrossSection* built = hasHeight ? new CEditableRoadCrossSection(chainage, height, heightExtrapolated)
                                               : new CEditableRoadCrossSection(chainage);
  built->setCenterLinePos(C2dPos(north, east), planExtrapolated);
  built->setCenterLineAzimuth(CMathAngle(azimuthDeg));
  const bool filled = (hasHeight && hasSurfaceByTemplates() && m_xsSf->fillSection(chainage, height, *built)) ||
                      (hasSurfaceByStrings() && m_stringSet->fillSection(chainage, *built));
  if (!filled) {
    delete built;
    return false;
  }
  section = built;
  return true;
}

const CAlntHe* CRoadBaseImpl::getHe(int index) const { return m_hal != nullptr ? m_hal->getHe(index) : nullptr; }
const CAlntHe* CRoadBaseImpl::getFirstHe() const { return m_hal != nullptr ? m_hal->getFirstHe() : nullptr; }
const CAlntHe* CRoadBaseImpl::getLastHe() const { return m_hal != nullptr ? m_hal->getLastHe() : nullptr; }
const CAlntHe* CRoadBaseImpl::getAlntHeAtChain(double chainage, double* distanceInElement) const {
  return m_hal != nullptr ? m_hal->getAlntHeAtChain(chainage, distanceInElement) : nullptr;
}
const CAlntVe* CRoadBaseImpl::getVe(int index) const { return m_val != nullptr ? m_val->getVe(index) : nullptr; }
const CAlntVe* CRoadBaseImpl::getFirstVe() const { return m_val != nullptr ? m_val->getFirstVe() : nullptr; }
const CAlntVe* CRoadBaseImpl::getLastVe() const { return m_val != nullptr ? m_val->getLastVe() : nullptr; }
const CAlntVe* CRoadBaseImpl::getAlntVeAtChain(double chainage, double* distanceInElement) const {
  return m_val != nullptr ? m_val->getAlntVeAtChain(chainage, distanceInElement) : nullptr;
}
bool CRoadBaseImpl::getIpPosForElement(int index, double& north, double& east) const {
  return m_hal != nullptr && m_hal->getIpPosForElement(index, north, east);
}
