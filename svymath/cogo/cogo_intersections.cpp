#include "svymath/cogo/cogo_intersections.h"

#include <algorithm>
#include <cmath>

#include "svymath/cogo/circle_solvers.h"
#include "svymath/foundation/constants.h"

namespace CogoFunctions {

namespace {

using svy_math::tol::kZero;

bool isPositiveDistance(double d) { return std::isfinite(d) && d >= kZero; }

// Hands on the solutions of a circle solver that found `found` of them (0: none, outputs untouched).
ECogoMathErrorCode acceptSolutions(int found, const C2dPos& first, const C2dPos& second, C2dPos& solution1,
                                   C2dPos& solution2, int& count) {
  if (found == 0) return eCogoNoSolution;
  solution1 = first;
  solution2 = second;
  count = found;
  return eCogoOk;
}

}  // namespace

ECogoMathErrorCode eIntersectBearings(const C2dPos& point1, const CMathAngle& azimuth1, const C2dPos& point2,
                                      const CMathAngle& azimuth2, C2dPos& crossing) {
  if (!point1.isFinite() || !point2.isFinite() || !azimuth1.isok() || !azimuth2.isok()) return eCogoInvalidInput;
  // point1 + t1 u1 = point2 + t2 u2; the cross product with u2 leaves t1 = (rel x u2) / (u1 x u2), where
  // a x b = aN bE - aE bN is the sine of the angle from a to b for unit vectors.
  const double u1N = azimuth1.getCos(), u1E = azimuth1.getSin();
  const double u2N = azimuth2.getCos(), u2E = azimuth2.getSin();
  const double sine = u1N * u2E - u1E * u2N;
  if (-svy_math::tol::kParallelSine < sine && sine < svy_math::tol::kParallelSine) return eCogoParallel;
  const double relN = point2.north() - point1.north();
  const double relE = point2.east() - point1.east();
  const double t1 = (relN * u2E - relE * u2N) / sine;
  const C2dPos result(point1.north() + t1 * u1N, point1.east() + t1 * u1E);
  if (!result.isFinite()) return eCogoNoSolution;
  crossing = result;
  return eCogoOk;
}

ECogoMathErrorCode eIntersectBearingDistance(const C2dPos& point1, const CMathAngle& azimuth1, const C2dPos& point2,
                                             double distance2, C2dPos& solution1, C2dPos& solution2, int& count) {
  if (!point1.isFinite() || !point2.isFinite() || !azimuth1.isok() || !isPositiveDistance(distance2))
    return eCogoInvalidInput;
  // A second point of the line at the scale of the problem, so that its rounding tilts the line by no more
  // than the rounding of the given points does.
  const double scale = std::max(1.0, distance2 + std::hypot(point2.north() - point1.north(),
                                                            point2.east() - point1.east()));
  if (!std::isfinite(scale)) return eCogoInvalidInput;
  C2dPos ahead;
  azimuth1.getPosAlong(scale, point1, ahead);
  C2dPos first, second;
  return acceptSolutions(IntersectionCoordsOfLineAndCircle(point1, ahead, point2, distance2, first, second), first,
                         second, solution1, solution2, count);
}

ECogoMathErrorCode eIntersectDistances(const C2dPos& point1, double distance1, const C2dPos& point2,
                                       double distance2, C2dPos& solution1, C2dPos& solution2, int& count) {
  if (!point1.isFinite() || !point2.isFinite() || !isPositiveDistance(distance1) || !isPositiveDistance(distance2))
    return eCogoInvalidInput;
  const double apart = std::hypot(point2.north() - point1.north(), point2.east() - point1.east());
  if (!(apart >= kZero)) return eCogoConcentric;
  C2dPos first, second;
  return acceptSolutions(IntersectionCoordsOfTwoCircles(point1, distance1, point2, distance2, first, second), first,
                         second, solution1, solution2, count);
}

}  // namespace CogoFunctions
