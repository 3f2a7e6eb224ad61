// rotRange: the angle between two earth-centred Cartesian coordinates seen from the centre of the earth,
// i.e. the angle of the rotation about the centre that carries the direction of `from` onto that of `to`.
#include <cmath>

#include "svymath/foundation/angle_functions.h"
#include "svymath/foundation/constants.h"

double rotRange(const Coord& from, const Coord& to) {
  // atan2 of the cross and dot products keeps full precision for small and nearly opposite angles, where
  // acos of the normalised dot product would not.
  const double sinPart = from.VectorProduct(to).Module();
  const double cosPart = from * to;
  if (!std::isfinite(sinPart) || !std::isfinite(cosPart) || from.ModuleSq() == 0.0 || to.ModuleSq() == 0.0)
    return svy_math::undefinedValue();
  return std::atan2(sinPart, cosPart);
}
