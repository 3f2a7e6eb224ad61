#pragma once
// The wide-character string of the library: a thin class over std::wstring with the familiar method set
// (Find, Mid, Trim..., Format, GetBuffer/ReleaseBuffer). Positions and lengths are int counts of wchar_t;
// a position outside the text is clamped where a sensible result exists (Mid, Left, Right, Insert,
// Delete) and ignored where none does (SetAt). Find returns -1 when nothing is found.
//
// Narrow text is converted with a code page: kCodePageUtf8 decodes UTF-8 (a malformed sequence becomes
// U+FFFD), kCodePageCLocale maps every byte to the code point of the same value (ASCII as is, bytes
// 0x80-0xFF as U+0080-U+00FF), whatever the host's locale is.
#include <cstdarg>
#include <string>

#include "svyutils/svyutils_export.h"

namespace svy_text {

// Code pages for narrow text (the numbers are the usual code page identifiers).
constexpr unsigned kCodePageCLocale = 0;
constexpr unsigned kCodePageUtf8 = 65001;

template <class TChar>
class CSvyStringT;

template <>
class SVYUTILS_API CSvyStringT<wchar_t> {
 public:
  CSvyStringT() = default;
  CSvyStringT(const wchar_t* text);  // NOLINT(google-explicit-constructor): used like a string literal
  CSvyStringT(const wchar_t* text, int length);
  CSvyStringT(const char* text, unsigned codePage = kCodePageUtf8);  // NOLINT(google-explicit-constructor)
  CSvyStringT(const std::wstring& text);                             // NOLINT(google-explicit-constructor)
  CSvyStringT(wchar_t ch, int repeat);

  CSvyStringT& operator=(const wchar_t* text);
  CSvyStringT& operator=(const char* text);
  CSvyStringT& operator+=(const CSvyStringT& text);
  CSvyStringT& operator+=(const wchar_t* text);
  CSvyStringT& operator+=(wchar_t ch);

  // printf-style formatting of wide text, always in the C locale (decimal point '.', no grouping).
  // Wide strings are passed with %ls (or %s: both read wchar_t text here), narrow ones with %hs (ASCII
  // only: other narrow text cannot be converted in the C locale, and the result is then empty). Pass
  // c_str() for a CSvyString argument.
  void Format(const wchar_t* format, ...);
  void FormatV(const wchar_t* format, va_list args);
  void AppendFormat(const wchar_t* format, ...);

  int GetLength() const { return static_cast<int>(text_.size()); }
  bool IsEmpty() const { return text_.empty(); }
  void Empty() { text_.clear(); }
  // The character at index; 0 when the index is outside the text.
  wchar_t GetAt(int index) const;
  wchar_t operator[](int index) const { return GetAt(index); }
  // Replaces the character at index; ignored when the index is outside the text.
  void SetAt(int index, wchar_t ch);

  const wchar_t* c_str() const { return text_.c_str(); }
  const wchar_t* GetString() const { return text_.c_str(); }
  const std::wstring& str() const { return text_; }
  // The text as narrow characters in the code page (code points above 0xFF become '?' in the C locale).
  std::string ToNarrow(unsigned codePage = kCodePageUtf8) const;

  int Find(wchar_t ch, int start = 0) const;
  int Find(const wchar_t* sub, int start = 0) const;
  int ReverseFind(wchar_t ch) const;
  int FindOneOf(const wchar_t* charSet) const;

  CSvyStringT Mid(int first) const;
  CSvyStringT Mid(int first, int count) const;
  CSvyStringT Left(int count) const;
  CSvyStringT Right(int count) const;

  // Trimming without arguments removes blanks: space, tab, line feed, carriage return, vertical tab and
  // form feed.
  CSvyStringT& TrimLeft();
  CSvyStringT& TrimLeft(wchar_t target);
  CSvyStringT& TrimLeft(const wchar_t* targets);
  CSvyStringT& TrimRight();
  CSvyStringT& TrimRight(wchar_t target);
  CSvyStringT& TrimRight(const wchar_t* targets);
  CSvyStringT& Trim();

  // Each returns the number of replacements; an empty search text replaces nothing.
  int Replace(wchar_t oldChar, wchar_t newChar);
  int Replace(const wchar_t* oldText, const wchar_t* newText);
  // Each returns the new length; an index beyond the end appends.
  int Insert(int index, wchar_t ch);
  int Insert(int index, const wchar_t* text);
  // Removes up to count characters from index and returns the new length.
  int Delete(int index, int count = 1);
  // Removes every occurrence of ch and returns how many were removed.
  int Remove(wchar_t ch);

  // Ordinal comparison: negative, zero or positive.
  int Compare(const wchar_t* text) const;
  // Comparison that folds the letters of ASCII and Latin-1 to lower case, independent of the locale.
  int CompareNoCase(const wchar_t* text) const;
  CSvyStringT& MakeUpper();
  CSvyStringT& MakeLower();

  // Direct access to a buffer of at least minLength characters (plus a terminating zero). After writing,
  // ReleaseBuffer sets the length: to newLength, or up to the first zero character when it is -1.
  wchar_t* GetBuffer(int minLength = 0);
  void ReleaseBuffer(int newLength = -1);

  friend bool operator==(const CSvyStringT& a, const CSvyStringT& b) { return a.text_ == b.text_; }
  friend bool operator!=(const CSvyStringT& a, const CSvyStringT& b) { return a.text_ != b.text_; }
  friend bool operator<(const CSvyStringT& a, const CSvyStringT& b) { return a.text_ < b.text_; }
  friend bool operator==(const CSvyStringT& a, const wchar_t* b) { return a.Compare(b) == 0; }
  friend bool operator!=(const CSvyStringT& a, const wchar_t* b) { return a.Compare(b) != 0; }
  friend CSvyStringT operator+(CSvyStringT a, const CSvyStringT& b) { return a += b; }
  friend CSvyStringT operator+(CSvyStringT a, const wchar_t* b) { return a += b; }
  friend CSvyStringT operator+(CSvyStringT a, wchar_t b) { return a += b; }

 private:
  std::wstring text_;
};

using CSvyString = CSvyStringT<wchar_t>;

}  // namespace svy_text
