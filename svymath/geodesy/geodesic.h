#pragma once
// Geodesics on the reference ellipsoid (see ellipsoid.h): the shortest path between two positions.
//
// Conventions: latitudes and longitudes in radians (latitude positive north, longitude positive east),
// azimuths in radians clockwise from north in (-pi, pi], distances in metres along the ellipsoid surface.
// The azimuth at the second point is the FORWARD azimuth there (the direction of travel on arrival); the
// back azimuth is that plus pi.
//
// The solution works on the auxiliary sphere of reduced latitudes with series in the third flattening for
// the distance and longitude integrals (sixth order: truncation far below a micrometre on the earth). The
// inverse problem is solved by Newton's method on the azimuth at the first point, bracketed by bisection,
// from a starting azimuth that for nearly antipodal points comes from the astroid approximation: it
// converges for every pair, the antipodal ones included, in a bounded number of steps.
#include "svymath/foundation/export.h"

namespace svy_math {

// Inverse problem: the geodesic distance and the forward azimuths at both ends from (lat1, lon1) to
// (lat2, lon2). Returns false, writing nothing, when a latitude lies outside [-pi/2, pi/2] or a value is
// not finite. Coincident points give distance 0 and the azimuths of their meridian (0 or pi). For
// exactly antipodal points every azimuth leads to the other point; one of them is returned.
SVYMATH_API bool invers(double lat1, double lon1, double lat2, double lon2, double& distance, double& azimuth1,
                        double& azimuth2);

// Direct problem: the end (lat2, lon2) and forward azimuth there of the geodesic that leaves (lat1, lon1)
// along azimuth1 for `distance` metres (negative: backwards). The longitude comes out in [-pi, pi].
// Returns false, writing nothing, for a latitude outside [-pi/2, pi/2] or a value that is not finite. At a
// pole the azimuth is taken as measured from the meridian of lon1.
SVYMATH_API bool frgeod(double lat1, double lon1, double azimuth1, double distance, double& lat2, double& lon2,
                        double& azimuth2);

// Moves a position by north and east metres: the point at the geodesic distance hypot(dNorth, dEast) along
// the azimuth atan2(dEast, dNorth). This is the azimuthal-equidistant offset about the start, exact at any
// length and undone by GetNeOffsetFromLatLon. Radians in and out; false (nothing written) on bad input.
SVYMATH_API bool shiftLatLonByDelta(double lat, double lon, double dNorth, double dEast, double& latOut,
                                    double& lonOut);

// North and east metres of (lat2, lon2) from (lat1, lon1): the geodesic distance split along the azimuth
// at the first point. Radians in; false (nothing written) on bad input.
SVYMATH_API bool GetNeOffsetFromLatLon(double lat1, double lon1, double lat2, double lon2, double& dNorth,
                                       double& dEast);

}  // namespace svy_math

using svy_math::frgeod;
using svy_math::GetNeOffsetFromLatLon;
using svy_math::invers;
using svy_math::shiftLatLonByDelta;
