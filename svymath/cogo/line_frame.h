#pragma once
// A straight line as a local frame, internal to the coordinate-geometry subsystem: its origin, its unit
// direction u = (uN, uE) and the right-hand normal n = (-uE, uN). A position in the frame is (along,
// offset), the offset positive to the right of u, as everywhere in the library. Working in the frame keeps
// the digits of survey coordinates: only differences from the origin are multiplied.
#include <cmath>

#include "svymath/foundation/constants.h"
#include "svymath/foundation/positions.h"

namespace svy_math {
namespace detail {

struct TLineFrame {
  C2dPos origin;
  double uN = 1.0;
  double uE = 0.0;
  double length = 0.0;  // from the origin to the point that set the direction (metres)

  // The frame from `from` toward `to`; false (the frame unchanged) when they coincide within the zero
  // tolerance or their distance is not finite.
  bool set(const C2dPos& from, const C2dPos& to) {
    const double dN = to.north() - from.north();
    const double dE = to.east() - from.east();
    const double d = std::hypot(dN, dE);
    if (!(d >= tol::kZero) || !std::isfinite(d)) return false;
    origin = from;
    uN = dN / d;
    uE = dE / d;
    length = d;
    return true;
  }
  // The position origin + along u + offset n.
  C2dPos at(double along, double offset) const {
    return C2dPos(origin.north() + along * uN - offset * uE, origin.east() + along * uE + offset * uN);
  }
  double alongOf(const C2dPos& p) const { return uN * (p.north() - origin.north()) + uE * (p.east() - origin.east()); }
  double offsetOf(const C2dPos& p) const { return uN * (p.east() - origin.east()) - uE * (p.north() - origin.north()); }
};

}  // namespace detail
}  // namespace svy_math
