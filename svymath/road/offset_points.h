#pragma once
// A stake-out list: points at given offsets (metres, positive right) from a horizontal alignment at given
// chainages, with their plan positions (northing, easting, metres). Points are added one by one or as a run
// of stations (every multiple of an interval, every element joint and the ends of the run) with one point per
// offset at each; compute() fills the positions. A point whose chainage lies off the alignment keeps
// found == false. The alignment is read, not owned: the caller keeps it alive.
#include <vector>

#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/rtti.h"

class CHorzAlntBase;

struct SVYMATH_API TStakeOutPoint {
  double chainage;
  double offset;
  double north;
  double east;
  bool found;  // false until compute() places it on the alignment
};

class SVYMATH_API OffsetPoints : public virtual CRttiBase {
  SVY_RTTI_DECLARE(OffsetPoints)

 public:
  SVY_CLASS_NEW_DELETE

  explicit OffsetPoints(const CHorzAlntBase& alignment);
  ~OffsetPoints() override;

  void addPoint(double chainage, double offset);
  // The stations of the run from `from` to `to` (see StakeOutChainages), each with every offset in order;
  // false (nothing added) for a run or interval it refuses.
  bool addStations(double from, double to, double interval, const std::vector<double>& offsets);
  void removeAll() { m_points.clear(); }

  // Places every point; returns how many lie on the alignment.
  int compute();

  int getNumOfPoints() const { return static_cast<int>(m_points.size()); }
  // Point i, or null out of range.
  const TStakeOutPoint* getPoint(int index) const;

 private:
  const CHorzAlntBase* m_alignment;
  std::vector<TStakeOutPoint> m_points;
};
