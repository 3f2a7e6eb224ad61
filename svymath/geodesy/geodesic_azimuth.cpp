// CMathAngle::setAzFromLatLon: the forward azimuth of the geodesic (the shortest path on the reference
// ellipsoid) from one geodetic position to another, by the classic iterative inverse on the auxiliary
// sphere of reduced latitudes. The iteration is capped; for nearly antipodal pairs, where it does not
// settle, the azimuth of the great circle on the auxiliary sphere is taken instead (approximate there:
// near the antipode the direction of the shortest path changes quickly with position anyway).
#include <cmath>

#include "svymath/foundation/constants.h"
#include "svymath/foundation/math_angle.h"
#include "svymath/geodesy/ellipsoid.h"

namespace {

struct ReducedLatitude {
  double sinU;
  double cosU;
};

// The reduced (parametric) latitude U of a geodetic latitude: tan U = (1 - f) tan B.
ReducedLatitude reducedLatitude(double lat, double oneMinusF) {
  const double u = std::atan2(oneMinusF * std::sin(lat), std::cos(lat));
  return {std::sin(u), std::cos(u)};
}

// Forward azimuth on the auxiliary sphere for a longitude difference lambda there.
double sphereAzimuth(const ReducedLatitude& p1, const ReducedLatitude& p2, double lambda) {
  return std::atan2(p2.cosU * std::sin(lambda), p1.cosU * p2.sinU - p1.sinU * p2.cosU * std::cos(lambda));
}

bool isLatitude(double lat) { return std::isfinite(lat) && std::fabs(lat) <= svy_math::units::kHalfPi; }

}  // namespace

bool CMathAngle::setAzFromLatLon(double lat1, double lon1, double lat2, double lon2) {
  if (!isLatitude(lat1) || !isLatitude(lat2) || !std::isfinite(lon1) || !std::isfinite(lon2)) return false;
  const svy_math::TEllipsoidParams& ell = svy_math::ellipsoidParams();
  const double f = 1.0 - std::sqrt(1.0 - ell.e2);
  const ReducedLatitude p1 = reducedLatitude(lat1, 1.0 - f);
  const ReducedLatitude p2 = reducedLatitude(lat2, 1.0 - f);
  const double dLon = std::remainder(lon2 - lon1, svy_math::units::kTwoPi);

  double lambda = dLon;
  for (int step = 0; step < svy_math::tol::kGeodesicIterationCap; ++step) {
    const double sinLambda = std::sin(lambda);
    const double cosLambda = std::cos(lambda);
    const double a = p2.cosU * sinLambda;
    const double b = p1.cosU * p2.sinU - p1.sinU * p2.cosU * cosLambda;
    const double sinSigma = std::sqrt(a * a + b * b);
    if (sinSigma == 0.0) {
      // Coincident points give no direction; exactly antipodal ones leave the azimuth to the fallback.
      const double cosSigma = p1.sinU * p2.sinU + p1.cosU * p2.cosU * cosLambda;
      if (cosSigma > 0.0) return false;
      break;
    }
    const double cosSigma = p1.sinU * p2.sinU + p1.cosU * p2.cosU * cosLambda;
    const double sigma = std::atan2(sinSigma, cosSigma);
    const double sinAlpha = p1.cosU * p2.cosU * sinLambda / sinSigma;
    const double cos2Alpha = 1.0 - sinAlpha * sinAlpha;
    // On the equator (cos^2 alpha = 0) the midpoint term vanishes.
    const double cos2SigmaM = cos2Alpha != 0.0 ? cosSigma - 2.0 * p1.sinU * p2.sinU / cos2Alpha : 0.0;
    const double c = f / 16.0 * cos2Alpha * (4.0 + f * (4.0 - 3.0 * cos2Alpha));
    const double next =
        dLon + (1.0 - c) * f * sinAlpha *
                   (sigma + c * sinSigma * (cos2SigmaM + c * cosSigma * (-1.0 + 2.0 * cos2SigmaM * cos2SigmaM)));
    if (!(std::fabs(next) <= svy_math::units::kPi)) break;  // beyond the antipode: no convergence
    const double change = next - lambda;
    lambda = next;
    if (std::fabs(change) < svy_math::tol::kGeodesicLongitude) {
      setRad(sphereAzimuth(p1, p2, lambda));
      return true;
    }
  }
  setRad(sphereAzimuth(p1, p2, dLon));
  return true;
}
