#include "svymath/geodesy/local_frame.h"

#include <cmath>
#include <limits>

#include "svymath/foundation/constants.h"

namespace svy_math {

TAbstractPoint3<double> blh_to_neu(const TAbstractPoint3<double>& blh, const TAbstractPoint3<double>& dxyz) {
  const double sinB = std::sin(blh[0]);
  const double cosB = std::cos(blh[0]);
  const double sinL = std::sin(blh[1]);
  const double cosL = std::cos(blh[1]);
  // Horizontal component of the difference along the meridian plane of L (outward from the polar axis).
  const double u = cosL * dxyz[0] + sinL * dxyz[1];
  return TAbstractPoint3<double>(cosL * dxyz[1] - sinL * dxyz[0], cosB * dxyz[2] - sinB * u,
                                 sinB * dxyz[2] + cosB * u);
}

TAbstractPoint3<double> neu_to_polar(const TAbstractPoint3<double>& v) {
  const double east = v[0];
  const double north = v[1];
  const double up = v[2];
  const double s = east * east + north * north;
  const auto isZero = [](double x) { return -tol::kZero < x && x < tol::kZero; };
  if (isZero(s) && isZero(up)) {
    constexpr double kNoDirection = std::numeric_limits<double>::max();
    return TAbstractPoint3<double>(kNoDirection, kNoDirection, 0.0);
  }
  double azimuth = std::atan2(east, north);
  if (azimuth < 0.0) azimuth += units::kTwoPi;
  return TAbstractPoint3<double>(std::atan2(up, std::sqrt(s)), azimuth, std::sqrt(up * up + s));
}

}  // namespace svy_math
