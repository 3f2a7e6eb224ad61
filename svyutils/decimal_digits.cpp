#include "svyutils/decimal_digits.h"

#include <charconv>
#include <cmath>
#include <system_error>

namespace svy {
namespace math {
namespace detail {
namespace {

// Room for the shortest scientific form of any double: sign, 17 digits, point, 'e', sign, 3 digits.
constexpr int kScientificBufferSize = 32;

}  // namespace

TDecimal shortestDecimal(double value) {
  TDecimal number;
  number.negative = std::signbit(value);
  if (value == 0.0) return number;
  char buffer[kScientificBufferSize];
  const auto written = std::to_chars(buffer, buffer + kScientificBufferSize, std::fabs(value),
                                     std::chars_format::scientific);
  // "d.ddde+XX" or "de+XX": the digits around the point, then the exponent of the first digit.
  const char* p = buffer;
  for (; p != written.ptr && *p != 'e'; ++p) {
    if (*p != '.') number.digits += *p;
  }
  // The exponent follows 'e' with its sign; the buffer has no terminating zero.
  const bool negativeExponent = p + 1 != written.ptr && p[1] == '-';
  long long exponent = 0;
  std::from_chars(p + 2, written.ptr, exponent);
  number.pointPos = (negativeExponent ? -exponent : exponent) + 1;
  while (!number.digits.empty() && number.digits.back() == '0') number.digits.pop_back();
  return number;
}

void roundDecimal(TDecimal& number, int decimals) {
  const long long keep = number.pointPos + decimals;
  const long long count = static_cast<long long>(number.digits.size());
  if (keep >= count) return;
  if (keep < 0 || (keep == 0 && number.digits[0] < '5')) {
    number.digits.clear();
    number.pointPos = 0;
    return;
  }
  const bool up = number.digits[static_cast<std::size_t>(keep)] >= '5';
  number.digits.resize(static_cast<std::size_t>(keep));
  if (up) {
    // Carry from the last kept digit; all nines become a single one a place further left.
    std::size_t i = number.digits.size();
    while (i > 0 && number.digits[i - 1] == '9') number.digits[--i] = '0';
    if (i == 0) {
      number.digits.insert(number.digits.begin(), '1');
      ++number.pointPos;
    } else {
      ++number.digits[i - 1];
    }
  }
  while (!number.digits.empty() && number.digits.back() == '0') number.digits.pop_back();
}

bool decimalToDouble(const TDecimal& number, double& value) {
  if (number.digits.empty()) {
    value = number.negative ? -0.0 : 0.0;
    return true;
  }
  const std::string text = (number.negative ? "-0." : "0.") + number.digits + "e" +
                           std::to_string(number.pointPos);
  double parsed = 0.0;
  const auto result = std::from_chars(text.data(), text.data() + text.size(), parsed);
  if (result.ec != std::errc()) return false;
  value = parsed;
  return true;
}

}  // namespace detail
}  // namespace math
}  // namespace svy
