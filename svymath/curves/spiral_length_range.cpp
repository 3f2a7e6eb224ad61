#include "svymath/curves/spiral_length_range.h"

#include "svymath/foundation/constants.h"
#include "svyutils/svy_err_log.h"

namespace svy_math {

bool snapToRange(double& value, double lo, double hi) {
  if (value < lo && lo - value < tol::kSnap) {
    value = lo;
  } else if (value > hi && value - hi < tol::kSnap) {
    value = hi;
  }
  return lo <= value && value <= hi;
}

void logCurveFailure(int line) { svy_logging::svy_err_log(kCurvesLogSource, line, ""); }

bool checkLengthOrLog(bool defined, double& s, double length, int line) {
  if (defined && snapToRange(s, 0.0, length)) return true;
  logCurveFailure(line);
  return false;
}

}  // namespace svy_math
