#include "svymath/road/offset_points.h"

#include "svymath/alignments/horz_alignment_base.h"
#include "svymath/road/offset_stations.h"

SVY_RTTI_DEFINE(OffsetPoints, CRttiBase)

OffsetPoints::OffsetPoints(const CHorzAlntBase& alignment) : m_alignment(&alignment) {}

OffsetPoints::~OffsetPoints() = default;

void OffsetPoints::addPoint(double chainage, double offset) {
  m_points.push_back(TStakeOutPoint{chainage, offset, 0.0, 0.0, false});
}

bool OffsetPoints::addStations(double from, double to, double interval, const std::vector<double>& offsets) {
  std::vector<double> chainages;
  if (!svy_math::StakeOutChainages(*m_alignment, from, to, interval, {}, chainages)) return false;
  for (double chainage : chainages) {
    for (double offset : offsets) addPoint(chainage, offset);
  }
  return true;
}

int OffsetPoints::compute() {
  int found = 0;
  for (TStakeOutPoint& point : m_points) {
    double north = 0.0, east = 0.0;
    bool extrapolated = true;
    point.found = m_alignment->getPosNeAtChainAndOffsetExtr(point.chainage, point.offset, north, east, &extrapolated) &&
                  !extrapolated;
    if (point.found) {
      point.north = north;
      point.east = east;
      ++found;
    }
  }
  return found;
}

const TStakeOutPoint* OffsetPoints::getPoint(int index) const {
  return index >= 0 && index < getNumOfPoints() ? &m_points[static_cast<std::size_t>(index)] : nullptr;
}
