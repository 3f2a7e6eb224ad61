// Angle, bearing and packed-DMS text: writing with carries and signs, reading the typed forms, round trips.
#include <gtest/gtest.h>

#include <cmath>
#include <cwchar>
#include <limits>
#include <random>
#include <string>

#include "svymath/formats/angle_text.h"
#include "svymath/formats/bearing_text.h"
#include "svymath/formats/dms_text.h"

namespace {

using svy_text::CSvyString;
using namespace svy_formats;
constexpr double kDms = 45.0 + 30.0 / 60 + 15.25 / 3600;
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInf = std::numeric_limits<double>::infinity();

// Fields are padded, rounding carries (not reduced), the sign goes in front; non-finite input gives no text.
TEST(AngleTextWriting, PadsFieldsCarriesAndSigns) {
  struct { CSvyString (*write)(double, int); double degrees; int decimals; const wchar_t* text; } const cases[] = {
      {DMSToString, kDms, 2, L"45\u00B030'15.25\""},          {DMSToString, -0.5, 0, L"-0\u00B030'00\""},
      {DMSToString, 359.99999999, 2, L"360\u00B000'00.00\""}, {DMSToString, -0.00000001, 2, L"0\u00B000'00.00\""},
      {DMSToString, 1.0, -3, L"1\u00B000'00\""},              {DMMToString, -12.0 + -5.5 / 60, 1, L"-12\u00B005.5'"},
      {DMMToString, 10.99999, 2, L"11\u00B000.00'"},          {DMMToString, -0.00001, 2, L"0\u00B000.00'"},          {DegreeToString, -2.675, 2, L"-2.68\u00B0"},
      {DegreeToBearing, 0.0, 0, L"N 0\u00B000'00\" E"},       {DegreeToBearing, 180.0, 0, L"S 0\u00B000'00\" E"},
      {DegreeToBearing, 270.0, 0, L"N 90\u00B000'00\" W"},    {DegreeToBearing, -45.0, 0, L"N 45\u00B000'00\" W"},
      {DegreeToBearing, 405.0, 0, L"N 45\u00B000'00\" E"},
      {DegreeToBearing, 192.0 + 5.0 / 60, 0, L"S 12\u00B005'00\" W"},
      {DegreeToBearing, 10.0 + 59.0 / 60 + 59.96 / 3600, 1, L"N 11\u00B000'00.0\" E"},
      {DegreeToBearing, 30.0, -2, L"N 30\u00B000'00\" E"},    {DMSToString, kNaN, 2, L""},
      {DMSToString, 1e300, 2, L""}, {DMMToString, -kInf, 2, L""}, {DegreeToString, kNaN, 2, L""},
      {DegreeToBearing, kInf, 0, L""}};
  for (const auto& c : cases) EXPECT_EQ(c.write(c.degrees, c.decimals).str(), c.text) << c.degrees << " " << c.decimals;
}

// Each reader accepts its typed forms and leaves the value alone when it fails.
TEST(AngleTextReading, AcceptsTypedFormsAndLeavesFailuresAlone) {
  struct { const wchar_t* text; bool dms, dmm, degree; double degrees; } const cases[] = {
      {L"45\u00B030'15.25\"", true, false, false, kDms}, {L"45:30:15,25", true, false, false, kDms},
      {L"45d30m15.25s", true, false, false, kDms},       {L" 45\u00B0 30\u2032 15.25\u2033 ", true, false, false, kDms},
      {L"-12\u00B005'", true, true, false, -(12.0 + 5.0 / 60)}, {L"+12 5.5", true, true, false, 12.0 + 5.5 / 60},
      {L"45,5", true, true, true, 45.5},          {L".5", true, true, true, 0.5},
      {L"45.5\u00B030'", false, false, false, 0}, {L"45 30 60", false, false, false, 0},
      {L"45'", false, false, false, 0},           {L"45\u00B030\u00B0", false, false, false, 0},
      {L"45 30 15 5", false, false, false, 0},    {L"1e3", false, false, false, 0},
      {L"- 45", false, false, false, 0},          {L"", false, false, false, 0}};
  for (const auto& c : cases) {
    SCOPED_TRACE(CSvyString(c.text).ToNarrow());
    const CSvyString text(c.text);
    double dms = -777.0, dmm = -777.0, degree = -777.0;
    EXPECT_EQ(ParseDMS(text, dms), c.dms);
    EXPECT_EQ(ParseDMM(text, dmm), c.dmm);
    EXPECT_EQ(ParseDegree(text, degree), c.degree);
    EXPECT_TRUE(is_str_dmm(text) == c.dmm && is_str_degree(text) == c.degree);
    EXPECT_NEAR(dms, c.dms ? c.degrees : -777.0, 1e-12);
    EXPECT_NEAR(dmm, c.dmm ? c.degrees : -777.0, 1e-12);
    EXPECT_NEAR(degree, c.degree ? c.degrees : -777.0, 1e-12);
  }
}

// Written angles and bearings read back within half a unit of their last decimal.
TEST(AngleTextRoundTrip, WrittenFormsReadBack) {
  std::mt19937_64 random(17);
  std::uniform_real_distribution<double> angle(-720.0, 720.0);
  for (int i = 0; i < 3000; ++i) {
    const double degrees = angle(random);
    const int decimals = i % 5;
    const double unit = 0.5 * std::pow(10.0, -decimals);
    double read = 0.0;
    ASSERT_TRUE(StringToDegree(DMSToString(degrees, decimals), read));
    EXPECT_NEAR(read, degrees, unit / 3600.0 + 1e-11);
    ASSERT_TRUE(ParseDMM(DMMToString(degrees, decimals), read));
    EXPECT_NEAR(read, degrees, unit / 60.0 + 1e-11);
    ASSERT_TRUE(ParseDegree(DegreeToString(degrees, decimals), read));
    EXPECT_NEAR(read, degrees, unit + 1e-11);
    // A bearing is measured from the north or south point toward the east or west.
    const std::wstring text = DegreeToBearing(degrees, decimals % 4).str();
    wchar_t from = 0, toward = 0;
    int d = 0, m = 0;
    double s = 0.0;
    ASSERT_EQ(std::swscanf(text.c_str(), L"%lc %d\u00B0%d'%lf\" %lc", &from, &d, &m, &s, &toward), 5) << degrees;
    ASSERT_TRUE(m < 60 && s < 60.0);
    const double a = (toward == L'E' ? 1.0 : -1.0) * (d + m / 60.0 + s / 3600.0);
    EXPECT_LE(std::fabs(std::remainder((from == L'N' ? a : 180.0 - a) - degrees, 360.0)),
              0.5 * std::pow(10.0, -(decimals % 4)) / 3600.0 + 1e-12) << degrees;
  }
}

TEST(CheckValidDMSVal, AcceptsOnlyWellFormedFieldsWithinTheLimits) {
  struct { const wchar_t *text, *maxDegrees; bool allowMax, valid; } const cases[] = {
      {L"360.0000", L"360", true, true},     {L"360.0000", L"360", false, false}, {L"360.0001", L"360", true, false},
      {L"359.59599", L"360", false, true},   {L"0360", L"360", true, false},      {L"036", L"360", false, true},
      {L"90.0030", L"90", true, false},      {L"45.5", L"360", false, true},      {L"45.6", L"360", false, false},
      {L"45.3060", L"360", false, false},    {L"45.306", L"360", false, false},   {L"45.305", L"360", false, true},
      {L"45.30159999", L"360", false, true}, {L"-45.3015", L"360", false, true},  {L"  45,3015\t", L"360", false, true},
      {L"45-", L"360", false, false},        {L"45,30,15", L"360", false, false}, {L"45 30", L"360", false, false},
      {L"+45", L"360", false, false},        {L"   ", L"360", false, false},      {L"-", L"360", false, true}};
  for (const auto& c : cases)
    EXPECT_EQ(CheckValidDMSVal(CSvyString(c.text), CSvyString(c.maxDegrees), c.allowMax), c.valid)
        << CSvyString(c.text).ToNarrow();
}

}  // namespace
