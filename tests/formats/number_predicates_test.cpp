#include "svymath/formats/number_predicates.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "svymath/formats/sign_strings.h"

namespace {

using svy_text::CSvyString;

// The predicates agree with the readers: a NaN value marks text that is no number.
TEST(UserNumbers, PredicatesAgreeWithTheReaders) {
  constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
  struct {
    const wchar_t* text;
    bool isInt, isDouble, isNotEmptyDouble;
    double value;
  } const cases[] = {{L" -12 ", true, true, true, -12.0},
                     {L"12,5", false, true, true, 12.5},  // decimal comma of user text
                     {L"12.5", false, true, true, 12.5},        {L"1e-3", false, true, true, 0.001},
                     {L"", false, true, false, kNaN},  // an empty optional field
                     {L"  \t", false, true, false, kNaN},      {L"12 m", false, false, false, kNaN},
                     {L"1,234.5", false, false, false, kNaN},  // no grouping
                     {L"nan", false, false, false, kNaN},       {L"99999999999", false, true, true, 99999999999.0}};
  for (const auto& c : cases) {
    SCOPED_TRACE(CSvyString(c.text).ToNarrow());
    const CSvyString text(c.text);
    EXPECT_EQ(svy_formats::is_str_int(text), c.isInt);
    EXPECT_EQ(svy_formats::is_str_double(text), c.isDouble);
    EXPECT_EQ(svy_formats::is_str_notempty_double(text), c.isNotEmptyDouble);
    const double read = svy_formats::str_to_float(text);
    EXPECT_TRUE(std::isnan(c.value) ? std::isnan(read) : read == c.value) << read;
    double value = -1.0;
    EXPECT_EQ(svy_formats::String2Double(text, value), c.isNotEmptyDouble);
    EXPECT_EQ(value, c.isNotEmptyDouble ? c.value : -1.0);
  }
}

// The signs compose the texts the library itself reads back.
TEST(SignStrings, ComposeTextsTheReaderAccepts) {
  const CSvyString number = CSvyString(L"12") + svy_formats::DecimalSignString() + L"5";
  double value = 0.0;
  ASSERT_TRUE(svy_formats::String2Double(number, value));
  EXPECT_EQ(value, 12.5);
  EXPECT_NE(svy_formats::ThousandSignString(), svy_formats::DecimalSignString());
  EXPECT_EQ(svy_formats::DegreeSignString().str(), L"\u00B0");
}

}  // namespace
