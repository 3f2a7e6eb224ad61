// CMathAngle::setAzFromLatLon: the forward azimuth of the geodesic (the shortest path on the reference
// ellipsoid) from one geodetic position to another, by the classic iterative inverse on the auxiliary
// sphere of reduced latitudes. Every iteration is capped. For nearly antipodal pairs, where the classic
// iteration oscillates, a damped iteration follows; the few pairs (within about half a degree of the
// antipode) where that too fails take the azimuth of the great circle on the auxiliary sphere, which can be
// far from the geodesic's there: so close to the antipode the direction of the shortest path changes by
// tens of degrees over a few kilometres anyway.
#include <algorithm>
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

enum class LongitudeIteration { kConverged, kCoincident, kNotConverged };

// Iterates the longitude difference lambda on the auxiliary sphere, moving each step by `relaxation` times
// the classic update (1: the classic iteration; below 1: damped, which settles in part of the nearly
// antipodal region where the classic one oscillates).
LongitudeIteration iterateLongitude(const ReducedLatitude& p1, const ReducedLatitude& p2, double dLon, double f,
                                    double relaxation, int cap, double& lambda) {
  lambda = dLon;
  for (int step = 0; step < cap; ++step) {
    const double sinLambda = std::sin(lambda);
    const double cosLambda = std::cos(lambda);
    const double a = p2.cosU * sinLambda;
    const double b = p1.cosU * p2.sinU - p1.sinU * p2.cosU * cosLambda;
    const double sinSigma = std::sqrt(a * a + b * b);
    const double cosSigma = p1.sinU * p2.sinU + p1.cosU * p2.cosU * cosLambda;
    if (sinSigma == 0.0) return cosSigma > 0.0 ? LongitudeIteration::kCoincident : LongitudeIteration::kNotConverged;
    const double sigma = std::atan2(sinSigma, cosSigma);
    const double sinAlpha = p1.cosU * p2.cosU * sinLambda / sinSigma;
    const double cos2Alpha = 1.0 - sinAlpha * sinAlpha;
    // On the equator (cos^2 alpha = 0) the midpoint term vanishes.
    const double cos2SigmaM = cos2Alpha != 0.0 ? cosSigma - 2.0 * p1.sinU * p2.sinU / cos2Alpha : 0.0;
    const double c = f / 16.0 * cos2Alpha * (4.0 + f * (4.0 - 3.0 * cos2Alpha));
    const double next =
        dLon + (1.0 - c) * f * sinAlpha *
                   (sigma + c * sinSigma * (cos2SigmaM + c * cosSigma * (-1.0 + 2.0 * cos2SigmaM * cos2SigmaM)));
    const double change = relaxation * (next - lambda);
    lambda = std::max(-svy_math::units::kPi, std::min(svy_math::units::kPi, lambda + change));
    if (std::fabs(change) < svy_math::tol::kGeodesicLongitude) return LongitudeIteration::kConverged;
  }
  return LongitudeIteration::kNotConverged;
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
  LongitudeIteration result = iterateLongitude(p1, p2, dLon, f, 1.0, svy_math::tol::kGeodesicIterationCap, lambda);
  if (result == LongitudeIteration::kCoincident) return false;
  if (result == LongitudeIteration::kNotConverged)
    result = iterateLongitude(p1, p2, dLon, f, svy_math::tol::kGeodesicRelaxation, svy_math::tol::kGeodesicDampedCap, lambda);
  setRad(sphereAzimuth(p1, p2, result == LongitudeIteration::kConverged ? lambda : dLon));
  return true;
}
