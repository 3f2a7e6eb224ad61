#include "svymath/cogo/circle_solvers.h"

#include <cmath>
#include <utility>

#include "svymath/cogo/implicit_lines.h"
#include "svymath/foundation/constants.h"

namespace {

using svy_math::tol::kTangency;
using svy_math::tol::kZero;

bool isPositiveRadius(double radius) { return radius >= kZero && std::isfinite(radius); }

void writeBoth(const C2dPos& p, C2dPos& solution1, C2dPos& solution2) {
  solution1 = p;
  solution2 = p;
}

// Where two touching circles meet, as a distance from centre1 along the line centre1 -> centre2 (at
// `distance`): halfway between the two circles' points on that line that come closest. Externally these
// face each other between the centres; internally they lie on the far side of the smaller circle from
// the larger one's centre. Unlike the chord formula this stays well conditioned for nearly concentric
// circles.
double touchingPointAlongCentres(double distance, double radius1, double radius2, double externalGap,
                                 double internalGap) {
  if (std::fabs(externalGap) <= std::fabs(internalGap)) return radius1 + externalGap / 2.0;
  if (radius1 >= radius2) return (radius1 + distance + radius2) / 2.0;
  return -(radius1 + radius2 - distance) / 2.0;
}

}  // namespace

int IntersectionCoordsOfLineAndCircle(const C2dPos& linePos1, const C2dPos& linePos2,
                                      const C2dPos& center, double radius, C2dPos& solution1,
                                      C2dPos& solution2) {
  if (!isPositiveRadius(radius) || !center.isFinite()) return 0;
  const double dN = linePos2.north() - linePos1.north();
  const double dE = linePos2.east() - linePos1.east();
  if (-kZero < dN && dN < kZero && -kZero < dE && dE < kZero) return 0;

  // Work relative to the centre and in units of the radius: the circle becomes x^2 + y^2 = 1 with
  // x = northing, y = easting. The line is written in the slope form over its dominant axis u, so
  // that |slope| <= 1: a line of nearly constant northing advances along the easting and the roles of
  // the two axes swap (v = slope*u + intercept).
  const bool alongEasting = std::fabs(dE) > std::fabs(dN);
  const double u1 = ((alongEasting ? linePos1.east() : linePos1.north()) -
                     (alongEasting ? center.east() : center.north())) / radius;
  const double v1 = ((alongEasting ? linePos1.north() : linePos1.east()) -
                     (alongEasting ? center.north() : center.east())) / radius;
  const double du = alongEasting ? dE : dN;
  const double slope = (alongEasting ? dN : dE) / du;
  const double intercept = v1 - slope * u1;
  if (!std::isfinite(slope) || !std::isfinite(intercept)) return 0;

  // u^2 + (slope*u + intercept)^2 = 1.
  const double a = 1.0 + slope * slope;
  const double b = 2.0 * slope * intercept;
  const double c = intercept * intercept - 1.0;
  double uFirst = 0.0;
  double uSecond = 0.0;
  int count = 0;
  const double gapToCircle = (std::fabs(intercept) / std::sqrt(a) - 1.0) * radius;
  if (std::fabs(gapToCircle) <= kTangency) {
    // Touching: the foot of the perpendicular from the centre.
    uFirst = -b / (2.0 * a);
    uSecond = uFirst;
    count = 1;
  } else {
    count = SolutionTo2ndDegreePolynomial(a, b, c, uFirst, uSecond);
    if (count == 0) return 0;
    // The roots come larger first (a > 0), which is the order of travel only toward decreasing u.
    if (du > 0.0) std::swap(uFirst, uSecond);
  }

  auto toPos = [&](double u) {
    const double v = slope * u + intercept;
    const double north = alongEasting ? v : u;
    const double east = alongEasting ? u : v;
    return C2dPos(center.north() + north * radius, center.east() + east * radius);
  };
  const C2dPos first = toPos(uFirst);
  const C2dPos second = toPos(uSecond);
  if (!first.isFinite() || !second.isFinite()) return 0;
  solution1 = first;
  solution2 = second;
  return count;
}

int IntersectionCoordsOfTwoCircles(const C2dPos& center1, double radius1, const C2dPos& center2,
                                   double radius2, C2dPos& solution1, C2dPos& solution2) {
  if (!isPositiveRadius(radius1) || !isPositiveRadius(radius2)) return 0;
  if (!center1.isFinite() || !center2.isFinite()) return 0;
  const double dN = center2.north() - center1.north();
  const double dE = center2.east() - center1.east();
  const double distance = std::hypot(dN, dE);
  if (!std::isfinite(distance) || distance < kZero) return 0;
  const double radiusDiff = std::fabs(radius1 - radius2);
  // Circles that coincide within the tangency tolerance have no isolated crossing.
  if (distance <= kTangency && radiusDiff <= kTangency) return 0;

  const double externalGap = distance - (radius1 + radius2);
  const double internalGap = radiusDiff - distance;
  if (externalGap > kTangency || internalGap > kTangency) return 0;

  const double uN = dN / distance;
  const double uE = dE / distance;
  auto alongCentreLine = [&](double along) {
    return C2dPos(center1.north() + along * uN, center1.east() + along * uE);
  };
  // Distance from center1 along the centre line to the chord of the crossings,
  // (d^2 + r1^2 - r2^2) / (2d) written without squaring d.
  const double alongCentres =
      (distance + (radius1 - radius2) * ((radius1 + radius2) / distance)) / 2.0;
  const double halfChordSq = (radius1 - alongCentres) * (radius1 + alongCentres);
  const bool touching = std::fabs(externalGap) <= kTangency || std::fabs(internalGap) <= kTangency;
  if (touching || !(halfChordSq > 0.0)) {
    const C2dPos touchPoint = alongCentreLine(
        touchingPointAlongCentres(distance, radius1, radius2, externalGap, internalGap));
    if (!touchPoint.isFinite()) return 0;
    writeBoth(touchPoint, solution1, solution2);
    return 1;
  }
  const C2dPos chordMiddle = alongCentreLine(alongCentres);
  // The right-hand normal of the direction (uN, uE) is (-uE, uN).
  const double halfChord = std::sqrt(halfChordSq);
  const C2dPos right(chordMiddle.north() - halfChord * uE, chordMiddle.east() + halfChord * uN);
  const C2dPos left(chordMiddle.north() + halfChord * uE, chordMiddle.east() - halfChord * uN);
  if (!right.isFinite() || !left.isFinite()) return 0;
  solution1 = right;
  solution2 = left;
  return 2;
}
