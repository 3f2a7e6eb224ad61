// Series coefficients of the geodesic integrals (see geodesic_series.h). The expansions were derived for
// this code from the integrands and checked against numerical quadrature of each integral to 30 digits.
#include "svymath/geodesy/geodesic_series.h"

#include <cmath>

#include "svymath/foundation/constants.h"
#include "svymath/geodesy/ellipsoid.h"

namespace svy_math {
namespace detail {
namespace {

// Horner evaluation of sum_{i=0..count-1} p[i] x^i.
double polynomial(const double* p, int count, double x) {
  double y = 0.0;
  for (int i = count - 1; i >= 0; --i) y = y * x + p[i];
  return y;
}

GeodesicEllipsoid makeGeodesicEllipsoid() {
  const TEllipsoidParams& p = ellipsoidParams();
  GeodesicEllipsoid g{};
  g.a = p.a;
  g.e2 = p.e2;
  g.f1 = std::sqrt(1.0 - p.e2);
  g.f = 1.0 - g.f1;
  g.ep2 = p.ep2;
  g.n = g.f / (2.0 - g.f);
  g.b = p.a * g.f1;
  const double n = g.n, n2 = n * n;
  const double a3[kGeodesicOrder] = {1.0,
                                     -(1.0 / 2 - n / 2),
                                     -(1.0 / 4 + n / 8 - 3 * n2 / 8),
                                     -(1.0 / 16 + 3 * n / 16 + n2 / 16),
                                     -(3.0 / 64 + n / 32),
                                     -3.0 / 128};
  const double c3[kGeodesicOrder][kGeodesicOrder] = {
      {0, 0, 0, 0, 0, 0},
      {0, 1.0 / 4 - n / 4, 1.0 / 8 - n2 / 8, 3.0 / 64 + 3 * n / 64 - n2 / 64, 5.0 / 128 + n / 64, 3.0 / 128},
      {0, 0, 1.0 / 16 - 3 * n / 32 + n2 / 32, 3.0 / 64 - n / 32 - 3 * n2 / 64, 3.0 / 128 + n / 128, 5.0 / 256},
      {0, 0, 0, 5.0 / 192 - 3 * n / 64 + 5 * n2 / 192, 3.0 / 128 - 5 * n / 192, 7.0 / 512},
      {0, 0, 0, 0, 7.0 / 512 - 7 * n / 256, 7.0 / 512},
      {0, 0, 0, 0, 0, 21.0 / 2560}};
  for (int i = 0; i < kGeodesicOrder; ++i) {
    g.a3[i] = a3[i];
    for (int j = 0; j < kGeodesicOrder; ++j) g.c3[i][j] = c3[i][j];
  }
  return g;
}

}  // namespace

const GeodesicEllipsoid& geodesicEllipsoid() {
  static const GeodesicEllipsoid ellipsoid = makeGeodesicEllipsoid();
  return ellipsoid;
}

double geodesicEps(double k2) { return k2 / (2.0 * (1.0 + std::sqrt(1.0 + k2)) + k2); }

double geodesicA1(double eps) {
  const double e2 = eps * eps;
  return (1.0 + e2 * (1.0 / 4 + e2 * (1.0 / 64 + e2 / 256))) / (1.0 - eps);
}

void geodesicC1(double eps, double c[kGeodesicOrder + 1]) {
  const double e2 = eps * eps;
  c[0] = 0.0;
  c[1] = eps * (-1.0 / 2 + e2 * (3.0 / 16 - e2 / 32));
  c[2] = e2 * (-1.0 / 16 + e2 * (1.0 / 32 - 9.0 * e2 / 2048));
  c[3] = e2 * eps * (-1.0 / 48 + 3.0 * e2 / 256);
  c[4] = e2 * e2 * (-5.0 / 512 + 3.0 * e2 / 512);
  c[5] = e2 * e2 * eps * (-7.0 / 1280);
  c[6] = e2 * e2 * e2 * (-7.0 / 2048);
}

double geodesicA2(double eps) {
  const double e2 = eps * eps;
  return (1.0 - eps) * (1.0 + e2 * (1.0 / 4 + e2 * (9.0 / 64 + 25.0 * e2 / 256)));
}

void geodesicC2(double eps, double c[kGeodesicOrder + 1]) {
  const double e2 = eps * eps;
  c[0] = 0.0;
  c[1] = eps * (1.0 / 2 + e2 * (1.0 / 16 + e2 / 32));
  c[2] = e2 * (3.0 / 16 + e2 * (1.0 / 32 + 35.0 * e2 / 2048));
  c[3] = e2 * eps * (5.0 / 48 + 5.0 * e2 / 256);
  c[4] = e2 * e2 * (35.0 / 512 + 7.0 * e2 / 512);
  c[5] = e2 * e2 * eps * (63.0 / 1280);
  c[6] = e2 * e2 * e2 * (77.0 / 2048);
}

void geodesicC1p(double eps, double c[kGeodesicOrder + 1]) {
  const double e2 = eps * eps;
  c[0] = 0.0;
  c[1] = eps * (1.0 / 2 + e2 * (-9.0 / 32 + 205.0 * e2 / 1536));
  c[2] = e2 * (5.0 / 16 + e2 * (-37.0 / 96 + 1335.0 * e2 / 4096));
  c[3] = e2 * eps * (29.0 / 96 - 75.0 * e2 / 128);
  c[4] = e2 * e2 * (539.0 / 1536 - 2391.0 * e2 / 2560);
  c[5] = e2 * e2 * eps * (3467.0 / 7680);
  c[6] = e2 * e2 * e2 * (38081.0 / 61440);
}

double geodesicA3(const GeodesicEllipsoid& ell, double eps) { return polynomial(ell.a3, kGeodesicOrder, eps); }

void geodesicC3(const GeodesicEllipsoid& ell, double eps, double c[kGeodesicOrder]) {
  c[0] = 0.0;
  for (int l = 1; l < kGeodesicOrder; ++l) c[l] = polynomial(ell.c3[l], kGeodesicOrder, eps);
}

double sinCosSeries(double sinSigma, double cosSigma, const double* c, int count) {
  // b_l = c_l + 2 cos(2 sigma) b_{l+1} - b_{l+2}; the sum is b_1 sin(2 sigma).
  const double twoCos2 = 2.0 * (cosSigma - sinSigma) * (cosSigma + sinSigma);
  double b1 = 0.0, b2 = 0.0;
  for (int l = count; l >= 1; --l) {
    const double b0 = c[l] + twoCos2 * b1 - b2;
    b2 = b1;
    b1 = b0;
  }
  return 2.0 * sinSigma * cosSigma * b1;
}

bool isLatitude(double lat) { return std::isfinite(lat) && std::fabs(lat) <= units::kHalfPi; }

void normalizePair(double& s, double& c) {
  const double r = std::hypot(s, c);
  s /= r;
  c /= r;
}

}  // namespace detail
}  // namespace svy_math
