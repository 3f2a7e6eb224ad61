#pragma once
// Internal geometry shared by the area sources (not exported): sides of chords, signed area terms.
// Signed areas are positive for a boundary running counter-clockwise on the map (north up, east right).
#include "svymath/area/area_segment.h"
#include "svymath/foundation/positions.h"

namespace svy_math {
namespace detail {

// a.north * b.east - a.east * b.north: positive when b lies to the right of the direction a on the map.
inline double cross(const C2dPos& a, const C2dPos& b) { return a[0] * b[1] - a[1] * b[0]; }

// A plan position as a coordinate record with the height and mask of `like`.
inline TCoords toCoords(const C2dPos& p, const TCoords& like) {
  TCoords c = like;
  c.north = p.north();
  c.east = p.east();
  return c;
}

// Distance of point from an arc's chord line, positive on the side to which the arc bulges (right of the
// chord for a counter-clockwise arc, left for a clockwise one); 0 for a chord without length.
double bulgeSide(const AreaSegment& arc, const TCoords& point);

// Whether the arc bulges to the inner side of a chord polygon of the given signed area.
bool arcBulgesInto(const AreaSegment& arc, double signedChordArea);

// The signed area (square metres) that the segment adds to its boundary's, measured from origin: the
// triangle origin, start, end, plus for an arc its circular segment (added when the arc turns
// counter-clockwise, removed when it turns clockwise). False when an arc's sweep cannot be taken.
bool signedAreaTerm(const AreaSegment& segment, const C2dPos& origin, double& term);

// The signed area of a closed boundary of lines and arcs (sum of the terms about its first start).
bool signedBoundaryArea(const svy_list<AreaSegment>& list, double& area);

}  // namespace detail
}  // namespace svy_math
