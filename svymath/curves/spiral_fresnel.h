#pragma once
// Fresnel integrals in the normalisation of the clothoid law:
//   C(t) = integral from 0 to t of cos(pi*u^2/2) du,   S(t) = integral from 0 to t of sin(pi*u^2/2) du.
// Both are odd functions; they tend to 1/2 as t grows (and to -1/2 as t falls).
#include "svymath/foundation/export.h"

namespace svy_math {

// Writes S(t) and C(t). Accurate to a few units of the last place for every finite t: a power series below
// |t| = 1.5 and a continued fraction at and above it. An infinite t gives the limits (+-1/2), NaN gives NaN.
SVYMATH_API void fresnelCS(double t, double& S, double& C);

}  // namespace svy_math
