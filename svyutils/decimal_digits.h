#pragma once
// Internal: a finite double as the shortest decimal that reads back as the same double, and the decimal
// rounding of that form. round_prec and DoubleToString share it, so that a number rounds and prints the
// way it is written (2.675 is "2.675", not 2.67499999999999982236431605997495353221893310546875).
// Works in fixed buffers: no allocation.

namespace svy {
namespace math {
namespace detail {

// The value is (-1 if negative) x 0.d1d2d3... x 10^(pointPos): `digits` holds `count` decimal digit
// characters with no leading or trailing zeros, and pointPos is the count of digits before the decimal
// point (negative or zero for values below 0.1). Zero has no digits and pointPos 0.
struct TDecimal {
  // The shortest round-trip form of a double has at most 17 significant digits.
  static constexpr int kMaxDigits = 17;
  bool negative = false;
  char digits[kMaxDigits] = {};
  int count = 0;
  long long pointPos = 0;

  // The digit at a position counted from the first significant one; '0' outside the digits.
  char digitAt(long long index) const { return index >= 0 && index < count ? digits[index] : '0'; }
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
