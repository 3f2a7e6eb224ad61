#include "svymath/curves/spiral_length_range.h"

#include "svymath/foundation/constants.h"

namespace svy_math {

bool snapToRange(double& value, double lo, double hi) {
  if (value < lo && lo - value < tol::kSnap) {
    value = lo;
  } else if (value > hi && value - hi < tol::kSnap) {
    value = hi;
  }
  return lo <= value && value <= hi;
}

}  // namespace svy_math
