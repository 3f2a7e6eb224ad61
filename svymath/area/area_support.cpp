#include "svymath/area/area_support.h"

#include <algorithm>
#include <cmath>

#include "svymath/area/area_geometry.h"
#include "svymath/cogo/circle_solvers.h"
#include "svymath/cogo/inverse_radiate.h"
#include "svymath/foundation/angle_functions.h"
#include "svymath/foundation/constants.h"

using svy_math::detail::bulgeSide;
using svy_math::detail::cross;
using svy_math::detail::toCoords;

namespace tol = svy_math::tol;
namespace units = svy_math::units;

bool boComputeCenterPointCoords(const TCoords& start, const TCoords& end, double radius, bool counterClockwise,
                                TCoords& center) {
  const double dn = end.north - start.north;
  const double de = end.east - start.east;
  const double chord = std::hypot(dn, de);
  if (!std::isfinite(chord) || !std::isfinite(radius) || !(chord > tol::kZero) || !(radius > 0.0)) return false;
  const double half = 0.5 * chord;
  if (half > radius + tol::kAreaPoint) return false;
  const double rise = std::sqrt(std::max(0.0, (radius - half) * (radius + half)));
  // The right normal of the chord direction (n, e) is (-e, n); a clockwise arc turns about a centre on its right.
  const double side = counterClockwise ? -rise / chord : rise / chord;
  center.north = start.north + 0.5 * dn - side * de;
  center.east = start.east + 0.5 * de + side * dn;
  center.height = 0.5 * (start.height + end.height);
  center.mask = start.mask & end.mask;
  return true;
}

bool boGetArcLength(const TCoords& start, const TCoords& end, const TCoords& center, bool counterClockwise,
                    double& length) {
  double radius = 0.0;
  if (!boCompute2DDistanceBetweenCoords(center, start, radius)) return false;
  if (boAreSameAreaVertex(start, end)) {
    length = 0.0;
    return true;
  }
  double azStart = 0.0;
  double azEnd = 0.0;
  if (!boComputeAzimuthBetweenCoords(center, start, azStart) || !boComputeAzimuthBetweenCoords(center, end, azEnd))
    return false;
  double sweep = Normalize0To2PI(azEnd - azStart);
  if (counterClockwise) sweep = Normalize0To2PI(units::kTwoPi - sweep);
  length = sweep * radius;
  return true;
}

bool boGetArcSweep(const AreaSegment& arc, double& sweep) {
  double length = 0.0;
  if (!boGetArcLength(arc.start, arc.end, arc.center, arc.counterClockwise, length) || !(arc.radius() > 0.0))
    return false;
  // A stored whole circle (start on end, length 2 pi r) keeps its full turn.
  sweep = length == 0.0 && arc.length > 0.0 ? arc.length / arc.radius() : length / arc.radius();
  return true;
}

bool boGetAngleOnArc(const AreaSegment& arc, const TCoords& point, double& angle) {
  double azStart = 0.0;
  double azPoint = 0.0;
  if (!boComputeAzimuthBetweenCoords(arc.center, arc.start, azStart) ||
      !boComputeAzimuthBetweenCoords(arc.center, point, azPoint))
    return false;
  // Azimuths grow clockwise: a clockwise arc turns with them, a counter-clockwise one against them.
  angle = Normalize0ToLt2Pi(arc.counterClockwise ? azStart - azPoint : azPoint - azStart);
  return true;
}

TCoords getPointOnArc(const AreaSegment& arc, double angle) {
  const double dn = arc.start.north - arc.center.north;
  const double de = arc.start.east - arc.center.east;
  // Rotation on the map, clockwise for positive angles in (north, east) components.
  const double turn = arc.counterClockwise ? -angle : angle;
  const double c = std::cos(turn);
  const double s = std::sin(turn);
  TCoords point = arc.start;
  point.north = arc.center.north + dn * c - de * s;
  point.east = arc.center.east + dn * s + de * c;
  return point;
}

bool boIsPointOnLine(const TCoords& point, const AreaSegment& line) {
  const C2dPos origin = line.start.pos();
  const C2dSegment local(C2dPos(0.0, 0.0), C2dPos(line.end.north - origin.north(), line.end.east - origin.east()));
  return local.getDistance(C2dPos(point.north - origin.north(), point.east - origin.east())) <= tol::kAreaPoint;
}

bool boIsPointOnArc(const TCoords& point, const AreaSegment& arc) {
  double distance = 0.0;
  double sweep = 0.0;
  double angle = 0.0;
  if (!boCompute2DDistanceBetweenCoords(arc.center, point, distance) ||
      std::fabs(distance - arc.radius()) > tol::kAreaPoint || !boGetArcSweep(arc, sweep) ||
      !boGetAngleOnArc(arc, point, angle))
    return false;
  const double slack = tol::kAreaPoint / arc.radius();
  return angle <= sweep + slack || angle >= units::kTwoPi - slack;
}

bool boIsPointOnSegment(const TCoords& point, const AreaSegment& segment) {
  return segment.boIsArc() ? boIsPointOnArc(point, segment) : boIsPointOnLine(point, segment);
}

bool boComputeIntersectionCoord(const AreaSegment& a, const AreaSegment& b, TCoords& first, TCoords& second,
                                int& count) {
  count = 0;
  C2dPos p1;
  C2dPos p2;
  if (a.boIsLine() && b.boIsLine()) {
    // a.start + t (a.end - a.start) = b.start + u (b.end - b.start), relative to a.start.
    const C2dPos da(a.end.north - a.start.north, a.end.east - a.start.east);
    const C2dPos db(b.end.north - b.start.north, b.end.east - b.start.east);
    const C2dPos ab(b.start.north - a.start.north, b.start.east - a.start.east);
    const double det = cross(da, db);
    const double scale = std::hypot(da[0], da[1]) * std::hypot(db[0], db[1]);
    if (!std::isfinite(det) || !(std::fabs(det) > tol::kZero * scale)) return false;
    const double t = cross(ab, db) / det;
    p1 = C2dPos(a.start.north + t * da[0], a.start.east + t * da[1]);
    count = 1;
  } else if (a.boIsArc() && b.boIsArc()) {
    count = IntersectionCoordsOfTwoCircles(a.center.pos(), a.radius(), b.center.pos(), b.radius(), p1, p2);
  } else {
    const AreaSegment& line = a.boIsLine() ? a : b;
    const AreaSegment& arc = a.boIsLine() ? b : a;
    count = IntersectionCoordsOfLineAndCircle(line.start.pos(), line.end.pos(), arc.center.pos(), arc.radius(), p1,
                                              p2);
  }
  if (count == 1) p2 = p1;
  if (count > 0) {
    first = toCoords(p1, a.start);
    second = toCoords(p2, a.start);
  }
  return count > 0;
}

bool boIsCoordinateInPolygon(const TCoords& point, const svy_list<AreaSegment>& list) {
  if (list.empty()) return false;
  // The region of a boundary of lines and arcs is its chord polygon with the circular segment of every arc
  // added or removed: inside is the parity of the chord-polygon crossings plus the segments holding the point.
  bool inside = false;
  const C2dPos p = point.pos();
  for (const AreaSegment& s : list) {
    if (boIsPointOnSegment(point, s)) return true;
    const C2dPos a(s.start.north - p.north(), s.start.east - p.east());
    const C2dPos b(s.end.north - p.north(), s.end.east - p.east());
    // A ray due east from the point crosses the chord when the chord's northings straddle the point's.
    if ((a[0] > 0.0) != (b[0] > 0.0)) {
      const double eastAtPoint = a[1] + (b[1] - a[1]) * (0.0 - a[0]) / (b[0] - a[0]);
      if (eastAtPoint > 0.0) inside = !inside;
    }
    if (s.boIsArc()) {
      double distance = 0.0;
      if (boCompute2DDistanceBetweenCoords(s.center, point, distance) && distance < s.radius() &&
          bulgeSide(s, point) > 0.0)
        inside = !inside;
    }
  }
  return inside;
}
