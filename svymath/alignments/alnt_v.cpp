#include "svymath/alignments/alnt_v.h"

#include <cmath>

#include "svymath/alignments/vertical_ls_element.h"
#include "svymath/alignments/vertical_ls_with_arc.h"
#include "svymath/foundation/constants.h"

using svy_math::isUndefined;
using svy_math::units::kPercent;

SVY_RTTI_DEFINE(CVertAlntBase, CAlntBase)
SVY_RTTI_DEFINE2(CAlntV, CVertAlntBase, CAlntBaseImpl)

namespace {

// The kinds whose place is fixed by their intersection points.
bool isDefinedByPoints(const CAlntVe& element) {
  return element.getType() == eAlntVeLs || element.getType() == eAlntVeLsWithArc;
}

}  // namespace

CVertAlntBase::~CVertAlntBase() = default;

// A vertical alignment holds vertical elements only.
const CAlntVe* CVertAlntBase::getVe(int index) const { return static_cast<const CAlntVe*>(getElement(index)); }

CAlntV::CAlntV() : m_startHeight(svy_math::undefinedValue()) {}

CAlntV::CAlntV(const CAlntV& other)
    : CRttiBase(), CAlntBase(other), CVertAlntBase(other), CAlntBaseImpl(other), m_startHeight(other.m_startHeight) {
  for (const CAlntVe* element : other.m_elements) m_elements.push_back(element->clone());
  m_index.rebuild(*this);
}

CAlntV& CAlntV::operator=(const CAlntV& other) {
  if (this != &other) copy(other);
  return *this;
}

CAlntV::~CAlntV() { removeAllVes(); }

void CAlntV::copy(const CAlntV& other) {
  if (this == &other) return;
  removeAllVes();
  CAlntBaseImpl::copy(other);
  m_startHeight = other.m_startHeight;
  for (const CAlntVe* element : other.m_elements) m_elements.push_back(element->clone());
  m_index.rebuild(*this);
}

double CAlntV::getStartChainageInM() const {
  CLsInfo info;
  if (!m_elements.empty() && isDefinedByPoints(*m_elements.front()) && m_elements.front()->getAsLs(info)) {
    return info.ipChainage;
  }
  return getStoredStartChainageInM();
}

double CAlntV::getStartPosH() const {
  CLsInfo info;
  if (!m_elements.empty() && isDefinedByPoints(*m_elements.front()) && m_elements.front()->getAsLs(info)) {
    return info.ipHeight;
  }
  return m_startHeight;
}

bool CAlntV::getFinalChainageInM(double& chainage) const {
  double length = 0.0;
  if (!getHLengthInM(length)) return false;
  chainage = getStartChainageInM() + length;
  return true;
}

bool CAlntV::getHLengthInM(double& length) const { return getCachedTotalHLength(length); }

bool CAlntV::doObtainTotalHLength(double& length) const {
  length = 0.0;
  for (const CAlntVe* element : m_elements) {
    double elementLength = 0.0;
    if (!element->getHLengthInM(elementLength)) return false;
    length += elementLength;
  }
  return true;
}

double CAlntV::distance2Chainage(double distance) const { return distance + getStartChainageInM(); }

double CAlntV::chainage2Distance(double chainage) const { return chainage - getStartChainageInM(); }

int CAlntV::getNumOfElements() const { return static_cast<int>(m_elements.size()); }

const CAlntElBase* CAlntV::getElement(int index) const {
  if (index < 0 || index >= getNumOfElements()) return nullptr;
  return m_elements[static_cast<std::size_t>(index)];
}

CAlntVe* CAlntV::getVe(int index) {
  if (index < 0 || index >= getNumOfElements()) return nullptr;
  return m_elements[static_cast<std::size_t>(index)];
}

bool CAlntV::getFinalHeight(double& height) const {
  if (m_elements.empty()) return false;
  const double h = m_elements.back()->getFinalHt();
  if (isUndefined(h)) return false;
  height = h;
  return true;
}

const CAlntVe* CAlntV::getVertElemAtChain(double chainage, double* distanceInElement, int* index) const {
  double distance = 0.0;
  const int i = m_index.find(*this, chainage, &distance);
  if (i < 0) return nullptr;
  if (distanceInElement != nullptr) *distanceInElement = distance;
  if (index != nullptr) *index = i;
  return m_elements[static_cast<std::size_t>(i)];
}

const CAlntVe* CAlntV::getAlntVeAtChain(double chainage, double* distanceInElement) const {
  return getVertElemAtChain(chainage, distanceInElement, nullptr);
}

bool CAlntV::getHeightAtChain(double chainage, double& height) const {
  double distance = 0.0;
  const CAlntVe* element = getVertElemAtChain(chainage, &distance);
  return element != nullptr && element->getHtAtLen(distance, height) == eVeHtOk;
}

bool CAlntV::getGradeAtChainage(double chainage, double& grade) const {
  double distance = 0.0;
  const CAlntVe* element = getVertElemAtChain(chainage, &distance);
  return element != nullptr && element->getGradeAtLength(distance, grade);
}

bool CAlntV::getHeightAtChainExtr(double chainage, double& height, bool& extrapolated) const {
  if (getHeightAtChain(chainage, height)) {
    extrapolated = false;
    return true;
  }
  double finalChainage = 0.0;
  // A chainage off the number line has no height, not an infinite one.
  if (!std::isfinite(chainage) || m_elements.empty() || !getFinalChainageInM(finalChainage)) return false;
  double h = 0.0;
  const double distance = chainage2Distance(chainage);
  if (chainage < finalChainage) {
    // Before the start: back along the first grade from the start height.
    h = getStartPosH() + m_elements.front()->getStartGrade() * distance / kPercent;
  } else {
    double finalHeight = 0.0;
    if (!getFinalHeight(finalHeight)) return false;
    h = finalHeight + m_elements.back()->getEndGrade() * (distance - chainage2Distance(finalChainage)) / kPercent;
  }
  if (isUndefined(h)) return false;
  height = h;
  extrapolated = true;
  return true;
}

bool CAlntV::getHeightAtChainExtr(double chainage, double& height) const {
  bool extrapolated = false;
  return getHeightAtChainExtr(chainage, height, extrapolated);
}

void CAlntV::setStartPos(double /*north*/, double /*east*/, double height) { setStartHeight(height); }

void CAlntV::setStartHeight(double height) {
  m_startHeight = height;
  if (!m_elements.empty()) doVPostUpdate(-1);
}

void CAlntV::setStartChainageInM(double chainage) {
  CAlntBaseImpl::setStartChainageInM(chainage);
  if (!m_elements.empty()) doVPostUpdate(-1);
}

void CAlntV::onBulkUpdateFinished() {
  CAlntBaseImpl::onBulkUpdateFinished();
  if (!m_elements.empty()) doVPostUpdate(0);
}

void CAlntV::anchorFirstToStart() {
  CAlntVe* first = m_elements.front();
  const double start = getStoredStartChainageInM();
  if (CVerticalLSElement* byPoints = CVerticalLSElement::cast(first)) {
    byPoints->setCurrLSElement(CLsInfo(start, m_startHeight, 0.0, 0.0, 0.0));
  } else if (CAlntVeLsWithArc* withArc = CAlntVeLsWithArc::cast(first)) {
    withArc->setIpAndR(start, m_startHeight, 0.0);
  } else {
    first->setStartHtAndChain(m_startHeight, start);
  }
}

void CAlntV::doVPostUpdate(int index) {
  const int count = getNumOfElements();
  if (!isInBulkUpdate()) {
    doInvalidateTotalLen();
    if (count > index) {
      int from = index > 0 ? index - 1 : index;
      if (from < 0) {
        anchorFirstToStart();
        from = 0;
      } else if (from == 0) {
        // The first element gets its own reported start chainage back (see the file comment).
        m_elements.front()->setStartHtAndChain(m_startHeight, getStartChainageInM());
      }
      for (int k = from; k < count; ++k) {
        m_elements[static_cast<std::size_t>(k)]->onNeighbourUpdate(
            k > 0 ? m_elements[static_cast<std::size_t>(k - 1)] : nullptr,
            k + 1 < count ? m_elements[static_cast<std::size_t>(k + 1)] : nullptr);
      }
    }
  }
  m_index.rebuild(*this);
}

CAlntVe* CAlntV::CloneElement(const CAlntVe& element) const { return element.clone(); }

bool CAlntV::checkIfOk(int previousIndex, int nextIndex, const CAlntVe& candidate) const {
  const double length = candidate.getLen();
  if (!std::isfinite(length) || length < 0.0) return false;
  if (!isDefinedByPoints(candidate)) return true;
  CLsInfo point;
  if (!candidate.getAsLs(point) || !std::isfinite(point.ipChainage) || !std::isfinite(point.ipHeight)) return false;
  CLsInfo neighbour;
  const CAlntVe* previous = getVe(previousIndex);
  if (previous != nullptr && isDefinedByPoints(*previous) && previous->getAsLs(neighbour) &&
      !(neighbour.ipChainage < point.ipChainage)) {
    return false;
  }
  const CAlntVe* next = getVe(nextIndex);
  return next == nullptr || !isDefinedByPoints(*next) || !next->getAsLs(neighbour) ||
         point.ipChainage < neighbour.ipChainage;
}

void CAlntV::doInsertVe(int index, CAlntVe* element) {
  m_elements.insert(m_elements.begin() + index, element);
}

bool CAlntV::appendElement(const CAlntVe& element) {
  const int count = getNumOfElements();
  if (!checkIfOk(count - 1, -1, element)) return false;
  CAlntVe* copy = CloneElement(element);
  if (copy == nullptr) return false;
  m_elements.push_back(copy);
  doVPostUpdate(count);
  return true;
}

bool CAlntV::insertElement(int index, const CAlntVe& element) {
  if (index < 0 || index > getNumOfElements() || !checkIfOk(index - 1, index, element)) return false;
  CAlntVe* copy = CloneElement(element);
  if (copy == nullptr) return false;
  doInsertVe(index, copy);
  doVPostUpdate(index);
  return true;
}

bool CAlntV::replaceElement(int index, const CAlntVe& element) {
  if (index < 0 || index >= getNumOfElements() || !checkIfOk(index - 1, index + 1, element)) return false;
  CAlntVe* copy = CloneElement(element);
  if (copy == nullptr) return false;
  delete m_elements[static_cast<std::size_t>(index)];
  m_elements[static_cast<std::size_t>(index)] = copy;
  doVPostUpdate(index);
  return true;
}

bool CAlntV::removeVe(int index) {
  if (index < 0 || index >= getNumOfElements()) return false;
  delete m_elements[static_cast<std::size_t>(index)];
  m_elements.erase(m_elements.begin() + index);
  if (!m_elements.empty()) {
    doVPostUpdate(index > 0 ? index - 1 : 0);
  } else {
    doInvalidateTotalLen();
    m_index.rebuild(*this);
  }
  return true;
}

void CAlntV::removeAllVes() {
  for (CAlntVe* element : m_elements) delete element;
  m_elements.clear();
  doInvalidateTotalLen();
  m_index.rebuild(*this);
}
