#include "svymath/curves/spiral_cubic.h"

#include <cmath>

#include "svymath/curves/spiral_length_range.h"
#include "svymath/foundation/constants.h"

using svy_math::tol::kZero;

namespace {

// Series of the arc length of east = a*x^3: L(x) = x*(1 + c1*u + c2*u^2 + c3*u^3 + c4*u^4), u = a^2*x^4
// (the binomial series of the integral of sqrt(1 + 9a^2x^4), five terms).
constexpr double kLenC1 = 0.9;
constexpr double kLenC2 = -1.125;
constexpr double kLenC3 = 3.5048076923076925;
constexpr double kLenC4 = -15.075827205882353;
// Its reversion: x(s) = s*(1 + r1*u + r2*u^2 + r3*u^3 + r4*u^4), u = a^2*s^4.
constexpr double kXR1 = -0.9;
constexpr double kXR2 = 5.175;
constexpr double kXR3 = -43.19480769230769;
constexpr double kXR4 = 426.056586821267;

// On the unit parabola (a = 1) the ratio radius/length is smallest, 1.4416..., at the normalised length
// 0.3936...: a cubic spiral of length L cannot end in a radius below 1.4416*L, and the searches stay on the
// flat branch (0, 0.3936].
constexpr double kMinRadiusToLength = 1.4416123478778036;
constexpr double kMaxNormLength = 0.3936182748692745;
// Starting point of the radius-ratio search (half the branch), the ratio there, and the first step.
constexpr double kSearchStart = 0.19680913743463724;
constexpr double kRatioAtSearchStart = 4.395730752900214;
constexpr double kSearchFirstStep = 0.09840456871731862;
// The searches stop when the step has shrunk below this (normalised length, dimensionless).
constexpr double kSearchMinStep = 1e-12;
// A search result is accepted when its ratio error is at most this (dimensionless).
constexpr double kSearchMaxError = 1e-6;
// Hard bound on search iterations: the step halves every second failure, so a normal search ends after a
// few hundred; this only guards against inputs no search can settle.
constexpr int kSearchMaxIterations = 10000;

// The step multipliers after a failed trial: reverse, then halve, then reverse, ...
double nextStepFactor(int failures) { return failures % 2 == 0 ? -1.0 : 0.5; }

double lengthByX(double a, double x) {
  const double u = a * a * x * x * x * x;
  return x * (1.0 + u * (kLenC1 + u * (kLenC2 + u * (kLenC3 + u * kLenC4))));
}

double xByLength(double a, double s) {
  const double u = a * a * s * s * s * s;
  return s * (1.0 + u * (kXR1 + u * (kXR2 + u * (kXR3 + u * kXR4))));
}

// Radius-to-length ratio of the unit parabola at normalised length s.
double unitRatio(double s) { return CCubicSpiralTStoSC::calcRByL(1.0, s) / s; }
}  // namespace

CCubicSpiralTStoSC::CCubicSpiralTStoSC()
    : m_cacheLen(svy_math::undefinedValue()), m_cacheX(svy_math::undefinedValue()) {}

CCurveSpiralTStoSCBase* CCubicSpiralTStoSC::clone() const { return new CCubicSpiralTStoSC(*this); }

void CCubicSpiralTStoSC::reset() {
  CCurveSpiralTStoSCBase::reset();
  m_a = 0.0;
  m_cacheLen = svy_math::undefinedValue();
  m_cacheX = svy_math::undefinedValue();
}

bool CCubicSpiralTStoSC::copy(const CCurveSpiralTStoSCBase* other) {
  if (other == nullptr || other->getMathSpiralType() != getMathSpiralType()) return false;
  if (other != this) *this = *static_cast<const CCubicSpiralTStoSC*>(other);
  return true;
}

double CCubicSpiralTStoSC::getLengthByX(double x) const {
  if (std::fabs(x - m_cacheX) < kZero) return m_cacheLen;
  const double s = lengthByX(m_a, x);
  m_cacheX = x;
  m_cacheLen = s;
  return s;
}

double CCubicSpiralTStoSC::getXByLength(double s) const {
  if (std::fabs(s - m_cacheLen) < kZero) return m_cacheX;
  const double x = xByLength(m_a, s);
  m_cacheLen = s;
  m_cacheX = x;
  return x;
}

double CCubicSpiralTStoSC::calcRByL(double a, double s) {
  const double x = xByLength(a, s);
  if (!(std::fabs(x) >= kZero) || !(std::fabs(a) >= kZero)) return 0.0;
  return std::pow(1.0 + 9.0 * a * a * x * x * x * x, 1.5) / (6.0 * a * x);
}

void CCubicSpiralTStoSC::storeSpiral(double L, double R, double a) {
  m_radius = R;
  m_a = a;
  m_length = L;
  const double xL = xByLength(a, L);
  m_finalNorth = xL;
  m_finalEast = a * xL * xL * xL;
  m_spiralAngle.setRad(std::atan(3.0 * a * xL * xL));
}

bool CCubicSpiralTStoSC::setLenAndR(double L, double R, bool toTheRight) {
  reset();
  if (L <= 0.0 || std::fabs(R) < kMinRadiusToLength * L) return false;
  const double q = std::fabs(R) / L;
  double s = kSearchStart;
  double err = std::fabs(q - kRatioAtSearchStart);
  double step = q <= kRatioAtSearchStart ? kSearchFirstStep : -kSearchFirstStep;
  int failures = 0;
  for (int i = 0; i < kSearchMaxIterations && std::fabs(step) >= kSearchMinStep; ++i) {
    const double trial = s + step;
    if (trial > 0.0 && trial <= kMaxNormLength) {
      const double trialErr = std::fabs(q - unitRatio(trial));
      if (trialErr < err) {
        s = trial;
        err = trialErr;
        continue;
      }
    }
    step *= nextStepFactor(failures++);
  }
  if (!(err <= kSearchMaxError)) return false;
  const double a = (s / L) * (s / L);
  storeSpiral(L, toTheRight ? std::fabs(R) : -std::fabs(R), toTheRight ? a : -a);
  return true;
}

bool CCubicSpiralTStoSC::setLenAndSpPrm(double L, double K) {
  if (std::fabs(L) < kZero) return setLenAndR(L, 0.0, true);
  const double R = K / L;
  return setLenAndR(L, R, R >= 0.0);
}

bool CCubicSpiralTStoSC::setLenAndTwoR(double L, double R1, double R2, bool toTheRight) {
  reset();
  const double rMax = std::fmax(std::fabs(R1), std::fabs(R2));
  const double rMin = std::fmin(std::fabs(R1), std::fabs(R2));
  if (!(L > 0.0) || !(std::fabs(rMax - rMin) >= kZero) || rMin <= kMinRadiusToLength * L) return false;
  const double ratio = rMax / rMin;
  const double m = L / rMin;
  // s: normalised length of the sharp end; t: that of the flat end, L before it on the scaled curve.
  double s = kMaxNormLength;
  double r = calcRByL(1.0, s);
  double err = std::fabs(ratio - calcRByL(1.0, s - r * m) / r);
  double step = -kSearchStart;
  int failures = 0;
  for (int i = 0; i < kSearchMaxIterations && std::fabs(step) >= kSearchMinStep; ++i) {
    const double trial = s + step;
    if (trial > 0.0 && trial <= kMaxNormLength) {
      const double trialR = calcRByL(1.0, trial);
      const double trialT = trial - trialR * m;
      if (trialT > 0.0) {
        const double trialErr = std::fabs(ratio - calcRByL(1.0, trialT) / trialR);
        if (trialErr < err) {
          s = trial;
          r = trialR;
          err = trialErr;
          continue;
        }
      }
    }
    step *= nextStepFactor(failures++);
  }
  if (!(err <= kSearchMaxError)) return false;
  const double c = r / rMin;
  const double a = c * c;
  storeSpiral(s / c, toTheRight ? rMin : -rMin, toTheRight ? a : -a);
  return true;
}

double CCubicSpiralTStoSC::GetAzimuth(double s) const {
  const double x = getXByLength(s);
  return std::atan(3.0 * m_a * x * x) * svy_math::units::kRadToDeg;
}

double CCubicSpiralTStoSC::getLengthAtAzimuth(const CMathAngle& angle) const {
  const double t = angle.getTg();
  if (m_a == 0.0 || (t < 0.0) != (m_a < 0.0)) return 0.0;
  return getLengthByX(std::sqrt(0.5 * t / m_a));
}

double CCubicSpiralTStoSC::getCurvatureAtLength(double s) const {
  const double x = getXByLength(s);
  if (!(std::fabs(m_a) >= kZero) || !(std::fabs(x) >= kZero)) return 0.0;
  return 6.0 * m_a * x / std::pow(1.0 + 9.0 * m_a * m_a * x * x * x * x, 1.5);
}

bool CCubicSpiralTStoSC::getPosAtLength(double s, double& north, double& east) const {
  if (!svy_math::checkLengthOrLog(isok(), s, m_length, __LINE__)) return false;
  if (isDegenerate()) {
    north = 0.0;
    east = 0.0;
    return true;
  }
  const double x = getXByLength(s);
  north = x;
  east = m_a * x * x * x;
  return true;
}
