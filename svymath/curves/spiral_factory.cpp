#include "svymath/curves/spiral_factory.h"

#include "svymath/curves/spiral_cubic.h"
#include "svymath/curves/spiral_euler.h"

namespace svy_math {

CCurveSpiralTStoSCBase* createSpiralLaw(AlntMathSpiralType type) {
  if (type == eMathSpiralCubic) return new CCubicSpiralTStoSC();
  return new CEulerSpiralTStoSC();
}

}  // namespace svy_math
