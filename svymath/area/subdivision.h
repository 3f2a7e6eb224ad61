#pragma once
// Known-area subdivision: a closed boundary of lines and arcs is cut into two pieces so that one piece has a
// requested area (square metres). Success is eAreaCalcSubdivided (20), not 0.
//
// These entry points take a list of AreaSegment, so that callers holding points, alignments or segments
// alike reach them (getAreaSegmentListFromPointVector builds the list from points).
#include "svymath/area/area_search.h"
#include "svymath/area/area_segment.h"
#include "svymath/foundation/export.h"

// The parallel-line cut: the cut has the given grid azimuth (radians). `piece` receives the part on the left
// of the cut's direction when pieceOnLeft is true, on its right otherwise, with the requested area within
// 1e-3 m^2; `rest` the other part; cutStart and cutEnd the cut's ends in the order of the azimuth. The cut
// is searched by bisection of its distance from the boundary's extreme point across the azimuth; each trial
// line must cross the boundary exactly twice (other trials are probed around). Returns 20, or 27 (no total
// area), 28 (more than the total requested), 29 (a request below 0 or not a number, no bracket, no
// convergence, a stall). The boundary is changed only as eComputePolygonArea changes it; the pieces are cut
// from it as it was given.
SVYMATH_API EAreaCalcStatus eSubdivideSegmentList(const double& azimuth, const double& area, bool pieceOnLeft,
                                                  svy_list<AreaSegment>& boundary, svy_list<AreaSegment>* piece,
                                                  svy_list<AreaSegment>* rest, TCoords* cutStart,
                                                  TCoords* cutEnd);

// The hinge-point cut: the cut runs straight from the hinge (a point of the boundary, within 1 mm) to
// cutEnd. `piece` grows from the hinge along the boundary, segment by segment, and is closed by the cut back
// to the hinge; it receives the requested area (within 1e-3 m^2), `rest` the other part, which starts at
// cutEnd and ends with the cut from the hinge. The piece grows in the boundary's direction; `towards`
// (when its north and east are valid) selects the other direction when it lies nearer the segment that
// enters the hinge than the one that leaves it. A line is cut in closed form, an arc by bisection of its
// turning angle. The cut is not checked against the boundary: on a boundary that the hinge cannot see
// whole, the cut may leave it. Requesting the whole area gives the whole boundary as piece and an empty rest.
// Returns 20, or 18 (hinge not on the boundary), 27, 28, 29 as above.
SVYMATH_API EAreaCalcStatus eSubdivideSegmentList(const TCoords& hinge, const TCoords& towards, const double& area,
                                                  svy_list<AreaSegment>& boundary, svy_list<AreaSegment>* piece,
                                                  svy_list<AreaSegment>* rest, TCoords* cutEnd);
