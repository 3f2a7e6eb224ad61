#include "svymath/formats/number_display_text.h"

#include <cmath>
#include <string>

#include "svymath/formats/sign_strings.h"
#include "svyutils/svy_number_text.h"

namespace svy_formats {
namespace {

// Digits between two thousands signs.
constexpr std::size_t kGroupSize = 3;

bool hasFlag(unsigned flags, EFloatTextFlags flag) { return (flags & flag) != 0; }

std::wstring grouped(const std::wstring& whole) {
  const std::wstring thousands = ThousandSignString().str();
  std::wstring text;
  for (std::size_t i = 0; i < whole.size(); ++i) {
    if (i != 0 && (whole.size() - i) % kGroupSize == 0) text += thousands;
    text += whole[i];
  }
  return text;
}

}  // namespace

svy_text::CSvyString ConvertFloat(double value, int decimals) {
  return ConvertFloatEx(value, decimals, eFloatTextPlain);
}

svy_text::CSvyString ConvertFloatEx(double value, int decimals, unsigned flags) {
  if (!std::isfinite(value)) return svy_text::CSvyString();
  // The C-locale digits, "-1234.50", split into sign, whole part and decimals.
  std::wstring digits = DoubleToString(value, decimals).str();
  const bool negative = !digits.empty() && digits[0] == L'-';
  if (negative) digits.erase(0, 1);
  const std::size_t point = digits.find(L'.');
  std::wstring whole = digits.substr(0, point);
  std::wstring fraction = point == std::wstring::npos ? std::wstring() : digits.substr(point + 1);
  const bool zero = digits.find_first_not_of(L"0.") == std::wstring::npos;

  if (hasFlag(flags, eFloatTextTrimZeros)) fraction.erase(fraction.find_last_not_of(L'0') + 1);
  if (!hasFlag(flags, eFloatTextNoGrouping)) whole = grouped(whole);

  std::wstring text;
  if (negative) {
    text = L"-";
  } else if (hasFlag(flags, eFloatTextPlusSign) && !zero) {
    text = L"+";
  }
  text += whole;
  if (!fraction.empty()) text += DecimalSignString().str() + fraction;
  return svy_text::CSvyString(text);
}

}  // namespace svy_formats
