#pragma once
// Angles as plain numbers: reduction to ranges, conversion between radians, decimal degrees, grads (400 to
// the circle), mils (6400 to the circle) and the packed sexagesimal forms DDD.MMSS and DD.MMmm, and the
// readings of a theodolite (right/left horizontal circle, zenith/level vertical angle).
//
// Functions take decimal degrees unless their name says Rad, Grad, Mil or a DMS form. The boolean of the
// unit conversions, when false, first reduces the degree value with fmod(x, 360), keeping the sign of x.
//
// Non-finite input never loops: range reductions return NaN for NaN and infinity (the radian normalizers
// return them unchanged) and reduce very large values by fmod before the described loop.
#include "svymath/foundation/export.h"
#include "svymath/foundation/positions.h"

namespace svy_text {
template <class TChar>
class CSvyStringT;
}

// ---- unit conversions of angles ----
SVYMATH_API double Deg2Rad(double deg, bool noMod);
SVYMATH_API double Rad2Deg(double rad, bool noMod);
SVYMATH_API double Deg2Grad(double deg, bool noMod);
SVYMATH_API double Grad2Deg(double grad, bool noMod);
SVYMATH_API double Deg2Mil(double deg, bool noMod);
SVYMATH_API double Mil2Deg(double mil, bool noMod);
// Seconds of arc to centesimal seconds (1e-4 grad).
SVYMATH_API double DegSec2GradCC(double seconds, bool noMod);
SVYMATH_API double GradCC2DegSec(double centesimalSeconds);

// ---- reductions in degrees ----
// fmod(d, 360); when positive and the result is negative, + 360 (so [0, 360); -0 stays -0).
SVYMATH_API double ModDeg360(double deg, bool positive);
// fmod(d, 360) into (-180, 180]; when positive, a negative result gains 180.
SVYMATH_API double ModDeg180(double deg, bool positive);
// a - b with one correction into (-180, 180].
SVYMATH_API double AngleDiff(double a, double b);
SVYMATH_API double MinimizeTurnAngle(double deg);
// fmod(d, 360), plus 360 when negative: [0, 360).
SVYMATH_API double pos360(double deg);

// ---- instrument readings (degrees) ----
// Horizontal circle right <-> left: 360 - h reduced to [0, 360); a reading within the zero tolerance stays.
SVYMATH_API double HR2HL(double h);
SVYMATH_API double HL2HR(double h);
// Zenith angle <-> elevation above level: 90 - x reduced to [0, 360).
SVYMATH_API double Zenith2Level(double zenith);
SVYMATH_API double Level2Zenith(double level);
// A zenith reading beyond 180 degrees is taken on the second face of the telescope.
SVYMATH_API bool IsFaceReversed(double zenith);
// The readings of the other face: hz + 180 and 360 - v, both in [0, 360).
SVYMATH_API void CalcReverseAngles(double& hz, double& v);

// ---- radians ----
// atan2(y, x), 0 when both are within the zero tolerance.
SVYMATH_API double atan3(double y, double x);
// x wrapped into [lo, hi] by whole periods hi - lo, both ends possible; lo when lo >= hi.
SVYMATH_API double toRange(double x, double lo, double hi);
SVYMATH_API int toRange(int x, int lo, int hi);
// [0, 2pi] (2pi stays 2pi).
SVYMATH_API double Normalize0To2PI(double rad);
// [0, 2pi).
SVYMATH_API double Normalize0ToLt2Pi(double rad);
// Adds 2pi while negative, then subtracts 2pi while above pi: (pi, 2pi) comes out in (-pi, 0).
SVYMATH_API double Normalize0ToPi(double rad);
// (-pi, pi]: -pi is returned as pi.
SVYMATH_API double NormalizeNegPiToPi(double rad);
SVYMATH_API double NormalizeGtNegPiToPi(double rad);
// The rotation angle (radians) between two Cartesian coordinates; defined with the geodesy functions.
SVYMATH_API double rotRange(const Coord& from, const Coord& to);

// ---- sexagesimal forms ----
// (|d| + |m|/60 + |s|/3600), negative when any of the three is negative.
SVYMATH_API double dms_to_deg(double d, double m, double s);
// Whole degrees, whole minutes and seconds of x; the sign of x rides on the first non-zero of the three.
// Minutes may come out as 60 just below a whole degree (no carry).
SVYMATH_API void deg_to_dms(double x, double* d, double* m, double* s);
// Packed D.MMSSsss to decimal degrees (reduced modulo 360 in magnitude, sign kept).
SVYMATH_API double DDDMMSS2Deg(double packed);
// Split of decimal degrees into sign, degrees, minutes and seconds rounded to prec decimals on the total
// seconds, so no component reaches 60. Degrees beyond the int range give 0, 0, NaN.
SVYMATH_API void Deg2DDDMMSS(double deg, bool& negative, int& d, int& m, double& s, int prec);
// Decimal degrees to packed D.MMSSsss with prec decimals in the packed number (4 = whole seconds).
SVYMATH_API double Deg2DDDMMSS(double deg, int prec, bool noMod);
// Decimal degrees to packed degrees and decimal minutes D.MMmmm, the minutes rounded to prec decimals.
SVYMATH_API double Deg2DDMMDEC(double deg, int prec, bool noMod);
// Packed D.MMSS as text: degrees, degree sign, minutes, apostrophe, seconds with prec decimals, double
// quote. Minutes are not padded; the sign rides on the degrees, so it is lost between -1 and 0 degrees.
SVYMATH_API svy_text::CSvyStringT<wchar_t> DDDMMSS2String(double packed, int prec);
// Three text fields (degrees, minutes, seconds) to radians, reduced modulo 360 degrees; 0 when a field
// does not parse. The sign is taken from the degrees.
SVYMATH_API double AngleToRad(const svy_text::CSvyStringT<wchar_t>& degrees,
                              const svy_text::CSvyStringT<wchar_t>& minutes,
                              const svy_text::CSvyStringT<wchar_t>& seconds);
