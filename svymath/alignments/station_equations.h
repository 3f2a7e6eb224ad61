#pragma once
// Station equations: breaks in the displayed stationing of an alignment, where a station "back" (the last
// station of the stationing before the break) is re-labelled "ahead" (the first station after it), as
// after a re-alignment that lengthened or shortened the road without re-stationing all of it.
//
// Chainage here is the alignment's measured chainage (metres, continuous from the start chainage). Before
// the first break the displayed station equals the chainage. The breaks divide the alignment into regions
// 0 .. n: region k starts at the chainage of break k (k >= 1), where its station is ahead_k, and runs on
// metre for metre to the next break, where its station has reached back_(k+1). When ahead < back the
// stations just before the break occur again just after it (an overlap); when ahead > back some stations
// do not occur at all (a gap). A station in an overlap needs its region to name one point.
#include <vector>

#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/rtti.h"

// How a station was converted to a chainage.
enum EStationStatus : int {
  eStationOk = 0,
  eStationNotInRegion = 1,  // the station does not occur in the region asked for (or in any region: a gap)
  eStationAmbiguous = 2,    // the station occurs in several regions at different chainages: name the region
  eStationBadInput = 3,     // a non-finite station or a region that does not exist
};

class SVYMATH_API StationEquations : public virtual CRttiBase {
  SVY_RTTI_DECLARE(StationEquations)

 public:
  SVY_CLASS_NEW_DELETE

  StationEquations() = default;
  ~StationEquations() override;

  // Appends a break (stations in metres). It must come after the previous break: its back station beyond
  // the previous ahead station (so every region has a length). False, nothing changed, otherwise or for
  // non-finite values.
  bool addEquation(double backStation, double aheadStation);
  void removeAll() { m_breaks.clear(); }
  int getCount() const { return static_cast<int>(m_breaks.size()); }
  // Break i (0-based): its back and ahead stations and the chainage where it lies; false outside the list.
  bool getEquation(int index, double& backStation, double& aheadStation, double& chainage) const;
  int getRegionCount() const { return getCount() + 1; }

  // The displayed station of a chainage, and its region (a chainage at a break belongs to the region
  // after it). False for a non-finite chainage.
  bool chainageToStation(double chainage, double& station, int* region = nullptr) const;
  // The chainage of a station in a given region (region 0 reaches back without end, the last region
  // forward without end); the ends of a region, its ahead and next back stations, belong to it.
  EStationStatus stationToChainage(double station, int region, double& chainage) const;
  // The chainage of a station in whichever region holds it; ambiguous in an overlap, not found in a gap.
  EStationStatus stationToChainage(double station, double& chainage, int* region = nullptr) const;

 private:
  struct TBreak {
    double back;
    double ahead;
    double chainage;
  };
  // Region k's start chainage and start station (region 0: chainage 0 at station 0).
  void regionOrigin(int region, double& chainage, double& station) const;
  bool regionHolds(int region, double station) const;

  std::vector<TBreak> m_breaks;
};
