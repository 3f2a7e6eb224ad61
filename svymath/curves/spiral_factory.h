#pragma once
// Creation of a spiral law from its type.
#include "svymath/curves/spiral_base.h"

namespace svy_math {

// A new undefined law of the given type, owned by the caller; the clothoid for an unknown type value.
SVYMATH_API CCurveSpiralTStoSCBase* createSpiralLaw(AlntMathSpiralType type);

}  // namespace svy_math
