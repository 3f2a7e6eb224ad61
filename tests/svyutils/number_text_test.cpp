#include <gtest/gtest.h>
#include <locale.h>

#include <clocale>
#include <cmath>
#include <cstdint>
#include <limits>
#include <locale>
#include <random>
#include <string>
#include <utility>

#include "support/comma_locale.h"
#include "svyutils/round_prec.h"
#include "svyutils/svy_number_text.h"
#include "svyutils/svy_string.h"

namespace {

using svy_text::CSvyString;

// Whole-text readers: a failure leaves the output at a sentinel no successful read in the tables gives.
TEST(StringToNumber, ParsesWholeTextOrLeavesOutputAlone) {
  constexpr int kIntSentinel = -424242;
  constexpr double kDoubleSentinel = -4242.4242;
  struct {
    const wchar_t* text;
    bool ok;
    int value;
  } const ints[] = {{L"+42", true, 42},        {L" \t-17 \n", true, -17}, {L"-2147483648", true, -2147483647 - 1},
                    {L"2147483648", false, 0}, {L"   ", false, 0},          {L"1.0", false, 0},
                    {L"1 2", false, 0},        {L"+-1", false, 0},          {L"0x1F", false, 0},
                    {L"\uFF11", false, 0}};  // full-width digit
  for (const auto& c : ints) {
    SCOPED_TRACE(CSvyString(c.text).ToNarrow());
    int value = kIntSentinel;
    EXPECT_EQ(svy_formats::StringToInt(CSvyString(c.text), value), c.ok);
    EXPECT_EQ(value, c.ok ? c.value : kIntSentinel);
  }
  struct {
    const wchar_t* text;
    bool ok;
    double value;
  } const doubles[] = {{L"+1.5", true, 1.5}, {L"-.5", true, -0.5},  {L"2.", true, 2.0}, {L"  1.25E-2\t", true, 0.0125},
                       {L"1,5", false, 0},     {L"1.5.", false, 0},   {L".", false, 0},   {L"1e+", false, 0},
                       {L"inf", false, 0},     {L"nan", false, 0},    {L"0x1p3", false, 0}, {L"1e400", false, 0}};
  for (const auto& c : doubles) {
    SCOPED_TRACE(CSvyString(c.text).ToNarrow());
    double value = kDoubleSentinel;
    EXPECT_EQ(svy_formats::StringToDouble(CSvyString(c.text), value), c.ok);
    EXPECT_EQ(value, c.ok ? c.value : kDoubleSentinel);
  }
}

// Rounds half away from zero on the written decimal (binary neighbours below the half still round up).
TEST(DoubleToString, RoundsHalfAwayFromZeroOnTheWrittenDecimal) {
  constexpr double kInf = std::numeric_limits<double>::infinity();
  struct {
    double value;
    int decimals;
    const wchar_t* text;
  } const cases[] = {{-2.675, 2, L"-2.68"}, {9.995, 2, L"10.00"},  {-0.001, 2, L"0.00"}, {-0.0, 1, L"0.0"},
                     {1250.0, -2, L"1300"}, {-49.0, -2, L"0"},     {0.1, 25, L"0.10000000000000000"},
                     {1e21, 2, L"1000000000000000000000.00"},     {std::numeric_limits<double>::quiet_NaN(), 2, L"nan"},
                     {-kInf, 2, L"-inf"}};
  for (const auto& c : cases) {
    SCOPED_TRACE(::testing::Message() << c.value << " decimals " << c.decimals);
    EXPECT_EQ(svy_formats::DoubleToString(c.value, c.decimals).str(), c.text);
  }
}

TEST(DoubleToString, HugeValuesPrintEveryIntegerDigit) {
  const std::wstring text = svy_formats::DoubleToString(std::numeric_limits<double>::max(), 2).str();
  ASSERT_EQ(text.size(), 309U + 3U);
  EXPECT_EQ(text.substr(0, 17), L"17976931348623157");
  EXPECT_EQ(text.substr(17), std::wstring(292, L'0') + L".00");
}

// Text written with a number of decimals reads back as the value rounded to them, over random values
// from millimetres to grid coordinates (at most 15 significant digits, so that every text is the
// shortest form of the value it reads as).
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
    EXPECT_EQ(parsed, svy::math::round_prec(value, places)) << text.ToNarrow();
    EXPECT_EQ(svy_formats::DoubleToString(parsed, places).str(), text.str());
  }
}

TEST(NumberText, ReplaceCommasWithDecPt) {
  CSvyString text(L"1,5;2,25,");
  svy_formats::ReplaceCommasWithDecPt(text);
  EXPECT_EQ(text.str(), L"1.5;2.25.");
}

// A host that prefers a decimal comma must not change the text this library reads or writes.
class CommaLocaleHost : public ::testing::Test {
 protected:
  struct CCommaPunct : std::numpunct<char> {
    char do_decimal_point() const override { return ','; }
    char do_thousands_sep() const override { return '.'; }
    std::string do_grouping() const override { return "\3"; }
  };
  struct CWideCommaPunct : std::numpunct<wchar_t> {
    wchar_t do_decimal_point() const override { return L','; }
  };

  void SetUp() override {
    previousGlobal_ = std::locale::global(
        std::locale(std::locale(std::locale::classic(), new CCommaPunct), new CWideCommaPunct));
  }
  void TearDown() override { std::locale::global(previousGlobal_); }

  static void expectCLocaleText() {
    EXPECT_EQ(svy_formats::DoubleToString(1234.5, 2).str(), L"1234.50");
    double value = 0.0;
    EXPECT_TRUE(svy_formats::StringToDouble(CSvyString(L"1234.5"), value) && value == 1234.5);
    EXPECT_FALSE(svy_formats::StringToDouble(CSvyString(L"1234,5"), value));
    CSvyString formatted;
    formatted.Format(L"%.2f|%d", 1234.5, 1234567);
    EXPECT_EQ(formatted.str(), L"1234.50|1234567");
  }

 private:
  std::locale previousGlobal_;
};

// The fixture's C++ locale is in force (so the checks are meaningful), and GetCLocale still formats with
// the point, and so does the library.
TEST_F(CommaLocaleHost, StreamsOfTheHostUseTheComma) {
  EXPECT_EQ(std::use_facet<std::numpunct<char>>(std::locale()).decimal_point(), ',');
  EXPECT_EQ(std::use_facet<std::numpunct<char>>(svy_formats::GetCLocale()).decimal_point(), '.');
  expectCLocaleText();
}

TEST_F(CommaLocaleHost, CRuntimeLocaleWithDecimalComma) {
  const svy_test::CDecimalCommaCLocale comma;
  if (!comma.active()) GTEST_SKIP() << "no decimal-comma C locale installed";
  expectCLocaleText();
}

TEST(ScopedCLocale, RestoresTheThreadLocale) {
  const locale_t before = uselocale(static_cast<locale_t>(nullptr));
  {
    const svy_formats::CScopedCLocale first;
    const svy_formats::CScopedCLocale nested;
    EXPECT_EQ(std::localeconv()->decimal_point[0], '.');
  }
  EXPECT_EQ(uselocale(static_cast<locale_t>(nullptr)), before);
}

}  // namespace
