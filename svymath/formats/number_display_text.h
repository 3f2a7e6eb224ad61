#pragma once
// Numbers as display text: fixed decimals, the thousands sign between groups of three digits and the
// decimal sign of sign_strings.h, "-1,234,567.89". The text does not depend on the host's locale.
//
// Grouped text is for display: the user-number readers (String2Double) take a comma for a decimal point,
// so text meant to be read back is written with eFloatTextNoGrouping, and then reads back to the value
// rounded to the decimals written.
#include "svymath/foundation/export.h"
#include "svyutils/svy_string.h"

namespace svy_formats {

// Options of ConvertFloatEx and DegreeToStringEx, combined with '|'.
enum EFloatTextFlags : unsigned {
  eFloatTextPlain = 0,
  // Trailing zeros of the decimals are dropped, and the decimal sign with them when none remain:
  // 12.500 gives "12.5", 12.000 gives "12".
  eFloatTextTrimZeros = 1,
  // A '+' in front of a value that does not round to zero: "+12.50" (zero stays "0.00").
  eFloatTextPlusSign = 2,
  // No thousands sign: "1234567.89".
  eFloatTextNoGrouping = 4,
  // DegreeToStringEx only: no degree sign after the number.
  eFloatTextNoDegreeSign = 8,
};

// ConvertFloatEx(value, decimals, eFloatTextPlain): "1,234.50" for (1234.5, 2).
SVYMATH_API svy_text::CSvyString ConvertFloat(double value, int decimals);

// The value rounded half away from zero to `decimals` digits after the decimal sign (rounded on the decimal
// value the double stands for, so 2.675 gives "2.68"; a negative count rounds to tens, hundreds, ... and
// writes no decimal sign; counts beyond 17 count as 17). The whole part is grouped by threes with the
// thousands sign unless flags hold eFloatTextNoGrouping. A value that rounds to zero has no minus sign. A
// non-finite value gives an empty text.
SVYMATH_API svy_text::CSvyString ConvertFloatEx(double value, int decimals, unsigned flags);

}  // namespace svy_formats
