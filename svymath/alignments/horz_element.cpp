#include "svymath/alignments/horz_element.h"

#include "svymath/alignments/horz_alignment_base.h"
#include "svymath/alignments/horz_element_visitor.h"
#include "svymath/curves/generic_intersections.h"
#include "svymath/curves/generic_arc.h"
#include "svymath/curves/generic_line.h"
#include "svymath/curves/generic_segment.h"
#include "svymath/curves/generic_spiral.h"
#include "svymath/curves/generic_segment_visitor.h"
#include "svymath/foundation/constants.h"

SVY_RTTI_DEFINE(CAlntHe, CRttiBase)

CAlntHeVisitor::~CAlntHeVisitor() = default;
CAlntHeVisitor_const::~CAlntHeVisitor_const() = default;

CAlntHe::~CAlntHe() = default;

bool CAlntHe::isok() const { return CAlntElemImpl::isok() && isShapeOk(); }

void CAlntHe::getAnchor(const CHorzAlntBase& alignment, int index, double& chainage, C2dPos& start,
                        CMathAngle& azimuth) {
  const double undefined = svy_math::undefinedValue();
  chainage = 0.0;
  start = C2dPos(undefined, undefined);
  azimuth.reset();
  if (index < 1) {
    chainage = alignment.getStartChainageInM();
    start = C2dPos(alignment.getStartPosN(), alignment.getStartPosE());
    return;
  }
  const CHorzAlntElemBase* previous = alignment.getHe(index - 1);
  if (previous == nullptr) return;
  double north = 0.0;
  double east = 0.0;
  if (!previous->getFinalPosNe(north, east)) return;
  start = C2dPos(north, east);
  double finalChainage = 0.0;
  if (!previous->getFinalChainageInM(finalChainage)) return;
  chainage = finalChainage;
  previous->getFinalAzimut(azimuth);
}

bool CAlntHe::getIpPos(double& north, double& east) const {
  C2dPos start;
  C2dPos end;
  CMathAngle startAz;
  CMathAngle endAz;
  C2dPos ip;
  if (!getStartPosNe(start.north(), start.east()) || !getFinalPosNe(end.north(), end.east()) ||
      !getStartAzimut(startAz) || !getFinalAzimut(endAz) ||
      !svy_math::detail::intersectRays(start, startAz, end, endAz, ip)) {
    return false;
  }
  north = ip.north();
  east = ip.east();
  return true;
}

namespace {

// Collects the plan extent of the segments handed to it.
class CBoundaryCollector : public CGenericSegmentVisitor_const {
 public:
  void Visit(const CGenericLine& line) override { add(line); }
  void Visit(const CGenericArc& arc) override { add(arc); }
  void Visit(const CGenericSpiral& spiral) override { add(spiral); }
  const C2dMinMax& boundary() const { return m_boundary; }

 private:
  void add(const CGenericSegment& segment) { m_boundary.include(segment.getBoundary()); }
  C2dMinMax m_boundary;
};

}  // namespace

C2dMinMax CAlntHe::getBoundary() const {
  CBoundaryCollector collector;
  ForEachSegment(collector);
  return collector.boundary();
}
