#include "svymath/cogo/circle_tangents.h"

#include <algorithm>
#include <cmath>

#include "svymath/cogo/circle_solvers.h"
#include "svymath/cogo/cogo_intersections.h"
#include "svymath/cogo/line_frame.h"
#include "svymath/foundation/angle_functions.h"
#include "svymath/foundation/constants.h"

namespace {

using svy_math::tol::kTangency;
using svy_math::tol::kZero;

// The sine of the angle phi between the centre line and the radius to a touching point, where
// cos phi = k / d: sqrt((d - k)(d + k)) / d, which keeps its digits when |k| is close to d.
double sineOf(double k, double d) { return std::sqrt((d - k) * (d + k)) / d; }

}  // namespace

namespace svy_math {

CogoFunctions::ECogoMathErrorCode TTangentToCircles::solve(const C2dPos& center1, double radius1,
                                                           const C2dPos& center2, double radius2) {
  using namespace CogoFunctions;
  m_count = 0;
  const bool point1 = radius1 < kZero, point2 = radius2 < kZero;
  if (!center1.isFinite() || !center2.isFinite() || !(radius1 >= 0.0) || !(radius2 >= 0.0) ||
      !std::isfinite(radius1) || !std::isfinite(radius2) || (point1 && point2))
    return eCogoInvalidInput;
  svy_math::detail::TLineFrame line;
  if (!line.set(center1, center2))
    return std::isfinite(center2.north() - center1.north()) ? eCogoConcentric : eCogoInvalidInput;
  const double d = line.length;
  // Circles that coincide within the tangency tolerance share every tangent: none is isolated.
  if (d <= kTangency && std::fabs(radius1 - radius2) <= kTangency) return eCogoConcentric;

  // Outer tangents: the radius to each touching point has the same direction w, with w . u = (r1 - r2) / d.
  const double outerK = radius1 - radius2;
  if (d - std::fabs(outerK) < -kTangency) return eCogoNoSolution;
  if (d - std::fabs(outerK) <= kTangency) {
    // Touching inside (or a point on the circle): the one tangent at the touching point, taken on the
    // larger circle, whose radius points along the centre line.
    const double sign = outerK >= 0.0 ? 1.0 : -1.0;
    const C2dPos touch = radius1 >= radius2 ? line.at(sign * radius1, 0.0) : line.at(d + sign * radius2, 0.0);
    m_tangents[m_count++] = TTangent{touch, touch, true};
  } else {
    const double cosine = outerK / d, sine = sineOf(outerK, d);
    for (const double side : {1.0, -1.0}) {
      const double wA = cosine, wB = side * sine;
      m_tangents[m_count++] = TTangent{line.at(radius1 * wA, radius1 * wB), line.at(d + radius2 * wA, radius2 * wB), true};
    }
  }

  // Inner tangents (two real circles only): opposite radii, w . u = (r1 + r2) / d.
  if (!point1 && !point2) {
    const double innerK = radius1 + radius2;
    const double gap = d - innerK;
    if (std::fabs(gap) <= kTangency) {
      // Touching outside: halfway between the circles' nearest points on the centre line.
      const C2dPos touch = line.at(radius1 + gap / 2.0, 0.0);
      m_tangents[m_count++] = TTangent{touch, touch, false};
    } else if (gap > 0.0) {
      const double cosine = innerK / d, sine = sineOf(innerK, d);
      for (const double side : {1.0, -1.0}) {
        const double wA = cosine, wB = side * sine;
        m_tangents[m_count++] = TTangent{line.at(radius1 * wA, radius1 * wB), line.at(d - radius2 * wA, -radius2 * wB),
                                         false};
      }
    }
  }
  for (int i = 0; i < m_count; ++i) {
    if (!m_tangents[i].onFirst.isFinite() || !m_tangents[i].onSecond.isFinite()) {
      m_count = 0;
      return eCogoInvalidInput;
    }
  }
  return eCogoOk;
}

CogoFunctions::ECogoMathErrorCode TTangentToCircles::solveFromPoint(const C2dPos& point, const C2dPos& center,
                                                                    double radius) {
  if (!(radius >= kZero)) {
    m_count = 0;
    return CogoFunctions::eCogoInvalidInput;
  }
  return solve(point, 0.0, center, radius);
}

}  // namespace svy_math

int TwoCirclesIntersectionLine(const C2dPos& center1, double radius1, const C2dPos& center2, double radius2,
                               C2dPos& linePos1, C2dPos& linePos2) {
  C2dPos first, second;
  const int found = IntersectionCoordsOfTwoCircles(center1, radius1, center2, radius2, first, second);
  if (found == 0) return 0;
  if (found == 1) {
    // The common tangent at the touching point is perpendicular to the centre line: step to its right.
    svy_math::detail::TLineFrame centres;
    centres.set(center1, center2);
    centres.origin = first;
    second = centres.at(0.0, std::min(radius1, radius2));
  }
  linePos1 = first;
  linePos2 = second;
  return found;
}

namespace CogoFunctions {

ECogoMathErrorCode eFilletTwoLines(const C2dPos& point1, const CMathAngle& azimuth1, const C2dPos& point2,
                                   const CMathAngle& azimuth2, double radius, CArc& fillet) {
  if (!std::isfinite(radius) || !(radius >= kZero)) return eCogoInvalidInput;
  C2dPos crossing;
  const ECogoMathErrorCode status = eIntersectBearings(point1, azimuth1, point2, azimuth2, crossing);
  if (status != eCogoOk) return status;
  const double turn = NormalizeNegPiToPi(azimuth2.getRad() - azimuth1.getRad());
  // The tangent length from the crossing to either tangent point, R tan(|turn| / 2).
  const double tangentLength = radius * std::tan(std::fabs(turn) / 2.0);
  if (!std::isfinite(tangentLength)) return eCogoParallel;
  const bool clockwise = turn > 0.0;
  svy_math::detail::TLineFrame first;
  first.origin = crossing;
  first.uN = azimuth1.getCos();
  first.uE = azimuth1.getSin();
  const C2dPos start = first.at(-tangentLength, 0.0);
  const C2dPos centre = first.at(-tangentLength, clockwise ? radius : -radius);
  CMathAngle sweep;
  sweep.setRad(std::fabs(turn));
  CArc arc;
  if (!start.isFinite() || !centre.isFinite() || !arc.set_start_center_cAngle(start, centre, sweep, clockwise))
    return eCogoNoSolution;
  fillet = arc;
  return eCogoOk;
}

}  // namespace CogoFunctions
