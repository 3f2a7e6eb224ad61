#include "svymath/formats/station_text.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <string>

#include "support/comma_locale.h"

namespace {

using svy_text::CSvyString;

TEST(StnToString, CountPlusUnpaddedRemainder) {
  struct {
    double station, interval;
    const wchar_t* text;
  } const cases[] = {{1005.3, 1000, L"1+5.30"},
                     {-1234.5, 1000, L"-1+-234.50"},  // both parts carry the sign
                     {999.999, 1000, L"0+1000.00"},   // no carry into the count
                     {-234.5, 1000, L"0+-234.50"},    {-2000.0, 1000, L"-2+0.00"},
                     {12345.678, 100, L"123+45.68"},  {1234.5, -1000, L"-1+234.50"},
                     {2147483647000.0, 1000, L"2147483647+0.00"}};
  for (const auto& c : cases) {
    SCOPED_TRACE(::testing::Message() << c.station << " / " << c.interval);
    EXPECT_EQ(StnToString(c.station, c.interval).str(), c.text);
  }
  // Quotients beyond int use the indefinite count INT_MIN; the remainder follows from it. An interval of 0
  // is a caller error; it still gives a text and no trap.
  for (double x : {3e12, std::numeric_limits<double>::quiet_NaN()})
    EXPECT_EQ(StnToString(x, 1000).str().substr(0, 12), L"-2147483648+") << x;
  EXPECT_NE(StnToString(std::numeric_limits<double>::quiet_NaN(), 1000).str().find(L"nan"), std::wstring::npos);
  EXPECT_EQ(StnToString(0.0, 0).str(), L"-2147483648+0.00");
}

// A successful read gives the station; a failed one leaves it alone.
TEST(StnFromString, ReadsOrLeavesTheStationAlone) {
  constexpr double kUntouched = -99999.25;
  struct {
    const wchar_t* text;
    double interval;
    int result;
    double station;
  } const cases[] = {
      {L"-1+234.5", 1000, 1, -765.5},  {L"1,5", 1000, 1, 1.5},   {L"1+2,5", 1000, 1, 1002.5},
      {L"1+5 m", 1000, 1, 1005},       {L"3+45", 100, 1, 345},   {L"1e3", 1000, 1, 1000},
      {L"1+ 5", 1000, 1, 1005},  // the number after '+' may have leading blanks
      // Failures: "%d+%lf" needs both fields, so these quirks are rejected as they are.
      {L"1+", 1000, 0, 0},      {L"+5", 1000, 0, 0}, {L"1e+3", 1000, 0, 0}, {L"1 +5", 1000, 0, 0},
      {L"1,234+5", 1000, 0, 0}, {L"", 1000, 0, 0}};
  for (const auto& c : cases) {
    SCOPED_TRACE(CSvyString(c.text).ToNarrow());
    double station = kUntouched;
    EXPECT_EQ(StnFromString(CSvyString(c.text), station, c.interval), c.result);
    EXPECT_DOUBLE_EQ(station, c.result == 1 ? c.station : kUntouched);
  }
}

// Station text written with an interval reads back, with the same interval, to the station rounded to
// the centimetre that the text carries.
TEST(StationTextRoundTrip, WrittenTextReadsBackToTheStation) {
  for (double interval : {1000.0, 20.0, 1.0}) {
    for (double magnitude : {0.0, 0.005, 99.996, 999.999, 1234.567, 987654.321, 2.5e6}) {
      for (double station : {magnitude, -magnitude}) {
        const CSvyString text = StnToString(station, interval);
        double read = std::numeric_limits<double>::quiet_NaN();
        ASSERT_EQ(StnFromString(text, read, interval), 1) << text.ToNarrow();
        EXPECT_NEAR(read, station, 0.005 + 1e-9 * std::fabs(station)) << text.ToNarrow();
        // A second trip changes nothing more: the centimetre rounding happens once.
        double again = std::numeric_limits<double>::quiet_NaN();
        ASSERT_EQ(StnFromString(StnToString(read, interval), again, interval), 1);
        EXPECT_NEAR(again, read, 1e-9 * (1.0 + std::fabs(read))) << text.ToNarrow();
      }
    }
  }
}

TEST(StationText, IndependentOfAHostDecimalComma) {
  const svy_test::CDecimalCommaCLocale comma;
  if (!comma.active()) GTEST_SKIP() << "no decimal-comma C locale installed";
  EXPECT_EQ(StnToString(1234.567, 1000).str(), L"1+234.57");
  double station = 0.0;
  EXPECT_EQ(StnFromString(CSvyString(L"1+234.5"), station, 1000), 1);
  EXPECT_EQ(station, 1234.5);
}

}  // namespace
