#pragma once
// Circular-curve formulas: conversions between the quantities by which a circular curve is entered
// (radius R, deflection or central angle delta, arc length L, chord C, tangent length T, external distance
// E, middle ordinate M, degree of curve on a 100-unit base by the arc and by the chord definition), the
// transition-spiral length and constant, and arcs from tangents or through three points.
//
// Angles passed in and returned are decimal degrees; lengths in the caller's unit. No function fails
// loudly: an impossible input gives 0, or NaN where the quantity is infinite (the tangent and external
// distance of a half turn).
#include "svymath/foundation/export.h"
#include "svymath/foundation/positions.h"

// ---- degree of curve ----
// Arc definition: 100 / D_rad; 0 for D below 5e-7 degrees (negative D included).
SVYMATH_API double GetRadiusFromDegOfCurve(double degOfCurve);
// 5729.578 / R; 0 for R below 1e-05.
SVYMATH_API double GetDegOfCurveFromRadius(double radius);
// Chord definition: 50 / sin(D_rad / 2); 50 at a half turn; 0 outside (5e-7 degrees, 180 degrees).
SVYMATH_API double GetRadiusFromDegOfChord(double degOfChord);
// 2 asin(50 / R) for R >= 50; 180 for R just below 50 (within 1e-12); otherwise 0.
SVYMATH_API double GetDegOfChordFromRadius(double radius);
SVYMATH_API bool isValidRadiusForDegOfChord(double radius);

// ---- deflection, length, chord ----
// L / R in degrees; 0 for R below 1e-05 (a negative radius gives 0).
SVYMATH_API double GetDeltaFromLength(double length, double radius);
SVYMATH_API double GetLengthFromDelta(double delta, double radius);
SVYMATH_API double GetChordLenFromDelta(double delta, double radius);
SVYMATH_API double GetChordLenFromLength(double length, double radius);
// 2 asin(C / 2R) in degrees. A chord not shorter than the diameter: 180 when C/2R is at most 1 + 1e-12 (or
// at most -1, a negative radius), -180 beyond that; 0 for R within 1e-12 of zero.
SVYMATH_API double GetDeltaFromChordLength(double chord, double radius);
SVYMATH_API double GetLengthFromChordLength(double chord, double radius);

// ---- tangent, external, middle ordinate ----
// tan(delta / 2) R; NaN within 1e-05 degrees of a half turn.
SVYMATH_API double GetTangentFromDelta(double delta, double radius);
SVYMATH_API double GetTangentFromLength(double length, double radius);
SVYMATH_API double GetDeltaFromTangent(double tangent, double radius);
SVYMATH_API double GetLengthFromTangent(double tangent, double radius);
// |R / cos(delta / 2) - R| with R taken positive; NaN within 1e-05 degrees (inclusive) of a half turn.
SVYMATH_API double GetExternalFromDelta(double delta, double radius);
SVYMATH_API double GetExternalFromLength(double length, double radius);
// 2 acos(R / (R + E)) with both taken positive; 0 when there is no such angle.
SVYMATH_API double GetDeltaFromExternal(double external, double radius);
SVYMATH_API double GetLengthFromExternal(double external, double radius);
// (1 - cos(delta / 2)) R.
SVYMATH_API double GetMidOrdFromDelta(double delta, double radius);
SVYMATH_API double GetMidOrdFromLength(double length, double radius);
// 2 acos(1 - M / R); 0 when there is no such angle.
SVYMATH_API double GetDeltaFromMidOrd(double midOrdinate, double radius);
SVYMATH_API double GetLengthFromMidOrd(double midOrdinate, double radius);

// ---- transition spiral ----
// Length of a clothoid of parameter A ending in radius R: A^2 / |R|; 0 for |R| below 1e-05.
SVYMATH_API double GetSpiralLength(double spiralParam, double radius);
// Parameter A = sqrt(|L| |R|).
SVYMATH_API double GetSpiralConstant(double length, double radius);

// ---- arcs from points and tangents ----
// A circular arc in the plane, as the two functions below find it. The radius and the deflection carry the
// side: positive for an arc turning right (clockwise) from start to end.
struct SVYMATH_API TArcParams {
  C2dPos start;         // beginning of the arc (PC)
  C2dPos end;           // end of the arc (PT)
  C2dPos centre;
  double radius = 0.0;  // signed
  double delta = 0.0;   // central angle = deflection of the tangents, degrees, signed; |delta| < 360
  double length = 0.0;  // arc length
  double chord = 0.0;
  double tangent = 0.0;      // PI to PC (negative for an arc of more than a half turn; NaN at a half turn)
  double external = 0.0;     // PI to the arc's midpoint (NaN at a half turn)
  double midOrdinate = 0.0;  // chord's midpoint to the arc's midpoint
};

// The arc of radius |radius| that joins the tangent arriving at the intersection point pi with azimuth
// azimuthIn to the tangent leaving it with azimuthOut (decimal degrees, clockwise from north). The arc
// turns the way the tangents do; the sign of radius is ignored. False when the tangents are parallel (no
// deflection, or a reversal), the radius is zero, or an input is not finite.
SVYMATH_API bool GetArcTangentParams(const C2dPos& pi, double azimuthIn, double azimuthOut, double radius,
                                     TArcParams& arc);
// The arc that starts at p1, passes through p2 and ends at p3. False when the points are collinear,
// two of them coincide, or a coordinate is not finite.
SVYMATH_API bool GetArc3PointsParams(const C2dPos& p1, const C2dPos& p2, const C2dPos& p3, TArcParams& arc);
