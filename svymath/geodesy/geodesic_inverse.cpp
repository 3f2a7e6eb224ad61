// The inverse geodesic problem (see geodesic.h).
//
// The pair is first brought to a canonical form: longitude difference in [0, pi], the first point the one
// farther from the equator, and south of it (lat1 <= 0, lat1 <= lat2 <= -lat1). Meridians and short
// equatorial lines are solved directly; otherwise the azimuth alpha1 at the first point is found by Newton's
// method on the longitude misclosure lambda12(alpha1) - lambda12, whose derivative is the reduced length
// (1 - f) m12 / (cos(alpha2) cos(beta2) b). A bracket [alpha1a, alpha1b] kept from the signs of the
// misclosure turns any Newton step leaving it into bisection, so the solution always converges.
#include <algorithm>
#include <cmath>

#include "svymath/foundation/constants.h"
#include "svymath/geodesy/geodesic.h"
#include "svymath/geodesy/geodesic_series.h"

namespace svy_math {
namespace {

using detail::GeodesicEllipsoid;
using detail::kGeodesicOrder;
using detail::normalizePair;
using detail::sinCosSeries;

// A point on the auxiliary sphere: sine and cosine of the reduced latitude beta, and
// dn = sqrt(1 + e'^2 sin^2 beta).
struct ReducedPoint {
  double sinBeta;
  double cosBeta;
  double dn;
};

ReducedPoint reducedPoint(const GeodesicEllipsoid& ell, double lat) {
  double s = ell.f1 * std::sin(lat);
  // cos(pi/2) is 6e-17, not 0: a pole is exact so that it takes the meridian branch.
  double c = std::fabs(lat) == units::kHalfPi ? 0.0 : std::cos(lat);
  normalizePair(s, c);
  return {s, std::max(tol::kGeodesicTiny, c), std::sqrt(1.0 + ell.ep2 * s * s)};
}

// Distance s12 / b and reduced length m12 / b along a geodesic with parameter eps between sigma1 and sigma2.
struct Lengths {
  double s12b;
  double m12b;
};

Lengths geodesicLengths(double eps, double sig12, double ssig1, double csig1, double dn1, double ssig2,
                        double csig2, double dn2) {
  double c1[kGeodesicOrder + 1], c2[kGeodesicOrder + 1];
  detail::geodesicC1(eps, c1);
  detail::geodesicC2(eps, c2);
  const double a1 = detail::geodesicA1(eps), a2 = detail::geodesicA2(eps);
  const double b1 = sinCosSeries(ssig2, csig2, c1, kGeodesicOrder) - sinCosSeries(ssig1, csig1, c1, kGeodesicOrder);
  const double b2 = sinCosSeries(ssig2, csig2, c2, kGeodesicOrder) - sinCosSeries(ssig1, csig1, c2, kGeodesicOrder);
  const double j12 = (a1 - a2) * sig12 + (a1 * b1 - a2 * b2);
  return {a1 * (sig12 + b1), dn2 * (csig1 * ssig2) - dn1 * (ssig1 * csig2) - csig1 * csig2 * j12};
}

// Positive root k of k^4 + 2 k^3 - (x^2 + y^2 - 1) k^2 - 2 y^2 k - y^2 = 0: the astroid that gives the
// starting azimuth of nearly antipodal pairs (a cubic in closed form, then the quartic through it).
double astroid(double x, double y) {
  const double p = x * x, q = y * y, r = (p + q - 1.0) / 6.0;
  if (q == 0.0 && r <= 0.0) return 0.0;
  const double s = p * q / 4.0, r2 = r * r, r3 = r * r2;
  const double disc = s * (s + 2.0 * r3);
  double u = r;
  if (disc >= 0.0) {
    double t3 = s + r3;
    t3 += t3 < 0.0 ? -std::sqrt(disc) : std::sqrt(disc);
    const double t = std::cbrt(t3);
    u += t + (t != 0.0 ? r2 / t : 0.0);
  } else {
    const double angle = std::atan2(std::sqrt(-disc), -(s + r3));
    u += 2.0 * r * std::cos(angle / 3.0);
  }
  const double v = std::sqrt(u * u + q);
  const double uv = u < 0.0 ? q / (v - u) : u + v;
  const double w = (uv - q) / (2.0 * v);
  return uv / (std::sqrt(uv + w * w) + w);
}

// The state of one evaluation of the longitude along the geodesic leaving point 1 at alpha1.
struct LongitudeAtAzimuth {
  double misclosure;  // lambda12(alpha1) - lambda12 (radians)
  double derivative;  // d misclosure / d alpha1
  double sig12, ssig1, csig1, ssig2, csig2, eps;
  double salp2, calp2;
};

LongitudeAtAzimuth longitudeAtAzimuth(const GeodesicEllipsoid& ell, const ReducedPoint& p1, const ReducedPoint& p2,
                                      double salp1, double calp1, double slam12, double clam12) {
  LongitudeAtAzimuth r{};
  // An equatorial start heading along the equator is nudged off it so that the equator is not taken for
  // a geodesic longer than half the circle.
  if (p1.sinBeta == 0.0 && calp1 == 0.0) calp1 = -tol::kGeodesicTiny;
  const double salp0 = salp1 * p1.cosBeta;
  const double calp0 = std::hypot(calp1, salp1 * p1.sinBeta);
  r.ssig1 = p1.sinBeta;
  const double somg1 = salp0 * p1.sinBeta;
  r.csig1 = calp1 * p1.cosBeta;
  const double comg1 = r.csig1;
  normalizePair(r.ssig1, r.csig1);
  // Clairaut: cos(beta) sin(alpha) is constant; cos(alpha2) from it, the sign positive (north-going there).
  r.salp2 = p2.cosBeta != p1.cosBeta ? salp0 / p2.cosBeta : salp1;
  r.calp2 = p2.cosBeta != p1.cosBeta || std::fabs(p2.sinBeta) != -p1.sinBeta
                ? std::sqrt((calp1 * p1.cosBeta) * (calp1 * p1.cosBeta) +
                            (p1.cosBeta < -p1.sinBeta ? (p2.cosBeta - p1.cosBeta) * (p1.cosBeta + p2.cosBeta)
                                                      : (p1.sinBeta - p2.sinBeta) * (p1.sinBeta + p2.sinBeta))) /
                      p2.cosBeta
                : std::fabs(calp1);
  r.ssig2 = p2.sinBeta;
  const double somg2 = salp0 * p2.sinBeta;
  r.csig2 = r.calp2 * p2.cosBeta;
  const double comg2 = r.csig2;
  normalizePair(r.ssig2, r.csig2);
  r.sig12 = std::atan2(std::max(0.0, r.csig1 * r.ssig2 - r.ssig1 * r.csig2), r.csig1 * r.csig2 + r.ssig1 * r.ssig2);
  // omega12 on the auxiliary sphere, taken directly relative to the target longitude difference.
  const double somg12 = std::max(0.0, comg1 * somg2 - somg1 * comg2);
  const double comg12 = comg1 * comg2 + somg1 * somg2;
  const double eta = std::atan2(somg12 * clam12 - comg12 * slam12, comg12 * clam12 + somg12 * slam12);
  r.eps = detail::geodesicEps(calp0 * calp0 * ell.ep2);
  double c3[kGeodesicOrder];
  detail::geodesicC3(ell, r.eps, c3);
  const double b312 =
      sinCosSeries(r.ssig2, r.csig2, c3, kGeodesicOrder - 1) - sinCosSeries(r.ssig1, r.csig1, c3, kGeodesicOrder - 1);
  r.misclosure = eta - ell.f * detail::geodesicA3(ell, r.eps) * salp0 * (r.sig12 + b312);
  if (r.calp2 == 0.0) {
    r.derivative = -2.0 * ell.f1 * p1.dn / p1.sinBeta;
  } else {
    const Lengths len = geodesicLengths(r.eps, r.sig12, r.ssig1, r.csig1, p1.dn, r.ssig2, r.csig2, p2.dn);
    r.derivative = len.m12b * ell.f1 / (r.calp2 * p2.cosBeta);
  }
  return r;
}

// Result in the canonical frame.
struct CanonicalSolution {
  double s12;
  double salp1, calp1, salp2, calp2;
};

// Starting azimuth (salp1, calp1); for short lines the complete solution (returns true).
bool startingAzimuth(const GeodesicEllipsoid& ell, const ReducedPoint& p1, const ReducedPoint& p2, double lam12,
                     double slam12, double clam12, CanonicalSolution& sol) {
  const double sbet12 = p2.sinBeta * p1.cosBeta - p2.cosBeta * p1.sinBeta;
  const double cbet12 = p2.cosBeta * p1.cosBeta + p2.sinBeta * p1.sinBeta;
  const double sbet12a = p2.sinBeta * p1.cosBeta + p2.cosBeta * p1.sinBeta;
  const bool shortLine = cbet12 >= 0.0 && sbet12 < 0.5 && p2.cosBeta * lam12 < 0.5;
  double somg12 = slam12, comg12 = clam12, dnm = 1.0;
  if (shortLine) {
    // A sphere of the radius of curvature at the mean reduced latitude.
    double sbetm2 = (p1.sinBeta + p2.sinBeta) * (p1.sinBeta + p2.sinBeta);
    sbetm2 /= sbetm2 + (p1.cosBeta + p2.cosBeta) * (p1.cosBeta + p2.cosBeta);
    dnm = std::sqrt(1.0 + ell.ep2 * sbetm2);
    const double omg12 = lam12 / (ell.f1 * dnm);
    somg12 = std::sin(omg12);
    comg12 = std::cos(omg12);
  }
  double& salp1 = sol.salp1;
  double& calp1 = sol.calp1;
  salp1 = p2.cosBeta * somg12;
  calp1 = comg12 >= 0.0 ? sbet12 + p2.cosBeta * p1.sinBeta * somg12 * somg12 / (1.0 + comg12)
                        : sbet12a - p2.cosBeta * p1.sinBeta * somg12 * somg12 / (1.0 - comg12);
  const double ssig12 = std::hypot(salp1, calp1);
  const double csig12 = p1.sinBeta * p2.sinBeta + p1.cosBeta * p2.cosBeta * comg12;
  if (shortLine && ssig12 < tol::kGeodesicShortLine) {
    sol.salp2 = p1.cosBeta * somg12;
    sol.calp2 = sbet12 - p1.cosBeta * p2.sinBeta *
                             (comg12 >= 0.0 ? somg12 * somg12 / (1.0 + comg12) : 1.0 - comg12);
    normalizePair(sol.salp2, sol.calp2);
    normalizePair(salp1, calp1);
    sol.s12 = ell.b * std::atan2(ssig12, csig12) * dnm;
    return true;
  }
  if (csig12 < 0.0 && ssig12 < 6.0 * std::fabs(ell.n) * units::kPi * p1.cosBeta * p1.cosBeta) {
    // Nearly antipodal: scale the neighbourhood of the antipode (x along the equator, y across it) and
    // solve the astroid for the starting azimuth.
    const double lam12x = std::atan2(-slam12, -clam12);  // lambda12 - pi
    const double k2 = p1.sinBeta * p1.sinBeta * ell.ep2;
    const double lamscale = ell.f * p1.cosBeta * detail::geodesicA3(ell, detail::geodesicEps(k2)) * units::kPi;
    const double betscale = lamscale * p1.cosBeta;
    const double x = lam12x / lamscale, y = sbet12a / betscale;
    if (y > -tol::kGeodesicAntipodalStrip && x > -1.0 - tol::kGeodesicCutMargin) {
      salp1 = std::min(1.0, -x);
      calp1 = -std::sqrt(1.0 - salp1 * salp1);
    } else {
      const double k = astroid(x, y);
      const double omg12a = lamscale * (-x * k / (1.0 + k));
      somg12 = std::sin(omg12a);
      comg12 = -std::cos(omg12a);
      salp1 = p2.cosBeta * somg12;
      calp1 = sbet12a - p2.cosBeta * p1.sinBeta * somg12 * somg12 / (1.0 - comg12);
    }
  }
  if (salp1 > 0.0) {
    normalizePair(salp1, calp1);
  } else {
    salp1 = 1.0;
    calp1 = 0.0;
  }
  return false;
}

// Newton's method with a bisection bracket on alpha1 (see the top of the file).
void solveAzimuth(const GeodesicEllipsoid& ell, const ReducedPoint& p1, const ReducedPoint& p2, double slam12,
                  double clam12, CanonicalSolution& sol) {
  double salp1 = sol.salp1, calp1 = sol.calp1;
  double salp1a = tol::kGeodesicTiny, calp1a = 1.0, salp1b = tol::kGeodesicTiny, calp1b = -1.0;
  bool newtonConverged = false, bracketClosed = false;
  LongitudeAtAzimuth at{};
  for (int step = 0; step < tol::kGeodesicSolverSteps; ++step) {
    at = longitudeAtAzimuth(ell, p1, p2, salp1, calp1, slam12, clam12);
    const double v = at.misclosure;
    if (bracketClosed || !(std::fabs(v) >= (newtonConverged ? 8.0 : 1.0) * tol::kGeodesicLongitude)) break;
    if (v > 0.0 && (step > tol::kGeodesicNewtonSteps || calp1 / salp1 > calp1b / salp1b)) {
      salp1b = salp1;
      calp1b = calp1;
    } else if (v < 0.0 && (step > tol::kGeodesicNewtonSteps || calp1 / salp1 < calp1a / salp1a)) {
      salp1a = salp1;
      calp1a = calp1;
    }
    if (step < tol::kGeodesicNewtonSteps && at.derivative > 0.0) {
      const double dalp1 = -v / at.derivative;
      if (std::fabs(dalp1) < units::kPi) {
        const double sdalp1 = std::sin(dalp1), cdalp1 = std::cos(dalp1);
        const double nsalp1 = salp1 * cdalp1 + calp1 * sdalp1;
        if (nsalp1 > 0.0) {
          calp1 = calp1 * cdalp1 - salp1 * sdalp1;
          salp1 = nsalp1;
          normalizePair(salp1, calp1);
          newtonConverged = std::fabs(v) <= 16.0 * tol::kGeodesicLongitude;
          continue;
        }
      }
    }
    // Bisection: the Newton step left the bracket or was not possible.
    salp1 = (salp1a + salp1b) / 2.0;
    calp1 = (calp1a + calp1b) / 2.0;
    normalizePair(salp1, calp1);
    newtonConverged = false;
    bracketClosed = std::fabs(salp1a - salp1) + (calp1a - calp1) < tol::kGeodesicBracket ||
                    std::fabs(salp1 - salp1b) + (calp1 - calp1b) < tol::kGeodesicBracket;
  }
  const Lengths len = geodesicLengths(at.eps, at.sig12, at.ssig1, at.csig1, p1.dn, at.ssig2, at.csig2, p2.dn);
  sol.s12 = ell.b * len.s12b;
  sol.salp1 = salp1;
  sol.calp1 = calp1;
  sol.salp2 = at.salp2;
  sol.calp2 = at.calp2;
}

}  // namespace

bool invers(double lat1, double lon1, double lat2, double lon2, double& distance, double& azimuth1,
            double& azimuth2) {
  if (!detail::isLatitude(lat1) || !detail::isLatitude(lat2) || !std::isfinite(lon1) || !std::isfinite(lon2)) return false;
  const GeodesicEllipsoid& ell = detail::geodesicEllipsoid();
  double lam12 = std::remainder(lon2 - lon1, units::kTwoPi);
  // -pi and pi are one meridian; take pi so that the canonical difference is non-negative.
  if (lam12 == -units::kPi) lam12 = units::kPi;
  double lonSign = lam12 >= 0.0 ? 1.0 : -1.0;
  lam12 *= lonSign;
  const double swapSign = std::fabs(lat1) < std::fabs(lat2) ? -1.0 : 1.0;
  if (swapSign < 0.0) {
    lonSign = -lonSign;
    std::swap(lat1, lat2);
  }
  const double latSign = lat1 < 0.0 ? 1.0 : -1.0;
  lat1 *= latSign;
  lat2 *= latSign;
  ReducedPoint p1 = reducedPoint(ell, lat1);
  ReducedPoint p2 = reducedPoint(ell, lat2);
  // Keep the symmetry of lat2 = lat1 and lat2 = -lat1 exact after rounding.
  if (p1.cosBeta < -p1.sinBeta) {
    if (p2.cosBeta == p1.cosBeta) p2.sinBeta = std::copysign(p1.sinBeta, p2.sinBeta);
  } else if (std::fabs(p2.sinBeta) == -p1.sinBeta) {
    p2.cosBeta = p1.cosBeta;
  }
  const double slam12 = lam12 == units::kPi ? 0.0 : std::sin(lam12);
  const double clam12 = lam12 == units::kPi ? -1.0 : std::cos(lam12);

  CanonicalSolution sol{};
  bool solved = false;
  if (lat1 == -units::kHalfPi || slam12 == 0.0) {
    // Along a meridian: shortest unless a conjugate point lies between (m12 < 0 beyond half the meridian).
    sol.calp1 = clam12;
    sol.salp1 = slam12;
    sol.calp2 = 1.0;
    sol.salp2 = 0.0;
    double ssig1 = p1.sinBeta, csig1 = sol.calp1 * p1.cosBeta;
    double ssig2 = p2.sinBeta, csig2 = sol.calp2 * p2.cosBeta;
    const double sig12 = std::atan2(std::max(0.0, csig1 * ssig2 - ssig1 * csig2), csig1 * csig2 + ssig1 * ssig2);
    const Lengths len = geodesicLengths(detail::geodesicEps(ell.ep2), sig12, ssig1, csig1, p1.dn, ssig2, csig2, p2.dn);
    if (sig12 < 1.0 || len.m12b >= 0.0) {
      sol.s12 = ell.b * std::max(0.0, len.s12b);
      solved = true;
    }
  }
  if (!solved && p1.sinBeta == 0.0 && lam12 <= ell.f1 * units::kPi) {
    // Along the equator, which is the shortest path up to (1 - f) pi of longitude.
    sol.salp1 = sol.salp2 = 1.0;
    sol.calp1 = sol.calp2 = 0.0;
    sol.s12 = ell.a * lam12;
    solved = true;
  }
  if (!solved && !startingAzimuth(ell, p1, p2, lam12, slam12, clam12, sol)) solveAzimuth(ell, p1, p2, slam12, clam12, sol);

  if (swapSign < 0.0) {
    std::swap(sol.salp1, sol.salp2);
    std::swap(sol.calp1, sol.calp2);
  }
  distance = sol.s12;
  azimuth1 = std::atan2(swapSign * lonSign * sol.salp1, swapSign * latSign * sol.calp1);
  azimuth2 = std::atan2(swapSign * lonSign * sol.salp2, swapSign * latSign * sol.calp2);
  return true;
}

}  // namespace svy_math
