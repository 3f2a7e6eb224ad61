#include "svymath/formats/angle_text.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <random>

namespace {

using svy_text::CSvyString;

constexpr double kDms = 45.0 + 30.0 / 60 + 15.25 / 3600;

// Fields are padded and the sign goes in front.
TEST(AngleTextWriting, PadsFieldsCarriesAndSigns) {
  using svy_formats::DegreeToString;
  using svy_formats::DMMToString;
  using svy_formats::DMSToString;
  struct {
    CSvyString (*write)(double, int);
    double degrees;
    int decimals;
    const wchar_t* text;
  } const cases[] = {
      {DMSToString, kDms, 2, L"45\u00B030'15.25\""},
      {DMSToString, -0.5, 0, L"-0\u00B030'00\""},        // the sign survives below 1 degree
      {DMSToString, 359.99999999, 2, L"360\u00B000'00.00\""},  // carried, not reduced
      {DMSToString, -0.00000001, 2, L"0\u00B000'00.00\""},     // rounds to an unsigned zero
      {DMSToString, 1.0, -3, L"1\u00B000'00\""},         {DMMToString, -12.0 + -5.5 / 60, 1, L"-12\u00B005.5'"},
      {DMMToString, 10.99999, 2, L"11\u00B000.00'"},      {DegreeToString, -2.675, 2, L"-2.68\u00B0"}};
  for (const auto& c : cases) {
    SCOPED_TRACE(::testing::Message() << c.degrees << " decimals " << c.decimals);
    EXPECT_EQ(c.write(c.degrees, c.decimals).str(), c.text);
  }
  const double nan = std::numeric_limits<double>::quiet_NaN();
  for (const CSvyString& t : {DMSToString(nan, 2), DMSToString(1e300, 2),
                              DMMToString(-std::numeric_limits<double>::infinity(), 2), DegreeToString(nan, 2)})
    EXPECT_TRUE(t.IsEmpty()) << t.ToNarrow();
}

// Each reader accepts its typed forms and leaves the value alone when it fails.
TEST(AngleTextReading, AcceptsTypedFormsAndLeavesFailuresAlone) {
  struct {
    const wchar_t* text;
    bool dms, dmm, degree;
    double degrees;
  } const cases[] = {
      {L"45\u00B030'15.25\"", true, false, false, kDms}, {L"45:30:15,25", true, false, false, kDms},
      {L"45d30m15.25s", true, false, false, kDms},
      {L" 45\u00B0 30\u2032 15.25\u2033 ", true, false, false, kDms},
      {L"-12\u00B005'", true, true, false, -(12.0 + 5.0 / 60)}, {L"+12 5.5", true, true, false, 12.0 + 5.5 / 60},
      {L"45,5", true, true, true, 45.5},  {L".5", true, true, true, 0.5},
      // Rejected forms.
      {L"45.5\u00B030'", false, false, false, 0},  // decimals before the last field
      {L"45 30 60", false, false, false, 0},
      {L"45'", false, false, false, 0},  // a minute mark on the degrees
      {L"45\u00B030\u00B0", false, false, false, 0}, {L"45 30 15 5", false, false, false, 0},
      {L"1e3", false, false, false, 0},              {L"- 45", false, false, false, 0},
      {L"", false, false, false, 0}};
  for (const auto& c : cases) {
    SCOPED_TRACE(CSvyString(c.text).ToNarrow());
    const CSvyString text(c.text);
    constexpr double kUntouched = -777.0;
    double dms = kUntouched, dmm = kUntouched, degree = kUntouched;
    EXPECT_EQ(svy_formats::ParseDMS(text, dms), c.dms);
    EXPECT_EQ(svy_formats::ParseDMM(text, dmm), c.dmm);
    EXPECT_EQ(svy_formats::ParseDegree(text, degree), c.degree);
    EXPECT_EQ(svy_formats::is_str_dmm(text), c.dmm);
    EXPECT_EQ(svy_formats::is_str_degree(text), c.degree);
    EXPECT_NEAR(dms, c.dms ? c.degrees : kUntouched, 1e-12);
    EXPECT_NEAR(dmm, c.dmm ? c.degrees : kUntouched, 1e-12);
    EXPECT_NEAR(degree, c.degree ? c.degrees : kUntouched, 1e-12);
  }
}

// Written text reads back to the angle within half a unit of its last decimal.
TEST(AngleTextRoundTrip, WrittenFormsReadBack) {
  std::mt19937_64 random(17);
  std::uniform_real_distribution<double> angle(-720.0, 720.0);
  for (int i = 0; i < 3000; ++i) {
    const double degrees = angle(random);
    const int decimals = i % 5;
    const double unit = std::pow(10.0, -decimals);
    double read = 0.0;
    ASSERT_TRUE(svy_formats::StringToDegree(svy_formats::DMSToString(degrees, decimals), read));
    EXPECT_NEAR(read, degrees, 0.5 * unit / 3600.0 + 1e-11);
    ASSERT_TRUE(svy_formats::ParseDMM(svy_formats::DMMToString(degrees, decimals), read));
    EXPECT_NEAR(read, degrees, 0.5 * unit / 60.0 + 1e-11);
    ASSERT_TRUE(svy_formats::ParseDegree(svy_formats::DegreeToString(degrees, decimals), read));
    EXPECT_NEAR(read, degrees, 0.5 * unit + 1e-11);
  }
}

}  // namespace
