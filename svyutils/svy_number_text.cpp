#include "svyutils/svy_number_text.h"

#include <locale.h>

#include <algorithm>
#include <charconv>
#include <clocale>
#include <cmath>
#include <string>
#include <system_error>

#include "svyutils/decimal_digits.h"

namespace svy_formats {
namespace {

constexpr const wchar_t* kBlanks = L" \t\n\r\v\f";
// The largest number of decimals DoubleToString prints: beyond 17 a double has no more digits to show.
constexpr int kMaxDecimals = 17;

bool isDigit(char ch) { return ch >= '0' && ch <= '9'; }

// The text without surrounding blanks as ASCII; false when any other character is not ASCII.
bool trimmedAscii(const svy_text::CSvyString& text, std::string& ascii) {
  const std::wstring& wide = text.str();
  const std::size_t first = wide.find_first_not_of(kBlanks);
  if (first == std::wstring::npos) return false;
  const std::size_t last = wide.find_last_not_of(kBlanks);
  ascii.clear();
  for (std::size_t i = first; i <= last; ++i) {
    if (wide[i] < 0 || wide[i] > 0x7F) return false;
    ascii += static_cast<char>(wide[i]);
  }
  return true;
}

std::size_t skipDigits(const std::string& text, std::size_t pos) {
  while (pos < text.size() && isDigit(text[pos])) ++pos;
  return pos;
}

// True when text is a decimal number: [sign] (digits [. [digits]] | . digits) [(e|E) [sign] digits].
bool isDecimalNumber(const std::string& text) {
  std::size_t pos = (text[0] == '+' || text[0] == '-') ? 1 : 0;
  const std::size_t intEnd = skipDigits(text, pos);
  std::size_t mantissaDigits = intEnd - pos;
  pos = intEnd;
  if (pos < text.size() && text[pos] == '.') {
    const std::size_t fracEnd = skipDigits(text, pos + 1);
    mantissaDigits += fracEnd - pos - 1;
    pos = fracEnd;
  }
  if (mantissaDigits == 0) return false;
  if (pos < text.size() && (text[pos] == 'e' || text[pos] == 'E')) {
    ++pos;
    if (pos < text.size() && (text[pos] == '+' || text[pos] == '-')) ++pos;
    const std::size_t expEnd = skipDigits(text, pos);
    if (expEnd == pos) return false;
    pos = expEnd;
  }
  return pos == text.size();
}

// std::from_chars reads no leading '+'.
const char* withoutPlus(const std::string& text) { return text.data() + (text[0] == '+' ? 1 : 0); }

locale_t cLocaleHandle() {
  static const locale_t handle = newlocale(LC_ALL_MASK, "C", static_cast<locale_t>(nullptr));
  return handle;
}

std::string fixedText(const svy::math::detail::TDecimal& number, int decimals) {
  std::string text = number.negative && number.count > 0 ? "-" : "";
  if (number.pointPos <= 0) {
    text += '0';
  } else {
    for (long long i = 0; i < number.pointPos; ++i) text += number.digitAt(i);
  }
  if (decimals > 0) {
    text += '.';
    for (long long i = 0; i < decimals; ++i) text += number.digitAt(number.pointPos + i);
  }
  return text;
}

}  // namespace

bool StringToInt(const svy_text::CSvyString& text, int& value) {
  std::string ascii;
  if (!trimmedAscii(text, ascii)) return false;
  const std::size_t start = (ascii[0] == '+' || ascii[0] == '-') ? 1 : 0;
  if (start == ascii.size() || skipDigits(ascii, start) != ascii.size()) return false;
  int parsed = 0;
  const auto result = std::from_chars(withoutPlus(ascii), ascii.data() + ascii.size(), parsed);
  if (result.ec != std::errc() || result.ptr != ascii.data() + ascii.size()) return false;
  value = parsed;
  return true;
}

bool StringToDouble(const svy_text::CSvyString& text, double& value) {
  std::string ascii;
  if (!trimmedAscii(text, ascii) || !isDecimalNumber(ascii)) return false;
  double parsed = 0.0;
  const auto result = std::from_chars(withoutPlus(ascii), ascii.data() + ascii.size(), parsed);
  if (result.ec != std::errc() || result.ptr != ascii.data() + ascii.size() || !std::isfinite(parsed)) {
    return false;
  }
  value = parsed;
  return true;
}

svy_text::CSvyString DoubleToString(double value, int decimals) {
  if (std::isnan(value)) return svy_text::CSvyString(L"nan");
  if (std::isinf(value)) return svy_text::CSvyString(value > 0 ? L"inf" : L"-inf");
  const int places = std::min(decimals, kMaxDecimals);
  svy::math::detail::TDecimal number = svy::math::detail::shortestDecimal(value);
  svy::math::detail::roundDecimal(number, places);
  return svy_text::CSvyString(fixedText(number, places).c_str(), svy_text::kCodePageCLocale);
}

void ReplaceCommasWithDecPt(svy_text::CSvyString& text) { text.Replace(L',', L'.'); }

const std::locale& GetCLocale() { return std::locale::classic(); }

CScopedCLocale::CScopedCLocale() : previous_(uselocale(cLocaleHandle())) {}

CScopedCLocale::~CScopedCLocale() { uselocale(static_cast<locale_t>(previous_)); }

}  // namespace svy_formats
