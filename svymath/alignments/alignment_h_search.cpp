// Point to chainage on a horizontal alignment: the nearest-element search, its extension beyond the ends,
// the approximate local inverse and the batch query through the spatial index.
#include <cmath>

#include "svymath/alignments/alignment_h.h"
#include "svymath/alignments/alignment_search_index.h"
#include "svymath/cogo/inverse_radiate.h"
#include "svymath/foundation/angle_functions.h"
#include "svymath/foundation/constants.h"

using svy_math::tol::kSnap;
using svy_math::tol::kZero;

namespace {

double zeroBelowTolerance(double x) { return -kZero < x && x < kZero ? 0.0 : x; }

// The point resolved along and square to the direction `azimuth` from `origin` (positive right).
void resolveAlongAcross(const C2dPos& origin, const CMathAngle& azimuth, double north, double east, double& along,
                        double& across) {
  const double dN = north - origin.north();
  const double dE = east - origin.east();
  along = zeroBelowTolerance(dN * azimuth.getCos() + dE * azimuth.getSin());
  across = zeroBelowTolerance(-dN * azimuth.getSin() + dE * azimuth.getCos());
}

void writeResult(const TAlntStationResult& result, double& chainage, double& offset, int* index, bool* atJoint) {
  chainage = result.chainage;
  offset = result.offset;
  if (index != nullptr) *index = result.index;
  if (atJoint != nullptr) *atJoint = result.atJoint;
}

}  // namespace

// Every element in order (or the candidates, in ascending order) offers the point's offset from it, or,
// where the point has no foot on it but lies in the wedge outside the kink it makes with its predecessor,
// the point's distance from the joint. An element wins when its offset is within tol::kSnap of the best so
// far (so a later element wins a tie; the wedge needs to be strictly nearer). Elements whose cheap distance
// bound already exceeds that are skipped without projecting.
bool CAlntH::findOnAlignment(double north, double east, const std::vector<int>* candidates,
                             TAlntStationResult& result, svy_math::detail::TAlntSearchTrace* trace) const {
  TAlntStationResult best;
  const std::size_t count = candidates != nullptr ? candidates->size() : m_elements.size();
  for (std::size_t k = 0; k < count; ++k) {
    const int i = candidates != nullptr ? (*candidates)[k] : static_cast<int>(k);
    const CAlntHe* element = m_elements[static_cast<std::size_t>(i)];
    double distance = 0.0;
    if (best.found && elementDistance(i, north, east, candidates != nullptr, distance) &&
        distance > std::fabs(best.offset) + kSnap) {
      continue;
    }
    double along = 0.0;
    double off = 0.0;
    if (elementFoot(i, north, east, candidates != nullptr, along, off)) {
      double chainage = 0.0;
      if ((!best.found || std::fabs(off) <= std::fabs(best.offset) + kSnap) &&
          element->distance2Chainage(along, chainage)) {
        best = TAlntStationResult{true, chainage, off, i, false, false};
        if (trace != nullptr) trace->onAccepted(std::fabs(off));
      }
      continue;
    }
    if (i == 0) continue;
    // The wedge outside a kink: past the end of the previous element and before the start of this one.
    const CAlntHe* previous = m_elements[static_cast<std::size_t>(i - 1)];
    CMathAngle previousAz;
    CMathAngle startAz;
    C2dPos joint;
    if (!previous->getFinalAzimut(previousAz) || !element->getStartAzimut(startAz) || previousAz == startAz ||
        !element->getStartPosNe(joint.north(), joint.east())) {
      continue;
    }
    const double dN = north - joint.north();
    const double dE = east - joint.east();
    const double u = zeroBelowTolerance(dN * previousAz.getCos() + dE * previousAz.getSin());
    const double v = zeroBelowTolerance(dN * startAz.getCos() + dE * startAz.getSin());
    if (!(u > 0.0 && v < 0.0)) continue;
    const double r = std::sqrt(dN * dN + dE * dE);
    double startChainage = 0.0;
    if ((!best.found || r < std::fabs(best.offset) + kSnap) && element->getStartChainageInM(startChainage)) {
      // A right turn leaves the wedge on the left of the alignment.
      const double turn = toRange(startAz.getRad() - previousAz.getRad(), -svy_math::units::kPi, svy_math::units::kPi);
      best = TAlntStationResult{true, startChainage, turn >= 0.0 ? -r : r, i, true, false};
      if (trace != nullptr) trace->onAccepted(r);
    }
  }
  if (best.found) result = best;
  return best.found;
}

bool CAlntH::elementDistance(int index, double north, double east, bool remembered, double& distance) const {
  const CAlntHe* element = m_elements[static_cast<std::size_t>(index)];
  if (!remembered) return element->getShortestDistanceToPoint(north, east, distance);
  svy_math::detail::TAlntElementAnswer& answer = m_searchIndex->answer(index);
  if (answer.distanceStamp != m_searchIndex->stamp()) {
    answer.distanceOk = element->getShortestDistanceToPoint(north, east, answer.distance);
    answer.distanceStamp = m_searchIndex->stamp();
  }
  distance = answer.distance;
  return answer.distanceOk;
}

bool CAlntH::elementFoot(int index, double north, double east, bool remembered, double& along, double& offset) const {
  const CAlntHe* element = m_elements[static_cast<std::size_t>(index)];
  if (!remembered) return element->getLengthAndOffset(north, east, along, offset);
  svy_math::detail::TAlntElementAnswer& answer = m_searchIndex->answer(index);
  if (answer.footStamp != m_searchIndex->stamp()) {
    answer.footOk = element->getLengthAndOffset(north, east, answer.along, answer.offset);
    answer.footStamp = m_searchIndex->stamp();
  }
  along = answer.along;
  offset = answer.offset;
  return answer.footOk;
}

// Beyond the start along the first element's start tangent, beyond the end along the last element's final
// tangent; an extension wins only when strictly nearer than what was found on the alignment.
bool CAlntH::extendBeyondEnds(double north, double east, bool found, TAlntStationResult& result) const {
  if (found) result.extrapolated = false;
  const CAlntHe* first = getFirstHe();
  C2dPos origin;
  CMathAngle azimuth;
  double along = 0.0;
  double across = 0.0;
  if (first != nullptr && first->getStartPosNe(origin.north(), origin.east()) && first->getStartAzimut(azimuth)) {
    resolveAlongAcross(origin, azimuth, north, east, along, across);
    if (along <= 0.0 && (!found || std::fabs(across) < std::fabs(result.offset))) {
      result = TAlntStationResult{true, distance2Chainage(along), across, 0, false, true};
      found = true;
    }
  }
  const CAlntHe* last = getLastHe();
  if (last == nullptr || !last->getFinalPosNe(origin.north(), origin.east()) || !last->getFinalAzimut(azimuth)) {
    return found;
  }
  resolveAlongAcross(origin, azimuth, north, east, along, across);
  // Behind the final point (or a point off the number line): no extension.
  if (!(along >= 0.0)) return found;
  double length = 0.0;
  if ((!found || std::fabs(across) < std::fabs(result.offset)) && getHLengthInM(length)) {
    result = TAlntStationResult{true, distance2Chainage(length + along), across, getNumOfElements() - 1, false, true};
    found = true;
  }
  return found;
}

bool CAlntH::FindChainageAndOffset(double north, double east, double& chainage, double& offset, int* index,
                                   bool* atJoint) const {
  CAlntAccessGuard guard(*this);
  TAlntStationResult result;
  if (!findPoint(north, east, false, result)) return false;
  writeResult(result, chainage, offset, index, atJoint);
  return true;
}

bool CAlntH::FindChainageAndOffset(double north, double east, double& chainage, double& offset,
                                   bool& extrapolated, int* index, bool* atJoint) const {
  CAlntAccessGuard guard(*this);
  TAlntStationResult result;
  if (!findPoint(north, east, true, result)) return false;
  writeResult(result, chainage, offset, index, atJoint);
  extrapolated = result.extrapolated;
  return true;
}

// The tangent at the approximate chainage (on the extension beyond the ends when it lies outside), and the
// point resolved along and across it: a first-order inverse, good near the approximate chainage.
bool CAlntH::FindApproxChainageAndOffset(double approxChainage, double north, double east, double& chainage,
                                         double& offset) const {
  CAlntAccessGuard guard(*this);
  if (m_elements.empty()) return false;
  double distance = 0.0;
  const CAlntHe* element = findHeAtChain(approxChainage, &distance, nullptr);
  double azimuthDeg = 0.0;
  C2dPos onLine;
  if (element == nullptr || !element->getAzimuthAtLength(distance, azimuthDeg) ||
      !element->getPosNeAtLength(distance, onLine.north(), onLine.east())) {
    if (!getAzimuthAtChainExtr(approxChainage, azimuthDeg) ||
        !getPosNeAtChainExtr(approxChainage, onLine.north(), onLine.east())) {
      return false;
    }
  }
  double along = 0.0;
  double across = 0.0;
  double unusedHeight = 0.0;
  const int resolved =
      dENSoutInfo(north - onLine.north(), east - onLine.east(), 0.0, -azimuthDeg, along, across, unusedHeight);
  chainage = resolved != 0 ? approxChainage + along : approxChainage;
  offset = across;
  return true;
}

// ---- through the spatial index ----

bool CAlntH::findPoint(double north, double east, bool withExtension, TAlntStationResult& result) const {
  const bool found =
      m_useSearchIndex ? findThroughIndex(north, east, result) : findOnAlignment(north, east, nullptr, result, nullptr);
  return withExtension ? extendBeyondEnds(north, east, found, result) : found;
}

// The search over the elements near the point gives the full search's answer once no element outside the
// searched square could have been accepted after the nearest offer was taken. Every element outside offers
// more than the radius (its box, grown by tol::kSearchIndexMargin, lies beyond it), so the smallest offer
// lies inside, and the one search and the other, identical from the moment it is accepted, stay so while
// the best value held since then stays below the radius by tol::kSnap (the tie margin). Otherwise the radius
// grows; at worst every element is searched.
bool CAlntH::findThroughIndex(double north, double east, TAlntStationResult& result) const {
  using namespace svy_math::tol;
  if (!m_searchIndex) {
    std::vector<C2dMinMax> boxes;
    boxes.reserve(m_elements.size());
    for (const CAlntHe* element : m_elements) boxes.push_back(element->getBoundary());
    m_searchIndex.reset(new svy_math::detail::CAlntSearchIndex(boxes));
  }
  m_searchIndex->beginPoint();
  const C2dPos point(north, east);
  // A point off the number line is left to the plain scan, which finds nothing for it.
  double radius = std::isfinite(north) && std::isfinite(east)
                      ? m_searchIndex->nearestDistance(point) + kSearchStartRadius
                      : svy_math::undefinedValue();
  for (int step = 0;; ++step) {
    const std::vector<int>* candidates =
        std::isfinite(radius) && step < kSearchRadiusDoublings ? &m_searchIndex->collect(point, radius) : nullptr;
    if (candidates == nullptr || candidates->size() >= m_elements.size()) {
      return findOnAlignment(north, east, nullptr, result, nullptr);
    }
    svy_math::detail::TAlntSearchTrace trace;
    TAlntStationResult local;
    if (findOnAlignment(north, east, candidates, local, &trace) && trace.maxSinceMin + kSnap < radius) {
      result = local;
      return true;
    }
    radius = std::fmax(2.0 * radius, trace.maxSinceMin + 2.0 * kSnap);
  }
}

std::size_t CAlntH::FindChainagesAndOffsets(const double* north, const double* east, std::size_t count,
                                            TAlntStationResult* results, bool withExtension) const {
  if (north == nullptr || east == nullptr || results == nullptr) return 0;
  CAlntAccessGuard guard(*this);
  std::size_t found = 0;
  for (std::size_t k = 0; k < count; ++k) {
    TAlntStationResult& result = results[k];
    result = TAlntStationResult();
    if (findPoint(north[k], east[k], withExtension, result)) {
      ++found;
    } else {
      result = TAlntStationResult();
    }
  }
  return found;
}
