// Plain-number angle functions: reductions with their closed ends, unit round trips, sexagesimal forms,
// and termination on non-finite or absurd input.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <string>

#include "svymath/foundation/angle_functions.h"
#include "svymath/foundation/constants.h"
#include "svyutils/svy_err_log.h"
#include "svyutils/svy_string.h"

namespace {

constexpr double kPi = svy_math::units::kPi;
constexpr double kTwoPi = svy_math::units::kTwoPi;
const double kNaN = std::numeric_limits<double>::quiet_NaN();
const double kInf = std::numeric_limits<double>::infinity();
using Fn = double (*)(double);

// Both ends of the range are kept; values wrap by whole periods (also beyond the loop limit, by fmod); an
// empty or inverted range gives its low end. The integer form wraps alike and survives the ends of int.
TEST(ToRange, KeepsBothEndsWrapsByWholePeriodsAndTerminates) {
  const double cases[][4] = {{kPi, -kPi, kPi, kPi}, {-3 * kPi, -kPi, kPi, -kPi}, {3 * kPi, -kPi, kPi, kPi},
                             {-30, 0, 360, 330},     {725, 0, 360, 5},            {7, 5, 5, 5},
                             {7, 9, 5, 9},           {100 * kTwoPi + 1.0, -kPi, kPi, 1.0}};
  for (const auto& c : cases) EXPECT_NEAR(toRange(c[0], c[1], c[2]), c[3], 1e-12) << c[0] << " " << c[1];
  EXPECT_NEAR(toRange(-36010.0, 0.0, 360.0), 350.0, 1e-9);
  for (int x = -1000; x <= 1000; x += 7)
    EXPECT_EQ(toRange(x, 0, 360), static_cast<int>(toRange(static_cast<double>(x), 0.0, 360.0))) << x;
  EXPECT_TRUE(toRange(360, 0, 360) == 360 && toRange(5, 3, 3) == 3);
  const int far = toRange(std::numeric_limits<int>::min(), -180, 180);
  EXPECT_TRUE(far >= -180 && far <= 180);
  EXPECT_LE(toRange(std::numeric_limits<int>::max(), std::numeric_limits<int>::min(), 0), 0);
}

// Closed and half-open ends of each reduction, one correction only in the differences (720 stays a full
// turn), reductions that keep the sign, unit definitions (one circle is 2 pi rad, 400 grad, 6400 mil; one
// grad is 10000 centesimal seconds = 3240 seconds of arc) and atan3's zero for a (nearly) zero vector.
TEST(Reductions, DocumentedRangesAndUnits) {
  struct { Fn fn; double x, expected, tol; } const cases[] = {
      {Normalize0To2PI, kTwoPi, kTwoPi, 1e-12},      {Normalize0To2PI, -1, kTwoPi - 1, 1e-12},
      {Normalize0ToLt2Pi, kTwoPi, 0, 1e-12},         {Normalize0ToLt2Pi, -kTwoPi, 0, 1e-12},
      {Normalize0ToPi, 4, 4 - kTwoPi, 1e-12},        {Normalize0ToPi, kPi, kPi, 1e-12},
      {Normalize0ToPi, -1, -1, 1e-12},               {NormalizeNegPiToPi, -kPi, kPi, 1e-12},
      {NormalizeNegPiToPi, 3 * kPi, kPi, 1e-12},     {NormalizeGtNegPiToPi, -kPi, kPi, 1e-12},
      {NormalizeGtNegPiToPi, -3, -3, 1e-12},         {NormalizeGtNegPiToPi, 10, 10 - 2 * kTwoPi, 1e-12},
      {[](double x) { return ModDeg360(x, true); }, -30, 330, 0},
      {[](double x) { return ModDeg360(x, false); }, -30, -30, 0},
      {[](double x) { return ModDeg180(x, false); }, 190, -170, 0},
      {[](double x) { return ModDeg180(x, false); }, -180, 180, 0},
      {[](double x) { return ModDeg180(x, true); }, -10, 170, 0},
      {pos360, 720, 0, 0},                           {HR2HL, 90, 270, 0},    {Zenith2Level, 100, 350, 0},
      {[](double x) { return AngleDiff(x, 10); }, 350, -20, 0},
      {[](double x) { return AngleDiff(x, 0); }, -180, 180, 0},
      {[](double x) { return AngleDiff(x, 0); }, 720, 360, 0},   {MinimizeTurnAngle, -340, 20, 0},
      {MinimizeTurnAngle, 720, 360, 0}, {[](double x) { return Deg2Rad(x, true); }, 360, kTwoPi, 1e-15},
      {[](double x) { return Deg2Grad(x, true); }, 360, 400, 1e-12},
      {[](double x) { return Deg2Mil(x, true); }, 360, 6400, 1e-9},
      {[](double x) { return DegSec2GradCC(x, false); }, 3240, 10000, 1e-9},
      {[](double x) { return Deg2Rad(x, false); }, -370, -10 * kPi / 180, 1e-15},
      {[](double x) { return Mil2Deg(x, false); }, -7000, -33.75, 1e-9},
      {[](double x) { return Rad2Deg(x, false); }, 3 * kPi, 180, 1e-9},
      {[](double x) { return Grad2Deg(x, false); }, 500, 90, 1e-12},
      {[](double x) { return atan3(x, -x); }, 1e-13, 0, 0},
      {[](double x) { return atan3(0, x); }, -1, kPi, 1e-15}};
  for (const auto& c : cases) EXPECT_NEAR(c.fn(c.x), c.expected, c.tol) << "row " << (&c - cases);
  EXPECT_TRUE(std::signbit(ModDeg360(-0.0, true)));
}

// Every reduction ends on absurd input: NaN gives NaN, infinities give NaN (the radian normalizers pass them
// through), huge and tiny values land in range.
TEST(Reductions, TerminateInRangeOnAbsurdInput) {
  struct { const char* name; Fn fn; double lo, hi; bool passesInfinity; } const reducers[] = {
      {"toRange pi", [](double x) { return toRange(x, -kPi, kPi); }, -kPi, kPi, false},
      {"toRange 360", [](double x) { return toRange(x, 0.0, 360.0); }, 0, 360, false},
      {"Normalize0To2PI", Normalize0To2PI, 0, kTwoPi, true},
      {"Normalize0ToLt2Pi", Normalize0ToLt2Pi, 0, std::nextafter(kTwoPi, 0.0), true},
      {"Normalize0ToPi", Normalize0ToPi, -kPi, kPi, true},
      {"NormalizeNegPiToPi", NormalizeNegPiToPi, -kPi, kPi, true},
      {"NormalizeGtNegPiToPi", NormalizeGtNegPiToPi, -kPi, kPi, true},
      {"ModDeg360", [](double x) { return ModDeg360(x, true); }, 0, 360, false},
      {"ModDeg180", [](double x) { return ModDeg180(x, false); }, -180, 180, false},
      {"pos360", pos360, 0, 360, false}, {"HR2HL", HR2HL, 0, 360, false},
      {"Zenith2Level", Zenith2Level, 0, 360, false}, {"DDDMMSS2Deg", DDDMMSS2Deg, -361, 361, false},
      {"Deg2DDDMMSS", [](double x) { return Deg2DDDMMSS(x, 4, false); }, -360, 360, false},
      {"Deg2DDMMDEC", [](double x) { return Deg2DDMMDEC(x, 4, false); }, -360, 360, false},
      {"Deg2Rad", [](double x) { return Deg2Rad(x, false); }, -kTwoPi, kTwoPi, false},
  };
  for (const auto& r : reducers) {
    EXPECT_TRUE(std::isnan(r.fn(kNaN))) << r.name;
    for (double x : {kInf, -kInf}) EXPECT_TRUE(r.passesInfinity ? r.fn(x) == x : std::isnan(r.fn(x))) << r.name;
    for (double x : {1e300, -1e300, 1e17, -4e9, -0.0, 4e-320}) {
      const double y = r.fn(x);
      EXPECT_TRUE(y >= r.lo && y <= r.hi) << r.name << " " << x << " gives " << y;
    }
  }
}

// Round trips: faces and circles are involutions, units convert back, packed forms read back.
TEST(AngleUnits, RoundTrips) {
  for (double h : {0.0, 1e-13, 90.0, 359.5}) {
    EXPECT_NEAR(HL2HR(HR2HL(h)), h, 1e-9) << h;
    EXPECT_NEAR(Level2Zenith(Zenith2Level(h)), h, 1e-9) << h;
  }
  double hz = 10, v = 80;
  CalcReverseAngles(hz, v);
  EXPECT_TRUE(hz == 190 && v == 280 && IsFaceReversed(v) && !IsFaceReversed(180));
  for (double d : {-725.5, 12.3456, 1000.0}) {
    EXPECT_NEAR(Rad2Deg(Deg2Rad(d, true), true), d, 1e-11) << d;
    EXPECT_NEAR(Grad2Deg(Deg2Grad(d, true), true), d, 1e-11) << d;
    EXPECT_NEAR(Mil2Deg(Deg2Mil(d, true), true), d, 1e-9) << d;
  }
  EXPECT_NEAR(GradCC2DegSec(DegSec2GradCC(1234.5, true)), 1234.5, 1e-9);
  for (double x : {1.0 / 3600, -45.25, 123.456789})
    for (int prec : {4, 6, 8})
      EXPECT_NEAR(DDDMMSS2Deg(Deg2DDDMMSS(x, prec, false)), x, 0.51 * std::pow(10.0, 4 - prec) / 3600.0) << x;
}

// dms_to_deg takes the sign from any field; deg_to_dms puts it on the first non-zero field and reads back;
// the minute nudge can reach 60 just below a whole degree (no carry is made).
TEST(Sexagesimal, DegreesToDmsAndBack) {
  EXPECT_DOUBLE_EQ(dms_to_deg(-12, 30, 36), -12.51);
  EXPECT_DOUBLE_EQ(dms_to_deg(0, -30, 0), -0.5);
  EXPECT_DOUBLE_EQ(dms_to_deg(0, 0, -36), -0.01);
  double d = 0, m = 0, s = 0;
  for (double x : {0.0, -0.5, -12.51, 123.456789, 359.75}) {
    deg_to_dms(x, &d, &m, &s);
    EXPECT_NEAR(dms_to_deg(d, m, s), x, 1e-10) << x;
  }
  deg_to_dms(-0.01, &d, &m, &s);
  EXPECT_TRUE(d == 0 && m == 0 && std::fabs(s + 36) < 1e-9);
  deg_to_dms(11.9999999, &d, &m, &s);
  EXPECT_TRUE(d == 11 && m == 60);
}

// Packed DDD.MMSS unpacks with carries out of 60 seconds and 60 minutes and reduces the degrees; packing
// reduces unless asked not to; decimal minutes may round to 60.
TEST(PackedDms, UnpacksAndPacksWithCarries) {
  const struct {
    Fn fn;
    double x, expected;
  } cases[] = {{DDDMMSS2Deg, -12.3030, -(12.0 + 30.0 / 60 + 30.0 / 3600)}, {DDDMMSS2Deg, 12.3060, 12.0 + 31.0 / 60},
               {DDDMMSS2Deg, 12.30999999999, 12.0 + 31.0 / 60}, {DDDMMSS2Deg, 0.5960, 1.0}, {DDDMMSS2Deg, 370.3, 10.5},
               {[](double x) { return Deg2DDDMMSS(x, 4, false); }, 12.9999999, 13.0},
               {[](double x) { return Deg2DDDMMSS(x, 4, false); }, 370.5, 10.3},
               {[](double x) { return Deg2DDDMMSS(x, 4, true); }, 370.5, 370.3},
               {[](double x) { return Deg2DDMMDEC(x, 3, false); }, -12.51, -12.306},
               {[](double x) { return Deg2DDMMDEC(x, 2, false); }, 370.25, 10.15},
               {[](double x) { return Deg2DDMMDEC(x, 2, false); }, 59.99999, 60.0}};
  for (const auto& c : cases) EXPECT_NEAR(c.fn(c.x), c.expected, 1e-12) << c.x;
}

TEST(PackedDms, SplitNeverReachesSixtyAndBadPrecisionIsLogged) {
  bool negative = false;
  int d = 0, m = 0;
  double s = 0;
  for (double x = 0.0; x < 2.0; x += 0.0137) {
    Deg2DDDMMSS(-x + 1.0 / 7200.0 - 1e-9, negative, d, m, s, 0);
    EXPECT_TRUE(m < 60 && s < 60.0 && s >= 0.0) << x << ": " << m << "' " << s << "\"";
  }
  Deg2DDDMMSS(-12.51, negative, d, m, s, 2);
  EXPECT_TRUE(negative && d == 12 && m == 30 && std::fabs(s - 36.0) < 1e-9);
  for (double x : {kNaN, 1e300}) {
    Deg2DDDMMSS(x, negative, d, m, s, 2);
    EXPECT_TRUE(std::isnan(s)) << x;
  }
  svy_logging::CScopedErrLogCapture capture;
  Deg2DDDMMSS(1.0, 3, false);
  ASSERT_GE(capture.count(), 1u);
  EXPECT_TRUE(capture.entries()[0].file == "formats" && capture.entries()[0].message.empty());
  const std::size_t before = capture.count();
  Deg2DDDMMSS(1.0, 4, false);
  EXPECT_EQ(capture.count(), before);
}

// Packed DMS to text: the sign rides on the degrees (lost between -1 and 0), rounded seconds carry. Text
// fields to radians: the sign comes from the degrees (minus zero is an int zero: positive); a field that is
// no whole number gives 0; negative minutes or seconds are logged and used. Text reads back through them.
TEST(AngleText, WritesPackedDmsAndParsesThreeFieldsToRadians) {
  using svy_text::CSvyString;
  const std::pair<double, const wchar_t*> written[] = {
      {12.0502, L"12\u00B05'2.0\""}, {-12.3030, L"-12\u00B030'30\""}, {-0.3000, L"0\u00B030'0\""},
      {12.595999, L"13\u00B00'0\""}, {12.3060, L"12\u00B031'0\""}};
  for (const auto& w : written)
    EXPECT_EQ(std::wstring(DDDMMSS2String(w.first, w.first == 12.0502 ? 1 : 0).c_str()), w.second) << w.first;
  struct {
    const wchar_t *d, *m, *s;
    double degrees;
  } const cases[] = {{L"-12", L"30", L"36", -12.51}, {L"-0", L"30", L"0", 0.5}, {L"370", L"0", L"0", 10},
                     {L"12x", L"30", L"0", 0},      {L"12", L"", L"0", 0},      {L"12", L"1", L"abc", 0}};
  for (const auto& c : cases)
    EXPECT_NEAR(AngleToRad(CSvyString(c.d), CSvyString(c.m), CSvyString(c.s)), c.degrees * kPi / 180, 1e-15)
        << c.degrees;
  svy_logging::CScopedErrLogCapture capture;
  EXPECT_NEAR(AngleToRad(CSvyString(L"10"), CSvyString(L"-30"), CSvyString(L"-36")), (10.0 - 0.51) * kPi / 180, 1e-15);
  EXPECT_EQ(capture.count(), 2u);
  for (double deg : {0.0, 12.51, 359.99}) {
    const std::wstring text = DDDMMSS2String(Deg2DDDMMSS(deg, 6, false), 2).c_str();
    const std::size_t degSign = text.find(L'\u00B0'), minSign = text.find(L'\'');
    ASSERT_TRUE(degSign != std::wstring::npos && minSign != std::wstring::npos) << text;
    const double r = AngleToRad(CSvyString(text.substr(0, degSign)),
                                CSvyString(text.substr(degSign + 1, minSign - degSign - 1)),
                                CSvyString(text.substr(minSign + 1, text.size() - minSign - 2)));
    EXPECT_NEAR(r, deg * kPi / 180, 0.006 / 3600 * kPi / 180) << deg;
  }
}

}  // namespace
