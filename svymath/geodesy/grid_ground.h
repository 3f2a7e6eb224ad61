#pragma once
// Grid and ground distances. A projected grid shrinks or stretches lengths by its point scale factor, and
// lengths measured on the ground at a height h above the ellipsoid are longer than on the ellipsoid by
// (R + h) / R. Site software stakes out in ground distances by scaling grid coordinates about a base point
// by one combined factor for the site:
//
//   combined = gridScale * R / (R + h),   R the Gaussian radius sqrt(M N) at the site's latitude,
//   grid     = base + combined * (ground - base),   ground = base + (grid - base) / combined.
//
// Positions are (north, east) in metres, the base point common to both systems; latitude in radians.
#include "svymath/foundation/export.h"
#include "svymath/foundation/positions.h"

namespace svy_math {

// The combined factor of a site at `latitude` with mean height `meanHeight` above the ellipsoid and the
// projection's point scale factor `gridScale` there. NaN for a latitude outside [-pi/2, pi/2], a height at or
// below -R, or a value that is not finite.
SVYMATH_API double CombinedScaleFactor(double latitude, double meanHeight, double gridScale);

// Ground to grid and back about the base point. False (out unchanged) when the factor is not a positive
// finite number or a position is not finite.
SVYMATH_API bool GroundToGrid(const C2dPos& base, double combinedFactor, const C2dPos& ground, C2dPos& grid);
SVYMATH_API bool GridToGround(const C2dPos& base, double combinedFactor, const C2dPos& grid, C2dPos& ground);

}  // namespace svy_math

using svy_math::CombinedScaleFactor;
using svy_math::GridToGround;
using svy_math::GroundToGrid;
