#pragma once
// The length range rule of every curve position query (spiral laws, curve data records): a length a little
// outside the element, by less than the snap tolerance, is taken as the element's end, so that a length
// computed by summing element lengths still finds the end point.
#include "svymath/foundation/export.h"

namespace svy_math {

// Source name under which the curve code reports rejected lengths and undefined data to the error log.
constexpr const char* kCurvesLogSource = "mathCurves";

// A value below lo by less than tol::kSnap becomes lo, a value above hi by less than tol::kSnap becomes hi.
// Returns true when lo <= value <= hi afterwards (so false for NaN). The value is changed only by a snap.
SVYMATH_API bool snapToRange(double& value, double lo, double hi);

// Reports an unexpected state of the curve code to the error log at the caller's line.
SVYMATH_API void logCurveFailure(int line);

// The guard of the length queries: true when the data is defined and s lies in [0, length] after snapToRange
// (s snapped); otherwise false, with one log entry at the caller's line.
SVYMATH_API bool checkLengthOrLog(bool defined, double& s, double length, int line);

}  // namespace svy_math
