#pragma once
// Area of a closed boundary of lines and arcs (square metres).
#include "svymath/area/area_segment.h"
#include "svymath/foundation/export.h"

// Area of the polygon through the segments' start points (arcs replaced by their chords), taken relative to
// the first start. With signedArea it is positive for a boundary running counter-clockwise on the map,
// otherwise its absolute value. Sets area to 0 first; fewer than three segments give 6.
SVYMATH_API EAreaCalcStatus eComputePolygonVertexArea(const svy_list<AreaSegment>& list, double& area,
                                                      bool signedArea);

// Area enclosed by the boundary, whichever way it runs:
// - one segment: a whole circle (length 2 pi r within 1e-4 m) gives pi r^2, anything else 15;
// - two segments: a line and an arc give the arc's circular segment; two arcs give the sum or the difference
//   of their segments by their directions and sizes; two lines give 18;
// - three or more: the chord polygon's area plus the circular segment of each arc that bulges out, less
//   that of each arc that bulges in (boIsArcInPolygon); when an arc is the outer rim of the boundary
//   (boIsPolygonInArc; the first such arc only) the area is that arc's segment less the rest. A chord polygon
//   without area gives 19, a failed step 18. The boundary must not cross itself (see eDoAreaSegmentsCross).
// The outer-rim arc is turned into a line in the caller's list (type 0, its radiusOrAzimuth the azimuth
// start->end; length and centre kept): callers that reuse the list rely on this. A non-positive result is
// logged, not reported.
SVYMATH_API EAreaCalcStatus eComputePolygonArea(svy_list<AreaSegment>& list, double* area);

// Sum of the segments' lengths (metres); false when it is not finite.
SVYMATH_API bool boComputePolygonPerimeter(const svy_list<AreaSegment>& list, double& perimeter);
