#pragma once
// The status code and the inverse-result record shared by the coordinate-geometry functions of the
// CogoFunctions namespace (intersections, inverses to elements, point sets, tangents and fillets).
//
// Plan positions are (northing, easting); azimuths are radians clockwise from north; offsets are positive to
// the right of the direction of travel; lengths are metres. A function that returns anything but eCogoOk
// leaves its outputs as they were.
#include <cstdint>

#include "svymath/foundation/positions.h"

namespace CogoFunctions {

enum ECogoMathErrorCode : std::int32_t {
  eCogoOk = 0,
  // A value is not finite, a radius or distance is negative, a scale is not positive, a list is too short.
  eCogoInvalidInput = 1,
  // Two points that must define a direction (a line, a centre line) coincide within the zero tolerance,
  // or the point to project is the centre of the circle (every point of the circle is as near).
  eCogoCoincidentPoints = 2,
  // Two bearings or lines are parallel: they have no single crossing.
  eCogoParallel = 3,
  // The loci do not meet: circles too far apart or one inside the other, a line that misses a circle, a
  // point inside the circle it should be tangent to, lines that turn back on themselves for a fillet.
  eCogoNoSolution = 4,
  // The circles share their centre: no crossing and no common tangent.
  eCogoConcentric = 5,
};

// Where the foot of a point lies with respect to an element with ends.
enum EFootPosition : std::int32_t {
  eFootOnElement = 0,    // between the ends (both included): the nearest point is the perpendicular foot
  eFootBeforeStart = 1,  // before the start: the nearest point of the element is its start
  eFootAfterEnd = 2,     // beyond the end: the nearest point of the element is its end
};

// The inverse of a point to a segment, an arc or a polyline.
struct TElementInverse {
  // Distance from the element's start to the foot, along the element (metres): negative before the start,
  // beyond the length after the end. For a polyline, measured along the polyline to the foot on the
  // segment that holds the nearest point.
  double along = 0.0;
  // Perpendicular offset of the point from the element's line or circle (metres), positive to the right
  // of the direction of travel.
  double offset = 0.0;
  // The perpendicular foot on the infinite line, or the radial foot on the whole circle.
  C2dPos foot;
  // The nearest point of the element itself (the foot, or the nearer end).
  C2dPos nearest;
  // Distance from the point to `nearest` (metres).
  double distance = 0.0;
  EFootPosition position = eFootOnElement;
  // Polyline: the 0-based index of the segment that holds the nearest point (segment i runs from vertex i
  // to vertex i + 1, the closing segment from the last vertex to the first). 0 for a segment or an arc.
  int segment = 0;
};

}  // namespace CogoFunctions
