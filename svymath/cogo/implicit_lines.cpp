#include "svymath/cogo/implicit_lines.h"

#include <cmath>

#include "svymath/foundation/constants.h"

using svy_math::tol::kThreeMinNormal;
using svy_math::tol::kTwoMinNormal;

bool FindLineCoeffs(svy_math::TAbstractPoint2<double> p, svy_math::TAbstractPoint2<double> q,
                    CLineCoeffs& line) {
  const double dx = q[0] - p[0];
  if (!(std::fabs(dx) < kTwoMinNormal)) {
    line.a = (q[1] - p[1]) / dx;
    line.b = -1.0;
    line.c = (q[0] * p[1] - p[0] * q[1]) / dx;
    return true;
  }
  if (std::fabs(q[1] - p[1]) < kTwoMinNormal) return false;
  line.a = -1.0;
  line.b = 0.0;
  line.c = q[0];
  return true;
}

bool FindPerpendicular(CLineCoeffs line, svy_math::TAbstractPoint2<double> p,
                       CLineCoeffs& perpendicular) {
  if (std::fabs(line.a) < kThreeMinNormal) {
    // The given line has constant y: the perpendicular has constant x.
    perpendicular.a = -1.0;
    perpendicular.b = 0.0;
  } else {
    perpendicular.a = line.b / line.a;
    perpendicular.b = -1.0;
  }
  perpendicular.c = -(p[1] * perpendicular.b) - p[0] * perpendicular.a;
  return true;
}

bool FindLinesIntersection(CLineCoeffs l1, CLineCoeffs l2, svy_math::TAbstractPoint2<double>& point) {
  const double det = l2.b * l1.a - l1.b * l2.a;
  if (std::fabs(det) < kTwoMinNormal) return false;
  point[0] = (l1.b * l2.c - l2.b * l1.c) / det;
  point[1] = (l1.c * l2.a - l2.c * l1.a) / det;
  return true;
}

int SolutionTo2ndDegreePolynomial(double a, double b, double c, double& x1, double& x2) {
  using svy_math::tol::kDiscriminantZero;
  x1 = 0.0;
  x2 = 0.0;
  const double discriminant = b * b - 4.0 * a * c;
  if (discriminant < -kDiscriminantZero) return 0;
  if (std::fabs(discriminant) < kDiscriminantZero) {
    x2 = -b / (2.0 * a);
    x1 = x2;
    return 1;
  }
  if (std::fabs(a) >= svy_math::tol::kLeadingCoeffZero) {
    const double mid = -b / (2.0 * a);
    const double halfSpread = std::sqrt(discriminant) / (2.0 * a);
    x1 = mid + halfSpread;
    x2 = mid - halfSpread;
    return 2;
  }
  if (std::fabs(b) < svy_math::tol::kLinearCoeffZero) return 0;
  x2 = -c / b;
  x1 = x2;
  return 1;
}
