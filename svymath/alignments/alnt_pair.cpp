#include "svymath/alignments/alnt_pair.h"

#include <algorithm>
#include <cmath>

SVY_RTTI_DEFINE(CHorzAndVertAlntBase, CRttiBase)
SVY_RTTI_DEFINE2(CHorzAndVertAlnt, CAlntH, CHorzAndVertAlntBase)

namespace {

// The end of one alignment, when it has elements and a known length.
bool endOf(const CAlntBase& alignment, double& chainage) {
  return alignment.getNumOfElements() > 0 && alignment.getFinalChainageInM(chainage);
}

}  // namespace

CHorzAndVertAlntBase::~CHorzAndVertAlntBase() = default;

bool CHorzAndVertAlntBase::getFinalChainageInM(double& chainage) const {
  double horizontalEnd = 0.0;
  double verticalEnd = 0.0;
  const bool horizontal = endOf(getHorzAlnt(), horizontalEnd);
  const bool vertical = endOf(getVertAlnt(), verticalEnd);
  if (!horizontal && !vertical) return false;
  double end = horizontal ? (vertical ? std::min(horizontalEnd, verticalEnd) : horizontalEnd) : verticalEnd;
  chainage = std::max(end, getHorzAlnt().getStartChainageInM());
  return true;
}

bool CHorzAndVertAlntBase::getPosHAtChain(double chainage, double& height) const {
  return getVertAlnt().getHeightAtChain(chainage, height);
}

bool CHorzAndVertAlntBase::getPosHAtChainExtr(double chainage, double& height) const {
  return getVertAlnt().getHeightAtChainExtr(chainage, height);
}

bool CHorzAndVertAlntBase::getGradeAtChainage(double chainage, double& grade) const {
  return getVertAlnt().getGradeAtChainage(chainage, grade);
}

double CHorzAndVertAlntBase::getStartPosH() const { return getVertAlnt().getStartPosH(); }

bool CHorzAndVertAlntBase::getFinalPosH(double& height) const { return getVertAlnt().getFinalHeight(height); }

const CAlntVe* CHorzAndVertAlntBase::getVertElemAtChain(double chainage, double* distanceInElement,
                                                        int* index) const {
  return getVertAlnt().getVertElemAtChain(chainage, distanceInElement, index);
}

int CHorzAndVertAlntBase::getNumOfVes() const { return getVertAlnt().getNumOfVes(); }

const CAlntVe* CHorzAndVertAlntBase::getVe(int index) const { return getVertAlnt().getVe(index); }

const CAlntVe* CHorzAndVertAlntBase::getFirstVe() const { return getVertAlnt().getFirstVe(); }

const CAlntVe* CHorzAndVertAlntBase::getLastVe() const { return getVertAlnt().getLastVe(); }

void CHorzAndVertAlntBase::getStartPos(TCoords& position) const {
  position.north = getHorzAlnt().getStartPosN();
  position.east = getHorzAlnt().getStartPosE();
  position.height = getStartPosH();
  position.mask = (std::isnan(position.north) ? 0u : unsigned{TCoords::kNorthValid}) |
                  (std::isnan(position.east) ? 0u : unsigned{TCoords::kEastValid}) |
                  (std::isnan(position.height) ? 0u : unsigned{TCoords::kHeightValid});
}

bool CHorzAndVertAlntBase::getPosAtChain(double chainage, TCoords& position) const {
  const bool plan = getHorzAlnt().getPosNeAtChain(chainage, position.north, position.east);
  const bool height = getPosHAtChain(chainage, position.height);
  if (plan) position.mask |= TCoords::kNorthValid | TCoords::kEastValid;
  if (height) position.mask |= TCoords::kHeightValid;
  return plan || height;
}

bool CHorzAndVertAlntBase::getPosAtChainAndOffset(double chainage, double offset, double& north,
                                                  double& east) const {
  double n = 0.0;
  double e = 0.0;
  bool extrapolated = true;
  if (!getHorzAlnt().getPosNeAtChainAndOffsetExtr(chainage, offset, n, e, &extrapolated) || extrapolated) {
    return false;
  }
  north = n;
  east = e;
  return true;
}

bool CHorzAndVertAlntBase::getPosAtChainAndOffset(double chainage, double offset, TCoords& position) const {
  const bool plan = getPosAtChainAndOffset(chainage, offset, position.north, position.east);
  const bool height = getPosHAtChain(chainage, position.height);
  if (plan) position.mask |= TCoords::kNorthValid | TCoords::kEastValid;
  if (height) position.mask |= TCoords::kHeightValid;
  return plan || height;
}

CHorzAndVertAlnt::CHorzAndVertAlnt() : m_chainageInterval(100.0) {}

CHorzAndVertAlnt::CHorzAndVertAlnt(const CHorzAndVertAlnt& other)
    : CRttiBase(),
      CAlntBase(other),
      CHorzAlntBase(other),
      CAlntH(other),
      CHorzAndVertAlntBase(other),
      m_chainageInterval(other.m_chainageInterval),
      m_vertical(other.m_vertical) {}

CHorzAndVertAlnt& CHorzAndVertAlnt::operator=(const CHorzAndVertAlnt& other) {
  if (this != &other) {
    CAlntH::operator=(other);
    m_chainageInterval = other.m_chainageInterval;
    m_vertical = other.m_vertical;
  }
  return *this;
}

CHorzAndVertAlnt::~CHorzAndVertAlnt() = default;

void CHorzAndVertAlnt::removeAll() {
  removeAllHes();
  m_vertical.removeAllVes();
}

void CHorzAndVertAlnt::setStartPos(double north, double east, double height) {
  CAlntH::setStartPos(north, east, height);
  m_vertical.setStartHeight(height);
}

void CHorzAndVertAlnt::setStartChainageInM(double chainage) {
  CAlntH::setStartChainageInM(chainage);
  m_vertical.setStartChainageInM(chainage);
}
