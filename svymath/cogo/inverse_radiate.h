#pragma once
// Inverse and radiation between plane points, in 3-D and on a spherical earth.
//
// Argument order: functions on separate doubles take a plane point EASTING FIRST, then northing
// (x = east, y = north); Compute2DPointBLH takes latitude first, then longitude. TCoords records are
// read by field name (north, east, height).
// Azimuths are clockwise from north: azimuth = atan2(dE, dN); radian results get 2 pi added when atan2
// is negative, so they lie in [0, 2 pi].
// Zenith angles are radians from the upward vertical. Distances are metres.
// None of these functions logs or throws; they hold no state.
#include "svymath/foundation/export.h"
#include "svymath/foundation/positions.h"

// Azimuth (radians, from 0 to 2 pi) and distance from (e1, n1) to (e2, n2). Coincident points (both
// differences strictly within +-1e-12) get azimuth 0. Both outputs are always written; the result is
// whether both are finite.
SVYMATH_API bool Inverse2D(const double& e1, const double& n1, const double& e2, const double& n2,
                           double& azimuth, double& distance);

// Azimuth (radians, from 0 to 2 pi), slope distance and zenith angle (radians, 0 straight up) from point 1
// to point 2. Returns false and writes nothing when the slope distance is strictly within +-1e-12.
SVYMATH_API bool Inverse3D(const double& e1, const double& n1, const double& z1, const double& e2,
                           const double& n2, const double& z2, double& azimuth,
                           double& slopeDistance, double& zenith);

// The point at `distance` from (e, n) along `azimuth` (radians). Always true.
SVYMATH_API bool Radiate2D(const double& e, const double& n, const double& azimuth,
                           const double& distance, double& eastOut, double& northOut);

// The point at `distance` from (e, n) along azimuth + addedAngle (both decimal degrees). An added angle
// of +90 gives a perpendicular offset to the right, -90 to the left.
SVYMATH_API void Compute2DPoint(double e, double n, double distance, double azimuthDeg,
                                double addedAngleDeg, double& eastOut, double& northOut);

// A small step of `distance` metres from (latitude, longitude) (decimal degrees) along
// azimuth + addedAngle (decimal degrees) on a sphere of radius 6 371 000 m. At a pole (where the
// parallel has no radius) the longitude is left unchanged.
SVYMATH_API void Compute2DPointBLH(double latitude, double longitude, double distance,
                                   double azimuthDeg, double addedAngleDeg, double& latitudeOut,
                                   double& longitudeOut);

// Extends the 3-D line from -> through by `distance` beyond `through` (a negative distance goes back
// toward `from`) and writes north, east and height of `out` (its mask is left as it was). Returns 0 and
// writes nothing when the line is shorter than 1e-5 m or not finite; otherwise 1.
SVYMATH_API int Compute3DPoint(const TCoords& from, const TCoords& through, double distance,
                               TCoords& out);

// Plane distance between (x1, y1) and (x2, y2).
SVYMATH_API double HorizontalDistance(double x1, double y1, double x2, double y2);

// Rotates the plane vector (a, b) by `angleDeg` decimal degrees in the (a, b) axes:
// aOut = a cos t - b sin t, bOut = a sin t + b cos t; heightOut = height. aOut and bOut are first set
// to 0; a vector with a^2 + b^2 < 1e-16 returns 0 leaving them 0. Otherwise returns 1.
SVYMATH_API int dENSoutInfo(double a, double b, double height, double angleDeg, double& aOut,
                            double& bOut, double& heightOut);

// Plane distance between two records (heights ignored). False when a northing or easting is not
// finite, or the distance overflows.
SVYMATH_API bool boCompute2DDistanceBetweenCoords(const TCoords& p1, const TCoords& p2,
                                                  double& distance);

// Azimuth (radians, from 0 to 2 pi) from p1 to p2. False when a northing or easting is not finite or the
// points coincide within 1e-10 m in both northing and easting (azimuth then untouched).
SVYMATH_API bool boComputeAzimuthBetweenCoords(const TCoords& p1, const TCoords& p2,
                                               double& azimuth);
