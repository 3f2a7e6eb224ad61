#include "svymath/geodesy/grid_ground.h"

#include <cmath>
#include <limits>

#include "svymath/foundation/constants.h"
#include "svymath/geodesy/geomath_consts.h"

namespace svy_math {
namespace {

bool isUsable(double factor, const C2dPos& base, const C2dPos& p) {
  return std::isfinite(factor) && factor > 0.0 && std::isfinite(base.north()) && std::isfinite(base.east()) &&
         std::isfinite(p.north()) && std::isfinite(p.east());
}

// base + factor * (p - base), the difference formed first so that survey coordinates keep their digits.
C2dPos scaleAbout(const C2dPos& base, double factor, const C2dPos& p) {
  return C2dPos(base.north() + factor * (p.north() - base.north()), base.east() + factor * (p.east() - base.east()));
}

}  // namespace

double CombinedScaleFactor(double latitude, double meanHeight, double gridScale) {
  if (!(std::fabs(latitude) <= units::kHalfPi) || !std::isfinite(meanHeight) || !std::isfinite(gridScale))
    return std::numeric_limits<double>::quiet_NaN();
  const double r = TGeomathConsts::gaussianRadius(latitude);
  if (!(r + meanHeight > 0.0)) return std::numeric_limits<double>::quiet_NaN();
  return gridScale * r / (r + meanHeight);
}

bool GroundToGrid(const C2dPos& base, double combinedFactor, const C2dPos& ground, C2dPos& grid) {
  if (!isUsable(combinedFactor, base, ground)) return false;
  grid = scaleAbout(base, combinedFactor, ground);
  return true;
}

bool GridToGround(const C2dPos& base, double combinedFactor, const C2dPos& grid, C2dPos& ground) {
  if (!isUsable(combinedFactor, base, grid)) return false;
  ground = scaleAbout(base, 1.0 / combinedFactor, grid);
  return true;
}

}  // namespace svy_math
