#pragma once
// Closed-form area pieces of the area code: a circular sector, a triangle from two sides and the included
// angle, the circular segment between an arc and its chord, and the signed triangle of three points.
// Angles are radians, lengths metres, areas square metres.
#include "svymath/foundation/abstract_point.h"
#include "svymath/foundation/export.h"

// Sector of a circle: angle * r^2 / 2. Always true.
SVYMATH_API bool AreaPartCirc(double radius, double angle, double* area);
// Triangle from sides a and b and the angle between them: sin(angle) * a * b / 2. Always true.
SVYMATH_API bool AreaTri2DistAng(double a, double b, double angle, double* area);
// Circular segment between an arc of central angle `angle` and its chord: sector minus triangle, which for
// an angle above pi adds the triangle (its sine is negative) and gives the major segment.
SVYMATH_API bool AreaCircChord(double radius, double angle, double* area);

// Signed area of the triangle (x1, y1), (x2, y2), (x3, y3), taken relative to the first point: positive when
// the points turn from the first axis toward the second. For (northing, easting) positions, as everywhere in
// this library, that is clockwise on the map (north up, east right).
SVYMATH_API double triangle_area(double x1, double y1, double x2, double y2, double x3, double y3);
SVYMATH_API double triangle_area(const svy_math::TAbstractPoint2<double>& a, const svy_math::TAbstractPoint2<double>& b,
                                 const svy_math::TAbstractPoint2<double>& c);
// Whether the (northing, easting) positions a, b, c turn clockwise on the map (a positive triangle_area).
SVYMATH_API bool clockwise(const svy_math::TAbstractPoint2<double>& a, const svy_math::TAbstractPoint2<double>& b,
                           const svy_math::TAbstractPoint2<double>& c);
