#pragma once
// Cutting steps of the known-area subdivision: extents and distances in the frame of a cut direction, the
// side of a boundary, reordering a boundary to start at a point, and cutting a boundary by a line.
// Azimuths are radians clockwise from north; distances from a line are positive to its right.
#include "svymath/area/area_segment.h"
#include "svymath/foundation/export.h"

// The point on the ray from p1 with the given azimuth such that the triangle p1, p2, result has the given
// area: at 2 area / (|sin(a12 - azimuth)| d12) from p1 (a12, d12: azimuth and distance p1 -> p2). False when
// the azimuth or distance fails, or the ray runs along p1 -> p2.
SVYMATH_API bool boComputePointCoordsFromArea(TCoords* result, const TCoords& p1, const TCoords& p2,
                                              const double& azimuth, const double& area);

// The corners of the boundary's extent in the frame of the azimuth (one axis along it, one to its right),
// returned as grid coordinates: min has the least coordinates along and across, max the greatest. Vertices
// and the points of arcs farthest along and across are measured. False for an empty or non-finite boundary.
SVYMATH_API bool boGetPolygonMaxMin(TCoords* max, TCoords* min, const svy_list<AreaSegment>& boundary,
                                    const double& azimuth);

// Signed distance of point from the line through linePoint with the given azimuth (positive to the right).
// False when a value is not finite.
SVYMATH_API bool boComputeDistanceFromCoordToLine(const TCoords& point, const TCoords& linePoint,
                                                  const double& azimuth, double& distance);

// Whether the boundary lies to the left of the line through point with the given azimuth: its point
// farthest from the line (vertices and arc midpoints) lies on the left.
SVYMATH_API bool boIsPolygonLeftOfLine(const svy_list<AreaSegment>& boundary, const TCoords& point,
                                       const double& azimuth);

// The segment run backwards (an arc keeps its centre and turns the other way).
SVYMATH_API AreaSegment getReversedAreaSegment(const AreaSegment& segment);

// The segment split at a point on it into the part before and the part after it.
SVYMATH_API void splitAreaSegment(const AreaSegment& segment, const TCoords& at, AreaSegment& before,
                                  AreaSegment& after);

// The boundary made to start at start (run backwards first when reverse is true): a segment holding it
// (within 1 mm; the point is moved onto the segment, or onto a vertex as near) is split there, and
// the segments follow in order around the boundary. False when the point is not on the boundary.
SVYMATH_API bool boReorderSegmentList(const svy_list<AreaSegment>& boundary, const TCoords& start, bool reverse,
                                      svy_list<AreaSegment>* ordered);

// Cuts the boundary by the line through point with the given azimuth. The boundary must cross the line
// exactly twice (a boundary running along the line or touching it at a vertex does not cross it there):
// `first` receives the part that starts at the first crossing met in the boundary's order, `second` the other,
// each closed by the cut; arcs are split at the crossing. cutStart and cutEnd are the crossings in the order
// of the azimuth. False (outputs untouched) otherwise.
SVYMATH_API bool boGetSubdividedSegmentList(const svy_list<AreaSegment>& boundary, const TCoords& point,
                                            const double& azimuth, svy_list<AreaSegment>* first,
                                            svy_list<AreaSegment>* second, TCoords* cutStart, TCoords* cutEnd);
