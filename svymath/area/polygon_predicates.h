#pragma once
// Predicates of a closed boundary of lines and arcs that the area computation relies on.
#include "svymath/area/area_segment.h"
#include "svymath/foundation/export.h"

// Whether the arc is the outer rim of the boundary: every other vertex lies inside the arc's circle (within
// 1e-6 m) and on the side of the arc's chord to which the arc bulges, at least one clearly so. The region is
// then the arc's circular segment less the chord polygon. False for a line.
SVYMATH_API bool boIsPolygonInArc(const svy_list<AreaSegment>& list, const AreaSegment& arc);

// Whether the arc bulges into the chord polygon (the polygon through the segments' start points): its bulge
// side of the chord is the polygon's inner side. False for a line or a chord polygon without area.
SVYMATH_API bool boIsArcInPolygon(const svy_list<AreaSegment>& list, const AreaSegment& arc);

// Whether two segments of a boundary cross or overlap. Segments that meet only at a shared end point (the
// end of one being the start of the other, within 1e-6 m) do not cross; any other common point does, a touch
// included. Returns
// - 0 for fewer than two segments, or when nothing crosses;
// - 4 (eAreaCalcSegmentsCross) for two arcs on one circle (centres within 2e-9 m, heights within 1e-4 m,
//   equal radii) in opposite directions (the boundary retraces itself; logged when they do not meet end to
//   start within 1e-4 m), or, for three or more segments, for two crossing or overlapping segments;
// - 5 (eAreaCalcChordCrosses) when ignoreChords is false and the chord of an arc crosses or overlaps
//   another segment (the chord polygon of the area computation would not be simple);
// - 18 when a distance or azimuth of the test fails (non-finite coordinates).
SVYMATH_API EAreaCalcStatus eDoAreaSegmentsCross(const svy_list<AreaSegment>& list, bool ignoreChords);
