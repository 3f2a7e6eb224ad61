// Display texts: grouped numbers, degree texts in decimal and packed forms, the packed DD.MMmm reader, the
// degree suffix, bit texts and base re-reading; hand-written tables and round trips through the readers.
#include <gtest/gtest.h>

#include <cmath>
#include <cstdint>
#include <limits>
#include <random>

#include "support/comma_locale.h"
#include "svymath/formats/angle_text.h"
#include "svymath/formats/degree_display_text.h"
#include "svymath/formats/dms_text.h"
#include "svymath/formats/integer_text.h"
#include "svymath/formats/number_display_text.h"
#include "svymath/formats/number_predicates.h"
#include "svymath/foundation/angle_functions.h"

namespace {

using svy_text::CSvyString;
using namespace svy_formats;
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInf = std::numeric_limits<double>::infinity();
constexpr unsigned kTrim = eFloatTextTrimZeros;
constexpr unsigned kPlus = eFloatTextPlusSign;
constexpr unsigned kFlat = eFloatTextNoGrouping;

TEST(ConvertFloat, GroupsRoundsTrimsAndSigns) {
  struct { double value; int decimals; unsigned flags; const wchar_t* text; } const cases[] = {
      {1234567.891, 2, 0, L"1,234,567.89"},  {-1234.5, 2, 0, L"-1,234.50"},   {123456.0, 0, 0, L"123,456"},
      {999.9999, 2, 0, L"1,000.00"},         {2.675, 2, 0, L"2.68"},          {-0.004, 2, kPlus, L"0.00"},
      {12.5, 3, kTrim, L"12.5"},             {12.0, 3, kTrim | kPlus, L"+12"}, {0.0, 2, kTrim, L"0"},
      {-1234.5, 1, kFlat, L"-1234.5"},       {1250.0, -2, 0, L"1,300"},        {5e6, 0, kTrim, L"5,000,000"},
      {kNaN, 2, 0, L""},                     {-kInf, 2, 0, L""}};
  for (const auto& c : cases) {
    EXPECT_EQ(ConvertFloatEx(c.value, c.decimals, c.flags).str(), c.text) << c.value << ' ' << c.flags;
    if (c.flags == 0) {
      EXPECT_EQ(ConvertFloat(c.value, c.decimals), ConvertFloatEx(c.value, c.decimals, 0));
    }
  }
}

// Ungrouped text reads back to the value rounded to its decimals and writes again to the same text; the
// grouped text is the same digits with thousands signs.
TEST(ConvertFloat, UngroupedTextReadsBackAndGroupingOnlyAddsSigns) {
  std::mt19937_64 random(5);
  std::uniform_real_distribution<double> magnitude(-9.0, 9.0);
  for (int i = 0; i < 2000; ++i) {
    const double value = (i % 2 ? -1 : 1) * std::pow(10.0, magnitude(random));
    const int decimals = i % 7;
    const CSvyString flat = ConvertFloatEx(value, decimals, kFlat | (i % 3 ? kTrim : 0));
    double read = kNaN;
    ASSERT_TRUE(String2Double(flat, read)) << flat.ToNarrow();
    EXPECT_NEAR(read, value, 0.5 * std::pow(10.0, -decimals) * (1 + 1e-9) + 1e-15 * std::fabs(value));
    EXPECT_EQ(ConvertFloatEx(read, decimals, kFlat | (i % 3 ? kTrim : 0)), flat);
    CSvyString grouped = ConvertFloat(value, decimals);
    grouped.Remove(L',');
    EXPECT_EQ(grouped, ConvertFloatEx(value, decimals, kFlat));
  }
}

TEST(DegreeText, DecimalAndPackedForms) {
  struct { CSvyString text; const wchar_t* expected; } const cases[] = {
      {DegreeToStringEx(12.5, 3, kTrim | kPlus), L"+12.5\u00B0"},
      {DegreeToStringEx(-12345.25, 2, 0), L"-12345.25\u00B0"},
      {DegreeToStringEx(45.0, 4, eFloatTextNoDegreeSign), L"45.0000"},
      {DegreeToStringEx(1.0, 12, 0), L"1.000000000\u00B0"},
      {DegreesToString(45.504236, 4), L"45.5042\u00B0"},
      {DegreesToString(45.504236, eDegreeTextDecimal, 2), L"45.50\u00B0"},
      {DegreesToString(45.0 + 30.0 / 60 + 15.25 / 3600, eDegreeTextPackedDMS, 2), L"45.301525\u00B0"},
      {DegreesToString(-370.5, eDegreeTextPackedDMS, 0), L"-370.3000\u00B0"},
      {DegreesToString(12.9999999, eDegreeTextPackedDMS, 0), L"13.0000\u00B0"},
      {DegreesToString(-0.0001, eDegreeTextPackedDMS, 1), L"-0.00004\u00B0"},
      {DegreesToString(1e300, eDegreeTextPackedDMS, 0), L""},
      {DegreesToString(kNaN, eDegreeTextDecimal, 2), L""},
      {DegreeToStringEx(kInf, 2, 0), L""}};
  for (const auto& c : cases) EXPECT_EQ(c.text.str(), c.expected);
}

TEST(FromStringDMM, ReadsPackedDegreesAndMinutes) {
  struct { const wchar_t* text; bool ok; double degrees; } const cases[] = {
      {L"45.30254", true, 45 + 30.254 / 60},  {L" -12.05 ", true, -(12 + 5.0 / 60)}, {L"45.5", true, 45 + 50.0 / 60},
      {L"45", true, 45.0},                    {L"+7,3\u00B0", true, 7.5},            {L"0.59999d", true, 59.999 / 60},
      {L"45.", true, 45.0},                   {L"45.60", false, 0},                  {L".30", false, 0},
      {L"45.3a", false, 0},                   {L"4 5.30", false, 0},                 {L"45.30.1", false, 0},
      {L"-", false, 0},                       {L"", false, 0},                       {L"1e3", false, 0}};
  for (const auto& c : cases) {
    double degrees = -777.0;
    EXPECT_EQ(FromStringDMM(CSvyString(c.text), degrees), c.ok) << CSvyString(c.text).ToNarrow();
    EXPECT_NEAR(degrees, c.ok ? c.degrees : -777.0, 1e-12) << CSvyString(c.text).ToNarrow();
  }
}

TEST(CheckDegreeSuffix, StripsOneTrailingMark) {
  struct { const wchar_t* text; bool stripped; const wchar_t* rest; } const cases[] = {
      {L"45.5\u00B0", true, L"45.5"}, {L" 45.5 d  ", true, L" 45.5"}, {L"45D", true, L"45"},
      {L"45.5", false, L"45.5"},      {L"45\u00B0 ", true, L"45"},     {L"", false, L""}, {L"45'", false, L"45'"}};
  for (const auto& c : cases) {
    CSvyString text(c.text);
    EXPECT_EQ(CheckDegreeSuffix(text), c.stripped) << CSvyString(c.text).ToNarrow();
    EXPECT_EQ(text.str(), c.rest);
  }
}

// Every written degree text reads back with its reader to the angle within half a unit of its last digit.
TEST(DegreeText, WrittenFormsReadBack) {
  std::mt19937_64 random(29);
  std::uniform_real_distribution<double> angle(-720.0, 720.0);
  for (int i = 0; i < 3000; ++i) {
    const double degrees = angle(random);
    const int decimals = i % 6;
    const double unit = 0.5 * std::pow(10.0, -decimals) * (1 + 1e-9);
    double read = kNaN;
    ASSERT_TRUE(ParseDegree(DegreeToStringEx(degrees, decimals, i % 2 ? kPlus | kTrim : 0), read));
    EXPECT_NEAR(read, degrees, unit);
    CSvyString packed = DegreesToString(degrees, eDegreeTextPackedDMS, decimals);
    ASSERT_TRUE(CheckDegreeSuffix(packed));
    EXPECT_TRUE(CheckValidDMSVal(packed, L"720", false)) << packed.ToNarrow();
    // The packed reader reduces to one turn.
    EXPECT_NEAR(AngleDiff(DDDMMSS2Deg(str_to_float(packed)), degrees), 0.0, unit / 3600 + 1e-11) << packed.ToNarrow();
    // The packed DD.MMmm number of Deg2DDMMDEC, written with its decimals, reads back.
    const CSvyString dmm = ConvertFloatEx(Deg2DDMMDEC(degrees, decimals, true), decimals + 2, kFlat);
    ASSERT_TRUE(FromStringDMM(dmm, read)) << dmm.ToNarrow();
    EXPECT_NEAR(read, degrees, unit / 60 + 1e-11) << dmm.ToNarrow();
  }
}

TEST(DisplayText, IndependentOfAHostDecimalComma) {
  const svy_test::CDecimalCommaCLocale comma;
  if (!comma.active()) GTEST_SKIP() << "no decimal-comma C locale installed";
  EXPECT_EQ(ConvertFloat(1234.5, 2).str(), L"1,234.50");
  EXPECT_EQ(DegreesToString(45.5, eDegreeTextPackedDMS, 1).str(), L"45.30000\u00B0");
  double degrees = 0.0;
  EXPECT_TRUE(FromStringDMM(CSvyString(L"45.30"), degrees) && degrees == 45.5);
}

TEST(IntegerText, BitsAndBases) {
  struct { std::uint64_t value; int width; const wchar_t* text; } const bits[] = {
      {5, 8, L"00000101"}, {5, 0, L"101"}, {0, 0, L"0"}, {0, -3, L"0"}, {255, 4, L"11111111"},
      {std::uint32_t(-1), 0, L"11111111111111111111111111111111"}, {1, 100, nullptr}};
  for (const auto& c : bits) {
    const std::wstring text = bin_to_str(c.value, c.width).str();
    EXPECT_EQ(text, c.text ? std::wstring(c.text) : std::wstring(63, L'0') + L"1");
  }
  struct { long long value; int from, to; bool ok; long long result; } const bases[] = {
      {101, 2, 10, true, 5},     {5, 10, 2, true, 101},    {-777, 8, 10, true, -511}, {0, 2, 7, true, 0},
      {12, 2, 10, false, 0},     {5, 1, 10, false, 0},     {5, 10, 11, false, 0},
      {1LL << 40, 10, 2, false, 0}, {std::numeric_limits<long long>::min(), 10, 10, false, 0}};
  for (const auto& c : bases) {
    long long result = -1;
    EXPECT_EQ(int_to_int(c.value, c.from, c.to, result), c.ok) << c.value << ' ' << c.from << ' ' << c.to;
    EXPECT_EQ(result, c.ok ? c.result : -1) << c.value;
  }
  // Binary text, its digits as a number, and back: the three views of a mask agree.
  for (long long mask : {0LL, 1LL, 6LL, 1000LL, 524287LL}) {
    long long digits = 0, back = 0;
    ASSERT_TRUE(int_to_int(mask, 10, 2, digits) && int_to_int(digits, 2, 10, back));
    EXPECT_EQ(back, mask);
    EXPECT_EQ(CSvyString(std::to_wstring(digits)), bin_to_str(static_cast<std::uint64_t>(mask), 0));
  }
}

}  // namespace
