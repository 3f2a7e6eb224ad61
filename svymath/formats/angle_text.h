#pragma once
// Angles as text for display and from user input, in three forms of decimal degrees:
//   degrees, minutes, seconds   "45°30'15.25\""   (DMS)
//   degrees, decimal minutes    "45°30.254'"      (DMM)
//   decimal degrees             "45.50424°"
// Written texts pad minutes and whole seconds to two digits and carry the sign in front of the whole
// angle ("-0°30'00\""), so every written text reads back. For the packed DDD.MMSS number forms see
// DDDMMSS2String and CheckValidDMSVal.
//
// Reading accepts what users type: surrounding blanks, a leading '-' or '+', a decimal comma, and between
// the fields either the unit marks (degree sign or 'd'; apostrophe, prime or 'm'; double quote, double
// prime or 's'), a colon or blanks ("45 30 15.25", "45:30:15", "45d30m15s", "-12°05'"). Only the last
// field may have decimals; minutes and seconds must be below 60; a mark must belong to its field's place.
// On failure the output is left untouched and false is returned.
#include "svymath/foundation/export.h"
#include "svyutils/svy_string.h"

namespace svy_formats {

// Written forms; the last field is rounded half away from zero on the total of its unit, so no field
// reaches 60. Decimal counts below 0 count as 0 and beyond 9 as 9. A non-finite angle gives "", and so
// does a DMS angle whose degrees exceed the range of int.
SVYMATH_API svy_text::CSvyString DMSToString(double degrees, int secondDecimals);
SVYMATH_API svy_text::CSvyString DMMToString(double degrees, int minuteDecimals);
SVYMATH_API svy_text::CSvyString DegreeToString(double degrees, int decimals);

// Readers of one to three fields (DMS), one or two (DMM) and one (decimal degrees), in decimal degrees.
SVYMATH_API bool ParseDMS(const svy_text::CSvyString& text, double& degrees);
SVYMATH_API bool ParseDMM(const svy_text::CSvyString& text, double& degrees);
SVYMATH_API bool ParseDegree(const svy_text::CSvyString& text, double& degrees);
// Any of the three forms (the DMS reader accepts them all).
SVYMATH_API bool StringToDegree(const svy_text::CSvyString& text, double& degrees);

SVYMATH_API bool is_str_degree(const svy_text::CSvyString& text);
SVYMATH_API bool is_str_dmm(const svy_text::CSvyString& text);

}  // namespace svy_formats
