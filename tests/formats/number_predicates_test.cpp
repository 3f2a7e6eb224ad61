#include "svymath/formats/number_predicates.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "svymath/formats/sign_strings.h"

namespace {

using svy_text::CSvyString;

struct TUserNumberCase {
  const wchar_t* text;
  bool isInt;
  bool isDouble;
  bool isNotEmptyDouble;
  double value;  // NaN when the text is no number
};

class UserNumberTable : public ::testing::TestWithParam<TUserNumberCase> {};

TEST_P(UserNumberTable, PredicatesAgreeWithTheReader) {
  const TUserNumberCase& c = GetParam();
  const CSvyString text(c.text);
  EXPECT_EQ(svy_formats::is_str_int(text), c.isInt);
  EXPECT_EQ(svy_formats::is_str_double(text), c.isDouble);
  EXPECT_EQ(svy_formats::is_str_notempty_double(text), c.isNotEmptyDouble);
  const double read = svy_formats::str_to_float(text);
  if (std::isnan(c.value)) {
    EXPECT_TRUE(std::isnan(read));
  } else {
    EXPECT_EQ(read, c.value);
  }
  double value = -1.0;
  EXPECT_EQ(svy_formats::String2Double(text, value), c.isNotEmptyDouble);
  EXPECT_EQ(value, c.isNotEmptyDouble ? c.value : -1.0);
}

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

INSTANTIATE_TEST_SUITE_P(
    Cases, UserNumberTable,
    ::testing::Values(TUserNumberCase{L"12", true, true, true, 12.0},
                      TUserNumberCase{L" -12 ", true, true, true, -12.0},
                      TUserNumberCase{L"12,5", false, true, true, 12.5},  // decimal comma of user text
                      TUserNumberCase{L"12.5", false, true, true, 12.5},
                      TUserNumberCase{L"1e-3", false, true, true, 0.001},
                      TUserNumberCase{L"", false, true, false, kNaN},  // an empty optional field
                      TUserNumberCase{L"  \t", false, true, false, kNaN},
                      TUserNumberCase{L"12 m", false, false, false, kNaN},
                      TUserNumberCase{L"1,234.5", false, false, false, kNaN},  // no grouping
                      TUserNumberCase{L"nan", false, false, false, kNaN},
                      TUserNumberCase{L"99999999999", false, true, true, 99999999999.0}));

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
