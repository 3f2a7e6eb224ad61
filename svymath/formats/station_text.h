#pragma once
// Stations (chainages) as text: a whole count of station intervals, a plus sign and the remainder in
// metres, "1+234.57" for 1234.567 m with an interval of 1000 m. Both parts carry the sign of a negative
// station ("-1+-234.50"), so that every text this module writes reads back to the same station.
#include "svymath/foundation/export.h"
#include "svyutils/svy_string.h"

// The text "%d+%.2f" of k = station / interval truncated toward zero and r = station - k * interval.
// The remainder is not zero-padded ("1+5.30") and is rounded only by the formatting, so 999.999 gives
// "0+1000.00" with no carry into the count. interval (metres per station unit, e.g. 1000 or 100) must
// not be 0. When the quotient is NaN or beyond the range of a 32-bit int, k is INT_MIN, the value a
// truncating hardware conversion gives, and r is computed from it as usual.
SVYMATH_API svy_text::CSvyString StnToString(double station, double interval);

// Reads a station text: commas count as decimal points; a text without '+' is one number in metres; a
// text with '+' is read as "%d+%lf" and gives k * interval + r. Leading blanks are skipped and anything
// after the last number is ignored ("1+5 m" is 1005 with an interval of 1000). Returns 1 on success and
// 0 on failure ("1+", "+5", "1e+3"), leaving station untouched.
SVYMATH_API int StnFromString(const svy_text::CSvyString& text, double& station, double interval);
