#include <gtest/gtest.h>

#include <string>
#include <utility>

#include "svyutils/svy_string.h"

namespace {

using svy_text::CSvyString;
using svy_text::kCodePageCLocale;
using svy_text::kCodePageUtf8;

// Well-formed text decodes and encodes back; each malformed byte becomes one replacement character.
TEST(SvyStringUtf8, DecodesEncodesBackAndReplacesMalformedBytes) {
  const std::pair<const char*, std::wstring> wellFormed[] = {
      {"45\xC2\xB0" "30'", L"45\u00B030'"}, {"\xE2\x82\xAC 5", L"\u20AC 5"}, {"\xF0\x9D\x84\x9E", L"\U0001D11E"}};
  for (const auto& c : wellFormed) {
    const CSvyString text(c.first, kCodePageUtf8);
    EXPECT_EQ(text.str(), c.second);
    EXPECT_EQ(text.ToNarrow(kCodePageUtf8), std::string(c.first));
  }
  // Stray continuation, truncated, overlong, encoded surrogate, beyond U+10FFFF.
  const std::pair<const char*, std::wstring> malformed[] = {
      {"a\x80" "b", L"a\uFFFDb"}, {"a\xC3", L"a\uFFFD"}, {"\xC0\xAF", L"\uFFFD\uFFFD"},
      {"\xED\xA0\x80", L"\uFFFD\uFFFD\uFFFD"}, {"\xF4\x90\x80\x80", L"\uFFFD\uFFFD\uFFFD\uFFFD"}};
  for (const auto& c : malformed) EXPECT_EQ(CSvyString(c.first, kCodePageUtf8).str(), c.second) << c.first;
}

TEST(SvyStringCLocale, MapsEveryByteToTheSameCodePoint) {
  std::string bytes;
  for (int b = 1; b < 256; ++b) bytes += static_cast<char>(b);
  const CSvyString text(bytes.c_str(), kCodePageCLocale);
  ASSERT_EQ(text.GetLength(), 255);
  for (int i = 0; i < 255; ++i) EXPECT_EQ(static_cast<int>(text.GetAt(i)), i + 1);
  EXPECT_EQ(text.ToNarrow(kCodePageCLocale), bytes);
  EXPECT_EQ(CSvyString(L"a\u20ACb").ToNarrow(kCodePageCLocale), "a?b");
}

TEST(SvyStringSearch, FindsAndReportsMinusOne) {
  const CSvyString text(L"12+345.67+8");
  const int found[][2] = {{text.Find(L'+', 3), 9},     {text.Find(L'+', -1), -1},  {text.Find(L"45", 5), -1},
                          {text.Find(L"", 11), 11},     {text.Find(L"45"), 4},      {text.ReverseFind(L'+'), 9},
                          {text.FindOneOf(L".+"), 2},   {text.FindOneOf(L""), -1}};
  for (const auto& f : found) EXPECT_EQ(f[0], f[1]) << (&f - found);
}

TEST(SvyStringSubstrings, ClampToTheText) {
  const CSvyString text(L"abcdef");
  struct {
    CSvyString actual;
    const wchar_t* expected;
  } const cases[] = {{text.Mid(-3, 2), L"ab"}, {text.Mid(4, 99), L"ef"}, {text.Mid(9), L""},
                     {text.Mid(1, -1), L""},   {text.Left(99), L"abcdef"}, {text.Right(-1), L""},
                     {text.Right(2), L"ef"}};
  for (const auto& c : cases) EXPECT_EQ(c.actual.str(), c.expected);
}

TEST(SvyStringEditing, TrimsReplacesInsertsAndDeletes) {
  CSvyString text(L" \t 1,5 \r\n");
  EXPECT_EQ(CSvyString(text).TrimLeft().str(), L"1,5 \r\n");
  EXPECT_EQ(text.Trim().str(), L"1,5");
  EXPECT_EQ(CSvyString(L"   ").Trim().str(), L"");
  EXPECT_EQ(CSvyString(L"xxabxx").TrimLeft(L'x').TrimRight(L"x").str(), L"ab");

  // Results in the order of the edits (a braced list is evaluated left to right). A replacement that
  // contains the searched text must not be searched again; positions outside the text are clamped.
  CSvyString grow(L"a-a-a"), edit(L"1234");
  const int results[][2] = {{text.Replace(L',', L'.'), 1},    {grow.Replace(L"a", L"aa"), 3},
                            {grow.Replace(L"aa", nullptr), 3}, {grow.Replace(L"", L"x"), 0},
                            {edit.Insert(1, L'+'), 5},         {edit.Insert(99, L".00"), 8},
                            {edit.Insert(-5, L"-"), 9},        {edit.Delete(0), 8},
                            {edit.Delete(5, 99), 5},           {edit.Delete(-1, 1), 5},
                            {edit.Remove(L'+'), 1}};
  for (const auto& r : results) EXPECT_EQ(r[0], r[1]) << (&r - results);
  EXPECT_EQ(text.str(), L"1.5");
  EXPECT_EQ(grow.str(), L"--");
  EXPECT_EQ(edit.str(), L"1234");
  edit.SetAt(0, L'9');
  edit.SetAt(4, L'x');
  edit.SetAt(-1, L'x');
  EXPECT_EQ(edit.str(), L"9234");
  EXPECT_TRUE(edit.GetAt(4) == L'\0' && edit[3] == L'4');
}

TEST(SvyStringCompare, OrdinalAndCaseFolded) {
  struct {
    const wchar_t* a;
    const wchar_t* b;
    int ordinal;
    int noCase;
  } const cases[] = {
      {L"abc", L"ABC", 1, 0}, {L"ab", L"abc", -1, -1}, {L"abc", L"AB", 1, 1},
      {L"\u00C9t\u00C9", L"\u00E9T\u00E9", -1, 0},  // Latin-1 letters fold too
      {L"\u00D7", L"\u00F7", -1, -1}};              // the signs are no letters
  for (const auto& c : cases) {
    SCOPED_TRACE(::testing::Message() << "case " << (&c - cases));
    const int ordinal = CSvyString(c.a).Compare(c.b);
    const int noCase = CSvyString(c.a).CompareNoCase(c.b);
    EXPECT_EQ((ordinal > 0) - (ordinal < 0), c.ordinal);
    EXPECT_EQ((noCase > 0) - (noCase < 0), c.noCase);
  }
  EXPECT_EQ(CSvyString(L"Ab\u00E9").MakeUpper().str(), L"AB\u00C9");
  EXPECT_EQ(CSvyString(L"Ab\u00C9").MakeLower().str(), L"ab\u00E9");
}

TEST(SvyStringBuffer, WritesThroughAndSetsTheLength) {
  CSvyString text(L"ab");
  wchar_t* buffer = text.GetBuffer(10);
  ASSERT_NE(buffer, nullptr);
  const wchar_t written[] = L"12.345";
  for (int i = 0; i <= 6; ++i) buffer[i] = written[i];
  text.ReleaseBuffer();
  EXPECT_EQ(text.str(), L"12.345");
  text.GetBuffer(0);  // a request below the length keeps the text
  text.ReleaseBuffer(2);
  EXPECT_EQ(text.str(), L"12");
}

// printf conversions with wide strings, positional arguments, growth for long output; a narrow byte beyond
// ASCII has no meaning in the C locale: the text is empty, quickly.
TEST(SvyStringFormat, PrintfConversionsPositionalArgumentsAndLongOutput) {
  const auto format = [](const wchar_t* pattern, auto... args) {
    CSvyString text(L"old");
    text.Format(pattern, args...);
    return text.str();
  };
  const std::wstring longText(5000, L'z');
  const std::pair<std::wstring, std::wstring> cases[] = {
      {format(L"[%5s|%c|%hs]", L"abc", L'x', "nar"), L"[  abc|x|nar]"},
      {format(L"%d%% %ld %#x %.2e", 100, -7L, 31U, 5.3), L"100% -7 0x1f 5.30e+00"},
      {format(L"%2$s=%1$d", 7, L"k"), L"k=7"},
      {format(L"%hs", "\xC3\xA9"), L""},
      {format(L"<%ls>%d", longText.c_str(), 42), L"<" + longText + L">42"}};
  for (const auto& c : cases) EXPECT_EQ(c.first, c.second) << (&c - cases);
  CSvyString appended(L"N=");
  appended.AppendFormat(L"%.3f", 12.0);
  EXPECT_EQ(appended.str(), L"N=12.000");
}

TEST(SvyStringOperators, ConcatenateAndCompare) {
  CSvyString text = CSvyString(L"1") + L"+" + CSvyString("234", svy_text::kCodePageUtf8) + L'.';
  EXPECT_TRUE((text += L"5") == L"1+234.5");
  EXPECT_TRUE(text != CSvyString(L"1+234.50") && CSvyString(L"a") < CSvyString(L"b"));
  EXPECT_EQ(CSvyString(L'-', 3).str(), L"---");
  EXPECT_EQ(CSvyString(L"abcdef", 3).str(), L"abc");
  text = static_cast<const wchar_t*>(nullptr);
  EXPECT_TRUE(text.IsEmpty());
}

}  // namespace
