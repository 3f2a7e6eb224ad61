#include "svymath/formats/integer_text.h"

#include <algorithm>
#include <limits>
#include <string>

namespace svy_formats {
namespace {

constexpr int kMaxBits = 64;
constexpr int kMinBase = 2;
constexpr int kMaxBase = 10;
constexpr unsigned long long kMaxMagnitude = std::numeric_limits<long long>::max();

// magnitude * base + digit, false when it would pass kMaxMagnitude.
bool appendDigit(unsigned long long& magnitude, int base, int digit) {
  const auto b = static_cast<unsigned long long>(base);
  const auto d = static_cast<unsigned long long>(digit);
  if (magnitude > (kMaxMagnitude - d) / b) return false;
  magnitude = magnitude * b + d;
  return true;
}

}  // namespace

svy_text::CSvyString bin_to_str(std::uint64_t value, int width) {
  std::wstring bits;
  for (std::uint64_t rest = value; rest != 0; rest >>= 1U) bits += (rest & 1U) != 0 ? L'1' : L'0';
  const int digits = std::max({static_cast<int>(bits.size()), std::min(width, kMaxBits), 1});
  bits.resize(static_cast<std::size_t>(digits), L'0');
  std::reverse(bits.begin(), bits.end());
  return svy_text::CSvyString(bits);
}

bool int_to_int(long long value, int fromBase, int toBase, long long& result) {
  if (fromBase < kMinBase || fromBase > kMaxBase || toBase < kMinBase || toBase > kMaxBase) return false;
  // The magnitude as unsigned, well defined for LLONG_MIN too.
  const unsigned long long magnitude =
      value < 0 ? 0ULL - static_cast<unsigned long long>(value) : static_cast<unsigned long long>(value);
  // The decimal digits of value, read as digits in fromBase.
  std::string digits = std::to_string(magnitude);
  unsigned long long number = 0;
  for (const char ch : digits) {
    const int digit = ch - '0';
    if (digit >= fromBase || !appendDigit(number, fromBase, digit)) return false;
  }
  // The number's digits in toBase, written as decimal digits.
  digits.clear();
  for (unsigned long long rest = number; rest != 0; rest /= static_cast<unsigned long long>(toBase))
    digits += static_cast<char>('0' + rest % static_cast<unsigned long long>(toBase));
  unsigned long long written = 0;
  for (auto it = digits.rbegin(); it != digits.rend(); ++it) {
    if (!appendDigit(written, kMaxBase, *it - '0')) return false;
  }
  result = value < 0 ? -static_cast<long long>(written) : static_cast<long long>(written);
  return true;
}

}  // namespace svy_formats
