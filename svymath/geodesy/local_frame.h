#pragma once
// Local-level frame at a geodetic position and polar form of a local vector.
//
// The local frame at (B, L) has east along increasing longitude, north along increasing latitude and up
// along the ellipsoid normal. Azimuths are radians clockwise from north in [0, 2 pi); elevation angles are
// radians above the horizontal plane, in [-pi/2, pi/2].
#include "svymath/foundation/abstract_point.h"
#include "svymath/foundation/export.h"

namespace svy_math {

// Rotates the Cartesian difference vector dxyz (metres) into the local frame at latitude blh[0] and
// longitude blh[1] (radians; blh[2] is not used). The result is (east, north, up) in metres.
SVYMATH_API TAbstractPoint3<double> blh_to_neu(const TAbstractPoint3<double>& blh, const TAbstractPoint3<double>& dxyz);

// Polar form of a local vector v = (east, north, up): (elevation angle, azimuth, slope distance). A vector
// whose horizontal length squared and up component both lie within +-1e-12 has no direction: both angles
// are then the largest double (1.7976931348623157e308) and the distance is 0.
SVYMATH_API TAbstractPoint3<double> neu_to_polar(const TAbstractPoint3<double>& v);

}  // namespace svy_math

using svy_math::blh_to_neu;
using svy_math::neu_to_polar;
