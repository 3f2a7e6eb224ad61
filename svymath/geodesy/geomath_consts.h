#pragma once
// Quantities of the reference ellipsoid (see ellipsoid.h) that site computations use: its axes, flattening
// and radii of curvature. Latitudes in radians, lengths in metres.
#include "svymath/foundation/export.h"

namespace svy_math {

struct SVYMATH_API TGeomathConsts {
  // Semi-major axis a, semi-minor axis b = a sqrt(1 - e^2), flattening f = 1 - b / a, e^2, e'^2.
  static double a();
  static double b();
  static double f();
  static double e2();
  static double ep2();
  // Mean radius (2a + b) / 3.
  static double meanRadius();
  // Radius of curvature in the meridian M = a (1 - e^2) / W^3 and in the prime vertical N = a / W, with
  // W = sqrt(1 - e^2 sin^2 B); their geometric mean sqrt(M N) is the Gaussian radius, the radius of the
  // sphere that fits the ellipsoid best about the latitude in every direction.
  static double meridianRadius(double latitude);
  static double primeVerticalRadius(double latitude);
  static double gaussianRadius(double latitude);
};

// cos(latitude), exactly 0 at +-pi/2 (where cos gives 6e-17): the pole test of callers stays exact.
SVYMATH_API double cosphi(double latitude);

// Radians of longitude per metre eastwards along the parallel of `latitude` at `height` above the
// ellipsoid: 1 / ((N + h) cos B). Infinite at a pole, where the parallel has no length.
SVYMATH_API double invlon(double latitude, double height = 0.0);

}  // namespace svy_math

using svy_math::cosphi;
using svy_math::invlon;
