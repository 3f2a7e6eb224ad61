#include "svymath/cogo/similarity_2d.h"

#include <cmath>

namespace svy_math {

C2dPos TSimilarity2d::forward(const C2dPos& from) const {
  const double a = scale * std::cos(rotation), b = scale * std::sin(rotation);
  return C2dPos(shift.north() + a * from.north() - b * from.east(), shift.east() + b * from.north() + a * from.east());
}

bool TSimilarity2d::inverse(const C2dPos& to, C2dPos& from) const {
  if (!std::isfinite(scale) || scale == 0.0) return false;
  // R(t)^-1 = R(-t), applied to (to - shift) / scale.
  const double c = std::cos(rotation) / scale, s = std::sin(rotation) / scale;
  const double dn = to.north() - shift.north(), de = to.east() - shift.east();
  from = C2dPos(c * dn + s * de, -s * dn + c * de);
  return true;
}

}  // namespace svy_math
