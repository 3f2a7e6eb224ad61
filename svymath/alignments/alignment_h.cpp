#include "svymath/alignments/alignment_h.h"

#include <algorithm>
#include <cmath>

#include "svymath/alignments/alignment_search_index.h"
#include "svymath/cogo/inverse_radiate.h"
#include "svymath/foundation/constants.h"

using svy_math::tol::kSnap;

SVY_RTTI_DEFINE2(CAlntH, CHorzAlntBase, CAlntBaseImpl)

CAlntH::CAlntH()
    : m_startNorth(svy_math::undefinedValue()), m_startEast(svy_math::undefinedValue()), m_useSearchIndex(true) {}

CAlntH::CAlntH(const CAlntH& other)
    : CRttiBase(), CAlntBase(other), CHorzAlntBase(other), CAlntBaseImpl(other),
      m_startNorth(other.m_startNorth), m_startEast(other.m_startEast), m_useSearchIndex(other.m_useSearchIndex) {
  m_elements.reserve(other.m_elements.size());
  for (const CAlntHe* element : other.m_elements) m_elements.push_back(element->clone());
}

CAlntH& CAlntH::operator=(const CAlntH& other) {
  if (this != &other) copy(other);
  return *this;
}

CAlntH::~CAlntH() { deleteElements(); }

void CAlntH::copy(const CAlntH& other) {
  if (this == &other) return;
  deleteElements();
  CAlntBaseImpl::copy(other);
  m_startNorth = other.m_startNorth;
  m_startEast = other.m_startEast;
  m_useSearchIndex = other.m_useSearchIndex;
  m_elements.reserve(other.m_elements.size());
  for (const CAlntHe* element : other.m_elements) m_elements.push_back(element->clone());
}

void CAlntH::deleteElements() {
  for (CAlntHe* element : m_elements) delete element;
  m_elements.clear();
  invalidateSearchIndex();
}

void CAlntH::invalidateSearchIndex() const { m_searchIndex.reset(); }

const CAlntHe* CAlntH::getHe(int index) const {
  if (index < 0 || index >= getNumOfElements()) return nullptr;
  return m_elements[static_cast<std::size_t>(index)];
}

// ---- length and chainage ----

bool CAlntH::doObtainTotalHLength(double& length) const {
  length = 0.0;
  for (const CAlntHe* element : m_elements) {
    double elementLength = 0.0;
    if (!element->getHLengthInM(elementLength)) return false;
    length += elementLength;
  }
  return true;
}

bool CAlntH::getHLengthInM(double& length) const {
  CAlntAccessGuard guard(*this);
  return getCachedTotalHLength(length);
}

bool CAlntH::getFinalChainageInM(double& chainage) const {
  double length = 0.0;
  if (!getHLengthInM(length)) return false;
  chainage = getStoredStartChainageInM() + length;
  return true;
}

bool CAlntH::getFinalPosNe(double& north, double& east) const {
  CAlntAccessGuard guard(*this);
  const CAlntHe* last = getLastHe();
  return last != nullptr && last->getFinalPosNe(north, east);
}

C2dMinMax CAlntH::getBoundary() const {
  CAlntAccessGuard guard(*this);
  C2dMinMax boundary;
  for (const CAlntHe* element : m_elements) boundary.include(element->getBoundary());
  return boundary;
}

// Walks backwards, so that a chainage exactly at a joint belongs to the later element, and a chainage up to
// tol::kSnap beyond the final chainage (or before the start) still belongs to the last (first) element.
const CAlntHe* CAlntH::findHeAtChain(double chainage, double* distanceInElement, int* index) const {
  for (int i = getNumOfElements() - 1; i >= 0; --i) {
    const CAlntHe* element = m_elements[static_cast<std::size_t>(i)];
    double start = 0.0;
    if (!element->getStartChainageInM(start)) return nullptr;
    if (!(start <= chainage || (i == 0 && start - kSnap <= chainage))) continue;
    double length = 0.0;
    double distance = 0.0;
    if (element->getHLengthInM(length) && element->chainage2Distance(chainage, distance) && distance >= -kSnap &&
        distance < length + kSnap) {
      if (distanceInElement != nullptr) *distanceInElement = distance;
      if (index != nullptr) *index = i;
      return element;
    }
  }
  return nullptr;
}

const CHorzAlntElemBase* CAlntH::getHorzElemAtChain(double chainage, double* distanceInElement,
                                                    int* index) const {
  return findHeAtChain(chainage, distanceInElement, index);
}

const CAlntHe* CAlntH::getAlntHeAtChain(double chainage, double* distanceInElement) const {
  return findHeAtChain(chainage, distanceInElement, nullptr);
}

// ---- queries by chainage ----

bool CAlntH::getPosNeAtChain(double chainage, double& north, double& east) const {
  CAlntAccessGuard guard(*this);
  double distance = 0.0;
  const CAlntHe* element = findHeAtChain(chainage, &distance, nullptr);
  return element != nullptr && element->getPosNeAtLength(distance, north, east);
}

bool CAlntH::getAzimuthAtChain(double chainage, double& azimuthDeg) const {
  CAlntAccessGuard guard(*this);
  double distance = 0.0;
  const CAlntHe* element = findHeAtChain(chainage, &distance, nullptr);
  return element != nullptr && element->getAzimuthAtLength(distance, azimuthDeg);
}

bool CAlntH::getCurvatureAtChainage(double chainage, double& curvature) const {
  CAlntAccessGuard guard(*this);
  double distance = 0.0;
  const CAlntHe* element = findHeAtChain(chainage, &distance, nullptr);
  return element != nullptr && element->getCurvatureAtLength(distance, curvature);
}

bool CAlntH::getPosNeAtChainExtr(double chainage, double& north, double& east, bool& extrapolated) const {
  return getPosNeAtChainAndOffsetExtr(chainage, 0.0, north, east, &extrapolated);
}

bool CAlntH::getPosNeAtChainExtr(double chainage, double& north, double& east) const {
  return getPosNeAtChainAndOffsetExtr(chainage, 0.0, north, east, nullptr);
}

namespace {

// An azimuth in degrees for the extension queries: an undefined angle counts as 0.
double degreesOrZero(const CMathAngle& azimuth) { return azimuth.isNan() ? 0.0 : azimuth.getDeg(); }

}  // namespace

// Inside the alignment the centre-line point and its tangent; before the start the first element's start
// tangent prolonged backwards, after the end the last element's final tangent prolonged forwards. The offset
// is laid off square to the tangent (positive right); below tol::kOffsetZero the centre-line point is kept.
bool CAlntH::getPosNeAtChainAndOffsetExtr(double chainage, double offset, double& north, double& east,
                                          bool* extrapolated) const {
  CAlntAccessGuard guard(*this);
  if (std::isnan(chainage) || std::isnan(offset)) return false;
  double finalChainage = 0.0;
  if (!getFinalChainageInM(finalChainage)) return false;
  const double startChainage = getStoredStartChainageInM();
  C2dPos centre;
  double azimuthDeg = 0.0;
  bool outside = false;
  if (startChainage <= chainage && chainage <= finalChainage &&
      getPosNeAtChain(chainage, centre.north(), centre.east())) {
    if (!getAzimuthAtChain(chainage, azimuthDeg)) return false;
  } else {
    const bool before = chainage < finalChainage;
    const CAlntHe* end = before ? getFirstHe() : getLastHe();
    if (end == nullptr) return false;
    C2dPos endPos;
    CMathAngle azimuth;
    const bool ok = before ? end->getStartPosNe(endPos.north(), endPos.east()) && end->getStartAzimut(azimuth)
                           : end->getFinalPosNe(endPos.north(), endPos.east()) && end->getFinalAzimut(azimuth);
    if (!ok) return false;
    const double along = before ? -(startChainage - chainage) : chainage - finalChainage;
    centre = C2dPos(endPos.north() + along * azimuth.getCos(), endPos.east() + along * azimuth.getSin());
    azimuthDeg = degreesOrZero(azimuth);
    outside = true;
  }
  if (std::fabs(offset) >= svy_math::tol::kOffsetZero) {
    Compute2DPoint(centre.east(), centre.north(), std::fabs(offset), azimuthDeg,
                   offset > 0.0 ? svy_math::units::kRightAngleDeg : -svy_math::units::kRightAngleDeg,
                   centre.east(), centre.north());
  }
  north = centre.north();
  east = centre.east();
  if (extrapolated != nullptr) *extrapolated = outside;
  return true;
}

bool CAlntH::getAzimuthAtChainExtr(double chainage, double& azimuthDeg) const {
  CAlntAccessGuard guard(*this);
  if (std::isnan(chainage)) return false;
  if (getAzimuthAtChain(chainage, azimuthDeg)) return true;
  double finalChainage = 0.0;
  if (!getFinalChainageInM(finalChainage)) return false;
  const bool before = chainage < finalChainage;
  const CAlntHe* end = before ? getFirstHe() : getLastHe();
  CMathAngle azimuth;
  if (end == nullptr || !(before ? end->getStartAzimut(azimuth) : end->getFinalAzimut(azimuth))) return false;
  azimuthDeg = degreesOrZero(azimuth);
  return true;
}

bool CAlntH::getIpPosForElement(int index, double& north, double& east) const {
  CAlntAccessGuard guard(*this);
  const CAlntHe* element = getHe(index);
  return element != nullptr && element->getIpPos(north, east);
}

// ---- editing ----

void CAlntH::setStartPos(double north, double east, double /*third: a plan alignment has no height*/) {
  m_startNorth = north;
  m_startEast = east;
  if (!m_elements.empty()) doHPostUpdate(0);
}

void CAlntH::setStartChainageInM(double chainage) {
  CAlntBaseImpl::setStartChainageInM(chainage);
  doHPostUpdate(0);
}

void CAlntH::onBulkUpdateFinished() {
  CAlntBaseImpl::onBulkUpdateFinished();
  if (!m_elements.empty()) doHPostUpdate(0);
}

CAlntHe* CAlntH::CloneElement(const CAlntHe& element) const { return element.clone(); }

void CAlntH::doInsertHe(int index, CAlntHe* element) {
  m_elements.insert(m_elements.begin() + index, element);
  invalidateSearchIndex();
}

void CAlntH::doHPostUpdate(int index) {
  invalidateSearchIndex();
  if (isInBulkUpdate()) return;
  doInvalidateTotalLen();
  const int count = getNumOfElements();
  if (index >= count) return;
  for (int j = std::max(index - 1, 0); j < count; ++j) {
    CAlntHe* element = m_elements[static_cast<std::size_t>(j)];
    element->onSetIndex(*this, j);
  }
}

bool CAlntH::insertElement(int index, const CAlntHe& element) {
  if (index < 0 || index > getNumOfElements() || !element.isShapeOk()) return false;
  CAlntHe* copy = CloneElement(element);
  if (copy == nullptr) return false;
  doInsertHe(index, copy);
  doHPostUpdate(index);
  return true;
}

bool CAlntH::replaceElement(int index, const CAlntHe& element) {
  if (index < 0 || index >= getNumOfElements() || !element.isShapeOk()) return false;
  CAlntHe* copy = CloneElement(element);
  if (copy == nullptr) return false;
  std::swap(m_elements[static_cast<std::size_t>(index)], copy);
  delete copy;
  invalidateSearchIndex();
  doHPostUpdate(index);
  return true;
}

bool CAlntH::removeHe(int index) {
  if (index < 0 || index >= getNumOfElements()) return false;
  delete m_elements[static_cast<std::size_t>(index)];
  m_elements.erase(m_elements.begin() + index);
  invalidateSearchIndex();
  doInvalidateTotalLen();
  if (!m_elements.empty()) doHPostUpdate(std::max(index - 1, 0));
  return true;
}

// Appending keeps a known total length known: the cache becomes the old length plus the new element's,
// unless re-anchoring changed the length of the element before it (an intersection-point element, whose
// curve group depends on its successor), in which case the length is summed again on the next query.
bool CAlntH::appendElement(const CAlntHe& element) {
  if (!element.isShapeOk()) return false;
  CAlntHe* copy = CloneElement(element);
  if (copy == nullptr) return false;
  const double lengthBefore = internal_getTotalLengthAsItIs();
  const CAlntHe* previous = getLastHe();
  double previousBefore = svy_math::undefinedValue();
  if (previous != nullptr) previous->getHLengthInM(previousBefore);
  m_elements.push_back(copy);
  invalidateSearchIndex();
  doHPostUpdate(getNumOfElements() - 1);
  double previousAfter = svy_math::undefinedValue();
  if (previous != nullptr) previous->getHLengthInM(previousAfter);
  const bool previousKept = previous == nullptr || previousBefore == previousAfter;
  double added = 0.0;
  if (!svy_math::isUndefined(lengthBefore) && previousKept && copy->getHLengthInM(added)) {
    internal_setTotalLengthAsItIs(lengthBefore + added);
  }
  return true;
}

void CAlntH::removeAllHes() {
  deleteElements();
  doInvalidateTotalLen();
}
