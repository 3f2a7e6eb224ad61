#pragma once
// The chainages a surveyor sets out along an alignment pair, in order: the regular stations (every multiple
// of the pair's chainage interval), the transition points of the horizontal alignment (TS, SC, CS, ST, PC,
// PT and the other element joints), the starts and ends of the vertical curves and the other joints of the
// profile, the high and low points of the vertical curves, and the two ends of the range walked.
//
// Points closer than 1 mm (tol::kSnap) are one point: it keeps the chainage of its most specific member
// (a transition or vertical curve point before a high or low point, that before a regular station, that
// before an end of the range) and carries the kinds of all of them.
#include <vector>

#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"

class CHorzAndVertAlntBase;

// What a chainage point is: a combination of these bits.
enum EChainagePointKind : unsigned {
  eChainageRangeStart = 1u << 0,
  eChainageRangeEnd = 1u << 1,
  eChainageStation = 1u << 2,    // a multiple of the chainage interval
  eChainageTS = 1u << 3,         // tangent to spiral
  eChainageSC = 1u << 4,         // spiral to circular arc
  eChainageCS = 1u << 5,         // circular arc to spiral
  eChainageST = 1u << 6,         // spiral to tangent
  eChainagePC = 1u << 7,         // tangent to circular arc (point of curvature)
  eChainagePT = 1u << 8,         // circular arc to tangent (point of tangency)
  eChainageHorzJoint = 1u << 9,  // any joint of horizontal elements (also the others: arc to arc, ...)
  eChainageVertCurveStart = 1u << 10,  // start of a vertical curve (VPC)
  eChainageVertCurveEnd = 1u << 11,    // end of a vertical curve (VPT)
  eChainageVertJoint = 1u << 12,       // any joint of vertical elements (grade breaks included)
  eChainageHighPoint = 1u << 13,
  eChainageLowPoint = 1u << 14,
};

struct SVYMATH_API TChainagePoint {
  double chainage;  // metres
  unsigned kinds;   // EChainagePointKind bits
};

class SVYMATH_API CChainageIteratorBase {
 public:
  SVY_CLASS_NEW_DELETE

  // The points of the whole pair (its start chainage to its final chainage); none when it has no end.
  explicit CChainageIteratorBase(const CHorzAndVertAlntBase& pair);
  // The points from `start` to `end` (metres; none when end < start or either is not finite).
  CChainageIteratorBase(const CHorzAndVertAlntBase& pair, double start, double end);
  virtual ~CChainageIteratorBase();

  // ---- walking ----
  void rewind() { m_current = 0; }
  bool isDone() const { return m_current >= m_points.size(); }
  const TChainagePoint& current() const { return m_points[m_current]; }
  void next() { ++m_current; }

  // ---- all at once ----
  const std::vector<TChainagePoint>& getPoints() const { return m_points; }

 protected:
  // Collects, sorts and merges the points of the range.
  void build(const CHorzAndVertAlntBase& pair, double start, double end);

 private:
  std::vector<TChainagePoint> m_points;
  std::size_t m_current = 0;
};
