#include "svymath/road/cross_section.h"

#include <cmath>

#include "svymath/foundation/constants.h"

SVY_RTTI_DEFINE(CRoadCrossSection, CRttiBase)
SVY_RTTI_DEFINE(CEditableRoadCrossSection, CRoadCrossSection)

CRoadCrossSection::CRoadCrossSection(double chainage)
    : m_hasClElevation(false),
      m_clElevation(svy_math::undefinedValue()),
      m_clElevationExtrapolated(false),
      m_chainage(chainage) {
  init();
}

CRoadCrossSection::CRoadCrossSection(double chainage, double clElevation, bool clElevationExtrapolated)
    : m_hasClElevation(true),
      m_clElevation(clElevation),
      m_clElevationExtrapolated(clElevationExtrapolated),
      m_chainage(chainage) {
  init();
}

// No points, the centre line at the origin with azimuth 0 and zero vectors (no direction until an azimuth
// is set), not extrapolated, version 0.
void CRoadCrossSection::init() {
  m_leftMost = nullptr;
  m_rightMost = nullptr;
  m_clPos = C2dPos();
  m_azimuth = CMathAngle(0.0);
  m_along = C2dPos();
  m_across = C2dPos();
  m_clPosExtrapolated = false;
  m_cacheVersion = 0;
}

CRoadCrossSection::~CRoadCrossSection() { deleteAllPoints(); }

C2dPos CRoadCrossSection::getPosAtOffset(double offset) const {
  return C2dPos(m_clPos.north() + offset * m_across.north(), m_clPos.east() + offset * m_across.east());
}

bool CRoadCrossSection::getElevationAtOffs(double offset, double& elevation, double* slopeRatio) const {
  const CRoadCrossSectPoint* left = getLeftOfOffset(offset);
  if (left == nullptr || left->getRight() == nullptr) return false;
  const double z = left->getElevationFromSurfaceRight(offset);
  if (std::isnan(z)) return false;
  elevation = z;
  if (slopeRatio != nullptr) *slopeRatio = left->getSlopeRatio(*left->getRight());
  return true;
}

bool CRoadCrossSection::getElevationAtOffsSlope(double offset, double& elevation, double& slopeRatio) const {
  if (getElevationAtOffs(offset, elevation, &slopeRatio)) return true;
  if (m_leftMost == nullptr || m_leftMost == m_rightMost || std::isnan(offset)) return false;
  const CRoadCrossSectPoint& inner = offset <= m_leftMost->getOffset() ? *m_leftMost : *m_rightMost->getLeft();
  const double z = inner.getElevationFromSurfaceRight(offset);
  if (std::isnan(z)) return false;
  elevation = z;
  slopeRatio = inner.getSlopeRatio(*inner.getRight());
  return true;
}

bool CRoadCrossSection::getSlopeRatioAtOffset(double offset, double& slopeRatio) const {
  double elevation = 0.0;
  return getElevationAtOffs(offset, elevation, &slopeRatio);
}

const CRoadCrossSectPoint* CRoadCrossSection::findPointWithId(unsigned featureIndex) const {
  for (const CRoadCrossSectPoint* p = m_leftMost; p != nullptr; p = p->getRight()) {
    if (p->getFeatureIndex() == featureIndex) return p;
  }
  return nullptr;
}

const CRoadCrossSectPoint* CRoadCrossSection::findPointFromNameAndOffs(const svy_text::CSvyString& name,
                                                                       double offset) const {
  const CRoadCrossSectPoint* best = nullptr;
  double bestDistance = 0.0;
  for (const CRoadCrossSectPoint* p = m_leftMost; p != nullptr; p = p->getRight()) {
    if (!(p->getName() == name)) continue;
    const double distance = std::fabs(p->getOffset() - offset);
    if (best == nullptr || distance < bestDistance) {
      best = p;
      bestDistance = distance;
    }
  }
  return best;
}

const CRoadCrossSectPoint* CRoadCrossSection::getPointAtIndex(int index) const {
  if (index < 0) return nullptr;
  const CRoadCrossSectPoint* p = m_leftMost;
  for (int i = 0; p != nullptr && i < index; ++i) p = p->getRight();
  return p;
}

const CRoadCrossSectPoint* CRoadCrossSection::findCenterPoint() const {
  for (const CRoadCrossSectPoint* p = m_leftMost; p != nullptr; p = p->getRight()) {
    if (std::fabs(p->getOffset()) < svy_math::tol::kOffsetZero) return p;
  }
  return nullptr;
}

int CRoadCrossSection::getNumOfPoints() const {
  int count = 0;
  for (const CRoadCrossSectPoint* p = m_leftMost; p != nullptr; p = p->getRight()) ++count;
  return count;
}

void CRoadCrossSection::setClElevation(double elevation, bool extrapolated) {
  m_hasClElevation = true;
  m_clElevation = elevation;
  m_clElevationExtrapolated = extrapolated;
  ++m_cacheVersion;
}

const CRoadCrossSectPoint* CRoadCrossSection::getLeftOfOffset(double offset) const {
  if (m_leftMost == nullptr || std::isnan(offset) || offset < m_leftMost->getOffset()) return nullptr;
  if (offset > m_rightMost->getOffset()) return m_rightMost;
  if (std::fabs(offset - m_rightMost->getOffset()) <= std::fabs(offset - m_leftMost->getOffset())) {
    const CRoadCrossSectPoint* p = m_rightMost;
    while (p != nullptr && p->getOffset() > offset) p = p->getLeft();
    return p;
  }
  if (m_leftMost->getOffset() >= offset) return nullptr;
  const CRoadCrossSectPoint* p = m_leftMost;
  while (p->getRight() != nullptr && p->getRight()->getOffset() < offset) p = p->getRight();
  return p;
}

const CRoadCrossSectPoint* CRoadCrossSection::getRightOfOffset(double offset) const {
  if (m_leftMost == nullptr || std::isnan(offset) || offset > m_rightMost->getOffset()) return nullptr;
  if (offset < m_leftMost->getOffset()) return m_leftMost;
  if (std::fabs(offset - m_leftMost->getOffset()) <= std::fabs(offset - m_rightMost->getOffset())) {
    const CRoadCrossSectPoint* p = m_leftMost;
    while (p != nullptr && p->getOffset() < offset) p = p->getRight();
    return p;
  }
  if (m_rightMost->getOffset() <= offset) return nullptr;
  const CRoadCrossSectPoint* p = m_rightMost;
  while (p->getLeft() != nullptr && p->getLeft()->getOffset() > offset) p = p->getLeft();
  return p;
}

bool CRoadCrossSection::canAdopt(const CRoadCrossSectPoint& point) const {
  return point.m_section == nullptr && !std::isnan(point.getOffset());
}

void CRoadCrossSection::adopt(CRoadCrossSectPoint& point, CRoadCrossSectPoint* left, CRoadCrossSectPoint* right) {
  point.m_section = this;
  point.m_left = left;
  point.m_right = right;
  (left != nullptr ? left->m_right : m_leftMost) = &point;
  (right != nullptr ? right->m_left : m_rightMost) = &point;
  ++m_cacheVersion;
}

bool CRoadCrossSection::addToLeft(CRoadCrossSectPoint& point) {
  if (!canAdopt(point) || (m_leftMost != nullptr && point.getOffset() > m_leftMost->getOffset())) return false;
  adopt(point, nullptr, m_leftMost);
  return true;
}

bool CRoadCrossSection::addToRight(CRoadCrossSectPoint& point) {
  if (!canAdopt(point) || (m_rightMost != nullptr && point.getOffset() < m_rightMost->getOffset())) return false;
  adopt(point, m_rightMost, nullptr);
  return true;
}

bool CRoadCrossSection::insertByOffset(CRoadCrossSectPoint& point) {
  if (!canAdopt(point)) return false;
  // Points come mostly in order, so the place is sought from the right end.
  CRoadCrossSectPoint* left = m_rightMost;
  while (left != nullptr && left->getOffset() > point.getOffset()) left = left->m_left;
  adopt(point, left, left != nullptr ? left->m_right : m_leftMost);
  return true;
}

void CRoadCrossSection::deleteAllPoints() {
  while (m_leftMost != nullptr) delete m_leftMost;
}

void CRoadCrossSection::onPointDetaching(CRoadCrossSectPoint& point) {
  (point.m_left != nullptr ? point.m_left->m_right : m_leftMost) = point.m_right;
  (point.m_right != nullptr ? point.m_right->m_left : m_rightMost) = point.m_left;
  point.m_section = nullptr;
  point.m_left = nullptr;
  point.m_right = nullptr;
  ++m_cacheVersion;
}

void CRoadCrossSection::setChainage(double chainage) {
  m_chainage = chainage;
  ++m_cacheVersion;
}

void CRoadCrossSection::setCenterLinePos(const C2dPos& position, bool extrapolated) {
  m_clPos = position;
  m_clPosExtrapolated = extrapolated;
  ++m_cacheVersion;
}

void CRoadCrossSection::setCenterLineAzimuth(const CMathAngle& azimuth) {
  m_azimuth = azimuth;
  m_along = C2dPos(azimuth.getCos(), azimuth.getSin());
  m_across = C2dPos(-azimuth.getSin(), azimuth.getCos());
  ++m_cacheVersion;
}

CEditableRoadCrossSection::~CEditableRoadCrossSection() = default;

bool CEditableRoadCrossSection::addPoint(double offset, double elevation, const svy_text::CSvyString& name,
                                         unsigned featureIndex) {
  if (std::isnan(offset)) return false;
  return insertByOffset(*new CRoadCrossSectOffsPoint(offset, elevation, name, featureIndex));
}
