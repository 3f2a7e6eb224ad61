#pragma once
// A local datum: the plane system of a site, tied to the ellipsoid at an origin (latitude, longitude,
// height). Three forms of a position take part:
//
//   geodetic (WGS)   latitude, longitude (radians; degrees in the *WGSCoords* forms), ellipsoidal height;
//   Ptl              the point in the local-level frame of the origin: (east, north, up) metres from the
//                    origin along the tangent plane's axes and the ellipsoid normal there (the order of
//                    blh_to_neu; `up` falls below the surface away from the origin, 7.8 cm at 1 km);
//   EN coordinates   the site's plane coordinates (north, east, height) as a TCoords: the Ptl's horizontal
//                    part turned to the site's grid north and moved to the false origin (north0, east0);
//                    height = height0 + up. The rotation is the angle (radians, clockwise) from true north
//                    to the site's grid north: a direction of true azimuth a has the site azimuth
//                    a - rotation.
//
// blh2loc / loc2blh are exact both ways (through earth-centred coordinates). PtlTodENU gives the
// (east, north, up) vector between two local points in the local-level frame of the first, which is what a
// baseline measured at that point reads.
#include "svymath/foundation/abstract_point.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/positions.h"
#include "svymath/geodesy/geo_coord.h"

namespace svy_math {

// The earth-centred difference (metres) of a local-level (east, north, up) vector at latitude blh[0] and
// longitude blh[1] (radians): the inverse rotation of blh_to_neu.
SVYMATH_API TAbstractPoint3<double> neu_to_xyz(const TAbstractPoint3<double>& blh, const TAbstractPoint3<double>& enu);

struct SVYMATH_API TLocDatum {
  GeoCoord origin;            // latitude, longitude (radians), ellipsoidal height (metres)
  double north0 = 0.0;        // site coordinates of the origin (metres)
  double east0 = 0.0;
  double height0 = 0.0;
  double rotation = 0.0;      // radians, clockwise from true north to the site's grid north
  Coord originXyz;            // the origin, earth-centred (set by InitializeLPS2)
  bool initialized = false;

  // Geodetic to Ptl (east, north, up) and back. False (out unchanged) before initialisation or on input
  // that is not finite or gives no geodetic position.
  bool blh2loc(const GeoCoord& blh, TAbstractPoint3<double>& ptl) const;
  bool loc2blh(const TAbstractPoint3<double>& ptl, GeoCoord& blh) const;
};

// Sets the datum's origin (radians, metres) and the site coordinates given to it, and marks it ready. False
// (datum unchanged) for a latitude outside [-pi/2, pi/2] or a value that is not finite.
SVYMATH_API bool InitializeLPS2(TLocDatum& datum, const GeoCoord& origin, double north0 = 0.0, double east0 = 0.0,
                                double height0 = 0.0, double rotation = 0.0);

// Site plane coordinates and Ptl both ways (false on an uninitialised datum or values not finite).
SVYMATH_API bool PtlToENCoords(const TLocDatum& datum, const TAbstractPoint3<double>& ptl, TCoords& en);
SVYMATH_API bool ENCoordsToPtl(const TLocDatum& datum, const TCoords& en, TAbstractPoint3<double>& ptl);

// Geodetic in degrees (latitude, longitude) and metres to Ptl and back; the longitude comes out in
// (-180, 180].
SVYMATH_API bool WGSCoordsToPtl(const TLocDatum& datum, double latDeg, double lonDeg, double height,
                                TAbstractPoint3<double>& ptl);
SVYMATH_API bool PtlToWGSCoords(const TLocDatum& datum, const TAbstractPoint3<double>& ptl, double& latDeg,
                                double& lonDeg, double& height);

// The (east, north, up) vector from local point `from` to local point `to`, in the local-level frame at
// `from` (not the origin's).
SVYMATH_API bool PtlTodENU(const TLocDatum& datum, const TAbstractPoint3<double>& from,
                           const TAbstractPoint3<double>& to, TAbstractPoint3<double>& denu);

}  // namespace svy_math

using svy_math::ENCoordsToPtl;
using svy_math::neu_to_xyz;
using svy_math::InitializeLPS2;
using svy_math::PtlTodENU;
using svy_math::PtlToENCoords;
using svy_math::PtlToWGSCoords;
using svy_math::WGSCoordsToPtl;
