#pragma once
// Geodetic positions (radians, metres) moved by north, east and up metres, and the offsets between two:
// the horizontal part is the azimuthal-equidistant offset of shiftLatLonByDelta / GetNeOffsetFromLatLon
// (geodesic.h), the up part the change of ellipsoidal height. The two are exact inverses. The local-level
// forms for earth-centred positions are Coord::offsetCoord and Coord::relatCoord (positions.h).
#include "svymath/foundation/export.h"
#include "svymath/geodesy/geo_coord.h"

namespace svy_math {

// False (to unchanged) on a latitude outside [-pi/2, pi/2] or a value that is not finite.
SVYMATH_API bool OffsetWgsCoords(const GeoCoord& from, double dNorth, double dEast, double dUp, GeoCoord& to);
SVYMATH_API bool GetOffsetFromWgsCoords(const GeoCoord& from, const GeoCoord& to, double& dNorth, double& dEast,
                                        double& dUp);

}  // namespace svy_math

using svy_math::GetOffsetFromWgsCoords;
using svy_math::OffsetWgsCoords;
