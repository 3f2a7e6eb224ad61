#pragma once
// Preparation of a number for a truncating conversion to a fixed count of decimals.
#include "svymath/foundation/export.h"

namespace svy_formats {

// x plus half a unit of the last kept decimal, with the sign of x: h = 0.5 * 10^-digits (0.5 * 10^|digits|
// for negative digits); the result is x + h when x > 0 and x - h otherwise, so 0 gives -h. The result is
// not truncated: the caller's conversion does that. NaN stays NaN.
SVYMATH_API double RoundDouble(double x, int digits);

}  // namespace svy_formats
