#pragma once
// Sets of points: scaling and rotating them about a base point, and the (weighted) mean of repeated
// positions of one point with its spread.
//
// Plan positions are (northing, easting); a positive rotation turns clockwise on the map; lengths are
// metres. Sums are taken relative to the base point or the first position, so that survey coordinates
// (N 5 000 000) keep their digits. Nothing here logs or throws; a result other than eCogoOk leaves the
// outputs as they were.
#include "svymath/cogo/cogo_results.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/math_angle.h"
#include "svymath/foundation/positions.h"
#include "svyutils/svy_containers.h"

namespace CogoFunctions {

// The mean of repeated positions and their spread about it.
struct TMeanPosition {
  C2dPos mean;
  // Sample standard deviations of the northings and eastings about the mean (metres): with weights w_i and
  // n positions, sqrt(sum w_i v_i^2 / sum w_i * n / (n - 1)); 0 for a single position.
  double sdNorth = 0.0;
  double sdEast = 0.0;
  // The largest plan distance of a position from the mean (metres).
  double maxDistance = 0.0;
  int count = 0;
};

// Moves every point p to base + scale * R(angle) (p - base): scaled about the base point and rotated about
// it clockwise by angle. eCogoInvalidInput (points unchanged) for a scale that is not positive and finite,
// a base or a point that is not finite.
SVYMATH_API ECogoMathErrorCode eScaleRotatePoints(svy_vector<C2dPos>& points, const C2dPos& base, double scale,
                                                  const CMathAngle& angle);

// The mean of the positions, each with weight 1.
SVYMATH_API ECogoMathErrorCode eMeanPosition(const svy_vector<C2dPos>& positions, TMeanPosition& result);
// The weighted mean of the positions: weights positive and finite, one per position. eCogoInvalidInput
// for an empty list, a count mismatch, a bad weight or a position that is not finite.
SVYMATH_API ECogoMathErrorCode eMeanPosition(const svy_vector<C2dPos>& positions, const svy_vector<double>& weights,
                                             TMeanPosition& result);

}  // namespace CogoFunctions
