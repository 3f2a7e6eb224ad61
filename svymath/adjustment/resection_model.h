#pragma once
// Internal to the resection: the observation model shared by the adjustment, its starting position and the
// height-only solution.
#include "svymath/adjustment/three_d_resection.h"

namespace svy_math {
namespace detail {

// How far a target at horizontal distance d (metres) appears below the station's horizontal plane through
// the earth's curvature, less the lift of refraction: (1 - k) d^2 / (2 R).
double curvatureAndRefraction(double horizontalDistance, double refraction);

// Height difference from the instrument's axis to the sighted point that one sighting gives, before the
// curvature term: S cos z with a slope distance, else d / tan z for a known horizontal distance d (NaN
// for none). Also the horizontal distance of the sighting (S sin z, or d).
bool sightedHeightDifference(const TResectionObservation& o, double knownHorizontal, double& dHeight,
                             double& horizontal);

// Standard deviation of a measured distance (metres).
double distanceSd(const TResectionAccuracy& accuracy, double distance);

// Whether the observation has a direction, a zenith angle, a distance.
inline bool observed(double value) { return value == value; }

}  // namespace detail
}  // namespace svy_math
