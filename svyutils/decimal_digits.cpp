#include "svyutils/decimal_digits.h"

#include <charconv>
#include <cmath>
#include <system_error>

namespace svy {
namespace math {
namespace detail {
namespace {

// Room for the shortest scientific form of any double: sign, 17 digits, point, 'e', sign, 3 digits; and
// for "-0.<17 digits>e<20 digit exponent>" when reading a decimal back.
constexpr int kTextBufferSize = 48;

void dropTrailingZeros(TDecimal& number) {
  while (number.count > 0 && number.digits[number.count - 1] == '0') --number.count;
  if (number.count == 0) number.pointPos = 0;
}

}  // namespace

TDecimal shortestDecimal(double value) {
  TDecimal number;
  number.negative = std::signbit(value);
  if (value == 0.0) return number;
  char buffer[kTextBufferSize];
  const auto written =
      std::to_chars(buffer, buffer + kTextBufferSize, std::fabs(value), std::chars_format::scientific);
  // "d.ddde+XX" or "de-XX": the digits around the point, then the exponent of the first digit.
  const char* p = buffer;
  for (; p != written.ptr && *p != 'e'; ++p) {
    if (*p != '.' && number.count < TDecimal::kMaxDigits) number.digits[number.count++] = *p;
  }
  // The exponent follows 'e' with its sign; the buffer has no terminating zero.
  long long exponent = 0;
  if (p != written.ptr && p + 1 != written.ptr) {
    std::from_chars(p + 2, written.ptr, exponent);
    if (p[1] == '-') exponent = -exponent;
  }
  number.pointPos = exponent + 1;
  dropTrailingZeros(number);
  return number;
}

void roundDecimal(TDecimal& number, int decimals) {
  const long long keep = number.pointPos + decimals;
  if (keep >= number.count) return;
  if (keep < 0 || (keep == 0 && number.digits[0] < '5')) {
    number.count = 0;
    number.pointPos = 0;
    return;
  }
  const bool up = number.digits[keep] >= '5';
  number.count = static_cast<int>(keep);
  if (up) {
    // Carry from the last kept digit; all nines become a single one a place further left.
    int i = number.count;
    while (i > 0 && number.digits[i - 1] == '9') number.digits[--i] = '0';
    if (i == 0) {
      number.digits[0] = '1';
      number.count = 1;
      ++number.pointPos;
    } else {
      ++number.digits[i - 1];
    }
  }
  dropTrailingZeros(number);
}

bool decimalToDouble(const TDecimal& number, double& value) {
  if (number.count == 0) {
    value = number.negative ? -0.0 : 0.0;
    return true;
  }
  // "-0.<digits>e<pointPos>"
  char text[kTextBufferSize];
  char* out = text;
  if (number.negative) *out++ = '-';
  *out++ = '0';
  *out++ = '.';
  for (int i = 0; i < number.count; ++i) *out++ = number.digits[i];
  *out++ = 'e';
  out = std::to_chars(out, text + kTextBufferSize, number.pointPos).ptr;
  double parsed = 0.0;
  const auto result = std::from_chars(text, out, parsed);
  if (result.ec != std::errc()) return false;
  value = parsed;
  return true;
}

}  // namespace detail
}  // namespace math
}  // namespace svy
