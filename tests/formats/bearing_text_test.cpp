#include "svymath/formats/bearing_text.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cwchar>
#include <limits>
#include <random>
#include <string>

namespace {

using svy_formats::DegreeToBearing;

TEST(DegreeToBearing, QuadrantLettersPaddedFieldsAndNonFiniteInput) {
  struct {
    double azimuth;
    int decimals;
    const wchar_t* text;
  } const cases[] = {
      {0.0, 0, L"N 0\u00B000'00\" E"},    {90.0, 1, L"N 90\u00B000'00.0\" E"}, {180.0, 0, L"S 0\u00B000'00\" E"},
      {270.0, 0, L"N 90\u00B000'00\" W"}, {-45.0, 0, L"N 45\u00B000'00\" W"},  {405.0, 0, L"N 45\u00B000'00\" E"},
      {135.5, 0, L"S 44\u00B030'00\" E"}, {192.0 + 5.0 / 60, 0, L"S 12\u00B005'00\" W"},
      {10.0 + 59.0 / 60 + 59.96 / 3600, 1, L"N 11\u00B000'00.0\" E"},  // carry
      {30.0, -2, L"N 30\u00B000'00\" E"}};
  for (const auto& c : cases) {
    SCOPED_TRACE(::testing::Message() << c.azimuth << " decimals " << c.decimals);
    EXPECT_EQ(DegreeToBearing(c.azimuth, c.decimals).str(), c.text);
  }
  EXPECT_TRUE(DegreeToBearing(std::numeric_limits<double>::quiet_NaN(), 0).IsEmpty());
  EXPECT_TRUE(DegreeToBearing(std::numeric_limits<double>::infinity(), 0).IsEmpty());
}

// The bearing read back (letters, degrees, minutes, seconds) gives the azimuth within half a unit of the
// last written decimal of the seconds.
TEST(DegreeToBearing, ReadsBackToTheAzimuth) {
  std::mt19937_64 random(5);
  std::uniform_real_distribution<double> azimuth(0.0, 360.0);
  for (int i = 0; i < 3000; ++i) {
    const double az = azimuth(random);
    const int decimals = i % 4;
    const std::wstring text = DegreeToBearing(az, decimals).str();
    wchar_t from = 0, toward = 0;
    int d = 0, m = 0;
    double s = 0.0;
    ASSERT_EQ(std::swscanf(text.c_str(), L"%lc %d\u00B0%d'%lf\" %lc", &from, &d, &m, &s, &toward), 5) << az;
    ASSERT_LT(m, 60);
    ASSERT_LT(s, 60.0);
    // Measured from the north or south point toward the east or west.
    const double angle = (toward == L'E' ? 1.0 : -1.0) * (d + m / 60.0 + s / 3600.0);
    const double back = from == L'N' ? angle : 180.0 - angle;
    const double diff = std::fabs(std::remainder(back - az, 360.0));
    EXPECT_LE(diff, 0.5 * std::pow(10.0, -decimals) / 3600.0 + 1e-12) << az << " " << decimals;
  }
}

}  // namespace
