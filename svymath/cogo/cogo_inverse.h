#pragma once
// The inverse of a point to an element: how far along a segment, an arc or a polyline its foot lies and
// how far it is offset, with the nearest point of the element; and the point at a distance along and
// offset from a line.
//
// Plan positions are (northing, easting); offsets are positive to the right of the direction of travel
// (for an arc: toward the centre of a clockwise arc); lengths are metres. The work is done relative to the
// element's start (an arc's centre), so that survey coordinates (N 5 000 000) keep their digits. Nothing
// here logs, throws or allocates; a result other than eCogoOk leaves the outputs as they were.
#include "svymath/cogo/cogo_results.h"
#include "svymath/foundation/arc.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/positions.h"
#include "svyutils/svy_containers.h"

namespace CogoFunctions {

// The inverse of `point` to the segment start -> end: `along` from the start along the segment's direction,
// the perpendicular foot on the infinite line, and the nearest point of the segment (the foot, or the nearer
// end). eCogoCoincidentPoints when the segment is shorter than the zero tolerance (1e-12 m).
SVYMATH_API ECogoMathErrorCode eInverseToSegment(const C2dPos& start, const C2dPos& end, const C2dPos& point,
                                                 TElementInverse& result);

// The inverse of `point` to the arc: the radial foot on the circle, `along` the arc from its start in its
// direction of travel (negative before the start, beyond the arc length after the end; a point beyond the
// ends goes to the end it is nearer to), and the offset, positive toward the centre of a clockwise arc.
// A whole circle has no ends. eCogoInvalidInput for an arc without radius; eCogoCoincidentPoints for the
// centre itself.
SVYMATH_API ECogoMathErrorCode eInverseToArc(const CArc& arc, const C2dPos& point, TElementInverse& result);

// The inverse of `point` to the polyline through `vertices` (closed: with a segment from the last vertex
// back to the first). The nearest segment wins, the first of equally near ones. At an interior vertex whose
// corner holds the point, the foot and nearest point are the vertex and the offset is the distance to it,
// signed by the side of the segment. Repeated vertices are passed over. eCogoInvalidInput for fewer than two
// vertices or a non-finite one; eCogoCoincidentPoints when all vertices coincide.
SVYMATH_API ECogoMathErrorCode eInverseToPolyline(const svy_vector<C2dPos>& vertices, bool closed,
                                                  const C2dPos& point, TElementInverse& result);

// The point `along` metres from start in the direction start -> end and `offset` metres to the right of it
// (negative values go back, respectively to the left). eCogoCoincidentPoints for coincident start and end.
SVYMATH_API ECogoMathErrorCode ePointAtAlongOffset(const C2dPos& start, const C2dPos& end, double along,
                                                   double offset, C2dPos& point);

}  // namespace CogoFunctions
