#include "svymath/area/area_pieces.h"

#include <cmath>

bool AreaPartCirc(double radius, double angle, double* area) {
  *area = angle * 0.5 * radius * radius;
  return true;
}

bool AreaTri2DistAng(double a, double b, double angle, double* area) {
  *area = std::sin(angle) * (a * 0.5 * b);
  return true;
}

bool AreaCircChord(double radius, double angle, double* area) {
  double sector = 0.0;
  double triangle = 0.0;
  if (!AreaPartCirc(radius, angle, &sector) || !AreaTri2DistAng(radius, radius, angle, &triangle)) return false;
  *area = sector - triangle;
  return true;
}

double triangle_area(double x1, double y1, double x2, double y2, double x3, double y3) {
  return 0.5 * ((x2 - x1) * (y3 - y1) - (x3 - x1) * (y2 - y1));
}

double triangle_area(const svy_math::TAbstractPoint2<double>& a, const svy_math::TAbstractPoint2<double>& b,
                     const svy_math::TAbstractPoint2<double>& c) {
  return triangle_area(a[0], a[1], b[0], b[1], c[0], c[1]);
}

bool clockwise(const svy_math::TAbstractPoint2<double>& a, const svy_math::TAbstractPoint2<double>& b,
               const svy_math::TAbstractPoint2<double>& c) {
  return triangle_area(a, b, c) > 0.0;
}
