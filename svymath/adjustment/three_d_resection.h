#pragma once
// Free-station resection: the position, height and orientation of a total-station setup from observations
// to two or more known points, by least squares (Gauss-Newton on the library's engine), and the station
// height alone from zenith angles and distances.
//
// Conventions: plan positions (north, east) and heights in metres; a horizontal direction is the circle
// reading in radians, increasing clockwise; the orientation is the azimuth of the circle's zero direction,
// so that azimuth = direction + orientation; zenith angles are radians from the upward vertical. The
// station height is that of the ground mark: the instrument's axis is `instrumentHeight` above it, and a
// target's sighted point `targetHeight` above the known point.
//
// Trigonometric heights take the earth's curvature and refraction into account: a target at horizontal
// distance d appears (1 - k) d^2 / (2 R) lower than on a plane (R = 6 371 000 m, k the refraction
// coefficient; 8 mm at 350 m for k = 0.13).
//
// Without any zenith angle the height is not solved (NaN) and distances are taken as horizontal.
//
// Standard deviations come from the a-priori accuracies (variance factor 1): when the observations are as
// good as stated, the errors of the result are normally distributed with these deviations. sigma0, the a
// posteriori standard error of unit weight, tells whether they are (near 1) or not.
#include <cstdint>

#include "svymath/foundation/export.h"
#include "svymath/foundation/positions.h"
#include "svyutils/svy_containers.h"

namespace svy_math {

// Source name of the resection's error-log entries.
constexpr const char* kResectionLogSource = "3DRESECT";

enum EResectionStatus : std::int32_t {
  eResOk = 0,
  // Fewer observations than unknowns, fewer than two targets, or no horizontal direction.
  eResTooFewObservations = 1,
  // The geometry fixes no unique station: targets coincide, all on a line through the station, the
  // station on the circle through three direction-only targets, or no starting position was found.
  eResDegenerate = 2,
  // An observation or a known point is not finite, or an accuracy is not positive.
  eResNotFinite = 3,
  // The iteration did not settle (observations that contradict each other grossly).
  eResNoConvergence = 4,
};

// One sighting of a known point. Quantities not observed are NaN (svy_math::undefinedValue()).
struct SVYMATH_API TResectionObservation {
  double north = 0.0;          // the known point (metres)
  double east = 0.0;
  double height = 0.0;         // not needed when neither a zenith angle nor the height is used
  double direction;            // horizontal circle reading (radians, clockwise) or NaN
  double zenith;               // zenith angle (radians) or NaN
  double slopeDistance;        // metres, or NaN
  double targetHeight = 0.0;   // metres above the known point
  TResectionObservation();
};

// A-priori standard deviations of the observations and the refraction coefficient.
struct SVYMATH_API TResectionAccuracy {
  double direction;         // radians (default 3 seconds of arc)
  double zenith;            // radians (default 3 seconds of arc)
  double distanceConstant;  // metres (default 2 mm)
  double distancePpm;       // parts per million of the distance (default 2)
  double refraction;        // coefficient k (default 0.13); the curvature always applies
  TResectionAccuracy();
};

// Residuals (observed minus adjusted) of one sighting; NaN for what was not observed.
struct SVYMATH_API TResectionResidual {
  double direction;  // radians
  double zenith;     // radians
  double distance;   // metres
};

struct SVYMATH_API TResectionResult {
  double north = 0.0;
  double east = 0.0;
  double height = 0.0;       // NaN without zenith angles
  double orientation = 0.0;  // radians in [0, 2 pi)
  double sdNorth = 0.0, sdEast = 0.0, sdHeight = 0.0, sdOrientation = 0.0;
  double sigma0 = 0.0;  // NaN without redundancy
  svy_vector<TResectionResidual> residuals;  // one per observation, in order
};

// Computes the free station. On failure, result is left as it was.
SVYMATH_API EResectionStatus ThreeDResection(const TResectionObservation* observations, int count,
                                             double instrumentHeight, const TResectionAccuracy& accuracy,
                                             TResectionResult& result);

// The station's ground-mark height alone, as the weighted mean of the heights each zenith angle gives.
// A sighting needs a zenith angle and either a slope distance or, when `station` is not null, the known
// plan position of the station (the horizontal distance then comes from the coordinates). sdHeight is the
// standard deviation of the mean from the a-priori accuracies. eResTooFewObservations without any usable
// sighting; outputs untouched on failure.
SVYMATH_API EResectionStatus HeightInResection(const TResectionObservation* observations, int count,
                                               double instrumentHeight, const C2dPos* station,
                                               const TResectionAccuracy& accuracy, double& height,
                                               double& sdHeight);

}  // namespace svy_math

using svy_math::HeightInResection;
using svy_math::ThreeDResection;
