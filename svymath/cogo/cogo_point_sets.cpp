#include "svymath/cogo/cogo_point_sets.h"

#include <algorithm>
#include <cmath>
#include <cstddef>

namespace CogoFunctions {

namespace {

// The weighted mean relative to the first position; weights null means weight 1 for every position.
ECogoMathErrorCode meanOf(const svy_vector<C2dPos>& positions, const double* weights, TMeanPosition& result) {
  const std::size_t n = positions.size();
  if (n == 0) return eCogoInvalidInput;
  const C2dPos origin = positions.front();
  double weightSum = 0.0, sumN = 0.0, sumE = 0.0;
  for (std::size_t i = 0; i < n; ++i) {
    const double w = weights ? weights[i] : 1.0;
    if (!positions[i].isFinite() || !std::isfinite(w) || !(w > 0.0)) return eCogoInvalidInput;
    weightSum += w;
    sumN += w * (positions[i].north() - origin.north());
    sumE += w * (positions[i].east() - origin.east());
  }
  const double meanN = sumN / weightSum, meanE = sumE / weightSum;
  double squaresN = 0.0, squaresE = 0.0, maxDistance = 0.0;
  for (std::size_t i = 0; i < n; ++i) {
    const double w = weights ? weights[i] : 1.0;
    const double vN = positions[i].north() - origin.north() - meanN;
    const double vE = positions[i].east() - origin.east() - meanE;
    squaresN += w * vN * vN;
    squaresE += w * vE * vE;
    maxDistance = std::max(maxDistance, std::hypot(vN, vE));
  }
  TMeanPosition out;
  out.mean = C2dPos(origin.north() + meanN, origin.east() + meanE);
  if (!out.mean.isFinite() || !std::isfinite(squaresN + squaresE)) return eCogoInvalidInput;
  const double sampleFactor = n > 1 ? static_cast<double>(n) / static_cast<double>(n - 1) : 0.0;
  out.sdNorth = std::sqrt(squaresN / weightSum * sampleFactor);
  out.sdEast = std::sqrt(squaresE / weightSum * sampleFactor);
  out.maxDistance = maxDistance;
  out.count = static_cast<int>(n);
  result = out;
  return eCogoOk;
}

}  // namespace

ECogoMathErrorCode eScaleRotatePoints(svy_vector<C2dPos>& points, const C2dPos& base, double scale,
                                      const CMathAngle& angle) {
  if (!base.isFinite() || !std::isfinite(scale) || !(scale > 0.0) || !angle.isok()) return eCogoInvalidInput;
  for (const C2dPos& p : points)
    if (!p.isFinite()) return eCogoInvalidInput;
  for (C2dPos& p : points) {
    const double n = p.north() - base.north(), e = p.east() - base.east();
    p = C2dPos(base.north() + scale * angle.getRotatedNorth(n, e), base.east() + scale * angle.getRotatedEast(n, e));
  }
  return eCogoOk;
}

ECogoMathErrorCode eMeanPosition(const svy_vector<C2dPos>& positions, TMeanPosition& result) {
  return meanOf(positions, nullptr, result);
}

ECogoMathErrorCode eMeanPosition(const svy_vector<C2dPos>& positions, const svy_vector<double>& weights,
                                 TMeanPosition& result) {
  if (weights.size() != positions.size()) return eCogoInvalidInput;
  return meanOf(positions, weights.data(), result);
}

}  // namespace CogoFunctions
