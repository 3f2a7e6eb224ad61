#pragma once
// Geodetic coordinates on the reference ellipsoid (see ellipsoid.h) and their conversion from earth-centred
// Cartesian coordinates. The opposite conversion is Coord::blh2xyz (positions.h), defined beside this one.
//
// Geodetic: latitude B (radians, positive north), longitude L (radians, positive east), ellipsoidal height
// h (metres), in that order. Cartesian (Coord): X towards latitude 0 / longitude 0, Y towards longitude
// +90 deg, Z towards the north pole, metres, origin at the centre of the ellipsoid.
#include "svymath/foundation/abstract_point.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/positions.h"

class SVYMATH_API GeoCoord : public svy_math::TAbstractPoint3<double> {
 public:
  using Base3 = svy_math::TAbstractPoint3<double>;

  GeoCoord() : Base3(0.0, 0.0, 0.0) {}
  GeoCoord(double latitude, double longitude, double height) : Base3(latitude, longitude, height) {}
  GeoCoord(const svy_math::TAbstractPoint<double, 3>& p) : Base3(p) {}  // NOLINT: point arithmetic results

  // All three components take the scalar.
  GeoCoord& operator=(double scalar) {
    Base3::operator=(scalar);
    return *this;
  }

  double& lat() { return m_comp[0]; }
  double lat() const { return m_comp[0]; }
  double& lon() { return m_comp[1]; }
  double lon() const { return m_comp[1]; }
  double& height() { return m_comp[2]; }
  double height() const { return m_comp[2]; }

  // Cartesian to geodetic by fixed-point iteration on t = tan(B), stopped when t changes by at most 1e-10.
  // The longitude comes out in [0, 2 pi): west longitudes are returned increased by 2 pi. Within 1e-10 m
  // of the polar axis the longitude is 0 and the latitude +-pi/2 (0 with h = -a at the centre).
  // Non-finite input, or an iteration that does not settle within a safety cap, gives NaN in all three.
  GeoCoord& xyz2blh(const Coord& cartesian);
};

static_assert(sizeof(GeoCoord) == 3 * sizeof(double), "geodetic coordinates are three doubles");
