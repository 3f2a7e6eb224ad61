// The direct geodesic problem and the north/east offsets built on both problems (see geodesic.h).
//
// The geodesic is placed on the auxiliary sphere by its equator crossing (azimuth alpha0) and the arc
// sigma1 from there to the start; the distance gives tau12 = s / (b A1), the reverted series gives the arc
// sigma12, and the longitude follows from omega12 and the I3 series.
#include <cmath>

#include "svymath/foundation/constants.h"
#include "svymath/geodesy/geodesic.h"
#include "svymath/geodesy/geodesic_series.h"

namespace svy_math {
namespace {

using detail::kGeodesicOrder;
using detail::normalizePair;
using detail::sinCosSeries;

}  // namespace

bool frgeod(double lat1, double lon1, double azimuth1, double distance, double& lat2, double& lon2,
            double& azimuth2) {
  if (!detail::isLatitude(lat1) || !std::isfinite(lon1) || !std::isfinite(azimuth1) || !std::isfinite(distance))
    return false;
  const detail::GeodesicEllipsoid& ell = detail::geodesicEllipsoid();
  const double salp1 = std::sin(azimuth1), calp1 = std::cos(azimuth1);
  double sbet1 = ell.f1 * std::sin(lat1);
  double cbet1 = std::fabs(lat1) == units::kHalfPi ? 0.0 : std::cos(lat1);
  normalizePair(sbet1, cbet1);
  cbet1 = std::fmax(tol::kGeodesicTiny, cbet1);
  // Equator crossing: sin(alpha0) = sin(alpha1) cos(beta1) (Clairaut).
  const double salp0 = salp1 * cbet1;
  const double calp0 = std::hypot(calp1, salp1 * sbet1);
  double ssig1 = sbet1;
  const double somg1 = salp0 * sbet1;
  double csig1 = sbet1 != 0.0 || calp1 != 0.0 ? cbet1 * calp1 : 1.0;
  const double comg1 = csig1;
  normalizePair(ssig1, csig1);

  const double k2 = calp0 * calp0 * ell.ep2;
  const double eps = detail::geodesicEps(k2);
  double c1[kGeodesicOrder + 1], c1p[kGeodesicOrder + 1], c3[kGeodesicOrder];
  detail::geodesicC1(eps, c1);
  detail::geodesicC1p(eps, c1p);
  detail::geodesicC3(ell, eps, c3);
  const double a1 = detail::geodesicA1(eps);
  const double b11 = sinCosSeries(ssig1, csig1, c1, kGeodesicOrder);
  const double stau1 = ssig1 * std::cos(b11) + csig1 * std::sin(b11);
  const double ctau1 = csig1 * std::cos(b11) - ssig1 * std::sin(b11);
  const double tau12 = distance / (ell.b * a1);
  const double stau2 = stau1 * std::cos(tau12) + ctau1 * std::sin(tau12);
  const double ctau2 = ctau1 * std::cos(tau12) - stau1 * std::sin(tau12);
  // sigma2 = tau2 + B1'(tau2), tau1 = sigma1 + B1(sigma1).
  const double sig12 = tau12 + b11 + sinCosSeries(stau2, ctau2, c1p, kGeodesicOrder);
  const double ssig12 = std::sin(sig12), csig12 = std::cos(sig12);
  const double ssig2 = ssig1 * csig12 + csig1 * ssig12;
  const double csig2 = csig1 * csig12 - ssig1 * ssig12;
  const double sbet2 = calp0 * ssig2;
  double cbet2 = std::hypot(salp0, calp0 * csig2);
  // At a pole the latitude is exact.
  if (cbet2 == 0.0) cbet2 = tol::kGeodesicTiny;
  const double somg2 = salp0 * ssig2, comg2 = csig2;
  const double omg12 = std::atan2(somg2 * comg1 - comg2 * somg1, comg2 * comg1 + somg2 * somg1);
  const double b31 = sinCosSeries(ssig1, csig1, c3, kGeodesicOrder - 1);
  const double b32 = sinCosSeries(ssig2, csig2, c3, kGeodesicOrder - 1);
  const double lam12 = omg12 - ell.f * detail::geodesicA3(ell, eps) * salp0 * (sig12 + b32 - b31);
  lat2 = std::atan2(sbet2, ell.f1 * cbet2);
  lon2 = std::remainder(lon1 + lam12, units::kTwoPi);
  azimuth2 = std::atan2(salp0, calp0 * csig2);
  return true;
}

bool shiftLatLonByDelta(double lat, double lon, double dNorth, double dEast, double& latOut, double& lonOut) {
  if (!std::isfinite(dNorth) || !std::isfinite(dEast)) return false;
  double azimuth2 = 0.0;
  return frgeod(lat, lon, std::atan2(dEast, dNorth), std::hypot(dNorth, dEast), latOut, lonOut, azimuth2);
}

bool GetNeOffsetFromLatLon(double lat1, double lon1, double lat2, double lon2, double& dNorth, double& dEast) {
  double distance = 0.0, azimuth1 = 0.0, azimuth2 = 0.0;
  if (!invers(lat1, lon1, lat2, lon2, distance, azimuth1, azimuth2)) return false;
  dNorth = distance * std::cos(azimuth1);
  dEast = distance * std::sin(azimuth1);
  return true;
}

}  // namespace svy_math
