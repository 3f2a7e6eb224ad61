#include "svymath/formats/dms_text.h"

#include "svyutils/svy_number_text.h"

namespace {

using svy_text::CSvyString;

// Minutes and seconds are two-digit fields.
constexpr int kFieldWidth = 2;

bool onlyDigitsAndOnePoint(const CSvyString& text) {
  int points = 0;
  for (int i = 0; i < text.GetLength(); ++i) {
    const wchar_t ch = text.GetAt(i);
    if (ch == L'.') {
      if (++points > 1) return false;
    } else if (ch < L'0' || ch > L'9') {
      return false;
    }
  }
  return true;
}

// A minutes or seconds field, right-padded with '0' ("5" is 50), compared with its limit as text.
bool fieldWithinLimit(CSvyString field, const CSvyString& limit) {
  while (field.GetLength() < kFieldWidth) field += L'0';
  return field.CompareNoCase(limit.c_str()) <= 0;
}

}  // namespace

bool CheckValidDMSVal(const CSvyString& text, const CSvyString& maxDegrees, bool allowMax) {
  CSvyString work(text);
  svy_formats::ReplaceCommasWithDecPt(work);
  work.Trim();
  if (work.IsEmpty()) return false;
  if (work.GetAt(0) == L'-') work.Delete(0);
  if (!onlyDigitsAndOnePoint(work)) return false;

  const int point = work.Find(L'.');
  CSvyString degrees = point < 0 ? work : work.Left(point);
  const int padding = maxDegrees.GetLength() - degrees.GetLength();
  if (padding < 0) return false;
  degrees.Insert(0, CSvyString(L' ', padding).c_str());
  const int order = degrees.CompareNoCase(maxDegrees.c_str());
  if (order > 0) return false;
  if (order == 0 && !allowMax) return false;
  // Nothing may follow the maximum itself.
  const CSvyString limit(order == 0 ? L"00" : L"59");

  const CSvyString rest = point < 0 ? CSvyString() : work.Mid(point + 1);
  if (!fieldWithinLimit(rest.Left(kFieldWidth), limit)) return false;
  if (rest.GetLength() > kFieldWidth && !fieldWithinLimit(rest.Mid(kFieldWidth, kFieldWidth), limit)) {
    return false;
  }
  return true;
}
