#include "svymath/foundation/angle_functions.h"

#include <cmath>
#include <limits>

#include "svymath/foundation/constants.h"
#include "svyutils/round_prec.h"
#include "svyutils/svy_err_log.h"
#include "svyutils/svy_number_text.h"
#include "svyutils/svy_string.h"

namespace {

namespace units = svy_math::units;
namespace tol = svy_math::tol;

// Source name of the entries this file logs.
constexpr char kLogSource[] = "formats";

// The reductions below move a value by whole periods in a loop. A value more than this many periods away
// from its range is first brought near it with fmod, so that 1e300 costs no more than 1 and the loop keeps
// its closed-end behaviour for ordinary input.
constexpr double kMaxLoopPeriods = 64.0;

// The largest number of degrees whose whole part fits an int.
constexpr double kIntDegreesLimit = 2147483647.0;

double nan() { return std::numeric_limits<double>::quiet_NaN(); }

bool withinZero(double x) { return -tol::kZero < x && x < tol::kZero; }

double reduceDeg(double deg, bool noMod) { return noMod ? deg : std::fmod(deg, units::kFullCircleDeg); }

// x moved by whole periods to within a few periods of anchor (unchanged when already near).
double bringNear(double x, double anchor, double period) {
  if (std::fabs(x - anchor) > kMaxLoopPeriods * period) return anchor + std::fmod(x - anchor, period);
  return x;
}

// One correction of a degree difference into (-180, 180].
double singleTurnCorrection(double d) {
  if (d > units::kHalfCircleDeg) return d - units::kFullCircleDeg;
  if (d <= -units::kHalfCircleDeg) return d + units::kFullCircleDeg;
  return d;
}

// The radian normalizers: period 2pi whatever the range. The lower threshold is -lo; flag kLowerStrict adds
// the period while threshold > x (otherwise while threshold >= x), flag kUpperStrict subtracts it while
// x > hi (otherwise while x >= hi). NaN and infinities pass unchanged.
enum : unsigned { kLowerStrict = 1u, kUpperStrict = 2u };

double normalizeRad(double x, double lo, double hi, unsigned flags) {
  if (!std::isfinite(x)) return x;
  const double period = units::kTwoPi;
  const double threshold = -lo;
  x = bringNear(x, 0.0, period);
  if (flags & kLowerStrict) {
    while (threshold > x) x += period;
  } else {
    while (threshold >= x) x += period;
  }
  if (flags & kUpperStrict) {
    while (x > hi) x -= period;
  } else {
    while (x >= hi) x -= period;
  }
  return x;
}

// A packed D.MMSS value split into its fields, with the carries of noisy or overfull seconds and minutes.
struct TPackedDms {
  bool negative;
  double deg;
  double min;
  double sec;
};

TPackedDms splitPacked(double x) {
  TPackedDms r;
  r.negative = x < 0.0;
  const double a = std::fabs(x);
  r.deg = std::trunc(a);
  const double minutes = (a - r.deg) * 100.0;
  r.min = std::trunc(minutes);
  r.sec = (minutes - r.min) * 100.0;
  if (r.sec < 0.0) svy_logging::svy_err_log(kLogSource, __LINE__, "");
  if (r.sec > tol::kPackedSecondsNoise) {
    r.min += 1.0;
    r.sec = 0.0;
  } else if (r.sec >= units::kArcMinutesPerDegree) {
    r.sec -= units::kArcMinutesPerDegree;
    r.min += 1.0;
  }
  if (r.min >= units::kArcMinutesPerDegree) {
    r.min -= units::kArcMinutesPerDegree;
    r.deg += 1.0;
  }
  return r;
}

}  // namespace

double Deg2Rad(double deg, bool noMod) { return reduceDeg(deg, noMod) * units::kDegToRad; }
double Rad2Deg(double rad, bool noMod) { return reduceDeg(rad * units::kRadToDeg, noMod); }
double Deg2Grad(double deg, bool noMod) { return reduceDeg(deg, noMod) / units::kDegPerGrad; }
double Grad2Deg(double grad, bool noMod) { return reduceDeg(grad * units::kDegPerGrad, noMod); }
double Deg2Mil(double deg, bool noMod) { return reduceDeg(deg, noMod) * units::kMilPerDeg; }
double Mil2Deg(double mil, bool noMod) { return reduceDeg(mil * units::kDegPerMil, noMod); }

double DegSec2GradCC(double seconds, bool noMod) {
  return reduceDeg(seconds / units::kArcSecondsPerDegree, noMod) / units::kDegPerGrad *
         units::kCentesimalSecondsPerGrad;
}

double GradCC2DegSec(double centesimalSeconds) {
  return centesimalSeconds * units::kArcSecondsPerGrad / units::kCentesimalSecondsPerGrad;
}

double ModDeg360(double deg, bool positive) {
  double r = std::fmod(deg, units::kFullCircleDeg);
  if (positive && r < 0.0) r += units::kFullCircleDeg;
  return r;
}

double ModDeg180(double deg, bool positive) {
  double r = std::fmod(deg, units::kFullCircleDeg);
  if (r > units::kHalfCircleDeg) r -= units::kFullCircleDeg;
  if (r <= -units::kHalfCircleDeg) r += units::kFullCircleDeg;
  if (positive && r < 0.0) r += units::kHalfCircleDeg;
  return r;
}

double AngleDiff(double a, double b) { return singleTurnCorrection(a - b); }
double MinimizeTurnAngle(double deg) { return singleTurnCorrection(deg); }

double pos360(double deg) {
  double r = std::fmod(deg, units::kFullCircleDeg);
  if (r < 0.0) r += units::kFullCircleDeg;
  return r;
}

double HR2HL(double h) { return withinZero(h) ? h : ModDeg360(units::kFullCircleDeg - h, true); }
double HL2HR(double h) { return HR2HL(h); }

double Zenith2Level(double zenith) {
  return ModDeg360(units::kFullCircleDeg - zenith + units::kRightAngleDeg, true);
}
double Level2Zenith(double level) { return Zenith2Level(level); }

bool IsFaceReversed(double zenith) { return zenith > units::kHalfCircleDeg; }

void CalcReverseAngles(double& hz, double& v) {
  hz = ModDeg360(hz + units::kHalfCircleDeg, true);
  v = ModDeg360(units::kFullCircleDeg - v, true);
}

double atan3(double y, double x) { return withinZero(y) && withinZero(x) ? 0.0 : std::atan2(y, x); }

double toRange(double x, double lo, double hi) {
  if (lo >= hi) return lo;
  if (std::isnan(x)) return x;
  if (std::isinf(x)) return nan();
  const double period = hi - lo;
  x = bringNear(x, lo, period);
  while (lo > x) x += period;
  while (x > hi) x -= period;
  return x;
}

int toRange(int x, int lo, int hi) {
  if (lo >= hi) return lo;
  const long long period = static_cast<long long>(hi) - lo;
  long long v = x;
  if (v < lo) v += (lo - v + period - 1) / period * period;
  if (v > hi) v -= (v - hi + period - 1) / period * period;
  return static_cast<int>(v);
}

double Normalize0To2PI(double rad) { return normalizeRad(rad, 0.0, units::kTwoPi, kLowerStrict | kUpperStrict); }
double Normalize0ToLt2Pi(double rad) { return normalizeRad(rad, 0.0, units::kTwoPi, kLowerStrict); }
double Normalize0ToPi(double rad) { return normalizeRad(rad, 0.0, units::kPi, kLowerStrict | kUpperStrict); }
double NormalizeNegPiToPi(double rad) {
  return normalizeRad(rad, -units::kPi, units::kPi, kLowerStrict | kUpperStrict);
}
double NormalizeGtNegPiToPi(double rad) { return normalizeRad(rad, -units::kPi, units::kPi, kUpperStrict); }

double dms_to_deg(double d, double m, double s) {
  const double sign = (d < 0.0 || m < 0.0 || s < 0.0) ? -1.0 : 1.0;
  return (std::fabs(d) + std::fabs(m) / units::kArcMinutesPerDegree + std::fabs(s) / units::kArcSecondsPerDegree) *
         sign;
}

void deg_to_dms(double x, double* d, double* m, double* s) {
  const double a = std::fabs(x);
  double deg = std::trunc(a);
  const double f = (a - deg) * units::kArcMinutesPerDegree;
  double min = std::trunc(f + tol::kDmsMinuteNudge);
  double sec = std::fabs((f - min) * units::kArcMinutesPerDegree);
  if (x < 0.0) {
    if (deg != 0.0) {
      deg = -deg;
    } else if (min != 0.0) {
      min = -min;
    } else {
      sec = -sec;
    }
  }
  if (d != nullptr) *d = deg;
  if (m != nullptr) *m = min;
  if (s != nullptr) *s = sec;
}

double DDDMMSS2Deg(double packed) {
  const TPackedDms p = splitPacked(std::fmod(std::fabs(packed), units::kFullCircleDeg));
  const double deg = ((p.deg * units::kArcMinutesPerDegree + p.min) * units::kArcMinutesPerDegree + p.sec) /
                     units::kArcSecondsPerDegree;
  return packed < 0.0 ? -deg : deg;
}

void Deg2DDDMMSS(double deg, bool& negative, int& d, int& m, double& s, int prec) {
  if (prec < 0) svy_logging::svy_err_log(kLogSource, __LINE__, "");
  const double t = svy::math::round_prec(deg * units::kArcSecondsPerDegree, prec < 0 ? 0 : prec);
  negative = t < 0.0;
  const double a = std::fabs(t);
  if (!(a < kIntDegreesLimit * units::kArcSecondsPerDegree)) {
    d = 0;
    m = 0;
    s = nan();
    return;
  }
  const double whole = std::floor(a);
  d = static_cast<int>(std::floor(whole / units::kArcSecondsPerDegree));
  m = static_cast<int>(std::floor(std::fmod(whole, units::kArcSecondsPerDegree) / units::kArcMinutesPerDegree));
  s = std::fmod(whole, units::kArcMinutesPerDegree) + (a - whole);
}

double Deg2DDDMMSS(double deg, int prec, bool noMod) {
  if (!noMod) deg = std::fmod(deg, units::kFullCircleDeg);
  if (prec < 4) svy_logging::svy_err_log(kLogSource, __LINE__, "");
  bool negative = false;
  int d = 0;
  int m = 0;
  double s = 0.0;
  Deg2DDDMMSS(deg, negative, d, m, s, prec - 4);
  if (!noMod) d %= 360;
  const double packed = d + (m * 100.0 + s) / 10000.0;
  return negative ? -packed : packed;
}

double Deg2DDMMDEC(double deg, int prec, bool noMod) {
  if (!noMod) deg = std::fmod(deg, units::kFullCircleDeg);
  const double t = svy::math::round_prec(deg * units::kArcMinutesPerDegree, prec);
  const double a = std::fabs(t);
  const double whole = std::floor(a);
  const double d = std::floor(whole / units::kArcMinutesPerDegree);
  const double packed = (d * 100.0 + (whole - units::kArcMinutesPerDegree * d) + (a - whole)) / 100.0;
  return t < 0.0 ? -packed : packed;
}

svy_text::CSvyString DDDMMSS2String(double packed, int prec) {
  if (prec < 0) svy_logging::svy_err_log(kLogSource, __LINE__, "");
  if (!(std::fabs(packed) < kIntDegreesLimit)) return svy_text::CSvyString();
  const int decimals = prec < 0 ? 0 : prec;
  TPackedDms p = splitPacked(packed);
  p.sec = svy::math::round_prec(p.sec, decimals);
  if (p.sec >= units::kArcMinutesPerDegree) {
    p.sec -= units::kArcMinutesPerDegree;
    p.min += 1.0;
  }
  if (p.min >= units::kArcMinutesPerDegree) {
    p.min -= units::kArcMinutesPerDegree;
    p.deg += 1.0;
  }
  const int deg = static_cast<int>(p.negative ? -p.deg : p.deg);
  svy_text::CSvyString text;
  text.Format(L"%d\u00B0%d'", deg, static_cast<int>(p.min));
  text += svy_formats::DoubleToString(p.sec, decimals);
  text += L'"';
  return text;
}

double AngleToRad(const svy_text::CSvyString& degrees, const svy_text::CSvyString& minutes,
                  const svy_text::CSvyString& seconds) {
  int d = 0;
  int m = 0;
  double s = 0.0;
  if (!svy_formats::StringToInt(degrees, d) || !svy_formats::StringToInt(minutes, m) ||
      !svy_formats::StringToDouble(seconds, s)) {
    return 0.0;
  }
  if (m < 0) svy_logging::svy_err_log(kLogSource, __LINE__, "");
  if (s < 0.0) svy_logging::svy_err_log(kLogSource, __LINE__, "");
  const double dm = static_cast<double>(d) * units::kArcMinutesPerDegree;
  const double value = d >= 0 ? ((dm + m) * units::kArcMinutesPerDegree + s) / units::kArcSecondsPerDegree
                              : ((dm - m) * units::kArcMinutesPerDegree - s) / units::kArcSecondsPerDegree;
  return Deg2Rad(value, false);
}
