#pragma once
// Internal to the geodesic solutions: the ellipsoid in the form they use and the series of the distance,
// reduced-length and longitude integrals on the auxiliary sphere.
//
// With k^2 = e'^2 cos^2(alpha0) (alpha0 the azimuth where the geodesic crosses the equator) the series run
// in eps = k^2 / (2 (1 + sqrt(1 + k^2)) + k^2) < 0.0017 on the earth and in the third flattening n. Each
// integral is I(sigma) = A (sigma + sum_l C_l sin(2 l sigma)), l = 1..kGeodesicOrder:
//   distance           s / b   = I1(sigma), integrand sqrt(1 + k^2 sin^2 sigma);
//   reduced length     from J  = I1 - I2,   I2's integrand 1 / sqrt(1 + k^2 sin^2 sigma);
//   longitude          lambda  = omega - f sin(alpha0) I3(sigma), I3's integrand
//                                (2 - f) / (1 + (1 - f) sqrt(1 + k^2 sin^2 sigma)).
// C1' inverts the distance series: sigma = tau + sum_l C1'_l sin(2 l tau) for tau = s / (b A1).
namespace svy_math {
namespace detail {

// Order of the series: the first neglected term is eps^7 ~ 4e-20 relative, nothing on the earth.
constexpr int kGeodesicOrder = 6;

struct GeodesicEllipsoid {
  double a;    // semi-major axis (metres)
  double f;    // flattening, from the stored eccentricity: 1 - sqrt(1 - e^2)
  double f1;   // 1 - f
  double e2;   // e^2
  double ep2;  // e'^2
  double n;    // third flattening f / (2 - f)
  double b;    // semi-minor axis (metres)
  // A3 as a polynomial in eps (coefficients of eps^0..eps^5) and C3_l as polynomials in eps (eps^1..eps^5),
  // their n-dependence evaluated once.
  double a3[kGeodesicOrder];
  double c3[kGeodesicOrder][kGeodesicOrder];
};

// The library's ellipsoid in this form, built once.
const GeodesicEllipsoid& geodesicEllipsoid();

// eps of a geodesic from k^2.
double geodesicEps(double k2);

// A1 and C1_1..C1_6 (c[0] unused); A2 and C2; C1'; A3 and C3 at eps.
double geodesicA1(double eps);
void geodesicC1(double eps, double c[kGeodesicOrder + 1]);
double geodesicA2(double eps);
void geodesicC2(double eps, double c[kGeodesicOrder + 1]);
void geodesicC1p(double eps, double c[kGeodesicOrder + 1]);
double geodesicA3(const GeodesicEllipsoid& ell, double eps);
void geodesicC3(const GeodesicEllipsoid& ell, double eps, double c[kGeodesicOrder]);

// sum_{l=1..count} c[l] sin(2 l sigma) from sin and cos of sigma, by Clenshaw summation.
double sinCosSeries(double sinSigma, double cosSigma, const double* c, int count);

// Whether a latitude (radians) is finite and within [-pi/2, pi/2].
bool isLatitude(double lat);

// Scales (s, c) to a unit vector.
void normalizePair(double& s, double& c);

}  // namespace detail
}  // namespace svy_math
