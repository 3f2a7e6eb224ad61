// Number text and decimal rounding: whole-text readers, half-away-from-zero rounding on the written decimal
// (against integer arithmetic), write-read round trips, and independence from a host decimal comma.
#include <gtest/gtest.h>
#include <locale.h>

#include <climits>
#include <clocale>
#include <cmath>
#include <cstdint>
#include <limits>
#include <locale>
#include <random>
#include <string>

#include "support/comma_locale.h"
#include "svyutils/round_prec.h"
#include "svyutils/svy_number_text.h"
#include "svyutils/svy_string.h"

namespace {

using svy::math::round_prec;
using svy_text::CSvyString;
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInf = std::numeric_limits<double>::infinity();
constexpr double kMax = std::numeric_limits<double>::max();
constexpr double kDenormMin = std::numeric_limits<double>::denorm_min();

// Whole-text readers: a failure leaves the output at a sentinel no successful read gives.
TEST(StringToNumber, ParsesWholeTextOrLeavesOutputAlone) {
  struct { const wchar_t* text; bool intOk, doubleOk; double value; } const cases[] = {
      {L"+42", true, true, 42},          {L" \t-17 \n", true, true, -17},   {L"-2147483648", true, true, INT_MIN},
      {L"2147483648", false, true, 2147483648.0}, {L"   ", false, false, 0}, {L"1.0", false, true, 1.0},
      {L"1 2", false, false, 0},         {L"+-1", false, false, 0},         {L"0x1F", false, false, 0},
      {L"\uFF11", false, false, 0},      {L"-.5", false, true, -0.5},       {L"2.", false, true, 2.0},
      {L"  1.25E-2\t", false, true, 0.0125}, {L"1,5", false, false, 0},    {L"1.5.", false, false, 0},
      {L".", false, false, 0},           {L"1e+", false, false, 0},         {L"inf", false, false, 0},
      {L"nan", false, false, 0},         {L"0x1p3", false, false, 0},       {L"1e400", false, false, 0}};
  for (const auto& c : cases) {
    int i = -424242;
    double d = -4242.4242;
    EXPECT_EQ(svy_formats::StringToInt(CSvyString(c.text), i), c.intOk) << CSvyString(c.text).ToNarrow();
    EXPECT_EQ(svy_formats::StringToDouble(CSvyString(c.text), d), c.doubleOk) << CSvyString(c.text).ToNarrow();
    EXPECT_EQ(i, c.intOk ? static_cast<int>(c.value) : -424242) << CSvyString(c.text).ToNarrow();
    EXPECT_EQ(d, c.doubleOk ? c.value : -4242.4242) << CSvyString(c.text).ToNarrow();
  }
}

// Half away from zero on the written decimal (binary neighbours below the half still round up); extreme
// values and decimals end in range, special values pass through, a value rounded to zero keeps its sign.
TEST(Rounding, HalfAwayFromZeroOnTheWrittenDecimal) {
  struct {
    double value;
    int decimals;
    double rounded;
    const wchar_t* text;
  } const cases[] = {{-2.675, 2, -2.68, L"-2.68"},   {9.995, 2, 10.0, L"10.00"},  {-0.001, 2, -0.0, L"0.00"},
                     {1250.0, -2, 1300.0, L"1300"},  {-49.0, -2, -0.0, L"0"},     {1.0049999, 2, 1.0, L"1.00"},
                     {0.1, 25, 0.1, L"0.10000000000000000"}, {1e21, 2, 1e21, L"1000000000000000000000.00"},
                     {kNaN, 2, kNaN, L"nan"},        {-kInf, 2, -kInf, L"-inf"},  {1.5e300, -300, 2e300, nullptr},
                     {kMax, -293, kMax, nullptr},    {kDenormMin, 2, 0.0, nullptr},
                     {kDenormMin, 400, kDenormMin, nullptr},
                     {123.456, INT_MAX, 123.456, nullptr}, {123.456, INT_MIN, 0.0, nullptr}};
  for (const auto& c : cases) {
    const double r = round_prec(c.value, c.decimals);
    EXPECT_TRUE(std::isnan(c.rounded) ? std::isnan(r) : r == c.rounded) << c.value << " " << c.decimals;
    if (c.text) {
      EXPECT_EQ(svy_formats::DoubleToString(c.value, c.decimals).str(), c.text) << c.value;
    }
  }
  EXPECT_TRUE(std::signbit(round_prec(-0.001, 2)));
  const std::wstring huge = svy_formats::DoubleToString(kMax, 2).str();  // every integer digit
  EXPECT_EQ(huge, L"17976931348623157" + std::wstring(292, L'0') + L".00");
  // Oracle in integer arithmetic: n thousandths to hundredths is (n +- 5) / 10, divisions correctly rounded.
  std::mt19937_64 random(7);
  std::uniform_int_distribution<std::int64_t> thousandths(-9'000'000'000'000LL, 9'000'000'000'000LL);
  for (int i = 0; i < 20000; ++i) {
    const std::int64_t n = i < 2000 ? i - 1000 : thousandths(random);
    const double expected = static_cast<double>((n + (n < 0 ? -5 : 5)) / 10) / 100.0;
    ASSERT_EQ(round_prec(static_cast<double>(n) / 1000.0, 2), expected) << n;
  }
}

// Text written with some decimals reads back as the value rounded to them, from millimetres to grid
// coordinates (at most 15 significant digits, so every text is the shortest form of what it reads as).
TEST(NumberTextRoundTrip, WrittenTextReadsBackAsTheRoundedValue) {
  std::mt19937_64 random(20240611);
  std::uniform_real_distribution<double> magnitude(-3.0, 6.9);
  std::uniform_int_distribution<int> decimals(0, 8);
  for (int i = 0; i < 5000; ++i) {
    const double value = (i % 2 == 0 ? 1.0 : -1.0) * std::pow(10.0, magnitude(random));
    const int places = decimals(random);
    double parsed = 0.0;
    const CSvyString text = svy_formats::DoubleToString(value, places);
    ASSERT_TRUE(svy_formats::StringToDouble(text, parsed)) << text.ToNarrow();
    EXPECT_EQ(parsed, round_prec(value, places)) << text.ToNarrow();
  }
  CSvyString commas(L"1,5;2,25,");
  svy_formats::ReplaceCommasWithDecPt(commas);
  EXPECT_EQ(commas.str(), L"1.5;2.25.");
}

// Found by fuzzing: rounding a number near the largest double to a large power of ten carries past it. The
// text is the true decimal rounding, which no double can hold, so it does not read back.
TEST(NumberTextRoundTrip, RoundingPastTheLargestDoubleIsWrittenButDoesNotReadBack) {
  const CSvyString text = svy_formats::DoubleToString(1.7976922785710768e+308, -304);
  EXPECT_EQ(text.ToNarrow(), "17977" + std::string(304, '0'));
  double parsed = 0.0;
  EXPECT_FALSE(svy_formats::StringToDouble(text, parsed));
}

// A host whose C++ locale (and, when one is installed, C locale) has a decimal comma changes no text.
TEST(NumberText, HostDecimalCommaChangesNothing) {
  struct CommaPunct : std::numpunct<char> {
    char do_decimal_point() const override { return ','; }
    char do_thousands_sep() const override { return '.'; }
    std::string do_grouping() const override { return "\3"; }
  };
  struct WideCommaPunct : std::numpunct<wchar_t> {
    wchar_t do_decimal_point() const override { return L','; }
  };
  const std::locale previous = std::locale::global(
      std::locale(std::locale(std::locale::classic(), new CommaPunct), new WideCommaPunct));
  const auto expectPointText = [] {
    EXPECT_EQ(svy_formats::DoubleToString(1234.5, 2).str(), L"1234.50");
    double value = 0.0;
    EXPECT_TRUE(svy_formats::StringToDouble(CSvyString(L"1234.5"), value) && value == 1234.5);
    EXPECT_FALSE(svy_formats::StringToDouble(CSvyString(L"1234,5"), value));
    CSvyString formatted;
    formatted.Format(L"%.2f|%d", 1234.5, 1234567);
    EXPECT_EQ(formatted.str(), L"1234.50|1234567");
  };
  EXPECT_EQ(std::use_facet<std::numpunct<char>>(std::locale()).decimal_point(), ',');
  EXPECT_EQ(std::use_facet<std::numpunct<char>>(svy_formats::GetCLocale()).decimal_point(), '.');
  expectPointText();
  {
    const svy_test::CDecimalCommaCLocale comma;
    if (comma.active()) expectPointText();
  }
  std::locale::global(previous);
  const locale_t before = uselocale(static_cast<locale_t>(nullptr));
  {
    const svy_formats::CScopedCLocale first, nested;
    EXPECT_EQ(std::localeconv()->decimal_point[0], '.');
  }
  EXPECT_EQ(uselocale(static_cast<locale_t>(nullptr)), before);
}

}  // namespace
