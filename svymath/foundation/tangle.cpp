#include "svymath/foundation/tangle.h"

#include <cmath>

#include "svymath/foundation/angle_functions.h"

namespace svy_math {

double TAngle::getNegPIToPI() const { return NormalizeNegPiToPi(getRad()); }

TAngle absoluteAngle(const TAngle& angle) { return TAngle(std::fabs(angle.getRad())); }

}  // namespace svy_math
