#include "svymath/geodesy/geomath_consts.h"

#include <cmath>
#include <limits>

#include "svymath/foundation/constants.h"
#include "svymath/geodesy/ellipsoid.h"

namespace svy_math {

double TGeomathConsts::a() { return ellipsoidParams().a; }
double TGeomathConsts::b() { return ellipsoidParams().a * std::sqrt(1.0 - ellipsoidParams().e2); }
double TGeomathConsts::f() { return 1.0 - std::sqrt(1.0 - ellipsoidParams().e2); }
double TGeomathConsts::e2() { return ellipsoidParams().e2; }
double TGeomathConsts::ep2() { return ellipsoidParams().ep2; }
double TGeomathConsts::meanRadius() { return (2.0 * a() + b()) / 3.0; }

double TGeomathConsts::primeVerticalRadius(double latitude) {
  const double s = std::sin(latitude);
  return a() / std::sqrt(1.0 - e2() * s * s);
}

double TGeomathConsts::meridianRadius(double latitude) {
  const double s = std::sin(latitude);
  const double w2 = 1.0 - e2() * s * s;
  return a() * (1.0 - e2()) / (w2 * std::sqrt(w2));
}

double TGeomathConsts::gaussianRadius(double latitude) {
  return std::sqrt(meridianRadius(latitude) * primeVerticalRadius(latitude));
}

double cosphi(double latitude) { return std::fabs(latitude) == units::kHalfPi ? 0.0 : std::cos(latitude); }

double invlon(double latitude, double height) {
  const double c = cosphi(latitude);
  if (c == 0.0) return std::numeric_limits<double>::infinity();
  return 1.0 / ((TGeomathConsts::primeVerticalRadius(latitude) + height) * c);
}

}  // namespace svy_math
