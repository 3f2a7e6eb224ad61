#pragma once
// Angles of decimal degrees as display text with the degree sign, and the packed forms surveyors key in:
//   decimal degrees               "45.504236°"
//   packed DDD.MMSS               "45.301525°"  (45°30'15.25": degrees, point, two digits of minutes, two
//                                                of seconds, then decimals of seconds)
//   packed DD.MMmm                "45.30254"    (45°30.254': degrees, point, two digits of minutes, then
//                                                decimals of minutes)
// The sign goes in front of the whole angle. Written texts read back: the decimal form with ParseDegree,
// the packed DDD.MMSS form with CheckDegreeSuffix and DDDMMSS2Deg (CheckValidDMSVal accepts it), the
// packed DD.MMmm form with FromStringDMM. Numbers use the decimal sign of sign_strings.h; angles are
// never grouped by thousands.
#include "svymath/formats/number_display_text.h"
#include "svymath/foundation/export.h"
#include "svyutils/svy_string.h"

namespace svy_formats {

// Output forms of DegreesToString.
enum EDegreeTextForm : int {
  eDegreeTextDecimal = 0,
  eDegreeTextPackedDMS = 1,
};

// Decimal degrees with the options of ConvertFloatEx (grouping never applies) and the degree sign unless
// flags hold eFloatTextNoDegreeSign: (12.5, 3, eFloatTextTrimZeros | eFloatTextPlusSign) gives "+12.5°".
// Decimals are clamped to 0..9. A non-finite angle gives an empty text.
SVYMATH_API svy_text::CSvyString DegreeToStringEx(double degrees, int decimals, unsigned flags);

// The decimal form: the same text as DegreeToString, "45.5042°" for (45.504236, 4).
SVYMATH_API svy_text::CSvyString DegreesToString(double degrees, int decimals);
// The decimal form as above, or the packed DDD.MMSS form with the degree sign: decimals then counts the
// decimals of the seconds (0..9), the angle is rounded on its total seconds (so no field reaches 60) and
// not reduced to one turn: (-370.5, eDegreeTextPackedDMS, 0) gives "-370.3000°". A non-finite angle, or a
// packed angle whose degrees exceed the range of int, gives an empty text.
SVYMATH_API svy_text::CSvyString DegreesToString(double degrees, EDegreeTextForm form, int decimals);

// Reads the packed DD.MMmm text (the form of Deg2DDMMDEC): optional blanks and sign, the degrees, and
// optionally a point followed by the minutes, whose first two digits are the whole minutes (one digit
// stands for its tens, "45.5" is 45°50') and the rest their decimals; a trailing degree sign or 'd' is
// accepted and a comma counts as the point. "45.30254" gives 45 + 30.254 / 60. Minutes of 60 or more, any
// other character, or no degree digits make it fail: false, degrees untouched.
SVYMATH_API bool FromStringDMM(const svy_text::CSvyString& text, double& degrees);

// When text (ignoring trailing blanks) ends in a degree sign, 'd' or 'D', removes that mark and the blanks
// around it and returns true: "45.5 °" becomes "45.5". Otherwise returns false and leaves text unchanged.
SVYMATH_API bool CheckDegreeSuffix(svy_text::CSvyString& text);

}  // namespace svy_formats
