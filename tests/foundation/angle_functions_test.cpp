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

struct RangeCase {
  double x, lo, hi, expected;
};

class ToRange : public ::testing::TestWithParam<RangeCase> {};

TEST_P(ToRange, KeepsBothEndsAndWrapsByWholePeriods) {
  const RangeCase& c = GetParam();
  EXPECT_NEAR(toRange(c.x, c.lo, c.hi), c.expected, 1e-12) << c.x;
}

INSTANTIATE_TEST_SUITE_P(
    Cases, ToRange,
    ::testing::Values(RangeCase{kPi, -kPi, kPi, kPi}, RangeCase{-kPi, -kPi, kPi, -kPi},
                      RangeCase{3 * kPi, -kPi, kPi, kPi}, RangeCase{-3 * kPi, -kPi, kPi, -kPi},
                      RangeCase{kTwoPi, 0, kTwoPi, kTwoPi}, RangeCase{0, 0, kTwoPi, 0},
                      RangeCase{360, 0, 360, 360}, RangeCase{-30, 0, 360, 330}, RangeCase{725, 0, 360, 5},
                      RangeCase{7, 5, 5, 5}, RangeCase{7, 9, 5, 9}));

TEST(ToRange, HugeAndNonFiniteInputTerminateInRange) {
  EXPECT_TRUE(std::isnan(toRange(kNaN, -kPi, kPi)));
  EXPECT_TRUE(std::isnan(toRange(kInf, -kPi, kPi)));
  EXPECT_TRUE(std::isnan(toRange(-kInf, 0.0, 360.0)));
  for (double x : {1e300, -1e300, 1e17, -4e9, 1e100}) {
    const double r = toRange(x, -kPi, kPi);
    EXPECT_GE(r, -kPi) << x;
    EXPECT_LE(r, kPi) << x;
    const double d = toRange(x, 0.0, 360.0);
    EXPECT_GE(d, 0) << x;
    EXPECT_LE(d, 360) << x;
  }
  // Just beyond the loop limit the fmod reduction agrees with the loop.
  EXPECT_NEAR(toRange(100 * kTwoPi + 1.0, -kPi, kPi), 1.0, 1e-12);
  EXPECT_NEAR(toRange(-100 * 360.0 - 10.0, 0.0, 360.0), 350.0, 1e-9);
}

TEST(ToRange, IntegerFormWrapsLikeTheRealForm) {
  for (int x = -1000; x <= 1000; x += 7) {
    EXPECT_EQ(toRange(x, 0, 360), static_cast<int>(toRange(static_cast<double>(x), 0.0, 360.0))) << x;
  }
  EXPECT_EQ(toRange(360, 0, 360), 360);
  EXPECT_EQ(toRange(5, 3, 3), 3);
  const int far = toRange(std::numeric_limits<int>::min(), -180, 180);
  EXPECT_GE(far, -180);
  EXPECT_LE(far, 180);
  const int farUp = toRange(std::numeric_limits<int>::max(), std::numeric_limits<int>::min(), 0);
  EXPECT_LE(farUp, 0);
}

struct NormalizeCase {
  double (*fn)(double);
  const char* name;
  double x, expected;
};

class RadianNormalizers : public ::testing::TestWithParam<NormalizeCase> {};

TEST_P(RadianNormalizers, GiveTheirDocumentedRanges) {
  const NormalizeCase& c = GetParam();
  EXPECT_NEAR(c.fn(c.x), c.expected, 1e-12) << c.name << "(" << c.x << ")";
}

INSTANTIATE_TEST_SUITE_P(
    Cases, RadianNormalizers,
    ::testing::Values(NormalizeCase{Normalize0To2PI, "0To2PI", kTwoPi, kTwoPi},
                      NormalizeCase{Normalize0To2PI, "0To2PI", 0, 0},
                      NormalizeCase{Normalize0To2PI, "0To2PI", -1, kTwoPi - 1},
                      NormalizeCase{Normalize0ToLt2Pi, "0ToLt2Pi", kTwoPi, 0},
                      NormalizeCase{Normalize0ToLt2Pi, "0ToLt2Pi", -kTwoPi, 0},
                      NormalizeCase{Normalize0ToPi, "0ToPi", 4, 4 - kTwoPi},
                      NormalizeCase{Normalize0ToPi, "0ToPi", kPi, kPi},
                      NormalizeCase{Normalize0ToPi, "0ToPi", -1, -1},
                      NormalizeCase{NormalizeNegPiToPi, "NegPiToPi", -kPi, kPi},
                      NormalizeCase{NormalizeNegPiToPi, "NegPiToPi", kPi, kPi},
                      NormalizeCase{NormalizeNegPiToPi, "NegPiToPi", 0, 0},
                      NormalizeCase{NormalizeNegPiToPi, "NegPiToPi", 3 * kPi, kPi},
                      NormalizeCase{NormalizeGtNegPiToPi, "GtNegPiToPi", -kPi, kPi},
                      NormalizeCase{NormalizeGtNegPiToPi, "GtNegPiToPi", -3, -3},
                      NormalizeCase{NormalizeGtNegPiToPi, "GtNegPiToPi", 10, 10 - 2 * kTwoPi}));

TEST(RadianNormalizers, PassNonFiniteThroughAndSurviveHugeValues) {
  for (auto fn : {Normalize0To2PI, Normalize0ToLt2Pi, Normalize0ToPi, NormalizeNegPiToPi, NormalizeGtNegPiToPi}) {
    EXPECT_TRUE(std::isnan(fn(kNaN)));
    EXPECT_EQ(fn(kInf), kInf);
    EXPECT_EQ(fn(-kInf), -kInf);
    const double r = fn(1e300);
    EXPECT_GT(r, -kPi - 1e-9);
    EXPECT_LE(r, kTwoPi);
  }
  const double r = Normalize0ToLt2Pi(-1e300);
  EXPECT_GE(r, 0.0);
  EXPECT_LT(r, kTwoPi);
}

struct Reducer {
  const char* name;
  double (*fn)(double);
  double lo, hi;
};

// Every degree reduction ends on absurd input: NaN and infinities give NaN, huge values land in range.
TEST(DegreeReductions, TerminateInRangeOnAbsurdInput) {
  const Reducer reducers[] = {
      {"ModDeg360", [](double x) { return ModDeg360(x, true); }, 0, 360},
      {"ModDeg180", [](double x) { return ModDeg180(x, false); }, -180, 180},
      {"pos360", pos360, 0, 360},
      {"HR2HL", HR2HL, 0, 360},
      {"Zenith2Level", Zenith2Level, 0, 360},
      {"DDDMMSS2Deg", DDDMMSS2Deg, -361, 361},
      {"Deg2DDDMMSS", [](double x) { return Deg2DDDMMSS(x, 4, false); }, -360, 360},
      {"Deg2DDMMDEC", [](double x) { return Deg2DDMMDEC(x, 4, false); }, -360, 360},
      {"Deg2Rad", [](double x) { return Deg2Rad(x, false); }, -kTwoPi, kTwoPi},
  };
  for (const Reducer& r : reducers) {
    for (double x : {kNaN, kInf, -kInf}) EXPECT_TRUE(std::isnan(r.fn(x))) << r.name << " " << x;
    for (double x : {1e300, -1e300, 1e17, -0.0, 4e-320}) {
      const double y = r.fn(x);
      EXPECT_GE(y, r.lo) << r.name << " " << x;
      EXPECT_LE(y, r.hi) << r.name << " " << x;
    }
  }
}

TEST(DegreeReductions, ModDeg360AndModDeg180) {
  EXPECT_EQ(ModDeg360(-30, true), 330);
  EXPECT_EQ(ModDeg360(-30, false), -30);
  EXPECT_EQ(ModDeg360(725, true), 5);
  EXPECT_TRUE(std::signbit(ModDeg360(-0.0, true)));
  EXPECT_EQ(ModDeg180(190, false), -170);
  EXPECT_EQ(ModDeg180(-180, false), 180);
  EXPECT_EQ(ModDeg180(180, false), 180);
  EXPECT_EQ(ModDeg180(-10, true), 170);
  EXPECT_EQ(pos360(-0.5), 359.5);
  EXPECT_EQ(pos360(720), 0);
}

struct DiffCase {
  double a, b, expected;
};

class AngleDifference : public ::testing::TestWithParam<DiffCase> {};

TEST_P(AngleDifference, AppliesOneCorrection) {
  const DiffCase& c = GetParam();
  EXPECT_DOUBLE_EQ(AngleDiff(c.a, c.b), c.expected);
  EXPECT_DOUBLE_EQ(MinimizeTurnAngle(c.a - c.b), c.expected);
}

INSTANTIATE_TEST_SUITE_P(Cases, AngleDifference,
                         ::testing::Values(DiffCase{350, 10, -20}, DiffCase{10, 350, 20}, DiffCase{180, 0, 180},
                                           DiffCase{-180, 0, 180}, DiffCase{720, 0, 360},
                                           DiffCase{0, 0, 0}));

TEST(InstrumentReadings, FacesAndCirclesAreInvolutions) {
  for (double h : {0.0, 1e-13, 10.0, 90.0, 180.0, 359.5}) {
    EXPECT_NEAR(HL2HR(HR2HL(h)), h, 1e-9) << h;
    EXPECT_NEAR(Level2Zenith(Zenith2Level(h)), h, 1e-9) << h;
  }
  EXPECT_EQ(HR2HL(90), 270);
  EXPECT_EQ(Zenith2Level(100), 350);
  double hz = 10, v = 80;
  CalcReverseAngles(hz, v);
  EXPECT_EQ(hz, 190);
  EXPECT_EQ(v, 280);
  EXPECT_TRUE(IsFaceReversed(v));
  EXPECT_FALSE(IsFaceReversed(180));
  CalcReverseAngles(hz, v);
  EXPECT_EQ(hz, 10);
  EXPECT_EQ(v, 80);
}

TEST(AngleUnits, RoundTripsWithoutReduction) {
  for (double d : {-725.5, -90.0, 0.0, 12.3456, 359.999, 1000.0}) {
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
}

TEST(AngleUnits, ReductionKeepsTheSign) {
  EXPECT_NEAR(Deg2Rad(370, false), Deg2Rad(10, true), 1e-15);
  EXPECT_NEAR(Deg2Rad(-370, false), Deg2Rad(-10, true), 1e-15);
  EXPECT_NEAR(Rad2Deg(3 * kPi, false), 180, 1e-9);
  EXPECT_NEAR(Grad2Deg(500, false), 90, 1e-12);
  EXPECT_NEAR(Mil2Deg(-7000, false), -33.75, 1e-9);
}

TEST(Atan3, ZeroVectorGivesZero) {
  EXPECT_EQ(atan3(0, 0), 0);
  EXPECT_EQ(atan3(1e-13, -1e-13), 0);
  EXPECT_DOUBLE_EQ(atan3(1, 0), kPi / 2);
  EXPECT_DOUBLE_EQ(atan3(0, -1), kPi);
}

TEST(Sexagesimal, DmsToDegreesTakesTheSignFromAnyField) {
  EXPECT_DOUBLE_EQ(dms_to_deg(12, 30, 36), 12.51);
  EXPECT_DOUBLE_EQ(dms_to_deg(-12, 30, 36), -12.51);
  EXPECT_DOUBLE_EQ(dms_to_deg(0, -30, 0), -0.5);
  EXPECT_DOUBLE_EQ(dms_to_deg(0, 0, -36), -0.01);
}

TEST(Sexagesimal, DegreesToDmsAndBack) {
  for (double x : {0.0, 0.5, -0.5, -0.01, 12.51, -12.51, 123.456789, 359.75, -89.999}) {
    double d = 0, m = 0, s = 0;
    deg_to_dms(x, &d, &m, &s);
    EXPECT_NEAR(dms_to_deg(d, m, s), x, 1e-10) << x;
  }
  double d = 0, m = 0, s = 0;
  deg_to_dms(-0.01, &d, &m, &s);
  EXPECT_EQ(d, 0);
  EXPECT_EQ(m, 0);
  EXPECT_NEAR(s, -36, 1e-9);
  // The minute nudge can reach 60 just below a whole degree; no carry is made.
  deg_to_dms(11.9999999, &d, &m, &s);
  EXPECT_EQ(d, 11);
  EXPECT_EQ(m, 60);
}

struct PackedCase {
  double packed, degrees;
};

class PackedDms : public ::testing::TestWithParam<PackedCase> {};

TEST_P(PackedDms, UnpacksWithCarries) {
  const PackedCase& c = GetParam();
  EXPECT_NEAR(DDDMMSS2Deg(c.packed), c.degrees, 1e-12) << c.packed;
}

INSTANTIATE_TEST_SUITE_P(
    Cases, PackedDms,
    ::testing::Values(PackedCase{12.3030, 12.0 + 30.0 / 60 + 30.0 / 3600}, PackedCase{12.3060, 12.0 + 31.0 / 60},
                      PackedCase{-12.3030, -(12.0 + 30.0 / 60 + 30.0 / 3600)},
                      PackedCase{12.30999999999, 12.0 + 31.0 / 60}, PackedCase{0.5960, 1.0},
                      PackedCase{370.3000, 10.5}, PackedCase{0.0001, 1.0 / 3600}));

TEST(PackedDms, DegreesToPackedAndBack) {
  for (double x : {0.0, 1.0 / 3600, 12.508333333333333, -45.25, 89.99, 123.456789, 359.5, -0.75}) {
    for (int prec : {4, 6, 8}) {
      const double packed = Deg2DDDMMSS(x, prec, false);
      const double tolerance = 0.51 * std::pow(10.0, 4 - prec) / 3600.0;
      EXPECT_NEAR(DDDMMSS2Deg(packed), x, tolerance) << x << " prec " << prec;
    }
  }
  EXPECT_DOUBLE_EQ(Deg2DDDMMSS(12.9999999, 4, false), 13.0);
  EXPECT_NEAR(Deg2DDDMMSS(370.5, 4, false), 10.3, 1e-12);
  EXPECT_NEAR(Deg2DDDMMSS(370.5, 4, true), 370.3, 1e-12);
}

TEST(PackedDms, SplitNeverReachesSixty) {
  for (double x = 0.0; x < 2.0; x += 0.0137) {
    bool negative = true;
    int d = -1, m = -1;
    double s = -1;
    Deg2DDDMMSS(-x + 1.0 / 7200.0 - 1e-9, negative, d, m, s, 0);
    EXPECT_LT(m, 60);
    EXPECT_LT(s, 60.0);
    EXPECT_GE(s, 0.0);
  }
  bool negative = false;
  int d = 0, m = 0;
  double s = 0;
  Deg2DDDMMSS(-12.51, negative, d, m, s, 2);
  EXPECT_TRUE(negative);
  EXPECT_EQ(d, 12);
  EXPECT_EQ(m, 30);
  EXPECT_NEAR(s, 36.0, 1e-9);
  Deg2DDDMMSS(kNaN, negative, d, m, s, 2);
  EXPECT_TRUE(std::isnan(s));
  Deg2DDDMMSS(1e300, negative, d, m, s, 2);
  EXPECT_TRUE(std::isnan(s));
}

TEST(PackedDms, DegreesAndDecimalMinutes) {
  EXPECT_NEAR(Deg2DDMMDEC(12.5, 3, false), 12.30, 1e-12);
  EXPECT_NEAR(Deg2DDMMDEC(-12.51, 3, false), -12.306, 1e-12);
  EXPECT_NEAR(Deg2DDMMDEC(370.25, 2, false), 10.15, 1e-12);
  EXPECT_NEAR(Deg2DDMMDEC(59.99999, 2, false), 60.0, 1e-12);
}

TEST(PackedDms, BadPrecisionIsLogged) {
  svy_logging::CScopedErrLogCapture capture;
  Deg2DDDMMSS(1.0, 3, false);
  ASSERT_GE(capture.count(), 1u);
  EXPECT_EQ(capture.entries()[0].file, "formats");
  EXPECT_EQ(capture.entries()[0].message, "");
  const std::size_t before = capture.count();
  Deg2DDDMMSS(1.0, 4, false);
  EXPECT_EQ(capture.count(), before);
}

struct TextCase {
  double packed;
  int prec;
  const wchar_t* text;
};

class PackedDmsText : public ::testing::TestWithParam<TextCase> {};

TEST_P(PackedDmsText, FormatsDegreesMinutesSeconds) {
  const TextCase& c = GetParam();
  EXPECT_EQ(std::wstring(DDDMMSS2String(c.packed, c.prec).c_str()), std::wstring(c.text));
}

INSTANTIATE_TEST_SUITE_P(Cases, PackedDmsText,
                         ::testing::Values(TextCase{12.3030, 0, L"12\u00B030'30\""},
                                           TextCase{12.0502, 1, L"12\u00B05'2.0\""},
                                           TextCase{-12.3030, 0, L"-12\u00B030'30\""},
                                           // The sign rides on the degrees: lost between -1 and 0.
                                           TextCase{-0.3000, 0, L"0\u00B030'0\""},
                                           // Rounded seconds carry into minutes and degrees.
                                           TextCase{12.595999, 0, L"13\u00B00'0\""},
                                           TextCase{12.3060, 0, L"12\u00B031'0\""}));

TEST(AngleText, ParsesThreeFieldsToRadians) {
  using svy_text::CSvyString;
  EXPECT_NEAR(AngleToRad(CSvyString(L"12"), CSvyString(L"30"), CSvyString(L"36")), 12.51 * kPi / 180, 1e-15);
  EXPECT_NEAR(AngleToRad(CSvyString(L"-12"), CSvyString(L"30"), CSvyString(L"36")), -12.51 * kPi / 180, 1e-15);
  // Minus zero degrees is an int zero: the angle is positive.
  EXPECT_NEAR(AngleToRad(CSvyString(L"-0"), CSvyString(L"30"), CSvyString(L"0")), 0.5 * kPi / 180, 1e-15);
  EXPECT_NEAR(AngleToRad(CSvyString(L"370"), CSvyString(L"0"), CSvyString(L"0")), 10 * kPi / 180, 1e-15);
  EXPECT_EQ(AngleToRad(CSvyString(L"12x"), CSvyString(L"30"), CSvyString(L"0")), 0);
  EXPECT_EQ(AngleToRad(CSvyString(L"12"), CSvyString(L""), CSvyString(L"0")), 0);
  EXPECT_EQ(AngleToRad(CSvyString(L"12"), CSvyString(L"1"), CSvyString(L"abc")), 0);
}

TEST(AngleText, NegativeMinutesOrSecondsAreLoggedAndUsed) {
  using svy_text::CSvyString;
  svy_logging::CScopedErrLogCapture capture;
  const double r = AngleToRad(CSvyString(L"10"), CSvyString(L"-30"), CSvyString(L"-36"));
  EXPECT_EQ(capture.count(), 2u);
  EXPECT_NEAR(r, (10.0 - 0.5 - 0.01) * kPi / 180, 1e-15);
}

TEST(AngleText, DegreesToTextAndBackThroughTheFields) {
  using svy_text::CSvyString;
  for (double deg : {0.0, 5.25, 12.51, 123.4567, 359.99}) {
    const std::wstring text = DDDMMSS2String(Deg2DDDMMSS(deg, 6, false), 2).c_str();
    const std::size_t degSign = text.find(L'\u00B0');
    const std::size_t minSign = text.find(L'\'');
    ASSERT_NE(degSign, std::wstring::npos);
    ASSERT_NE(minSign, std::wstring::npos);
    const double r = AngleToRad(CSvyString(text.substr(0, degSign)),
                                CSvyString(text.substr(degSign + 1, minSign - degSign - 1)),
                                CSvyString(text.substr(minSign + 1, text.size() - minSign - 2)));
    EXPECT_NEAR(r, deg * kPi / 180, 0.006 / 3600 * kPi / 180) << deg;
  }
}

}  // namespace
