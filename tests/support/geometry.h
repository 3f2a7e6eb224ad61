#pragma once
// Small geometric helpers shared by the tests.
#include <cmath>

#include "svymath/foundation/math_angle.h"

namespace svy_test {

// An angle set from radians.
inline CMathAngle radians(double r) {
  CMathAngle a;
  a.setRad(r);
  return a;
}

// Plan distance between two positions.
inline double dist(const C2dPos& a, const C2dPos& b) { return std::hypot(a.north() - b.north(), a.east() - b.east()); }

}  // namespace svy_test
