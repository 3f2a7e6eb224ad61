#include "svymath/road/road_base.h"

#include <algorithm>
#include <cmath>

#include "svymath/foundation/constants.h"
#include "svymath/road/road_log.h"
#include "svyutils/svy_err_log.h"

SVY_RTTI_DEFINE(CRoadBase, CHorzAndVertAlntBase)

CRoadBase::CRoadBase() = default;
CRoadBase::CRoadBase(const CRoadBase& other)
    : CRttiBase(), CHorzAndVertAlntBase(other), m_stringCache(other.m_stringCache) {}
CRoadBase& CRoadBase::operator=(const CRoadBase& other) {
  m_stringCache = other.m_stringCache;
  return *this;
}
CRoadBase::~CRoadBase() = default;

bool CRoadBase::getFinalChainageInM(double& chainage) const {
  return CHorzAndVertAlntBase::getFinalChainageInM(chainage);
}
double CRoadBase::distance2Chainage(double distance) const { return getStartChainageInM() + distance; }
double CRoadBase::chainage2Distance(double chainage) const { return chainage - getStartChainageInM(); }
double CRoadBase::getStartPosN() const { return getHorzAlnt().getStartPosN(); }
double CRoadBase::getStartPosE() const { return getHorzAlnt().getStartPosE(); }
bool CRoadBase::getFinalPosNe(double& north, double& east) const { return getHorzAlnt().getFinalPosNe(north, east); }
bool CRoadBase::getPosNeAtChain(double chainage, double& north, double& east) const {
  return getHorzAlnt().getPosNeAtChain(chainage, north, east);
}
bool CRoadBase::getHtAtChain(double chainage, double& height) const {
  return CHorzAndVertAlntBase::getPosHAtChain(chainage, height);
}
bool CRoadBase::getAzimuthAtChain(double chainage, double& azimuthDeg) const {
  return getHorzAlnt().getAzimuthAtChain(chainage, azimuthDeg);
}
bool CRoadBase::getPosNeAtChainExtr(double chainage, double& north, double& east, bool& extrapolated) const {
  return getHorzAlnt().getPosNeAtChainExtr(chainage, north, east, extrapolated);
}
bool CRoadBase::getPosNeAtChainAndOffsetExtr(double chainage, double offset, double& north, double& east,
                                             bool* extrapolated) const {
  return getHorzAlnt().getPosNeAtChainAndOffsetExtr(chainage, offset, north, east, extrapolated);
}
bool CRoadBase::getAzimuthAtChainExtr(double chainage, double& azimuthDeg) const {
  return getHorzAlnt().getAzimuthAtChainExtr(chainage, azimuthDeg);
}
const CHorzAlntElemBase* CRoadBase::getHorzElemAtChain(double chainage, double* distanceInElement, int* index) const {
  return getHorzAlnt().getHorzElemAtChain(chainage, distanceInElement, index);
}
bool CRoadBase::getPosAtChainAndOffset(double chainage, double offset, double& north, double& east) const {
  return CHorzAndVertAlntBase::getPosAtChainAndOffset(chainage, offset, north, east);
}
int CRoadBase::getNumOfVes() const { return CHorzAndVertAlntBase::getNumOfVes(); }
double CRoadBase::getStartPosH() const { return CHorzAndVertAlntBase::getStartPosH(); }
bool CRoadBase::getFinalPosH(double& height) const { return CHorzAndVertAlntBase::getFinalPosH(height); }
bool CRoadBase::getPosHAtChain(double chainage, double& height) const {
  return CHorzAndVertAlntBase::getPosHAtChain(chainage, height);
}
bool CRoadBase::getPosHAtChainExtr(double chainage, double& height) const {
  return CHorzAndVertAlntBase::getPosHAtChainExtr(chainage, height);
}
const CAlntVe* CRoadBase::getVertElemAtChain(double chainage, double* distanceInElement, int* index) const {
  return CHorzAndVertAlntBase::getVertElemAtChain(chainage, distanceInElement, index);
}

bool CRoadBase::hasSurfaceByTemplates() const {
  return getSectTemplSet() != nullptr && getSectTemplSet()->getNumOfAssignments() > 0;
}
bool CRoadBase::hasSurfaceByStrings() const {
  return getRoadStringSet() != nullptr && getRoadStringSet()->getNumOfStrings() > 0;
}
bool CRoadBase::hasSurfaceDefinition() const { return hasSurfaceByTemplates() || hasSurfaceByStrings(); }
bool CRoadBase::hasCorridorLeftOffset() const { return !std::isnan(getCorridorLeftOffset()); }
bool CRoadBase::hasCorridorRightOffset() const { return !std::isnan(getCorridorRightOffset()); }

bool CRoadBase::getHtAtChainAndOffset(double chainage, double offset, double& height, bool useCrossSection,
                                      double* slopePercent) const {
  CRoadCrossSection* section = nullptr;
  if (useCrossSection && getCrossSectionAtChainage(chainage, section, true)) {
    double ratio = 0.0;
    bool found = false;
    if (section->getElevationAtOffs(offset, height, &ratio)) {
      found = true;
    } else if (section->hasPoints()) {
      // At or beyond the outermost points the nearer one's height, level. (At the rightmost point's offset
      // there is no segment to its right, and at the leftmost one's the lookup passes it over.)
      const CRoadCrossSectPoint* left = section->getLeftMostPoint();
      const CRoadCrossSectPoint* right = section->getRightMostPoint();
      const CRoadCrossSectPoint* end = offset >= right->getOffset()  ? right
                                       : offset <= left->getOffset() ? left
                                                                     : nullptr;
      if (end != nullptr) {
        height = end->getElevation();
        ratio = 0.0;
        found = true;
      }
    }
    delete section;
    if (found && slopePercent != nullptr) *slopePercent = ratio * svy_math::units::kPercent;
    return found;
  }
  if (slopePercent != nullptr) *slopePercent = 0.0;
  return getHtAtChain(chainage, height);
}

bool CRoadBase::get3DPosAtChainAndOffset(double chainage, double offset, double& north, double& east, double& height,
                                         bool useCrossSection, double* slopePercent) const {
  const bool plan = getPosAtChainAndOffset(chainage, offset, north, east);
  const bool elevation = getHtAtChainAndOffset(chainage, offset, height, useCrossSection, slopePercent);
  return plan && elevation;
}

bool CRoadBase::generateStringCache() {
  m_stringCache.removeAll();
  const double start = getStartChainageInM();
  double end = 0.0;
  if (!hasSurfaceDefinition() || !getFinalChainageInM(end) || !std::isfinite(start) || !(end > start)) return false;

  // The stations: the regular ones from the start, every template assignment on the road, and the end.
  svy_vector<double> stations;
  const double interval = getChainageIntervalInM();
  if (interval > 0.0 && (end - start) / interval < svy_math::limits::kMaxChainageStations) {
    for (double k = 0.0; start + k * interval < end; k += 1.0) stations.push_back(start + k * interval);
  } else {
    stations.push_back(start);
  }
  if (const CXsSf* templates = getSectTemplSet()) {
    for (int i = 0; i < templates->getNumOfAssignments(); ++i) {
      const double c = templates->getAssignmentChainage(i);
      if (c > start && c < end) stations.push_back(c);
    }
  }
  stations.push_back(end);
  std::sort(stations.begin(), stations.end());
  stations.erase(
      std::unique(stations.begin(), stations.end(), [](double a, double b) { return b - a < svy_math::tol::kSnap; }),
      stations.end());

  // A string per point name and occurrence: the n-th point of a name from the left at every station (names
  // repeat on the two sides of a section).
  struct TStringKey {
    svy_text::CSvyString name;
    int occurrence;
    int index;
  };
  svy_vector<TStringKey> keys;
  for (double c : stations) {
    CRoadCrossSection* section = nullptr;
    if (!getCrossSectionAtChainage(c, section, false)) continue;
    for (const CRoadCrossSectPoint* p = section->getLeftMostPoint(); p != nullptr; p = p->getRight()) {
      int occurrence = 0;
      for (const CRoadCrossSectPoint* q = section->getLeftMostPoint(); q != p; q = q->getRight()) {
        occurrence += q->getName() == p->getName() ? 1 : 0;
      }
      auto key = std::find_if(keys.begin(), keys.end(), [&](const TStringKey& k) {
        return k.occurrence == occurrence && k.name == p->getName();
      });
      if (key == keys.end()) {
        keys.push_back(TStringKey{p->getName(), occurrence,
                                  m_stringCache.addString(CRoadString(p->getName(), p->getFeatureIndex()))});
        key = keys.end() - 1;
      }
      // The stations increase, so a refused vertex means a section point that is not a number.
      if (!m_stringCache.getString(key->index)->addVertex(c, p->getOffset(), p->getElevation())) {
        svy_logging::svy_err_log(svy_math::kRoadTemplLogSource, __LINE__, "");
      }
    }
    delete section;
  }
  return m_stringCache.getNumOfStrings() > 0;
}
