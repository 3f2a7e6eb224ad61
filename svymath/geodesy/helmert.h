#pragma once
// Seven-parameter (Helmert) transformation between earth-centred reference frames, and the first-order
// Gauss-Markov process used for correlated GNSS errors.
//
// Helmert, position-vector convention (the one of the published frame-to-frame transformations): a
// position X (metres) of the `from` frame has in the `to` frame
//
//   X' = T + (1 + scalePpm 1e-6) R X,
//
// with T = (tx, ty, tz) metres and R the rotation of the VECTOR by rx, ry, rz radians about the X, Y, Z
// axes, positive anticlockwise seen from the positive axis towards the origin:
//   rigorous     R = Rz(rz) Ry(ry) Rx(rx), orthogonal at any angle;
//   small-angle  R = I + [[0, -rz, ry], [rz, 0, -rx], [-ry, rx, 0]], the first-order form to which the
//                published parameters (milliarcseconds) are given; it differs from the rigorous one by
//                about r^2 |X| (below 0.01 mm for r < 1e-6 rad).
// Parameters given in the coordinate-frame convention are these with the three rotations negated.
// The inverse direction solves the same relation for X exactly (R^T, or the closed inverse of I + [r]x).
#include "svymath/foundation/export.h"
#include "svymath/foundation/positions.h"

namespace svy_math {

struct SVYMATH_API THelmertParams {
  double tx = 0.0, ty = 0.0, tz = 0.0;  // metres
  double rx = 0.0, ry = 0.0, rz = 0.0;  // radians, position-vector convention
  double scalePpm = 0.0;                // parts per million
};

enum EHelmertRotation { eHelmertSmallAngle = 0, eHelmertRigorous = 1 };

// Transforms `in` from the `from` frame to the `to` frame, or back when inverse is true. False (out
// unchanged) when a value is not finite or the scale is -1e6 ppm or below.
SVYMATH_API bool ECRFCorrections(const Coord& in, const THelmertParams& params, EHelmertRotation form, bool inverse,
                                 Coord& out);

// One step of a first-order Gauss-Markov process x(t + dt) = exp(-dt / tau) x(t) + w, whose white driving
// noise w keeps the process's variance at steadyStateVariance: from the current expectation and variance,
// the expectation and variance after `step` (seconds, >= 0) for the correlation time tau (seconds, > 0):
//   mean' = phi mean,   variance' = phi^2 variance + steadyStateVariance (1 - phi^2),   phi = exp(-step/tau).
// False (outputs unchanged) for tau <= 0, a negative step, a negative variance or values not finite.
SVYMATH_API bool firstOrderGaussMarkov(double mean, double variance, double correlationTime, double step,
                                       double steadyStateVariance, double& nextMean, double& nextVariance);

}  // namespace svy_math

using svy_math::ECRFCorrections;
using svy_math::firstOrderGaussMarkov;
