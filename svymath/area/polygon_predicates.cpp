#include "svymath/area/polygon_predicates.h"

#include <algorithm>
#include <cmath>
#include <numeric>
#include <vector>

#include "svymath/area/area_geometry.h"
#include "svymath/area/area_support.h"
#include "svymath/area/polygon_area.h"
#include "svymath/foundation/constants.h"
#include "svyutils/svy_err_log.h"

namespace tol = svy_math::tol;
using svy_math::detail::bulgeSide;

namespace {

// Line of the log entry for two arcs on one circle that do not meet end to start.
constexpr int kLogLineArcsApart = 1466;

double planDistance(const TCoords& a, const TCoords& b) { return std::hypot(a.north - b.north, a.east - b.east); }
bool samePoint(const TCoords& a, const TCoords& b) { return planDistance(a, b) <= tol::kAreaPoint; }

// Whether p is a vertex where one of the two segments ends and the other starts.
bool atSharedEnd(const TCoords& p, const AreaSegment& a, const AreaSegment& b) {
  return (samePoint(a.end, b.start) && samePoint(p, a.end)) || (samePoint(b.end, a.start) && samePoint(p, b.end));
}

bool isEnd(const TCoords& p, const AreaSegment& s) { return samePoint(p, s.start) || samePoint(p, s.end); }

TCoords midpoint(const AreaSegment& s) {
  double sweep = 0.0;
  if (s.boIsArc() && boGetArcSweep(s, sweep)) return getPointOnArc(s, 0.5 * sweep);
  TCoords m = s.start;
  m.north = 0.5 * (s.start.north + s.end.north);
  m.east = 0.5 * (s.start.east + s.end.east);
  return m;
}

// Whether two collinear lines, or two arcs on one circle, share more than an end point.
bool overlap(const AreaSegment& a, const AreaSegment& b) {
  if (a.boIsLine() != b.boIsLine()) return false;
  if (a.boIsLine()) {
    const double length = planDistance(a.start, a.end);
    if (!(length > 0.0)) return false;
    const double un = (a.end.north - a.start.north) / length;
    const double ue = (a.end.east - a.start.east) / length;
    const auto along = [&](const TCoords& p) { return (p.north - a.start.north) * un + (p.east - a.start.east) * ue; };
    const auto across = [&](const TCoords& p) { return (p.east - a.start.east) * un - (p.north - a.start.north) * ue; };
    if (std::fabs(across(b.start)) > tol::kAreaPoint || std::fabs(across(b.end)) > tol::kAreaPoint) return false;
    const double lo = std::max(0.0, std::min(along(b.start), along(b.end)));
    const double hi = std::min(length, std::max(along(b.start), along(b.end)));
    return hi - lo > tol::kAreaPoint;
  }
  if (planDistance(a.center, b.center) > tol::kAreaPoint || std::fabs(a.radius() - b.radius()) > tol::kAreaPoint)
    return false;
  const auto strictlyOn = [](const TCoords& p, const AreaSegment& s) { return boIsPointOnArc(p, s) && !isEnd(p, s); };
  return strictlyOn(b.start, a) || strictlyOn(b.end, a) || strictlyOn(a.start, b) || strictlyOn(a.end, b) ||
         boIsPointOnArc(midpoint(b), a) || boIsPointOnArc(midpoint(a), b);
}

// Whether the two segments have a common point other than a shared end.
bool segmentsCross(const AreaSegment& a, const AreaSegment& b) {
  TCoords first;
  TCoords second;
  int count = 0;
  if (!boComputeIntersectionCoord(a, b, first, second, count)) return overlap(a, b);
  for (const TCoords* p : {&first, &second}) {
    if (boIsPointOnSegment(*p, a) && boIsPointOnSegment(*p, b) && !atSharedEnd(*p, a, b)) return true;
    if (count == 1) break;
  }
  return false;
}

AreaSegment chordOf(const AreaSegment& arc) {
  AreaSegment chord = arc;
  chord.type = AreaSegment::kLine;
  return chord;
}

// The plan extent of a segment: its ends and, for an arc, the points of its circle due north, east, south
// and west of the centre that lie on it.
C2dMinMax extentOf(const AreaSegment& s) {
  C2dMinMax box(s.start.pos(), s.end.pos());
  if (s.boIsArc()) {
    const double r = s.radius();
    for (const C2dPos& offset : {C2dPos(r, 0.0), C2dPos(0.0, r), C2dPos(-r, 0.0), C2dPos(0.0, -r)}) {
      TCoords p = s.center;
      p.north += offset.north();
      p.east += offset.east();
      if (boIsPointOnArc(p, s)) box.include(p.pos());
    }
  }
  return box;
}

bool allFinite(const svy_list<AreaSegment>& list) {
  for (const AreaSegment& s : list) {
    if (!s.start.hasFinitePlanPosition() || !s.end.hasFinitePlanPosition()) return false;
    if (s.boIsArc() && (!s.center.hasFinitePlanPosition() || !std::isfinite(s.radius()))) return false;
  }
  return true;
}

EAreaCalcStatus twoArcsRetrace(const AreaSegment& a, const AreaSegment& b) {
  const bool sameCentre = std::fabs(a.center.north - b.center.north) <= tol::kAreaSameVertex &&
                          std::fabs(a.center.east - b.center.east) <= tol::kAreaSameVertex &&
                          std::fabs(a.center.height - b.center.height) <= tol::kAreaSameHeight;
  if (a.counterClockwise == b.counterClockwise || !sameCentre ||
      !(std::fabs(a.radius() - b.radius()) <= tol::kAreaSameRadius))
    return eAreaCalcOk;
  if (planDistance(a.end, b.start) > tol::kAreaArcsMeet)
    svy_logging::svy_err_log(kAreaMathLogSource, kLogLineArcsApart, "");
  return eAreaCalcSegmentsCross;
}

}  // namespace

bool boIsPolygonInArc(const svy_list<AreaSegment>& list, const AreaSegment& arc) {
  if (!arc.boIsArc()) return false;
  bool clearlyInside = false;
  for (const AreaSegment& s : list) {
    const TCoords& vertex = s.start;
    if (isEnd(vertex, arc)) continue;
    const double side = bulgeSide(arc, vertex);
    if (planDistance(vertex, arc.center) > arc.radius() + tol::kAreaPoint || side < -tol::kAreaPoint) return false;
    clearlyInside = clearlyInside || side > tol::kAreaPoint;
  }
  return clearlyInside;
}

bool boIsArcInPolygon(const svy_list<AreaSegment>& list, const AreaSegment& arc) {
  double signedArea = 0.0;
  if (eComputePolygonVertexArea(list, signedArea, true) != eAreaCalcOk) return false;
  return svy_math::detail::arcBulgesInto(arc, signedArea);
}

EAreaCalcStatus eDoAreaSegmentsCross(const svy_list<AreaSegment>& list, bool ignoreChords) {
  if (list.size() < 2) return eAreaCalcOk;
  if (!allFinite(list)) return eAreaCalcGeometryFailed;
  if (list.size() == 2) {
    const AreaSegment& a = list.front();
    const AreaSegment& b = list.back();
    return a.boIsArc() && b.boIsArc() ? twoArcsRetrace(a, b) : eAreaCalcOk;
  }
  const std::vector<AreaSegment> segments(list.begin(), list.end());
  std::vector<C2dMinMax> boxes;
  boxes.reserve(segments.size());
  for (const AreaSegment& s : segments) boxes.push_back(extentOf(s));
  // Sweep over the extents in order of their southern edge: only pairs whose extents overlap are tested.
  std::vector<std::size_t> order(segments.size());
  std::iota(order.begin(), order.end(), std::size_t{0});
  std::sort(order.begin(), order.end(),
            [&](std::size_t a, std::size_t b) { return boxes[a].minNorth < boxes[b].minNorth; });
  EAreaCalcStatus found = eAreaCalcOk;
  for (std::size_t k = 0; k < order.size(); ++k) {
    const std::size_t i = order[k];
    for (std::size_t m = k + 1; m < order.size(); ++m) {
      const std::size_t j = order[m];
      if (boxes[j].minNorth > boxes[i].maxNorth + tol::kAreaPoint) break;
      if (!boxes[i].intersects(boxes[j], tol::kAreaPoint)) continue;
      if (segmentsCross(segments[i], segments[j])) return eAreaCalcSegmentsCross;
      if (ignoreChords || found != eAreaCalcOk) continue;
      const AreaSegment& a = segments[i];
      const AreaSegment& b = segments[j];
      if ((a.boIsArc() && segmentsCross(chordOf(a), b)) || (b.boIsArc() && segmentsCross(a, chordOf(b))) ||
          (a.boIsArc() && b.boIsArc() && segmentsCross(chordOf(a), chordOf(b))))
        found = eAreaCalcChordCrosses;
    }
  }
  return found;
}
