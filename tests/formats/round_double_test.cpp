#include "svymath/formats/round_double.h"

#include <gtest/gtest.h>

#include <climits>
#include <cmath>
#include <limits>

namespace {

using svy_formats::RoundDouble;

TEST(RoundDouble, AddsHalfAUnitWithTheSignOfXAndEndsOnExtremes) {
  struct {
    double x;
    int digits;
    double expected;
  } const cases[] = {{0.0, 2, -0.005},  // zero takes the negative branch
                     {1.234, 2, 1.239}, {-2.5, 0, -3.0}, {-1234.0, -2, -1284.0}, {7.0, -1, 12.0}};
  for (const auto& c : cases) {
    SCOPED_TRACE(::testing::Message() << c.x << " digits " << c.digits);
    EXPECT_NEAR(RoundDouble(c.x, c.digits), c.expected, 1e-15 * (1.0 + std::fabs(c.expected)));
  }
  // The half unit formed by squaring agrees with the power function over the usable range of digits.
  for (int digits = -20; digits <= 20; ++digits) {
    const double half = RoundDouble(1.0, digits) - 1.0;
    const double expected = 0.5 * std::pow(10.0, -digits);
    EXPECT_NEAR(half, expected, 1e-15 * expected + 2.3e-16) << digits;
  }
  // Extreme digits and non-finite values end without a trap.
  EXPECT_EQ(RoundDouble(3.0, INT_MAX), 3.0);  // the half unit underflows to zero
  EXPECT_TRUE(std::isinf(RoundDouble(3.0, INT_MIN)));
  EXPECT_TRUE(std::isnan(RoundDouble(std::numeric_limits<double>::quiet_NaN(), 2)));
  EXPECT_EQ(RoundDouble(-std::numeric_limits<double>::infinity(), 2), -std::numeric_limits<double>::infinity());
}

// With a truncating conversion it gives the nearest count of units for values away from the half.
TEST(RoundDouble, TruncationAfterItRoundsToTheNearestUnit) {
  for (int cents = -100000; cents <= 100000; cents += 7) {
    for (double frac : {0.2, 0.45, 0.55, 0.8}) {
      const double x = (cents + (cents < 0 ? -frac : frac)) / 100.0;
      const long truncated = static_cast<long>(RoundDouble(x, 2) * 100.0);
      const long nearest = std::lround(x * 100.0);
      ASSERT_EQ(truncated, nearest) << x;
    }
  }
}

}  // namespace
