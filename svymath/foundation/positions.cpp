#include "svymath/foundation/positions.h"

#include <cmath>

#include "svymath/foundation/constants.h"
#include "svymath/foundation/math_angle.h"

bool TCoords::hasFinitePlanPosition() const { return std::isfinite(north) && std::isfinite(east); }

void TCoords::rotateAroundZ(const CMathAngle& angle, const C2dPos& centre) {
  const double dn = north - centre.north();
  const double de = east - centre.east();
  north = centre.north() + angle.getRotatedNorth(dn, de);
  east = centre.east() + angle.getRotatedEast(dn, de);
}

C2dMinMax::C2dMinMax(const C2dPos& a, const C2dPos& b) {
  include(a);
  include(b);
}

void C2dMinMax::include(const C2dPos& p) {
  if (std::isnan(p.north()) || std::isnan(p.east())) return;
  if (empty) {
    minNorth = maxNorth = p.north();
    minEast = maxEast = p.east();
    empty = false;
    return;
  }
  minNorth = std::fmin(minNorth, p.north());
  minEast = std::fmin(minEast, p.east());
  maxNorth = std::fmax(maxNorth, p.north());
  maxEast = std::fmax(maxEast, p.east());
}

void C2dMinMax::include(const C2dMinMax& other) {
  if (other.empty) return;
  include(C2dPos(other.minNorth, other.minEast));
  include(C2dPos(other.maxNorth, other.maxEast));
}

bool C2dMinMax::contains(const C2dPos& p, double margin) const {
  return !empty && p.north() >= minNorth - margin && p.north() <= maxNorth + margin &&
         p.east() >= minEast - margin && p.east() <= maxEast + margin;
}

bool C2dMinMax::intersects(const C2dMinMax& other, double margin) const {
  return !empty && !other.empty && other.minNorth <= maxNorth + 2.0 * margin &&
         other.maxNorth >= minNorth - 2.0 * margin && other.minEast <= maxEast + 2.0 * margin &&
         other.maxEast >= minEast - 2.0 * margin;
}

double C2dSegment::getDistance(const C2dPos& p) const {
  const C2dPos along = end - start;
  const double length = along.Module();
  if (-svy_math::tol::kZero < length && length < svy_math::tol::kZero) return (p - end).Module();
  const C2dPos u = along / length;
  const C2dPos v = p - start;
  const double t = u * v;
  if (0.0 <= t && t <= length) return std::fabs(u.north() * v.east() - u.east() * v.north());
  const double toStart = (p - start).Module();
  const double toEnd = (p - end).Module();
  return toStart < toEnd ? toStart : toEnd;
}
