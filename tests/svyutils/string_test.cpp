#include <gtest/gtest.h>

#include <string>
#include <utility>

#include "svyutils/svy_string.h"

namespace {

using svy_text::CSvyString;
using svy_text::kCodePageCLocale;
using svy_text::kCodePageUtf8;

// Well-formed UTF-8 decodes and encodes back; each malformed byte (stray continuation, truncated, overlong,
// encoded surrogate, beyond U+10FFFF) becomes one replacement character. The C locale maps bytes to code
// points one to one and writes '?' for what it cannot encode.
TEST(SvyStringCodePages, Utf8RoundTripsReplacesMalformedBytesAndCLocaleMapsBytes) {
  const std::pair<const char*, std::wstring> cases[] = {
      {"45\xC2\xB0" "30'", L"45\u00B030'"}, {"\xE2\x82\xAC 5", L"\u20AC 5"}, {"\xF0\x9D\x84\x9E", L"\U0001D11E"},
      {"a\x80" "b", L"a\uFFFDb"}, {"a\xC3", L"a\uFFFD"}, {"\xC0\xAF", L"\uFFFD\uFFFD"},
      {"\xED\xA0\x80", L"\uFFFD\uFFFD\uFFFD"}, {"\xF4\x90\x80\x80", L"\uFFFD\uFFFD\uFFFD\uFFFD"}};
  for (const auto& c : cases) {
    const CSvyString text(c.first, kCodePageUtf8);
    EXPECT_EQ(text.str(), c.second) << c.first;
    if (c.second.find(L'\uFFFD') == std::wstring::npos) {
      EXPECT_EQ(text.ToNarrow(kCodePageUtf8), c.first);
    }
  }
  std::string bytes;
  for (int b = 1; b < 256; ++b) bytes += static_cast<char>(b);
  const CSvyString text(bytes.c_str(), kCodePageCLocale);
  ASSERT_EQ(text.GetLength(), 255);
  for (int i = 0; i < 255; ++i) EXPECT_EQ(static_cast<int>(text.GetAt(i)), i + 1);
  EXPECT_EQ(text.ToNarrow(kCodePageCLocale), bytes);
  EXPECT_EQ(CSvyString(L"a\u20ACb").ToNarrow(kCodePageCLocale), "a?b");
}

// Searches report -1; substrings clamp to the text; a replacement containing the searched text is not
// searched again; positions outside the text are clamped. Results in the order of the edits (a braced list
// is evaluated left to right).
TEST(SvyStringEditing, SearchesSubstringsTrimsReplacesInsertsAndDeletes) {
  const CSvyString s(L"12+345.67+8"), abc(L"abcdef");
  CSvyString text(L" \t 1,5 \r\n"), grow(L"a-a-a"), edit(L"1234");
  const int results[][2] = {
      {s.Find(L'+', 3), 9},         {s.Find(L'+', -1), -1},       {s.Find(L"45", 5), -1},   {s.Find(L"", 11), 11},
      {s.Find(L"45"), 4},           {s.ReverseFind(L'+'), 9},     {s.FindOneOf(L".+"), 2},  {s.FindOneOf(L""), -1},
      {text.Replace(L',', L'.'), 1}, {grow.Replace(L"a", L"aa"), 3}, {grow.Replace(L"aa", nullptr), 3},
      {grow.Replace(L"", L"x"), 0}, {edit.Insert(1, L'+'), 5},     {edit.Insert(99, L".00"), 8},
      {edit.Insert(-5, L"-"), 9},   {edit.Delete(0), 8},           {edit.Delete(5, 99), 5},  {edit.Delete(-1, 1), 5},
      {edit.Remove(L'+'), 1}};
  for (const auto& r : results) EXPECT_EQ(r[0], r[1]) << (&r - results);
  const std::pair<CSvyString, const wchar_t*> strings[] = {
      {abc.Mid(-3, 2), L"ab"}, {abc.Mid(4, 99), L"ef"}, {abc.Mid(9), L""}, {abc.Mid(1, -1), L""},
      {abc.Left(99), L"abcdef"}, {abc.Right(-1), L""}, {abc.Right(2), L"ef"},
      {CSvyString(text).TrimLeft(), L"1.5 \r\n"}, {text.Trim(), L"1.5"}, {CSvyString(L"   ").Trim(), L""},
      {CSvyString(L"xxabxx").TrimLeft(L'x').TrimRight(L"x"), L"ab"}, {grow, L"--"}, {edit, L"1234"},
      {CSvyString(L"Ab\u00E9").MakeUpper(), L"AB\u00C9"}, {CSvyString(L"Ab\u00C9").MakeLower(), L"ab\u00E9"},
      {CSvyString(L'-', 3), L"---"}, {CSvyString(L"abcdef", 3), L"abc"}};
  for (const auto& c : strings) EXPECT_EQ(c.first.str(), c.second) << (&c - strings);
  edit.SetAt(0, L'9');
  edit.SetAt(4, L'x');
  edit.SetAt(-1, L'x');
  EXPECT_TRUE(edit.str() == L"9234" && edit.GetAt(4) == L'\0' && edit[3] == L'4');
}

TEST(SvyStringCompare, OrdinalAndCaseFoldedIncludingLatin1) {
  struct {
    const wchar_t *a, *b;
    int ordinal, noCase;
  } const cases[] = {{L"abc", L"ABC", 1, 0}, {L"ab", L"abc", -1, -1}, {L"abc", L"AB", 1, 1},
                     {L"\u00C9t\u00C9", L"\u00E9T\u00E9", -1, 0}, {L"\u00D7", L"\u00F7", -1, -1}};
  const auto sign = [](int x) { return (x > 0) - (x < 0); };
  for (const auto& c : cases) {
    EXPECT_EQ(sign(CSvyString(c.a).Compare(c.b)), c.ordinal) << (&c - cases);
    EXPECT_EQ(sign(CSvyString(c.a).CompareNoCase(c.b)), c.noCase) << (&c - cases);
  }
  CSvyString text = CSvyString(L"1") + L"+" + CSvyString("234", kCodePageUtf8) + L'.';
  EXPECT_TRUE((text += L"5") == L"1+234.5");
  EXPECT_TRUE(text != CSvyString(L"1+234.50") && CSvyString(L"a") < CSvyString(L"b"));
  text = static_cast<const wchar_t*>(nullptr);
  EXPECT_TRUE(text.IsEmpty());
}

// printf conversions with wide strings, positional arguments, growth for long output; a narrow byte beyond
// ASCII has no meaning in the C locale: the text is empty. The buffer writes through and sets the length.
TEST(SvyStringFormat, PrintfConversionsPositionalArgumentsLongOutputAndBuffer) {
  const auto format = [](const wchar_t* pattern, auto... args) {
    CSvyString text(L"old");
    text.Format(pattern, args...);
    return text.str();
  };
  const std::wstring longText(5000, L'z');
  const std::pair<std::wstring, std::wstring> cases[] = {
      {format(L"[%5s|%c|%hs]", L"abc", L'x', "nar"), L"[  abc|x|nar]"},
      {format(L"%d%% %ld %#x %.2e", 100, -7L, 31U, 5.3), L"100% -7 0x1f 5.30e+00"},
      {format(L"%2$s=%1$d", 7, L"k"), L"k=7"}, {format(L"%hs", "\xC3\xA9"), L""},
      {format(L"<%ls>%d", longText.c_str(), 42), L"<" + longText + L">42"}};
  for (const auto& c : cases) EXPECT_EQ(c.first, c.second) << (&c - cases);
  CSvyString text(L"N=");
  text.AppendFormat(L"%.3f", 12.0);
  EXPECT_EQ(text.str(), L"N=12.000");
  wchar_t* buffer = text.GetBuffer(10);
  ASSERT_NE(buffer, nullptr);
  for (int i = 0; i <= 6; ++i) buffer[i] = L"12.345"[i];
  text.ReleaseBuffer();
  EXPECT_EQ(text.str(), L"12.345");
  text.GetBuffer(0);  // a request below the length keeps the text
  text.ReleaseBuffer(2);
  EXPECT_EQ(text.str(), L"12");
}

}  // namespace
