#include "svymath/alignments/chainage_iterator.h"

#include <algorithm>
#include <cmath>

#include "svymath/alignments/alnt_pair.h"
#include "svymath/alignments/vertical_arc.h"
#include "svymath/alignments/vertical_element.h"
#include "svymath/alignments/vertical_ls_element.h"
#include "svymath/alignments/vertical_ls_with_arc.h"
#include "svymath/alignments/vertical_visitor.h"
#include "svymath/foundation/constants.h"

namespace {

// When two points merge, the chainage of the more specific one is kept.
enum EPriority : int { ePriorityRangeEnd = 0, ePriorityStation = 1, ePriorityExtremum = 2, ePriorityGeometry = 3 };

struct TCandidate {
  double chainage;
  unsigned kinds;
  int priority;
};

class CCandidates {
 public:
  CCandidates(double start, double end) : m_start(start), m_end(end) {}
  void add(double chainage, unsigned kinds, int priority) {
    if (chainage >= m_start && chainage <= m_end) m_items.push_back({chainage, kinds, priority});
  }
  std::vector<TCandidate>& items() { return m_items; }

 private:
  double m_start;
  double m_end;
  std::vector<TCandidate> m_items;
};

// The kind of the joint between two horizontal elements (-1: none on that side, the alignment's end).
unsigned horizontalJoint(int before, int after) {
  unsigned kinds = eChainageHorzJoint;
  const bool tangentBefore = before == eAlntHeSegment || before < 0;
  const bool tangentAfter = after == eAlntHeSegment || after < 0;
  if (tangentBefore && after == eAlntHeSpiral) kinds |= eChainageTS;
  if (before == eAlntHeSpiral && after == eAlntHeArc) kinds |= eChainageSC;
  if (before == eAlntHeArc && after == eAlntHeSpiral) kinds |= eChainageCS;
  if (before == eAlntHeSpiral && tangentAfter) kinds |= eChainageST;
  if (tangentBefore && after == eAlntHeArc) kinds |= eChainagePC;
  if (before == eAlntHeArc && tangentAfter) kinds |= eChainagePT;
  return kinds;
}

// The vertical curves of the profile's elements: their ends and their high or low points.
class CVerticalCurvePoints : public CAlntVeVisitor_const {
 public:
  explicit CVerticalCurvePoints(CCandidates& candidates) : m_candidates(candidates) {}

  void Visit(const CVerticalElement& element) override {
    double chainage = 0.0;
    double height = 0.0;
    bool isMax = false;
    if (!element.isParabola() || !(element.getLen() > 0.0)) return;
    addEnds(element);
    if (element.getParabolaExtremum(chainage, height, isMax)) addExtremum(chainage, isMax);
  }
  void Visit(const CAlntVeArc& element) override {
    double chainage = 0.0;
    double height = 0.0;
    bool isMax = false;
    if (element.isSimplePoint() || !(element.getLen() > 0.0)) return;
    addEnds(element);
    if (element.getExtremum(chainage, height, isMax)) addExtremum(chainage, isMax);
  }
  void Visit(const CVerticalLSElement& element) override {
    if (element.isValid()) Visit(element.getParabola());
  }
  void Visit(const CAlntVeLsWithArc& element) override {
    if (element.isValid()) Visit(element.getArc());
  }

 private:
  void addEnds(const CAlntVe& curve) {
    double start = 0.0;
    double end = 0.0;
    if (!curve.getStartChainageInM(start) || !curve.getFinalChainageInM(end)) return;
    m_candidates.add(start, eChainageVertCurveStart, ePriorityGeometry);
    m_candidates.add(end, eChainageVertCurveEnd, ePriorityGeometry);
  }
  void addExtremum(double chainage, bool isMax) {
    m_candidates.add(chainage, isMax ? eChainageHighPoint : eChainageLowPoint, ePriorityExtremum);
  }

  CCandidates& m_candidates;
};

void addStations(CCandidates& candidates, double start, double end, double interval) {
  if (!(interval > 0.0) || !std::isfinite(interval)) return;
  const double first = std::ceil(start / interval);
  const double last = std::floor(end / interval);
  for (double k = first; k <= last && k - first < svy_math::limits::kMaxChainageStations; k += 1.0) {
    candidates.add(k * interval, eChainageStation, ePriorityStation);
  }
}

void addHorizontal(CCandidates& candidates, const CHorzAlntBase& horizontal) {
  const int count = horizontal.getNumOfElements();
  for (int i = 0; i < count; ++i) {
    const CHorzAlntElemBase* element = horizontal.getHe(i);
    const int type = element->getType();
    double start = 0.0;
    double end = 0.0;
    if (element->getStartChainageInM(start)) {
      candidates.add(start, horizontalJoint(i > 0 ? horizontal.getHe(i - 1)->getType() : -1, type),
                     ePriorityGeometry);
    }
    if (i + 1 == count && element->getFinalChainageInM(end)) {
      candidates.add(end, horizontalJoint(type, -1), ePriorityGeometry);
    }
  }
}

void addVertical(CCandidates& candidates, const CVertAlntBase& vertical) {
  CVerticalCurvePoints curves(candidates);
  for (int i = 0; i < vertical.getNumOfVes(); ++i) {
    const CAlntVe* element = vertical.getVe(i);
    double start = 0.0;
    double end = 0.0;
    if (element->getStartChainageInM(start)) candidates.add(start, eChainageVertJoint, ePriorityGeometry);
    if (element->getFinalChainageInM(end)) candidates.add(end, eChainageVertJoint, ePriorityGeometry);
    element->Accept(curves);
  }
}

}  // namespace

CChainageIteratorBase::CChainageIteratorBase(const CHorzAndVertAlntBase& pair) {
  double end = 0.0;
  if (pair.getFinalChainageInM(end)) build(pair, pair.getHorzAlnt().getStartChainageInM(), end);
}

CChainageIteratorBase::CChainageIteratorBase(const CHorzAndVertAlntBase& pair, double start, double end) {
  build(pair, start, end);
}

CChainageIteratorBase::~CChainageIteratorBase() = default;

void CChainageIteratorBase::build(const CHorzAndVertAlntBase& pair, double start, double end) {
  m_points.clear();
  m_current = 0;
  if (!std::isfinite(start) || !std::isfinite(end) || end < start) return;
  CCandidates candidates(start, end);
  candidates.add(start, eChainageRangeStart, ePriorityRangeEnd);
  candidates.add(end, eChainageRangeEnd, ePriorityRangeEnd);
  addStations(candidates, start, end, pair.getChainageIntervalInM());
  addHorizontal(candidates, pair.getHorzAlnt());
  addVertical(candidates, pair.getVertAlnt());
  std::vector<TCandidate>& items = candidates.items();
  std::stable_sort(items.begin(), items.end(),
                   [](const TCandidate& a, const TCandidate& b) { return a.chainage < b.chainage; });
  // Merge runs of points less than the snap apart; the most specific member gives the chainage.
  int priority = -1;
  double previous = -HUGE_VAL;
  for (const TCandidate& item : items) {
    if (m_points.empty() || !(item.chainage - previous < svy_math::tol::kSnap)) {
      m_points.push_back({item.chainage, item.kinds});
      priority = item.priority;
    } else {
      m_points.back().kinds |= item.kinds;
      if (item.priority > priority) {
        m_points.back().chainage = item.chainage;
        priority = item.priority;
      }
    }
    previous = item.chainage;
  }
}
