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

// Both ends of the range are kept; values wrap by whole periods; an empty or inverted range gives its low
// end. Huge input ends in range, non-finite input gives NaN.
TEST(ToRange, KeepsBothEndsWrapsByWholePeriodsAndTerminates) {
  const double cases[][4] = {{kPi, -kPi, kPi, kPi},         {-kPi, -kPi, kPi, -kPi},   {3 * kPi, -kPi, kPi, kPi},
                             {-3 * kPi, -kPi, kPi, -kPi},   {kTwoPi, 0, kTwoPi, kTwoPi}, {360, 0, 360, 360},
                             {-30, 0, 360, 330},            {725, 0, 360, 5},          {7, 5, 5, 5},
                             {7, 9, 5, 9},
                             // Just beyond the loop limit the fmod reduction agrees with the loop.
                             {100 * kTwoPi + 1.0, -kPi, kPi, 1.0}};
  for (const auto& c : cases) EXPECT_NEAR(toRange(c[0], c[1], c[2]), c[3], 1e-12) << c[0] << " " << c[1];
  EXPECT_NEAR(toRange(-100 * 360.0 - 10.0, 0.0, 360.0), 350.0, 1e-9);
  // The integer form wraps like the real one and survives the ends of int.
  for (int x = -1000; x <= 1000; x += 7)
    EXPECT_EQ(toRange(x, 0, 360), static_cast<int>(toRange(static_cast<double>(x), 0.0, 360.0))) << x;
  EXPECT_TRUE(toRange(360, 0, 360) == 360 && toRange(5, 3, 3) == 3);
  const int far = toRange(std::numeric_limits<int>::min(), -180, 180);
  EXPECT_TRUE(far >= -180 && far <= 180);
  EXPECT_LE(toRange(std::numeric_limits<int>::max(), std::numeric_limits<int>::min(), 0), 0);
}

TEST(RadianNormalizers, GiveTheirDocumentedRanges) {
  struct {
    double (*fn)(double);
    double x, expected;
  } const cases[] = {{Normalize0To2PI, kTwoPi, kTwoPi},        {Normalize0To2PI, -1, kTwoPi - 1},
                     {Normalize0ToLt2Pi, kTwoPi, 0},           {Normalize0ToLt2Pi, -kTwoPi, 0},
                     {Normalize0ToPi, 4, 4 - kTwoPi},          {Normalize0ToPi, kPi, kPi},
                     {Normalize0ToPi, -1, -1},                 {NormalizeNegPiToPi, -kPi, kPi},
                     {NormalizeNegPiToPi, 3 * kPi, kPi},       {NormalizeGtNegPiToPi, -kPi, kPi},
                     {NormalizeGtNegPiToPi, -3, -3},           {NormalizeGtNegPiToPi, 10, 10 - 2 * kTwoPi}};
  for (const auto& c : cases) EXPECT_NEAR(c.fn(c.x), c.expected, 1e-12) << (&c - cases);
}

// Every reduction ends on absurd input: NaN gives NaN, infinities give NaN (the radian normalizers pass them
// through), huge and tiny values land in range.
TEST(Reductions, TerminateInRangeOnAbsurdInput) {
  struct {
    const char* name;
    double (*fn)(double);
    double lo, hi;
    bool passesInfinity;
  } const reducers[] = {
      {"toRange pi", [](double x) { return toRange(x, -kPi, kPi); }, -kPi, kPi, false},
      {"toRange 360", [](double x) { return toRange(x, 0.0, 360.0); }, 0, 360, false},
      {"Normalize0To2PI", Normalize0To2PI, 0, kTwoPi, true},
      {"Normalize0ToLt2Pi", Normalize0ToLt2Pi, 0, std::nextafter(kTwoPi, 0.0), true},
      {"Normalize0ToPi", Normalize0ToPi, -kPi, kPi, true},
      {"NormalizeNegPiToPi", NormalizeNegPiToPi, -kPi, kPi, true},
      {"NormalizeGtNegPiToPi", NormalizeGtNegPiToPi, -kPi, kPi, true},
      {"ModDeg360", [](double x) { return ModDeg360(x, true); }, 0, 360, false},
      {"ModDeg180", [](double x) { return ModDeg180(x, false); }, -180, 180, false},
      {"pos360", pos360, 0, 360, false},
      {"HR2HL", HR2HL, 0, 360, false},
      {"Zenith2Level", Zenith2Level, 0, 360, false},
      {"DDDMMSS2Deg", DDDMMSS2Deg, -361, 361, false},
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

TEST(DegreeReductions, ModDeg360ModDeg180AndOneCorrectionDifferences) {
  EXPECT_EQ(ModDeg360(-30, true), 330);
  EXPECT_EQ(ModDeg360(-30, false), -30);
  EXPECT_TRUE(std::signbit(ModDeg360(-0.0, true)));
  EXPECT_EQ(ModDeg180(190, false), -170);
  EXPECT_EQ(ModDeg180(-180, false), 180);
  EXPECT_EQ(ModDeg180(-10, true), 170);
  EXPECT_EQ(pos360(720), 0);
  // One correction only: 720 stays a full turn.
  const double diffs[][3] = {{350, 10, -20}, {10, 350, 20}, {-180, 0, 180}, {720, 0, 360}};
  for (const auto& d : diffs) {
    EXPECT_DOUBLE_EQ(AngleDiff(d[0], d[1]), d[2]);
    EXPECT_DOUBLE_EQ(MinimizeTurnAngle(d[0] - d[1]), d[2]);
  }
}

TEST(InstrumentReadings, FacesAndCirclesAreInvolutions) {
  for (double h : {0.0, 1e-13, 90.0, 359.5}) {
    EXPECT_NEAR(HL2HR(HR2HL(h)), h, 1e-9) << h;
    EXPECT_NEAR(Level2Zenith(Zenith2Level(h)), h, 1e-9) << h;
  }
  EXPECT_TRUE(HR2HL(90) == 270 && Zenith2Level(100) == 350);
  double hz = 10, v = 80;
  CalcReverseAngles(hz, v);
  EXPECT_TRUE(hz == 190 && v == 280 && IsFaceReversed(v));
  EXPECT_FALSE(IsFaceReversed(180));
}

TEST(AngleUnits, RoundTripsAndReductions) {
  for (double d : {-725.5, 12.3456, 1000.0}) {
    EXPECT_NEAR(Rad2Deg(Deg2Rad(d, true), true), d, 1e-11) << d;
    EXPECT_NEAR(Grad2Deg(Deg2Grad(d, true), true), d, 1e-11) << d;
    EXPECT_NEAR(Mil2Deg(Deg2Mil(d, true), true), d, 1e-9) << d;
  }
  // One circle is 2pi rad, 400 grad, 6400 mil; one grad is 10000 centesimal seconds = 3240 seconds of arc.
  EXPECT_NEAR(Deg2Rad(360, true), kTwoPi, 1e-15);
  EXPECT_NEAR(Deg2Grad(360, true), 400, 1e-12);
  EXPECT_NEAR(Deg2Mil(360, true), 6400, 1e-9);
  EXPECT_NEAR(DegSec2GradCC(3240, false), 10000, 1e-9);
  EXPECT_NEAR(GradCC2DegSec(DegSec2GradCC(1234.5, true)), 1234.5, 1e-9);
  // Reduction keeps the sign.
  EXPECT_NEAR(Deg2Rad(-370, false), Deg2Rad(-10, true), 1e-15);
  EXPECT_NEAR(Mil2Deg(-7000, false), -33.75, 1e-9);
  EXPECT_NEAR(Rad2Deg(3 * kPi, false), 180, 1e-9);
  EXPECT_NEAR(Grad2Deg(500, false), 90, 1e-12);
  // atan3 gives zero for a (nearly) zero vector.
  EXPECT_EQ(atan3(1e-13, -1e-13), 0);
  EXPECT_DOUBLE_EQ(atan3(0, -1), kPi);
}

// dms_to_deg takes the sign from any field; deg_to_dms puts it on the first non-zero field and reads back.
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
  // The minute nudge can reach 60 just below a whole degree; no carry is made.
  deg_to_dms(11.9999999, &d, &m, &s);
  EXPECT_TRUE(d == 11 && m == 60);
}

// Packed DDD.MMSS unpacks with carries out of 60 seconds and 60 minutes, reduces the degrees, and reads back.
TEST(PackedDms, UnpacksWithCarriesAndRoundTrips) {
  const double cases[][2] = {{-12.3030, -(12.0 + 30.0 / 60 + 30.0 / 3600)}, {12.3060, 12.0 + 31.0 / 60},
                             {12.30999999999, 12.0 + 31.0 / 60}, {0.5960, 1.0}, {370.3000, 10.5}};
  for (const auto& c : cases) EXPECT_NEAR(DDDMMSS2Deg(c[0]), c[1], 1e-12) << c[0];
  for (double x : {1.0 / 3600, -45.25, 123.456789}) {
    for (int prec : {4, 6, 8}) {
      const double packed = Deg2DDDMMSS(x, prec, false);
      const double tolerance = 0.51 * std::pow(10.0, 4 - prec) / 3600.0;
      EXPECT_NEAR(DDDMMSS2Deg(packed), x, tolerance) << x << " prec " << prec;
    }
  }
  EXPECT_DOUBLE_EQ(Deg2DDDMMSS(12.9999999, 4, false), 13.0);
  EXPECT_NEAR(Deg2DDDMMSS(370.5, 4, false), 10.3, 1e-12);
  EXPECT_NEAR(Deg2DDDMMSS(370.5, 4, true), 370.3, 1e-12);
  // Degrees and decimal minutes: reduced, and rounded minutes may reach 60.
  EXPECT_NEAR(Deg2DDMMDEC(-12.51, 3, false), -12.306, 1e-12);
  EXPECT_NEAR(Deg2DDMMDEC(370.25, 2, false), 10.15, 1e-12);
  EXPECT_NEAR(Deg2DDMMDEC(59.99999, 2, false), 60.0, 1e-12);
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
  svy_logging::CScopedErrLogCapture capture;  // a bad precision is logged
  Deg2DDDMMSS(1.0, 3, false);
  ASSERT_GE(capture.count(), 1u);
  EXPECT_TRUE(capture.entries()[0].file == "formats" && capture.entries()[0].message.empty());
  const std::size_t before = capture.count();
  Deg2DDDMMSS(1.0, 4, false);
  EXPECT_EQ(capture.count(), before);
}

TEST(PackedDmsText, FormatsDegreesMinutesSeconds) {
  struct {
    double packed;
    int prec;
    const wchar_t* text;
  } const cases[] = {{12.0502, 1, L"12\u00B05'2.0\""},  {-12.3030, 0, L"-12\u00B030'30\""},
                     {-0.3000, 0, L"0\u00B030'0\""},    // the sign rides on the degrees: lost between -1 and 0
                     {12.595999, 0, L"13\u00B00'0\""},  // rounded seconds carry into minutes and degrees
                     {12.3060, 0, L"12\u00B031'0\""}};
  for (const auto& c : cases) EXPECT_EQ(std::wstring(DDDMMSS2String(c.packed, c.prec).c_str()), c.text) << c.packed;
}

// Three text fields to radians; the sign comes from the degrees (minus zero is an int zero: positive);
// a field that is no whole number gives 0; negative minutes or seconds are logged and used.
TEST(AngleText, ParsesThreeFieldsToRadians) {
  using svy_text::CSvyString;
  struct {
    const wchar_t *d, *m, *s;
    double degrees;
  } const cases[] = {{L"-12", L"30", L"36", -12.51}, {L"-0", L"30", L"0", 0.5}, {L"370", L"0", L"0", 10},
                     {L"12x", L"30", L"0", 0},      {L"12", L"", L"0", 0},      {L"12", L"1", L"abc", 0}};
  for (const auto& c : cases)
    EXPECT_NEAR(AngleToRad(CSvyString(c.d), CSvyString(c.m), CSvyString(c.s)), c.degrees * kPi / 180, 1e-15)
        << c.degrees;
  svy_logging::CScopedErrLogCapture capture;  // negative minutes or seconds are logged and used
  const double r = AngleToRad(CSvyString(L"10"), CSvyString(L"-30"), CSvyString(L"-36"));
  EXPECT_EQ(capture.count(), 2u);
  EXPECT_NEAR(r, (10.0 - 0.5 - 0.01) * kPi / 180, 1e-15);
}

TEST(AngleText, DegreesToTextAndBackThroughTheFields) {
  using svy_text::CSvyString;
  for (double deg : {0.0, 12.51, 359.99}) {
    const std::wstring text = DDDMMSS2String(Deg2DDDMMSS(deg, 6, false), 2).c_str();
    const std::size_t degSign = text.find(L'\u00B0');
    const std::size_t minSign = text.find(L'\'');
    ASSERT_TRUE(degSign != std::wstring::npos && minSign != std::wstring::npos) << text;
    const double r = AngleToRad(CSvyString(text.substr(0, degSign)),
                                CSvyString(text.substr(degSign + 1, minSign - degSign - 1)),
                                CSvyString(text.substr(minSign + 1, text.size() - minSign - 2)));
    EXPECT_NEAR(r, deg * kPi / 180, 0.006 / 3600 * kPi / 180) << deg;
  }
}

}  // namespace
