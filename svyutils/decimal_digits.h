#pragma once
// Internal: a finite double as the shortest decimal that reads back as the same double, and the decimal
// rounding of that form. round_prec and DoubleToString share it, so that a number rounds and prints the
// way it is written (2.675 is "2.675", not 2.67499999999999982236431605997495353221893310546875).
#include <string>

namespace svy {
namespace math {
namespace detail {

// The value is (-1 if negative) x 0.d1d2d3... x 10^(pointPos): `digits` holds no leading zeros, and
// pointPos is the count of digits before the decimal point (negative or zero for values below 0.1).
// Zero has no digits.
struct TDecimal {
  bool negative = false;
  std::string digits;
  long long pointPos = 0;
};

// The shortest round-trip decimal of a finite value.
TDecimal shortestDecimal(double value);
// Rounds half away from zero to `decimals` digits after the point (negative: before it).
void roundDecimal(TDecimal& number, int decimals);
// The nearest double; false when it is beyond the range of double.
bool decimalToDouble(const TDecimal& number, double& value);

}  // namespace detail
}  // namespace math
}  // namespace svy
