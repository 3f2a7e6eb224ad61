#include "svyutils/round_prec.h"

#include <gtest/gtest.h>

#include <climits>
#include <cmath>
#include <cstdint>
#include <limits>
#include <random>

namespace {

using svy::math::round_prec;

constexpr double kMax = std::numeric_limits<double>::max();
constexpr double kDenormMin = std::numeric_limits<double>::denorm_min();

// Half away from zero: binary neighbours just below the written half still round up, as written. Extreme
// values and decimals end in range; special values pass through with their sign.
TEST(RoundPrec, RoundsHalfAwayFromZero) {
  const double cases[][3] = {{-2.675, 2, -2.68},    {1.005, 2, 1.01},     {1.0049999, 2, 1.0}, {999.9995, 3, 1000.0},
                             {-1250.0, -2, -1300.0}, {0.1 + 0.2, 15, 0.3}, {1.5e300, -300, 2e300},
                             {kMax, -293, kMax},  // the carry would pass the largest double
                             {kDenormMin, 2, 0.0},   {kDenormMin, 400, kDenormMin}};
  for (const auto& c : cases) EXPECT_EQ(round_prec(c[0], static_cast<int>(c[1])), c[2]) << c[0] << " " << c[1];
  EXPECT_EQ(round_prec(123.456, INT_MAX), 123.456);
  EXPECT_EQ(round_prec(123.456, INT_MIN), 0.0);
  EXPECT_TRUE(std::isnan(round_prec(std::numeric_limits<double>::quiet_NaN(), 2)));
  EXPECT_EQ(round_prec(-std::numeric_limits<double>::infinity(), -3), -std::numeric_limits<double>::infinity());
  EXPECT_TRUE(std::signbit(round_prec(-0.001, 2)));  // the sign of a value rounded to zero is kept
}

// Oracle in integer arithmetic: n thousandths rounded half away from zero to hundredths is
// (n +- 5) / 10 hundredths, and the nearest double of both decimals is a correctly rounded division.
TEST(RoundPrec, MatchesIntegerRoundingOfThousandths) {
  std::mt19937_64 random(7);
  std::uniform_int_distribution<std::int64_t> thousandths(-9'000'000'000'000LL, 9'000'000'000'000LL);
  for (int i = 0; i < 20000; ++i) {
    const std::int64_t n = i < 2000 ? i - 1000 : thousandths(random);
    const std::int64_t hundredths = (n + (n < 0 ? -5 : 5)) / 10;
    const double value = static_cast<double>(n) / 1000.0;
    const double expected = static_cast<double>(hundredths) / 100.0;
    ASSERT_EQ(round_prec(value, 2), expected) << n;
  }
}

}  // namespace
