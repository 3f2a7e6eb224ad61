// User numbers, the half-unit rounding helper and station text: predicates and readers agree, station text
// reads back, and none of it depends on a host decimal comma.
#include <gtest/gtest.h>

#include <climits>
#include <cmath>
#include <limits>
#include <string>

#include "support/comma_locale.h"
#include "svymath/formats/number_predicates.h"
#include "svymath/formats/round_double.h"
#include "svymath/formats/sign_strings.h"
#include "svymath/formats/station_text.h"

namespace {

using svy_text::CSvyString;
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInf = std::numeric_limits<double>::infinity();

bool same(double a, double b) { return std::isnan(b) ? std::isnan(a) : a == b; }

// The predicates agree with the readers: a NaN value marks text that is no number.
TEST(UserNumbers, PredicatesAgreeWithTheReaders) {
  struct {
    const wchar_t* text;
    bool isInt, isDouble, isNotEmptyDouble;
    double value;
  } const cases[] = {{L" -12 ", true, true, true, -12.0},       {L"12,5", false, true, true, 12.5},
                     {L"12.5", false, true, true, 12.5},        {L"1e-3", false, true, true, 0.001},
                     {L"", false, true, false, kNaN},           {L"  \t", false, true, false, kNaN},
                     {L"12 m", false, false, false, kNaN},      {L"1,234.5", false, false, false, kNaN},
                     {L"nan", false, false, false, kNaN},       {L"99999999999", false, true, true, 99999999999.0}};
  for (const auto& c : cases) {
    SCOPED_TRACE(CSvyString(c.text).ToNarrow());
    const CSvyString text(c.text);
    EXPECT_EQ(svy_formats::is_str_int(text), c.isInt);
    EXPECT_EQ(svy_formats::is_str_double(text), c.isDouble);
    EXPECT_EQ(svy_formats::is_str_notempty_double(text), c.isNotEmptyDouble);
    EXPECT_TRUE(same(svy_formats::str_to_float(text), c.value));
    double value = -1.0;
    EXPECT_EQ(svy_formats::String2Double(text, value), c.isNotEmptyDouble);
    EXPECT_EQ(value, c.isNotEmptyDouble ? c.value : -1.0);
  }
  // The signs compose texts the reader accepts.
  double value = 0.0;
  EXPECT_TRUE(svy_formats::String2Double(CSvyString(L"12") + svy_formats::DecimalSignString() + L"5", value) &&
              value == 12.5);
  EXPECT_NE(svy_formats::ThousandSignString(), svy_formats::DecimalSignString());
  EXPECT_EQ(svy_formats::DegreeSignString().str(), L"\u00B0");
}

// Half a unit is added with the sign of x (zero takes the negative branch); extremes end without a trap.
TEST(RoundDouble, AddsHalfAUnitWithTheSignOfXAndEndsOnExtremes) {
  const double cases[][3] = {{0.0, 2, -0.005}, {1.234, 2, 1.239}, {-2.5, 0, -3.0},  {-1234.0, -2, -1284.0},
                             {7.0, -1, 12.0},  {3.0, INT_MAX, 3.0}, {3.0, INT_MIN, kInf}, {kNaN, 2, kNaN},
                             {-kInf, 2, -kInf}};
  for (const auto& c : cases) {
    const double got = svy_formats::RoundDouble(c[0], static_cast<int>(c[1]));
    EXPECT_TRUE(same(got, c[2]) || std::fabs(got - c[2]) <= 1e-15 * (1.0 + std::fabs(c[2]))) << c[0] << " " << c[1];
  }
  // Oracle: truncating after it gives the nearest count of units for values away from the half.
  for (int cents = -100000; cents <= 100000; cents += 7)
    for (double frac : {0.2, 0.45, 0.55, 0.8}) {
      const double x = (cents + (cents < 0 ? -frac : frac)) / 100.0;
      ASSERT_EQ(static_cast<long>(svy_formats::RoundDouble(x, 2) * 100.0), std::lround(x * 100.0)) << x;
    }
}

// Count "+" unpadded remainder: both parts carry the sign, no carry into the count; quotients beyond int
// (and an interval of 0, a caller error) use the indefinite count INT_MIN.
TEST(StnToString, CountPlusUnpaddedRemainder) {
  struct {
    double station, interval;
    const wchar_t* text;
  } const cases[] = {{1005.3, 1000, L"1+5.30"},       {-1234.5, 1000, L"-1+-234.50"}, {999.999, 1000, L"0+1000.00"},
                     {-234.5, 1000, L"0+-234.50"},    {-2000.0, 1000, L"-2+0.00"},    {12345.678, 100, L"123+45.68"},
                     {1234.5, -1000, L"-1+234.50"},   {2147483647000.0, 1000, L"2147483647+0.00"},
                     {0.0, 0, L"-2147483648+0.00"}};
  for (const auto& c : cases) EXPECT_EQ(StnToString(c.station, c.interval).str(), c.text) << c.station;
  for (double x : {3e12, kNaN}) EXPECT_EQ(StnToString(x, 1000).str().substr(0, 12), L"-2147483648+") << x;
  EXPECT_NE(StnToString(kNaN, 1000).str().find(L"nan"), std::wstring::npos);
}

// A successful read gives the station; a failed one ("%d+%lf" needs both fields) leaves it alone.
TEST(StnFromString, ReadsOrLeavesTheStationAlone) {
  struct {
    const wchar_t* text;
    double interval;
    int result;
    double station;
  } const cases[] = {{L"-1+234.5", 1000, 1, -765.5}, {L"1,5", 1000, 1, 1.5},  {L"1+2,5", 1000, 1, 1002.5},
                     {L"1+5 m", 1000, 1, 1005},      {L"3+45", 100, 1, 345},  {L"1e3", 1000, 1, 1000},
                     {L"1+ 5", 1000, 1, 1005},       {L"1+", 1000, 0, 0},     {L"+5", 1000, 0, 0},
                     {L"1e+3", 1000, 0, 0},          {L"1 +5", 1000, 0, 0},   {L"1,234+5", 1000, 0, 0},
                     {L"", 1000, 0, 0}};
  for (const auto& c : cases) {
    double station = -99999.25;
    EXPECT_EQ(StnFromString(CSvyString(c.text), station, c.interval), c.result) << CSvyString(c.text).ToNarrow();
    EXPECT_DOUBLE_EQ(station, c.result == 1 ? c.station : -99999.25) << CSvyString(c.text).ToNarrow();
  }
}

// Written with an interval, station text reads back with it to the station rounded once to the centimetre.
TEST(StationTextRoundTrip, WrittenTextReadsBackToTheStation) {
  for (double interval : {1000.0, 20.0, 1.0})
    for (double station : {0.0, 0.005, -99.996, 999.999, -1234.567, 987654.321, -2.5e6}) {
      const CSvyString text = StnToString(station, interval);
      double read = kNaN, again = kNaN;
      ASSERT_EQ(StnFromString(text, read, interval), 1) << text.ToNarrow();
      EXPECT_NEAR(read, station, 0.005 + 1e-9 * std::fabs(station)) << text.ToNarrow();
      ASSERT_EQ(StnFromString(StnToString(read, interval), again, interval), 1);
      EXPECT_NEAR(again, read, 1e-9 * (1.0 + std::fabs(read))) << text.ToNarrow();
    }
}

TEST(StationText, IndependentOfAHostDecimalComma) {
  const svy_test::CDecimalCommaCLocale comma;
  if (!comma.active()) GTEST_SKIP() << "no decimal-comma C locale installed";
  EXPECT_EQ(StnToString(1234.567, 1000).str(), L"1+234.57");
  double station = 0.0;
  EXPECT_TRUE(StnFromString(CSvyString(L"1+234.5"), station, 1000) == 1 && station == 1234.5);
}

}  // namespace
