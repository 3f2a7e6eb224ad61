#include "svymath/formats/angle_text.h"

#include <algorithm>
#include <cmath>
#include <cwchar>
#include <string>

#include "svymath/foundation/angle_functions.h"
#include "svyutils/round_prec.h"
#include "svyutils/svy_number_text.h"

namespace svy_formats {
namespace {

using svy_text::CSvyString;

// Fields read by the DMS, DMM and decimal-degree readers.
constexpr int kMaxFields = 3;
constexpr int kDmmFields = 2;
constexpr int kDegreeFields = 1;
constexpr int kMaxDecimals = 9;
constexpr double kMinutesPerDegree = 60.0;
constexpr double kSecondsPerDegree = 3600.0;
constexpr double kSixty = 60.0;
// The unit marks allowed after the degrees, minutes and seconds fields.
constexpr const wchar_t* kFieldMarks[kMaxFields] = {L"\u00B0dD", L"'\u2032mM", L"\"\u2033sS"};
constexpr const wchar_t* kBlanks = L" \t";

struct TAngleFields {
  bool negative = false;
  int count = 0;
  double value[kMaxFields] = {};
  bool fractional[kMaxFields] = {};
};

bool isDigit(wchar_t ch) { return ch >= L'0' && ch <= L'9'; }
bool isOneOf(wchar_t ch, const wchar_t* set) { return ch != L'\0' && std::wcschr(set, ch) != nullptr; }
bool isAnyMark(wchar_t ch) {
  return std::any_of(kFieldMarks, kFieldMarks + kMaxFields,
                     [ch](const wchar_t* set) { return isOneOf(ch, set); });
}

// Splits user angle text into at most maxFields unsigned numbers; see the header for the accepted forms.
bool splitAngleText(const CSvyString& text, int maxFields, TAngleFields& fields) {
  CSvyString work(text);
  ReplaceCommasWithDecPt(work);
  work.Trim();
  const std::wstring& s = work.str();
  std::size_t i = 0;
  if (i < s.size() && (s[i] == L'-' || s[i] == L'+')) fields.negative = s[i++] == L'-';
  while (i < s.size()) {
    if (fields.count == maxFields) return false;
    const std::size_t start = i;
    while (i < s.size() && isDigit(s[i])) ++i;
    const std::size_t point = i;
    if (i < s.size() && s[i] == L'.') {
      ++i;
      while (i < s.size() && isDigit(s[i])) ++i;
    }
    double value = 0.0;
    if (!StringToDouble(CSvyString(s.substr(start, i - start)), value)) return false;
    const int field = fields.count++;
    fields.value[field] = value;
    fields.fractional[field] = i > point + 1;
    // A separator must follow unless the text ends: blanks, then this field's mark or a colon, then blanks.
    const std::size_t end = i;
    while (i < s.size() && isOneOf(s[i], kBlanks)) ++i;
    if (i < s.size() && isAnyMark(s[i])) {
      if (!isOneOf(s[i], kFieldMarks[field])) return false;
      ++i;
    } else if (i < s.size() && s[i] == L':') {
      ++i;
    }
    while (i < s.size() && isOneOf(s[i], kBlanks)) ++i;
    if (i == end && i < s.size()) return false;
  }
  if (fields.count == 0) return false;
  for (int k = 0; k + 1 < fields.count; ++k) {
    if (fields.fractional[k]) return false;
  }
  for (int k = 1; k < fields.count; ++k) {
    if (!(fields.value[k] < kSixty)) return false;
  }
  return true;
}

bool parseFields(const CSvyString& text, int maxFields, double& degrees) {
  TAngleFields fields;
  if (!splitAngleText(text, maxFields, fields)) return false;
  const double magnitude =
      fields.value[0] + fields.value[1] / kMinutesPerDegree + fields.value[2] / kSecondsPerDegree;
  degrees = fields.negative ? -magnitude : magnitude;
  return true;
}

int clampedDecimals(int decimals) { return std::clamp(decimals, 0, kMaxDecimals); }

// The last field with two integer digits: "05.25".
CSvyString paddedField(double value, int decimals) {
  const CSvyString digits = DoubleToString(value, decimals);
  return value < 10.0 ? CSvyString(L"0") + digits : digits;
}

}  // namespace

CSvyString DMSToString(double degrees, int secondDecimals) {
  if (!std::isfinite(degrees)) return CSvyString();
  const int decimals = clampedDecimals(secondDecimals);
  bool negative = false;
  int d = 0;
  int m = 0;
  double s = 0.0;
  Deg2DDDMMSS(degrees, negative, d, m, s, decimals);
  if (std::isnan(s)) return CSvyString();
  CSvyString text;
  text.Format(L"%ls%d\u00B0%02d'%ls\"", negative ? L"-" : L"", d, m, paddedField(s, decimals).c_str());
  return text;
}

CSvyString DMMToString(double degrees, int minuteDecimals) {
  if (!std::isfinite(degrees)) return CSvyString();
  const int decimals = clampedDecimals(minuteDecimals);
  // Rounded on the total minutes, so the minutes never reach 60.
  const double total = svy::math::round_prec(std::fabs(degrees) * kMinutesPerDegree, decimals);
  const double d = std::floor(total / kMinutesPerDegree);
  const double m = std::fmod(total, kMinutesPerDegree);
  CSvyString text;
  text.Format(L"%ls%.0f\u00B0%ls'", degrees < 0 && total > 0 ? L"-" : L"", d,
              paddedField(m, decimals).c_str());
  return text;
}

CSvyString DegreeToString(double degrees, int decimals) {
  if (!std::isfinite(degrees)) return CSvyString();
  return DoubleToString(degrees, clampedDecimals(decimals)) + L"\u00B0";
}

bool ParseDMS(const CSvyString& text, double& degrees) { return parseFields(text, kMaxFields, degrees); }

bool ParseDMM(const CSvyString& text, double& degrees) { return parseFields(text, kDmmFields, degrees); }

bool ParseDegree(const CSvyString& text, double& degrees) {
  return parseFields(text, kDegreeFields, degrees);
}

bool StringToDegree(const CSvyString& text, double& degrees) { return ParseDMS(text, degrees); }

bool is_str_degree(const CSvyString& text) {
  double degrees = 0.0;
  return ParseDegree(text, degrees);
}

bool is_str_dmm(const CSvyString& text) {
  double degrees = 0.0;
  return ParseDMM(text, degrees);
}

}  // namespace svy_formats
