#include "svymath/road/offset_ts.h"

#include <algorithm>
#include <cmath>

#include "svymath/alignments/horz_alignment_base.h"
#include "svymath/alignments/horz_element_base.h"
#include "svymath/foundation/constants.h"
#include "svymath/road/offset_plane.h"
#include "svymath/road/offset_stations.h"

SVY_RTTI_DEFINE(Offsets4TS, CRttiBase)

Offsets4TS::Offsets4TS(const CHorzAlntBase& alignment, double offset)
    : Offsets4TS(alignment, alignment.getStartChainageInM(), offset, alignment.getStartChainageInM(), offset) {}

Offsets4TS::Offsets4TS(const CHorzAlntBase& alignment, double startChainage, double startOffset,
                       double endChainage, double endOffset)
    : m_alignment(&alignment),
      m_startChainage(startChainage),
      m_startOffset(startOffset),
      m_endChainage(endChainage),
      m_endOffset(endOffset),
      m_ok(false) {
  m_ok = std::isfinite(startChainage) && std::isfinite(endChainage) && endChainage >= startChainage &&
         std::isfinite(startOffset) && std::isfinite(endOffset) && alignment.getNumOfElements() > 0 &&
         checkCentres();
}

Offsets4TS::~Offsets4TS() = default;

bool Offsets4TS::checkCentres() const {
  // 1 - offset * k is linear in the offset: clearing the centres with the smallest and the largest offset
  // over an element clears them with every offset between.
  for (int i = 0; i < m_alignment->getNumOfElements(); ++i) {
    const auto* element = static_cast<const CHorzAlntElemBase*>(m_alignment->getElement(i));
    double start = 0.0, end = 0.0;
    if (!element->getStartChainageInM(start) || !element->getFinalChainageInM(end)) return false;
    double low = std::min(getOffsetAtChain(start), getOffsetAtChain(end));
    double high = std::max(getOffsetAtChain(start), getOffsetAtChain(end));
    for (double c : {m_startChainage, m_endChainage}) {
      if (c > start && c < end) {
        low = std::min(low, getOffsetAtChain(c));
        high = std::max(high, getOffsetAtChain(c));
      }
    }
    if (!PlaneOffset::boClearsCentres(*element, low, low) || !PlaneOffset::boClearsCentres(*element, high, high)) {
      return false;
    }
  }
  return true;
}

double Offsets4TS::getOffsetAtChain(double chainage) const {
  if (!std::isfinite(chainage)) return svy_math::undefinedValue();
  if (chainage <= m_startChainage) return m_startOffset;
  if (chainage >= m_endChainage) return m_endOffset;
  const double t = (chainage - m_startChainage) / (m_endChainage - m_startChainage);
  return m_startOffset + t * (m_endOffset - m_startOffset);
}

bool Offsets4TS::getPosNeAtChain(double chainage, double& north, double& east) const {
  double n = 0.0, e = 0.0;
  if (!m_ok || !m_alignment->getPosNeAtChain(chainage, n, e)) return false;
  return m_alignment->getPosNeAtChainAndOffsetExtr(chainage, getOffsetAtChain(chainage), north, east);
}

bool Offsets4TS::getAzimuthAtChain(double chainage, double& azimuthDeg) const {
  double base = 0.0, curvature = 0.0;
  if (!m_ok || !m_alignment->getAzimuthAtChain(chainage, base) ||
      !m_alignment->getCurvatureAtChainage(chainage, curvature)) {
    return false;
  }
  const bool ramp = chainage > m_startChainage && chainage < m_endChainage;
  const double slope = ramp ? (m_endOffset - m_startOffset) / (m_endChainage - m_startChainage) : 0.0;
  // d/dc of base + offset * normal = (1 - offset * k) tangent + offset' normal (the normal points right).
  const double turn = std::atan2(slope, 1.0 - getOffsetAtChain(chainage) * curvature);
  azimuthDeg = base + turn * svy_math::units::kRadToDeg;
  return true;
}

bool Offsets4TS::getChainageAndOffset(double north, double east, double& chainage, double& offset) const {
  double c = 0.0, o = 0.0;
  if (!m_ok || !m_alignment->FindChainageAndOffset(north, east, c, o)) return false;
  chainage = c;
  offset = o - getOffsetAtChain(c);
  return true;
}

bool Offsets4TS::getPoints(double interval, std::vector<TOffsetAlntPoint>& points) const {
  double end = 0.0;
  std::vector<double> chainages;
  if (!m_ok || !m_alignment->getFinalChainageInM(end) ||
      !svy_math::StakeOutChainages(*m_alignment, m_alignment->getStartChainageInM(), end, interval,
                                   {m_startChainage, m_endChainage}, chainages)) {
    return false;
  }
  std::vector<TOffsetAlntPoint> result;
  result.reserve(chainages.size());
  for (double c : chainages) {
    TOffsetAlntPoint point{c, getOffsetAtChain(c), 0.0, 0.0};
    if (!m_alignment->getPosNeAtChainAndOffsetExtr(c, point.offset, point.north, point.east)) return false;
    result.push_back(point);
  }
  points.swap(result);
  return true;
}
