#include "svymath/alignments/station_equations.h"

#include <cmath>

#include "svymath/foundation/constants.h"

SVY_RTTI_DEFINE(StationEquations, CRttiBase)

StationEquations::~StationEquations() = default;

bool StationEquations::addEquation(double backStation, double aheadStation) {
  if (!std::isfinite(backStation) || !std::isfinite(aheadStation)) return false;
  double startChainage = 0.0;
  double startStation = 0.0;
  regionOrigin(getCount(), startChainage, startStation);
  if (!m_breaks.empty() && !(backStation > startStation)) return false;
  m_breaks.push_back(TBreak{backStation, aheadStation, startChainage + (backStation - startStation)});
  return true;
}

bool StationEquations::getEquation(int index, double& backStation, double& aheadStation, double& chainage) const {
  if (index < 0 || index >= getCount()) return false;
  const TBreak& b = m_breaks[static_cast<std::size_t>(index)];
  backStation = b.back;
  aheadStation = b.ahead;
  chainage = b.chainage;
  return true;
}

void StationEquations::regionOrigin(int region, double& chainage, double& station) const {
  if (region <= 0) {
    chainage = 0.0;
    station = 0.0;
    return;
  }
  const TBreak& b = m_breaks[static_cast<std::size_t>(region - 1)];
  chainage = b.chainage;
  station = b.ahead;
}

bool StationEquations::chainageToStation(double chainage, double& station, int* region) const {
  if (!std::isfinite(chainage)) return false;
  int k = getCount();
  while (k > 0 && chainage < m_breaks[static_cast<std::size_t>(k - 1)].chainage) --k;
  double originChainage = 0.0;
  double originStation = 0.0;
  regionOrigin(k, originChainage, originStation);
  station = originStation + (chainage - originChainage);
  if (region != nullptr) *region = k;
  return true;
}

bool StationEquations::regionHolds(int region, double station) const {
  const bool aboveStart = region == 0 || station >= m_breaks[static_cast<std::size_t>(region - 1)].ahead;
  const bool belowEnd = region == getCount() || station <= m_breaks[static_cast<std::size_t>(region)].back;
  return aboveStart && belowEnd;
}

EStationStatus StationEquations::stationToChainage(double station, int region, double& chainage) const {
  if (!std::isfinite(station) || region < 0 || region > getCount()) return eStationBadInput;
  if (!regionHolds(region, station)) return eStationNotInRegion;
  double originChainage = 0.0;
  double originStation = 0.0;
  regionOrigin(region, originChainage, originStation);
  chainage = originChainage + (station - originStation);
  return eStationOk;
}

// A station at a break that is both back and ahead station (a null equation) names one chainage from two
// regions: that is not ambiguous.
EStationStatus StationEquations::stationToChainage(double station, double& chainage, int* region) const {
  if (!std::isfinite(station)) return eStationBadInput;
  int found = -1;
  double foundChainage = 0.0;
  for (int k = 0; k <= getCount(); ++k) {
    double candidate = 0.0;
    if (stationToChainage(station, k, candidate) != eStationOk) continue;
    if (found >= 0 && std::fabs(candidate - foundChainage) > svy_math::tol::kSnap) return eStationAmbiguous;
    if (found < 0) {
      found = k;
      foundChainage = candidate;
    }
  }
  if (found < 0) return eStationNotInRegion;
  chainage = foundChainage;
  if (region != nullptr) *region = found;
  return eStationOk;
}
