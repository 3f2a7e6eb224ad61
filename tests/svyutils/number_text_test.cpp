#include <gtest/gtest.h>
#include <locale.h>

#include <clocale>
#include <cmath>
#include <cstdint>
#include <limits>
#include <locale>
#include <random>
#include <string>

#include "svyutils/round_prec.h"
#include "svyutils/svy_number_text.h"
#include "svyutils/svy_string.h"

namespace {

using svy_text::CSvyString;

// A sentinel that no successful parse in these tables produces, to see that failures leave it alone.
constexpr int kIntSentinel = -424242;
constexpr double kDoubleSentinel = -4242.4242;

struct TIntCase {
  const wchar_t* text;
  bool ok;
  int value;
};

class StringToIntTable : public ::testing::TestWithParam<TIntCase> {};

TEST_P(StringToIntTable, ParsesWholeTextOrLeavesOutputAlone) {
  const TIntCase& c = GetParam();
  int value = kIntSentinel;
  EXPECT_EQ(svy_formats::StringToInt(CSvyString(c.text), value), c.ok);
  EXPECT_EQ(value, c.ok ? c.value : kIntSentinel);
}

INSTANTIATE_TEST_SUITE_P(
    Cases, StringToIntTable,
    ::testing::Values(TIntCase{L"0", true, 0}, TIntCase{L"42", true, 42}, TIntCase{L"+42", true, 42},
                      TIntCase{L"-42", true, -42}, TIntCase{L" \t17 \n", true, 17}, TIntCase{L"007", true, 7},
                      TIntCase{L"2147483647", true, 2147483647},
                      TIntCase{L"-2147483648", true, -2147483647 - 1}, TIntCase{L"2147483648", false, 0},
                      TIntCase{L"-2147483649", false, 0}, TIntCase{L"99999999999999999999", false, 0},
                      TIntCase{L"", false, 0}, TIntCase{L"   ", false, 0}, TIntCase{L"+", false, 0},
                      TIntCase{L"-", false, 0}, TIntCase{L"1.0", false, 0}, TIntCase{L"12abc", false, 0},
                      TIntCase{L"1 2", false, 0}, TIntCase{L"--1", false, 0}, TIntCase{L"+-1", false, 0},
                      TIntCase{L"0x1F", false, 0}, TIntCase{L"\uFF11", false, 0}));  // full-width digit

struct TDoubleCase {
  const wchar_t* text;
  bool ok;
  double value;
};

class StringToDoubleTable : public ::testing::TestWithParam<TDoubleCase> {};

TEST_P(StringToDoubleTable, ParsesWholeTextOrLeavesOutputAlone) {
  const TDoubleCase& c = GetParam();
  double value = kDoubleSentinel;
  EXPECT_EQ(svy_formats::StringToDouble(CSvyString(c.text), value), c.ok);
  EXPECT_EQ(value, c.ok ? c.value : kDoubleSentinel);
}

INSTANTIATE_TEST_SUITE_P(
    Cases, StringToDoubleTable,
    ::testing::Values(
        TDoubleCase{L"1.5", true, 1.5}, TDoubleCase{L"-1.5", true, -1.5}, TDoubleCase{L"+1.5", true, 1.5},
        TDoubleCase{L".5", true, 0.5}, TDoubleCase{L"-.5", true, -0.5}, TDoubleCase{L"2.", true, 2.0},
        TDoubleCase{L"  1234.567\t", true, 1234.567}, TDoubleCase{L"1e3", true, 1000.0},
        TDoubleCase{L"1.25E-2", true, 0.0125}, TDoubleCase{L"-7e+2", true, -700.0},
        TDoubleCase{L"0.1", true, 0.1}, TDoubleCase{L"1.7976931348623157e308", true, 1.7976931348623157e308},
        TDoubleCase{L"1,5", false, 0}, TDoubleCase{L"1.5.", false, 0}, TDoubleCase{L"1.5m", false, 0},
        TDoubleCase{L".", false, 0}, TDoubleCase{L"-", false, 0}, TDoubleCase{L"e5", false, 0},
        TDoubleCase{L"1e", false, 0}, TDoubleCase{L"1e+", false, 0}, TDoubleCase{L"", false, 0},
        TDoubleCase{L"inf", false, 0}, TDoubleCase{L"nan", false, 0}, TDoubleCase{L"0x1p3", false, 0},
        TDoubleCase{L"1e400", false, 0}, TDoubleCase{L"1 000", false, 0}, TDoubleCase{L"--1", false, 0}));

struct TFormatCase {
  double value;
  int decimals;
  const wchar_t* text;
};

class DoubleToStringTable : public ::testing::TestWithParam<TFormatCase> {};

TEST_P(DoubleToStringTable, RoundsHalfAwayFromZeroOnTheWrittenDecimal) {
  const TFormatCase& c = GetParam();
  EXPECT_EQ(svy_formats::DoubleToString(c.value, c.decimals).str(), c.text);
}

INSTANTIATE_TEST_SUITE_P(
    Cases, DoubleToStringTable,
    ::testing::Values(
        TFormatCase{2.675, 2, L"2.68"}, TFormatCase{-2.675, 2, L"-2.68"}, TFormatCase{1.005, 2, L"1.01"},
        TFormatCase{0.125, 2, L"0.13"}, TFormatCase{0.5, 0, L"1"}, TFormatCase{-0.5, 0, L"-1"},
        TFormatCase{1.5, 3, L"1.500"}, TFormatCase{9.995, 2, L"10.00"}, TFormatCase{-0.001, 2, L"0.00"},
        TFormatCase{-0.0, 1, L"0.0"}, TFormatCase{0.0, 0, L"0"}, TFormatCase{0.04, 1, L"0.0"},
        TFormatCase{0.05, 1, L"0.1"}, TFormatCase{1234.5, -2, L"1200"}, TFormatCase{1250.0, -2, L"1300"},
        TFormatCase{-49.0, -2, L"0"}, TFormatCase{0.1, 25, L"0.10000000000000000"},
        TFormatCase{1e21, 2, L"1000000000000000000000.00"}, TFormatCase{123456789.125, 2, L"123456789.13"},
        TFormatCase{std::numeric_limits<double>::quiet_NaN(), 2, L"nan"},
        TFormatCase{std::numeric_limits<double>::infinity(), 2, L"inf"},
        TFormatCase{-std::numeric_limits<double>::infinity(), 2, L"-inf"}));

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
    // And the value parsed prints as the same text.
    EXPECT_EQ(svy_formats::DoubleToString(parsed, places).str(), text.str());
  }
}

TEST(NumberTextRoundTrip, ShortestTextsSurviveValueAndBack) {
  const wchar_t* const texts[] = {L"0.1", L"2.675", L"-1234.567", L"500000.001", L"5000000.125", L"1e-07"};
  const int places[] = {1, 3, 3, 3, 3, 7};
  for (std::size_t i = 0; i < sizeof texts / sizeof texts[0]; ++i) {
    double value = 0.0;
    ASSERT_TRUE(svy_formats::StringToDouble(CSvyString(texts[i]), value));
    double again = 0.0;
    ASSERT_TRUE(svy_formats::StringToDouble(svy_formats::DoubleToString(value, places[i]), again));
    EXPECT_EQ(again, value) << i;
  }
}

TEST(ReplaceCommasWithDecPt, ReplacesEveryComma) {
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
    EXPECT_TRUE(svy_formats::StringToDouble(CSvyString(L"1234.5"), value));
    EXPECT_EQ(value, 1234.5);
    EXPECT_FALSE(svy_formats::StringToDouble(CSvyString(L"1234,5"), value));
    CSvyString formatted;
    formatted.Format(L"%.2f|%d", 1234.5, 1234567);
    EXPECT_EQ(formatted.str(), L"1234.50|1234567");
  }

 private:
  std::locale previousGlobal_;
};

TEST_F(CommaLocaleHost, StreamsOfTheHostUseTheComma) {
  // The fixture's locale is in force (so the next test is meaningful) ...
  EXPECT_EQ(std::use_facet<std::numpunct<char>>(std::locale()).decimal_point(), ',');
  // ... and GetCLocale still formats with the point.
  EXPECT_EQ(std::use_facet<std::numpunct<char>>(svy_formats::GetCLocale()).decimal_point(), '.');
  expectCLocaleText();
}

TEST_F(CommaLocaleHost, CRuntimeLocaleWithDecimalComma) {
  const char* candidates[] = {"de_DE.UTF-8", "de_DE.utf8", "fr_FR.UTF-8", "de_DE", "German_Germany.1252"};
  const std::string previous = std::setlocale(LC_ALL, nullptr);
  const char* chosen = nullptr;
  for (const char* name : candidates) {
    if (std::setlocale(LC_ALL, name) != nullptr && std::localeconv()->decimal_point[0] == ',') {
      chosen = name;
      break;
    }
  }
  if (chosen == nullptr) {
    std::setlocale(LC_ALL, previous.c_str());
    GTEST_SKIP() << "no decimal-comma C locale installed";
  }
  expectCLocaleText();
  std::setlocale(LC_ALL, previous.c_str());
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
