#include "svymath/formats/degree_display_text.h"

#include <algorithm>
#include <cmath>
#include <cwchar>
#include <string>

#include "svymath/formats/angle_text.h"
#include "svymath/formats/sign_strings.h"
#include "svymath/foundation/angle_functions.h"
#include "svymath/foundation/constants.h"
#include "svyutils/svy_number_text.h"

namespace svy_formats {
namespace {

using svy_text::CSvyString;

constexpr int kMaxDecimals = 9;
// Two digits of minutes (and of whole seconds) in the packed forms.
constexpr std::size_t kPackedFieldDigits = 2;
// Marks of degrees accepted after a number.
constexpr const wchar_t* kDegreeMarks = L"\u00B0dD";
constexpr const wchar_t* kBlanks = L" \t";

int clampedDecimals(int decimals) { return std::clamp(decimals, 0, kMaxDecimals); }

bool isDigits(const std::wstring& text) {
  return std::all_of(text.begin(), text.end(), [](wchar_t ch) { return ch >= L'0' && ch <= L'9'; });
}

// The seconds of a packed DDD.MMSS text: whole seconds as two digits, then their decimals, without a point
// ("0525" for 5.25 seconds written with 2 decimals).
std::wstring packedSecondsDigits(double seconds, int decimals) {
  std::wstring digits = DoubleToString(seconds, decimals).str();
  digits.erase(std::remove(digits.begin(), digits.end(), L'.'), digits.end());
  const std::size_t width = kPackedFieldDigits + static_cast<std::size_t>(decimals);
  if (digits.size() < width) digits.insert(0, width - digits.size(), L'0');
  return digits;
}

CSvyString packedDmsText(double degrees, int secondDecimals) {
  bool negative = false;
  int d = 0;
  int m = 0;
  double s = 0.0;
  Deg2DDDMMSS(degrees, negative, d, m, s, secondDecimals);
  if (std::isnan(s)) return CSvyString();
  CSvyString text;
  text.Format(L"%ls%d%ls%02d%ls%ls", negative ? L"-" : L"", d, DecimalSignString().c_str(), m,
              packedSecondsDigits(s, secondDecimals).c_str(), DegreeSignString().c_str());
  return text;
}

}  // namespace

CSvyString DegreeToStringEx(double degrees, int decimals, unsigned flags) {
  if (!std::isfinite(degrees)) return CSvyString();
  CSvyString text = ConvertFloatEx(degrees, clampedDecimals(decimals), flags | eFloatTextNoGrouping);
  if ((flags & eFloatTextNoDegreeSign) == 0) text += DegreeSignString();
  return text;
}

CSvyString DegreesToString(double degrees, int decimals) { return DegreeToString(degrees, decimals); }

CSvyString DegreesToString(double degrees, EDegreeTextForm form, int decimals) {
  if (!std::isfinite(degrees)) return CSvyString();
  if (form == eDegreeTextPackedDMS) return packedDmsText(degrees, clampedDecimals(decimals));
  return DegreeToString(degrees, decimals);
}

bool FromStringDMM(const CSvyString& text, double& degrees) {
  CSvyString work(text);
  ReplaceCommasWithDecPt(work);
  work.Trim();
  CheckDegreeSuffix(work);
  std::wstring s = work.str();
  const bool negative = !s.empty() && s[0] == L'-';
  if (!s.empty() && (s[0] == L'-' || s[0] == L'+')) s.erase(0, 1);
  const std::size_t point = s.find(L'.');
  const std::wstring whole = s.substr(0, point);
  std::wstring minutes = point == std::wstring::npos ? std::wstring() : s.substr(point + 1);
  if (whole.empty() || !isDigits(whole) || !isDigits(minutes)) return false;
  // "5" is 50 minutes; the digits after the first two are decimals of minutes.
  if (minutes.size() < kPackedFieldDigits) minutes.resize(kPackedFieldDigits, L'0');
  minutes.insert(kPackedFieldDigits, 1, L'.');
  double d = 0.0;
  double m = 0.0;
  if (!StringToDouble(CSvyString(whole), d) || !StringToDouble(CSvyString(minutes), m)) return false;
  if (!(m < svy_math::units::kArcMinutesPerDegree)) return false;
  const double magnitude = d + m / svy_math::units::kArcMinutesPerDegree;
  degrees = negative ? -magnitude : magnitude;
  return true;
}

bool CheckDegreeSuffix(CSvyString& text) {
  CSvyString work(text);
  work.TrimRight(kBlanks);
  if (work.IsEmpty() || std::wcschr(kDegreeMarks, work.GetAt(work.GetLength() - 1)) == nullptr) return false;
  work.Delete(work.GetLength() - 1);
  text = work.TrimRight(kBlanks);
  return true;
}

}  // namespace svy_formats
