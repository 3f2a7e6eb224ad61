#pragma once
// Intersections of a straight line with a circle and of two circles, in plan (northing, easting).
//
// Both solvers return the number of solutions (0, 1 or 2) and write two positions:
// - 2: two distinct crossing points;
// - 1: the line or the second circle touches the circle; both outputs hold the touching point;
// - 0: no crossing, or input that defines no line or circle (coincident line points, a radius that is
//   not positive, non-finite values, concentric circles); both outputs are left as they were.
// A line or circle that misses or overlaps the circle by at most svy_math::tol::kTangency (1e-8 m) is
// taken as touching it. The work is done relative to a circle's centre, so that survey coordinates
// (N 5 000 000, E 500 000) keep their digits.
// Nothing here logs or throws, allocates or keeps state.
#include "svymath/foundation/export.h"
#include "svymath/foundation/positions.h"

// The crossings of the infinite line through `linePos1` and `linePos2` with the circle of `center`
// and `radius` (metres). With two solutions, `solution1` is the one met first when travelling from
// linePos1 toward linePos2, `solution2` the one met second.
SVYMATH_API int IntersectionCoordsOfLineAndCircle(const C2dPos& linePos1, const C2dPos& linePos2,
                                                  const C2dPos& center, double radius,
                                                  C2dPos& solution1, C2dPos& solution2);

// The crossings of the circle (center1, radius1) with the circle (center2, radius2) (metres). With two
// solutions, `solution1` lies to the right of the direction center1 -> center2 and `solution2` to its
// left. Coincident circles have no isolated crossing and give 0.
SVYMATH_API int IntersectionCoordsOfTwoCircles(const C2dPos& center1, double radius1,
                                               const C2dPos& center2, double radius2,
                                               C2dPos& solution1, C2dPos& solution2);
