#pragma once
// Areas of closed horizontal alignments and their known-area subdivision.
//
// An alignment is a boundary when its tangent and arc elements run round an area: each tangent becomes a
// line segment, each arc an arc segment about its centre. An open alignment is closed by a line from its end
// to its start (an end within 1e-6 m of the start closes it as it is). Spirals have no area segment: an
// alignment holding one is refused.
#include "svymath/alignments/alnt_pair.h"
#include "svymath/area/area_segment.h"
#include "svymath/foundation/export.h"

// The boundary of the alignment's elements; false (list untouched) for an empty alignment, a spiral or an
// element whose geometry cannot be read.
SVYMATH_API bool boGetAreaSegmentListFromAlignment(const CAlntH& alignment, svy_list<AreaSegment>& list);

// Replaces the alignment's horizontal elements by the segments of the boundary: it starts at the first
// segment's start, each line a tangent and each arc an arc element, every start azimuth fixed so that the
// corners stay. False when an element cannot be made (the alignment may then hold the elements before it).
SVYMATH_API bool boSetAlignmentFromAreaSegmentList(const svy_list<AreaSegment>& list, CAlntH& alignment);

// Area enclosed by the alignment (square metres); false when it cannot be converted, its boundary or an
// arc's chord crosses another segment, or the area computation fails.
SVYMATH_API bool computePolygonArea(const CHorzAndVertAlnt& alignment, double* area);

// Sum of the boundary segments' lengths (metres, the closing line included); false when the alignment
// cannot be converted or the sum is not finite. No crossing test.
SVYMATH_API bool computePolygonPerimeter(const CHorzAndVertAlnt& alignment, double& perimeter);

// Cuts the boundary parallel to the line linePoint1 -> linePoint2 so that `piece` (its horizontal elements
// replaced) holds the requested area on the side of the cut toward that line, and cutPoint1 / cutPoint2 are
// the cut's ends in the order of the line's direction. False when the boundary cannot be converted, the two
// points coincide, or the subdivision fails.
SVYMATH_API bool solveKnownAreaParallelLineTask(double area, CHorzAndVertAlnt& boundary, C2dPos linePoint1,
                                                C2dPos linePoint2, CHorzAndVertAlnt& piece, C2dPos& cutPoint1,
                                                C2dPos& cutPoint2);

// Cuts the boundary by a line from the hinge (a point of the boundary) so that `piece` holds the requested
// area, grown from the hinge along the alignment's direction, or against it when againstDirection is true.
// cutPoint receives the cut's other end. False as above.
SVYMATH_API bool solveKnownAreaHingePointTask(C2dPos hinge, double area, CHorzAndVertAlnt& boundary,
                                              bool againstDirection, CHorzAndVertAlnt& piece, C2dPos& cutPoint);
