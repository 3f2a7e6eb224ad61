#pragma once
// Planar helpers of the area code: arc centres and lengths, points on segments, crossings of segments and
// the inside test of a boundary of lines and arcs. Positions are (northing, easting) in metres; heights are
// carried along but never used. Every computation is taken relative to a point of the geometry, so that
// survey coordinates (N 5 000 000) keep their digits.
#include "svymath/area/area_segment.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/positions.h"

// The centre of the arc of at most a half turn from start to end with the given radius and direction: to the
// right of the chord for a clockwise arc, to the left for a counter-clockwise one. A chord longer than the
// diameter by at most 1e-6 m gives the chord's midpoint. False (centre untouched) for coincident or
// non-finite ends, a radius that is not positive, or a chord longer than the diameter.
SVYMATH_API bool boComputeCenterPointCoords(const TCoords& start, const TCoords& end, double radius,
                                            bool counterClockwise, TCoords& center);

// Length of the arc about centre from start to end in the given direction: swept angle times the distance
// centre->start (see area_segment.h for the swept angle; 0 when start and end are the same vertex). False when
// an azimuth from the centre fails (a point on the centre, non-finite values).
SVYMATH_API bool boGetArcLength(const TCoords& start, const TCoords& end, const TCoords& center,
                                bool counterClockwise, double& length);

// The swept angle of an arc segment (radians, 0 to 2 pi) from its geometry; false as boGetArcLength.
SVYMATH_API bool boGetArcSweep(const AreaSegment& arc, double& sweep);

// The angle (radians, 0 to 2 pi) through which the arc must turn from its start to reach the ray from its
// centre through point; false when the point lies on the centre.
SVYMATH_API bool boGetAngleOnArc(const AreaSegment& arc, const TCoords& point, double& angle);

// The point of an arc reached after turning by angle (radians) from its start.
SVYMATH_API TCoords getPointOnArc(const AreaSegment& arc, double angle);

// Whether point lies on the line segment, ends included, within 1e-6 m.
SVYMATH_API bool boIsPointOnLine(const TCoords& point, const AreaSegment& line);

// Whether point lies on the arc, ends included, within 1e-6 m of its circle and of its ends.
SVYMATH_API bool boIsPointOnArc(const TCoords& point, const AreaSegment& arc);

// Whether point lies on the segment (line or arc), ends included, within 1e-6 m.
SVYMATH_API bool boIsPointOnSegment(const TCoords& point, const AreaSegment& segment);

// The crossings of the infinite line or the whole circle of segment a with that of segment b: count is 0, 1
// or 2, and first / second receive them (a line and a circle: in the order met from a line's start; two
// circles: the first lies to the right of centre a -> centre b). Touching within 1e-8 m gives one point.
// False (count 0) when the two are parallel lines, concentric circles, or do not meet.
SVYMATH_API bool boComputeIntersectionCoord(const AreaSegment& a, const AreaSegment& b, TCoords& first,
                                            TCoords& second, int& count);

// Whether point lies inside the closed boundary of lines and arcs or on it (within 1e-6 m). The boundary
// need not be oriented either way. False for fewer than one segment.
SVYMATH_API bool boIsCoordinateInPolygon(const TCoords& point, const svy_list<AreaSegment>& list);
