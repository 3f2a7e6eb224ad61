#pragma once
// Internal: the crossings of the segment kinds, shared by both sides of each pair so that line-arc and
// arc-line (and the like) run the same code. Every function appends the accepted crossings to `out` and
// returns true when it appended at least one.
#include "svymath/curves/generic_segment.h"

class CMathAngle;

namespace svy_math {
namespace detail {

// Line with line: the axis-parallel cases first, then the general determinant solution.
bool intersectLines(const CGenericLine& a, const CGenericLine& b, svy_vector<C2dPos>& out);
// Line with the circle of an arc, kept where both extent tests accept the point.
bool intersectLineArc(const CGenericLine& line, const CGenericArc& arc, svy_vector<C2dPos>& out);
// Circle with circle, kept where both arcs' sweep tests accept the point.
bool intersectArcs(const CGenericArc& a, const CGenericArc& b, svy_vector<C2dPos>& out);
// A spiral with a line or an arc, through the spiral's 20-arc approximation. A crossing at a point shared by
// two neighbouring arcs is reported once.
bool intersectSpiralWith(const CGenericSpiral& spiral, const CGenericSegment& other, svy_vector<C2dPos>& out);
// Spiral with spiral: every approximating arc of one with every approximating arc of the other.
bool intersectSpirals(const CGenericSpiral& a, const CGenericSpiral& b, svy_vector<C2dPos>& out);

// The crossing of the infinite lines through p0 along azimuth a0 and through p1 along a1; false when the
// directions are parallel (the sine of the angle between them within the zero tolerance) or undefined.
SVYMATH_API bool intersectRays(const C2dPos& p0, const CMathAngle& a0, const C2dPos& p1, const CMathAngle& a1,
                               C2dPos& out);

}  // namespace detail
}  // namespace svy_math
