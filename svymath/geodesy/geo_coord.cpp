#include "svymath/geodesy/geo_coord.h"

#include <cmath>

#include "svymath/foundation/constants.h"
#include "svymath/geodesy/ellipsoid.h"

Coord& Coord::blh2xyz(const GeoCoord& geodetic) {
  const svy_math::TEllipsoidParams& ell = svy_math::ellipsoidParams();
  const double sinB = std::sin(geodetic.lat());
  const double cosB = std::cos(geodetic.lat());
  // Radius of curvature in the prime vertical.
  const double n = ell.a / std::sqrt(1.0 - ell.e2 * sinB * sinB);
  const double h = geodetic.height();
  set((n + h) * cosB * std::cos(geodetic.lon()), (n + h) * cosB * std::sin(geodetic.lon()),
      (n + h - ell.e2 * n) * sinB);
  return *this;
}

GeoCoord& GeoCoord::xyz2blh(const Coord& cartesian) {
  using svy_math::tol::kGeodeticIteration;
  const svy_math::TEllipsoidParams& ell = svy_math::ellipsoidParams();
  const double x = cartesian.x();
  const double y = cartesian.y();
  const double z = cartesian.z();
  if (!std::isfinite(x) || !std::isfinite(y) || !std::isfinite(z)) {
    *this = svy_math::undefinedValue();
    return *this;
  }

  const double p = std::sqrt(x * x + y * y);
  if (p < svy_math::tol::kPolarAxisDistance) {
    if (z == 0.0) {
      set(0.0, 0.0, -ell.a);
    } else {
      const double pole = z > 0.0 ? svy_math::units::kHalfPi : -svy_math::units::kHalfPi;
      set(pole, 0.0, std::fabs(z) - std::sqrt(1.0 - ell.e2) * ell.a);
    }
    return *this;
  }

  double lon = std::atan2(y, x);
  if (lon < 0.0) lon += svy_math::units::kTwoPi;
  const double k = ell.e2 * ell.c / p;
  const double t0 = z / p;
  double t = t0;
  for (int step = 0;; ++step) {
    if (step == svy_math::tol::kGeodeticIterationCap || !std::isfinite(t)) {
      *this = svy_math::undefinedValue();
      return *this;
    }
    const double next = t0 + k * t / std::sqrt(t * t + ell.onePlusEp2);
    const double change = next - t;
    t = next;
    if (std::fabs(change) <= kGeodeticIteration) break;
  }
  const double h = (p - ell.c / std::sqrt(t * t + ell.onePlusEp2)) * std::sqrt(1.0 + t * t);
  set(std::atan(t), lon, h);
  return *this;
}
