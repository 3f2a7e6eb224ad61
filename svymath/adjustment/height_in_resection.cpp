// HeightInResection: the station height as the weighted mean of the heights of single sightings.
//
// Each sighting gives H = Ht + ht - hi - dH - (1 - k) d^2 / (2 R), with dH = S cos z (or d cot z from a
// known horizontal distance d). Its variance from the a-priori accuracies: with a slope distance,
// (cos z sd_S)^2 + (S sin z sd_z)^2; with a horizontal distance from coordinates, (d sd_z / sin^2 z)^2.
#include <cmath>

#include "svymath/adjustment/resection_model.h"
#include "svymath/foundation/constants.h"

namespace svy_math {

EResectionStatus HeightInResection(const TResectionObservation* observations, int count, double instrumentHeight,
                                   const C2dPos* station, const TResectionAccuracy& accuracy, double& height,
                                   double& sdHeight) {
  if (observations == nullptr || count <= 0) return eResTooFewObservations;
  if (!std::isfinite(instrumentHeight) || !(accuracy.zenith > 0.0)) return eResNotFinite;
  double sumWeights = 0.0, sumWeighted = 0.0;
  for (int i = 0; i < count; ++i) {
    const TResectionObservation& o = observations[i];
    const double known = station != nullptr ? std::hypot(o.north - station->north(), o.east - station->east())
                                            : undefinedValue();
    double dh = 0.0, horizontal = 0.0;
    if (!std::isfinite(o.height) || !std::isfinite(o.targetHeight) ||
        !detail::sightedHeightDifference(o, known, dh, horizontal))
      continue;
    const double sinZ = std::sin(o.zenith), cosZ = std::cos(o.zenith);
    const double variance =
        detail::observed(o.slopeDistance)
            ? std::pow(cosZ * detail::distanceSd(accuracy, o.slopeDistance), 2) +
                  std::pow(o.slopeDistance * sinZ * accuracy.zenith, 2)
            : std::pow(horizontal * accuracy.zenith / (sinZ * sinZ), 2);
    const double h = o.height + o.targetHeight - instrumentHeight - dh -
                     detail::curvatureAndRefraction(horizontal, accuracy.refraction);
    if (!std::isfinite(h) || !(variance > 0.0) || !std::isfinite(variance)) continue;
    sumWeights += 1.0 / variance;
    sumWeighted += h / variance;
  }
  if (sumWeights == 0.0) return eResTooFewObservations;
  height = sumWeighted / sumWeights;
  sdHeight = std::sqrt(1.0 / sumWeights);
  return eResOk;
}

}  // namespace svy_math
