#include "svymath/formats/round_double.h"

namespace svy_formats {
namespace {

// base^exponent by repeated squaring: about log2(exponent) products, so any int exponent is quick.
double powerBySquaring(double base, unsigned exponent) {
  double result = 1.0;
  while (exponent != 0) {
    if ((exponent & 1U) != 0) result *= base;
    base *= base;
    exponent >>= 1U;
  }
  return result;
}

}  // namespace

double RoundDouble(double x, int digits) {
  // The magnitude of digits as unsigned, well defined for INT_MIN too.
  const unsigned magnitude = digits < 0 ? 0U - static_cast<unsigned>(digits) : static_cast<unsigned>(digits);
  const double unit = digits >= 0 ? powerBySquaring(0.1, magnitude) : powerBySquaring(10.0, magnitude);
  const double half = 0.5 * unit;
  return x > 0 ? x + half : x - half;
}

}  // namespace svy_formats
