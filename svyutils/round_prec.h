#pragma once
// Decimal rounding of doubles.
#include "svyutils/svyutils_export.h"

namespace svy {
namespace math {

// value rounded half away from zero to `decimals` digits after the point (negative: to tens, hundreds,
// ...). The rounding works on the shortest decimal text that reads back as the same double, so values
// like 2.675 (stored as 2.67499999999999982...) round the way they are written: 2.68. Values that have
// no digits at that position (huge values, many decimals) and non-finite values are returned unchanged.
SVYUTILS_API double round_prec(double value, int decimals);

}  // namespace math
}  // namespace svy
