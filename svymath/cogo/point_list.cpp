#include "svymath/cogo/point_list.h"

#include <algorithm>
#include <cmath>
#include <cstddef>

#include "svymath/cogo/cogo_inverse.h"
#include "svymath/foundation/constants.h"

namespace {

double distance(const C2dPos& a, const C2dPos& b) { return std::hypot(a.north() - b.north(), a.east() - b.east()); }

// Whether v lies within `tolerance` of the segment a -> b and between its ends.
bool liesBetween(const C2dPos& a, const C2dPos& v, const C2dPos& b, double tolerance) {
  CogoFunctions::TElementInverse inverse;
  return CogoFunctions::eInverseToSegment(a, b, v, inverse) == CogoFunctions::eCogoOk &&
         inverse.position == CogoFunctions::eFootOnElement && std::fabs(inverse.offset) <= tolerance;
}

double usableTolerance(double tolerance) { return tolerance >= 0.0 && std::isfinite(tolerance) ? tolerance : 0.0; }

}  // namespace

double C2dPtListUt::getSignedArea(const svy_vector<C2dPos>& points) {
  const std::size_t n = points.size();
  if (n < 3) return 0.0;
  // The vertex area sum (E_prev - E) (N + N_prev) / 2 over every side, relative to the first vertex.
  const C2dPos& origin = points.front();
  double sum = 0.0;
  for (std::size_t i = 0; i < n; ++i) {
    const C2dPos& p = points[i];
    const C2dPos& prev = points[(i + n - 1) % n];
    sum += ((prev.east() - origin.east()) - (p.east() - origin.east())) *
           ((p.north() - origin.north()) + (prev.north() - origin.north()));
  }
  return 0.5 * sum;
}

double C2dPtListUt::getArea(const svy_vector<C2dPos>& points) { return std::fabs(getSignedArea(points)); }

double C2dPtListUt::getPerimeter(const svy_vector<C2dPos>& points, bool closed) {
  const std::size_t n = points.size();
  double length = 0.0;
  for (std::size_t i = 1; i < n; ++i) length += distance(points[i - 1], points[i]);
  if (closed && n > 1) length += distance(points.back(), points.front());
  return length;
}

C2dPtListUt::EOrientation C2dPtListUt::getOrientation(const svy_vector<C2dPos>& points) {
  const double area = getSignedArea(points);
  if (area >= svy_math::tol::kZero) return eOrientationCounterClockwise;
  if (area <= -svy_math::tol::kZero) return eOrientationClockwise;
  return eOrientationDegenerate;
}

bool C2dPtListUt::setOrientation(svy_vector<C2dPos>& points, EOrientation wanted) {
  const EOrientation current = getOrientation(points);
  if (current == eOrientationDegenerate || wanted == eOrientationDegenerate || current == wanted) return false;
  std::reverse(points.begin(), points.end());
  return true;
}

int C2dPtListUt::removeRepeatedPoints(svy_vector<C2dPos>& points, bool closed, double tolerance) {
  if (points.empty()) return 0;
  const double tol = usableTolerance(tolerance);
  const std::size_t before = points.size();
  std::size_t kept = 1;
  for (std::size_t i = 1; i < points.size(); ++i)
    if (!(distance(points[kept - 1], points[i]) <= tol)) points[kept++] = points[i];
  points.resize(kept);
  while (closed && points.size() > 1 && distance(points.back(), points.front()) <= tol) points.pop_back();
  return static_cast<int>(before - points.size());
}

int C2dPtListUt::removeCollinearPoints(svy_vector<C2dPos>& points, bool closed, double tolerance) {
  const double tol = usableTolerance(tolerance);
  int removed = removeRepeatedPoints(points, closed, tol);
  const std::size_t minimum = closed ? 3 : 2;
  // Each pass removes at least one vertex or ends the loop, so there are at most as many passes as vertices.
  for (bool changed = true; changed;) {
    changed = false;
    for (std::size_t i = 0; i < points.size() && points.size() > minimum;) {
      const std::size_t n = points.size();
      if (!closed && (i == 0 || i + 1 == n)) {
        ++i;
        continue;
      }
      if (liesBetween(points[(i + n - 1) % n], points[i], points[(i + 1) % n], tol)) {
        points.erase(points.begin() + static_cast<std::ptrdiff_t>(i));
        ++removed;
        changed = true;
      } else {
        ++i;
      }
    }
  }
  return removed;
}

int C2dPtListUt::getNearestVertex(const svy_vector<C2dPos>& points, const C2dPos& point, double& nearest) {
  int index = -1;
  double best = 0.0;
  for (std::size_t i = 0; i < points.size(); ++i) {
    const double d = distance(points[i], point);
    if (std::isfinite(d) && (index < 0 || d < best)) {
      index = static_cast<int>(i);
      best = d;
    }
  }
  if (index >= 0) nearest = best;
  return index;
}

CogoFunctions::ECogoMathErrorCode C2dPtListUt::getNearestPoint(const svy_vector<C2dPos>& points, bool closed,
                                                               const C2dPos& point,
                                                               CogoFunctions::TElementInverse& result) {
  return CogoFunctions::eInverseToPolyline(points, closed, point, result);
}
