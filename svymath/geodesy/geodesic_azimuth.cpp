// CMathAngle::setAzFromLatLon: the forward azimuth of the geodesic (the shortest path on the reference
// ellipsoid) from one geodetic position to another, from the inverse geodesic problem (geodesic.h), which
// converges for every pair, nearly antipodal ones included.
#include <cmath>

#include "svymath/foundation/math_angle.h"
#include "svymath/geodesy/geodesic.h"

bool CMathAngle::setAzFromLatLon(double lat1, double lon1, double lat2, double lon2) {
  double distance = 0.0, azimuth1 = 0.0, azimuth2 = 0.0;
  if (!svy_math::invers(lat1, lon1, lat2, lon2, distance, azimuth1, azimuth2) || distance == 0.0) return false;
  setRad(azimuth1);
  return true;
}
