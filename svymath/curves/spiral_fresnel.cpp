#include "svymath/curves/spiral_fresnel.h"

#include <cmath>
#include <complex>
#include <limits>

#include "svymath/foundation/constants.h"

namespace svy_math {
namespace {

// Below this argument the power series switches to the continued fraction: the series terms grow to about
// 11 at 1.5 (cancellation stays near one digit) while the continued fraction converges within its step limit
// from here on.
constexpr double kSeriesLimit = 1.5;
// Largest number of series passes (one term added to each sum per pass); 1.5 needs 14.
constexpr int kSeriesMaxPasses = 24;
// Below this argument only the leading terms C = x and S = pi*x^3/6 are kept: the next terms are smaller by
// a factor of x^4 <= 2^-56, below the rounding unit 2^-53 of the leading terms.
constexpr double kSeriesLeadingOnly = 1.0 / 16384.0;  // 2^-14
// Largest number of continued-fraction steps (odd indices 1 ... 49).
constexpr int kFractionMaxSteps = 25;
// Convergence test of the modified Lentz method: the last factor is 1 to the rounding unit.
constexpr double kFractionEps = std::numeric_limits<double>::epsilon();
// Smallest magnitude a Lentz denominator may take (keeps a zero denominator from dividing by zero).
constexpr double kFractionTiny = 1e-300;

// Power series, x >= 0 and x < kSeriesLimit. With t = pi*x^2/2 the terms are x*t^k/k! / (2k+1): the odd k
// belong to S, the even k to C, and the sign alternates per pair: +, -, -, +, +, ...
void fresnelSeries(double x, double& S, double& C) {
  C = x;
  if (x < kSeriesLeadingOnly) {
    S = x * (units::kHalfPi * x * x) / 3.0;
    return;
  }
  const double t = units::kHalfPi * x * x;
  double term = x * t;  // x*t^k/k! for k = 1
  S = term / 3.0;
  double sign = 1.0;
  for (int pass = 1; pass <= kSeriesMaxPasses; ++pass) {
    const int kc = 2 * pass;  // the C term of this pass
    sign = -sign;
    term *= t / kc;
    const double addC = sign * term / (2 * kc + 1);
    const int ks = kc + 1;  // the S term of this pass
    term *= t / ks;
    const double addS = sign * term / (2 * ks + 1);
    const double newC = C + addC;
    const double newS = S + addS;
    const bool settled = newC == C && newS == S;
    C = newC;
    S = newS;
    if (settled) break;
  }
}

// Continued fraction, x >= kSeriesLimit: erfc of (1 - i)*(sqrt(pi)/2)*x by the modified Lentz method, then
//   C + iS = (1 + i)/2 * (1 - exp(i*pi*x^2/2) * (1 - i)*x * h),  h the value of the fraction.
void fresnelFraction(double x, double& S, double& C) {
  using cplx = std::complex<double>;
  const double pix2 = units::kPi * x * x;
  cplx b(1.0, -pix2);
  cplx cc(1.0 / kFractionTiny, 0.0);
  cplx d = 1.0 / b;
  cplx h = d;
  int n = -1;
  for (int step = 1; step <= kFractionMaxSteps; ++step) {
    n += 2;
    const double a = -static_cast<double>(n) * (n + 1);
    b += 4.0;
    d = a * d + b;
    if (std::abs(d) < kFractionTiny) d = kFractionTiny;
    d = 1.0 / d;
    cc = b + a / cc;
    if (std::abs(cc) < kFractionTiny) cc = kFractionTiny;
    const cplx del = cc * d;
    h *= del;
    if (std::fabs(del.real() - 1.0) + std::fabs(del.imag()) < kFractionEps) break;
  }
  h *= cplx(x, -x);
  const double half = 0.5 * pix2;
  const cplx cs = cplx(0.5, 0.5) * (1.0 - cplx(std::cos(half), std::sin(half)) * h);
  C = cs.real();
  S = cs.imag();
}

}  // namespace

void fresnelCS(double t, double& S, double& C) {
  const double x = std::fabs(t);
  if (std::isnan(x)) {
    S = C = x;
    return;
  }
  if (std::isinf(x)) {
    S = C = 0.5;
  } else if (x < kSeriesLimit) {
    fresnelSeries(x, S, C);
  } else {
    fresnelFraction(x, S, C);
  }
  if (t < 0.0) {
    S = -S;
    C = -C;
  }
}

}  // namespace svy_math
