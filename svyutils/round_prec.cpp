#include "svyutils/round_prec.h"

#include <cmath>

#include "svyutils/decimal_digits.h"

namespace svy {
namespace math {

double round_prec(double value, int decimals) {
  if (!std::isfinite(value)) return value;
  detail::TDecimal number = detail::shortestDecimal(value);
  detail::roundDecimal(number, decimals);
  double rounded = value;
  // A carry beyond the largest double leaves the value as it was: it is the nearest representable one.
  return detail::decimalToDouble(number, rounded) ? rounded : value;
}

}  // namespace math
}  // namespace svy
