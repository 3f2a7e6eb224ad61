#include "svymath/area/alignment_area.h"

#include <cmath>

#include "svymath/alignments/horz_element_arc.h"
#include "svymath/alignments/horz_element_segment.h"
#include "svymath/area/boundary_cut.h"
#include "svymath/area/polygon_area.h"
#include "svymath/area/polygon_predicates.h"
#include "svymath/area/subdivision.h"
#include "svymath/cogo/inverse_radiate.h"
#include "svymath/foundation/constants.h"

namespace {

TCoords planCoords(double north, double east) {
  TCoords c;
  c.north = north;
  c.east = east;
  c.mask = TCoords::kNorthValid | TCoords::kEastValid;
  return c;
}

TCoords planCoords(const C2dPos& p) { return planCoords(p.north(), p.east()); }

bool segmentOfElement(const CAlntHe& element, AreaSegment& segment) {
  if (const CAlntHeSegment* line = CAlntHeSegment::cast(&element)) {
    double n0 = 0.0, e0 = 0.0, n1 = 0.0, e1 = 0.0;
    if (!line->getStartPosNe(n0, e0) || !line->getFinalPosNe(n1, e1)) return false;
    segment = AreaSegment(planCoords(n0, e0), planCoords(n1, e1));
    return true;
  }
  if (const CAlntHeArc* arcElement = CAlntHeArc::cast(&element)) {
    CArc arc;
    C2dPos end;
    if (!arcElement->getArc(arc) || !arc.get_end_pos(end)) return false;
    segment = AreaSegment(planCoords(arc.start), planCoords(end), planCoords(arc.center), !arc.clockwise);
    return true;
  }
  return false;
}

bool boundaryOf(const CHorzAndVertAlnt& alignment, svy_list<AreaSegment>& list) {
  return boGetAreaSegmentListFromAlignment(alignment, list);
}

}  // namespace

bool boGetAreaSegmentListFromAlignment(const CAlntH& alignment, svy_list<AreaSegment>& list) {
  svy_list<AreaSegment> result;
  for (int i = 0; i < alignment.getNumOfHes(); ++i) {
    const CAlntHe* element = alignment.getHe(i);
    AreaSegment segment;
    if (element == nullptr || !segmentOfElement(*element, segment)) return false;
    result.push_back(segment);
  }
  if (result.empty()) return false;
  const TCoords first = result.front().start;
  const TCoords last = result.back().end;
  if (std::hypot(last.north - first.north, last.east - first.east) > svy_math::tol::kAreaPoint)
    result.emplace_back(last, first);
  else
    result.back().end = first;
  list = std::move(result);
  return true;
}

bool boSetAlignmentFromAreaSegmentList(const svy_list<AreaSegment>& list, CAlntH& alignment) {
  alignment.removeAllHes();
  if (list.empty()) return false;
  alignment.setStartPos(list.front().start.north, list.front().start.east, 0.0);
  for (const AreaSegment& s : list) {
    if (s.boIsArc()) {
      CArc arc;
      CAlntHeArc element;
      if (!arc.set_start_center_finish(s.start.pos(), s.center.pos(), s.end.pos(), !s.counterClockwise) ||
          !element.setArc(arc))
        return false;
      element.setStartAzFixed();
      if (!alignment.appendElement(element)) return false;
    } else {
      CAlntHeSegment element(s.start, s.end);
      element.setStartAzFixed();
      if (!alignment.appendElement(element)) return false;
    }
  }
  return true;
}

bool computePolygonArea(const CHorzAndVertAlnt& alignment, double* area) {
  svy_list<AreaSegment> list;
  if (!boundaryOf(alignment, list) || eDoAreaSegmentsCross(list, false) != eAreaCalcOk) return false;
  return eComputePolygonArea(list, area) == eAreaCalcOk;
}

bool computePolygonPerimeter(const CHorzAndVertAlnt& alignment, double& perimeter) {
  svy_list<AreaSegment> list;
  return boundaryOf(alignment, list) && boComputePolygonPerimeter(list, perimeter);
}

bool solveKnownAreaParallelLineTask(double area, CHorzAndVertAlnt& boundary, C2dPos linePoint1, C2dPos linePoint2,
                                    CHorzAndVertAlnt& piece, C2dPos& cutPoint1, C2dPos& cutPoint2) {
  svy_list<AreaSegment> list;
  double azimuth = 0.0;
  const TCoords p1 = planCoords(linePoint1);
  if (!boundaryOf(boundary, list) || !boComputeAzimuthBetweenCoords(p1, planCoords(linePoint2), azimuth))
    return false;
  const bool pieceOnLeft = !boIsPolygonLeftOfLine(list, p1, azimuth);
  svy_list<AreaSegment> pieceList;
  svy_list<AreaSegment> rest;
  TCoords cutStart;
  TCoords cutEnd;
  if (eSubdivideSegmentList(azimuth, area, pieceOnLeft, list, &pieceList, &rest, &cutStart, &cutEnd) !=
      eAreaCalcSubdivided)
    return false;
  const unsigned plan = TCoords::kNorthValid | TCoords::kEastValid;
  if ((cutStart.mask & plan) != plan || (cutEnd.mask & plan) != plan) return false;
  cutPoint1 = cutStart.pos();
  cutPoint2 = cutEnd.pos();
  return boSetAlignmentFromAreaSegmentList(pieceList, piece);
}

bool solveKnownAreaHingePointTask(C2dPos hinge, double area, CHorzAndVertAlnt& boundary, bool againstDirection,
                                  CHorzAndVertAlnt& piece, C2dPos& cutPoint) {
  svy_list<AreaSegment> list;
  if (!boundaryOf(boundary, list)) return false;
  if (againstDirection) {
    svy_list<AreaSegment> reversed;
    if (!boReorderSegmentList(list, list.front().start, true, &reversed)) return false;
    list = std::move(reversed);
  }
  TCoords noDirection;
  noDirection.mask = 0;
  svy_list<AreaSegment> pieceList;
  svy_list<AreaSegment> rest;
  TCoords cutEnd;
  if (eSubdivideSegmentList(planCoords(hinge), noDirection, area, list, &pieceList, &rest, &cutEnd) !=
      eAreaCalcSubdivided)
    return false;
  cutPoint = cutEnd.pos();
  return boSetAlignmentFromAreaSegmentList(pieceList, piece);
}
