#pragma once
// The one reference ellipsoid of the geodesy functions.
//
// It is defined by the semi-major axis a = 6378137 m and the first eccentricity e = 0.0818191913305, stored
// exactly as that decimal (not derived from a flattening). Its e^2 = 0.006694380069977 therefore differs
// from the usual tabulated value by about 8e-11, which moves a surface point by up to 0.4 mm against an
// ellipsoid defined by 1/f = 298.257223563.
#include "svymath/foundation/export.h"

namespace svy_math {

struct SVYMATH_API TEllipsoidParams {
  double a;           // semi-major axis (metres)
  double e;           // first eccentricity
  double e2;          // e^2
  double ep2;         // second eccentricity squared: e2 / (1 - e2)
  double onePlusEp2;  // 1 + ep2
  double c;           // polar radius of curvature: a / sqrt(1 - e2) (metres)
};

// The ellipsoid, built on first use and read-only afterwards; safe to call from any thread.
SVYMATH_API const TEllipsoidParams& ellipsoidParams();

}  // namespace svy_math
