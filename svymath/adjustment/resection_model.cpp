#include "svymath/adjustment/resection_model.h"

#include <cmath>

#include "svymath/foundation/constants.h"

namespace svy_math {

TResectionObservation::TResectionObservation()
    : direction(undefinedValue()), zenith(undefinedValue()), slopeDistance(undefinedValue()) {}

TResectionAccuracy::TResectionAccuracy()
    : direction(units::kDefaultAngleSd),
      zenith(units::kDefaultAngleSd),
      distanceConstant(units::kDefaultDistanceSd),
      distancePpm(units::kDefaultDistancePpm),
      refraction(units::kRefractionCoefficient) {}

namespace detail {

double curvatureAndRefraction(double horizontalDistance, double refraction) {
  return (1.0 - refraction) * horizontalDistance * horizontalDistance / (2.0 * units::kSphereEarthRadius);
}

bool sightedHeightDifference(const TResectionObservation& o, double knownHorizontal, double& dHeight,
                             double& horizontal) {
  if (!observed(o.zenith)) return false;
  if (observed(o.slopeDistance)) {
    dHeight = o.slopeDistance * std::cos(o.zenith);
    horizontal = o.slopeDistance * std::sin(o.zenith);
    return true;
  }
  if (!observed(knownHorizontal) || std::sin(o.zenith) <= 0.0) return false;
  dHeight = knownHorizontal * std::cos(o.zenith) / std::sin(o.zenith);
  horizontal = knownHorizontal;
  return true;
}

double distanceSd(const TResectionAccuracy& accuracy, double distance) {
  return accuracy.distanceConstant + accuracy.distancePpm * units::kPartsPerMillion * std::fabs(distance);
}

}  // namespace detail
}  // namespace svy_math
