#pragma once
// Intersections of the field: bearing with bearing, bearing with distance, distance with distance.
//
// Plan positions are (northing, easting); azimuths are clockwise from north (CMathAngle holds radians);
// distances are metres. Bearings are whole lines through their point (a crossing behind the point counts).
// A line or circle that misses a circle by at most svy_math::tol::kTangency (1e-8 m) touches it: one
// solution, written to both outputs. Work is done relative to one of the given points. Nothing here logs,
// throws or allocates; a result other than eCogoOk leaves the outputs as they were.
#include "svymath/cogo/cogo_results.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/math_angle.h"
#include "svymath/foundation/positions.h"

namespace CogoFunctions {

// The crossing of the line through point1 along azimuth1 with the line through point2 along azimuth2.
// eCogoParallel when the directions are parallel or opposite (sine of the angle between them strictly
// within +-1e-12).
SVYMATH_API ECogoMathErrorCode eIntersectBearings(const C2dPos& point1, const CMathAngle& azimuth1,
                                                  const C2dPos& point2, const CMathAngle& azimuth2,
                                                  C2dPos& crossing);

// The points of the line through point1 along azimuth1 that lie `distance2` from point2. `count` is 2 or 1
// (touching); solution1 is the one met first travelling along azimuth1 (from behind point1 forward), so for
// a point1 outside the circle looking toward it, the nearer one. eCogoInvalidInput for a distance that is
// not positive; eCogoNoSolution when the line passes too far from point2.
SVYMATH_API ECogoMathErrorCode eIntersectBearingDistance(const C2dPos& point1, const CMathAngle& azimuth1,
                                                         const C2dPos& point2, double distance2,
                                                         C2dPos& solution1, C2dPos& solution2, int& count);

// The points `distance1` from point1 and `distance2` from point2. `count` is 2 or 1 (touching); solution1
// lies to the right of the line from point1 to point2, solution2 to its left. eCogoInvalidInput for a
// distance that is not positive; eCogoConcentric for coincident points; eCogoNoSolution when the circles
// are too far apart or one lies inside the other.
SVYMATH_API ECogoMathErrorCode eIntersectDistances(const C2dPos& point1, double distance1, const C2dPos& point2,
                                                   double distance2, C2dPos& solution1, C2dPos& solution2,
                                                   int& count);

}  // namespace CogoFunctions
