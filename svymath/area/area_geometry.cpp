#include "svymath/area/area_geometry.h"

#include <cmath>

#include "svymath/area/area_support.h"

namespace svy_math {
namespace detail {

double bulgeSide(const AreaSegment& arc, const TCoords& point) {
  const C2dPos chord(arc.end.north - arc.start.north, arc.end.east - arc.start.east);
  const C2dPos toPoint(point.north - arc.start.north, point.east - arc.start.east);
  const double length = std::hypot(chord[0], chord[1]);
  if (!(length > 0.0)) return 0.0;
  const double right = cross(chord, toPoint) / length;
  return arc.counterClockwise ? right : -right;
}

bool arcBulgesInto(const AreaSegment& arc, double signedChordArea) {
  // A clockwise arc bulges to the left of its chord, where a counter-clockwise polygon has its inside.
  return arc.boIsArc() && signedChordArea != 0.0 && arc.counterClockwise == (signedChordArea < 0.0);
}

bool signedAreaTerm(const AreaSegment& segment, const C2dPos& origin, double& term) {
  const C2dPos a(segment.start.north - origin.north(), segment.start.east - origin.east());
  const C2dPos b(segment.end.north - origin.north(), segment.end.east - origin.east());
  term = -0.5 * cross(a, b);
  if (segment.boIsLine()) return true;
  double sweep = 0.0;
  if (!boGetArcSweep(segment, sweep)) return false;
  const double r = segment.radius();
  const double circularSegment = 0.5 * r * r * (sweep - std::sin(sweep));
  term += segment.counterClockwise ? circularSegment : -circularSegment;
  return true;
}

bool signedBoundaryArea(const svy_list<AreaSegment>& list, double& area) {
  area = 0.0;
  if (list.empty()) return true;
  const C2dPos origin = list.front().start.pos();
  for (const AreaSegment& segment : list) {
    double term = 0.0;
    if (!signedAreaTerm(segment, origin, term)) return false;
    area += term;
  }
  return std::isfinite(area);
}

}  // namespace detail
}  // namespace svy_math
