#include "svyutils/svy_string.h"

#include <algorithm>
#include <cerrno>
#include <cstddef>
#include <cwchar>

#include "svyutils/svy_number_text.h"
#include "svyutils/utf_codec.h"

namespace svy_text {
namespace {

using String = CSvyStringT<wchar_t>;

constexpr const wchar_t* kBlanks = L" \t\n\r\v\f";
// Formatted text that fits this many characters (with the terminating zero) needs no heap buffer.
constexpr std::size_t kStackFormatLength = 128;
// Formatted text longer than this is not produced (Format leaves the string empty instead).
constexpr std::size_t kMaxFormattedLength = std::size_t{1} << 24;

std::size_t clampedPos(int pos, std::size_t size) {
  if (pos <= 0) return 0;
  return std::min(static_cast<std::size_t>(pos), size);
}

int toInt(std::size_t pos) { return pos == std::wstring::npos ? -1 : static_cast<int>(pos); }

// Letters of ASCII and Latin-1 folded to lower case; the multiplication sign U+00D7 is no letter.
wchar_t foldLower(wchar_t ch) {
  if ((ch >= L'A' && ch <= L'Z') || (ch >= 0xC0 && ch <= 0xDE && ch != 0xD7)) {
    return static_cast<wchar_t>(ch + 0x20);
  }
  return ch;
}
wchar_t foldUpper(wchar_t ch) {
  if ((ch >= L'a' && ch <= L'z') || (ch >= 0xE0 && ch <= 0xFE && ch != 0xF7)) {
    return static_cast<wchar_t>(ch - 0x20);
  }
  return ch;
}

// The C library's wide printf reads %s and %c as narrow text; this class's format strings read them as
// wide text (%hs and %hc stay narrow). Rewrites the conversions accordingly and leaves the rest alone.
std::wstring widenStringConversions(const wchar_t* format) {
  std::wstring out;
  for (const wchar_t* p = format; *p != L'\0'; ++p) {
    out += *p;
    if (*p != L'%') continue;
    ++p;
    if (*p == L'\0') break;
    if (*p == L'%') {
      out += *p;
      continue;
    }
    while (*p != L'\0' && std::wcschr(L"-+ #0'.*$123456789", *p) != nullptr) out += *p++;
    std::wstring length;
    while (*p != L'\0' && std::wcschr(L"hlLqjzt", *p) != nullptr) length += *p++;
    if (*p == L'\0') {
      out += length;
      break;
    }
    const bool text = *p == L's' || *p == L'c';
    if (text && length.empty()) {
      out += L'l';
    } else if (!(text && length == L"h")) {
      out += length;
    }
    out += *p;
  }
  return out;
}

}  // namespace

String::CSvyStringT(const wchar_t* text) : text_(text != nullptr ? text : L"") {}

String::CSvyStringT(const wchar_t* text, int length) {
  if (text != nullptr && length > 0) text_.assign(text, static_cast<std::size_t>(length));
}

String::CSvyStringT(const char* text, unsigned codePage)
    : text_(text != nullptr ? detail::decodeNarrow(text, codePage) : std::wstring()) {}

String::CSvyStringT(const std::wstring& text) : text_(text) {}

String::CSvyStringT(wchar_t ch, int repeat) {
  if (repeat > 0) text_.assign(static_cast<std::size_t>(repeat), ch);
}

String& String::operator=(const wchar_t* text) {
  text_ = text != nullptr ? text : L"";
  return *this;
}

String& String::operator=(const char* text) { return *this = String(text); }

String& String::operator+=(const String& text) {
  text_ += text.text_;
  return *this;
}

String& String::operator+=(const wchar_t* text) {
  if (text != nullptr) text_ += text;
  return *this;
}

String& String::operator+=(wchar_t ch) {
  text_ += ch;
  return *this;
}

void String::Format(const wchar_t* format, ...) {
  va_list args;
  va_start(args, format);
  FormatV(format, args);
  va_end(args);
}

void String::FormatV(const wchar_t* format, va_list args) {
  text_.clear();
  if (format == nullptr) return;
  // Only a format that mentions 's' or 'c' can hold a text conversion to rewrite.
  const std::wstring portable =
      std::wcspbrk(format, L"sc") != nullptr ? widenStringConversions(format) : format;
  const svy_formats::CScopedCLocale cLocale;
  // Wide printf cannot report the length it needs: short texts (stations, numbers) fit the stack buffer,
  // longer ones get a heap buffer that grows until the text fits.
  wchar_t stackBuffer[kStackFormatLength];
  std::wstring heapBuffer;
  wchar_t* buffer = stackBuffer;
  std::size_t size = kStackFormatLength;
  while (size <= kMaxFormattedLength) {
    va_list attempt;
    va_copy(attempt, args);
    errno = 0;
    const int written = std::vswprintf(buffer, size, portable.c_str(), attempt);
    va_end(attempt);
    if (written >= 0) {
      text_.assign(buffer, static_cast<std::size_t>(written));
      return;
    }
    // Narrow text that is not ASCII cannot be converted in the C locale: no buffer size would help.
    if (errno == EILSEQ) return;
    size *= 4;
    heapBuffer.assign(size, L'\0');
    buffer = &heapBuffer[0];
  }
}

void String::AppendFormat(const wchar_t* format, ...) {
  String appended;
  va_list args;
  va_start(args, format);
  appended.FormatV(format, args);
  va_end(args);
  text_ += appended.text_;
}

wchar_t String::GetAt(int index) const {
  return index >= 0 && index < GetLength() ? text_[static_cast<std::size_t>(index)] : L'\0';
}

void String::SetAt(int index, wchar_t ch) {
  if (index >= 0 && index < GetLength()) text_[static_cast<std::size_t>(index)] = ch;
}

std::string String::ToNarrow(unsigned codePage) const { return detail::encodeNarrow(text_, codePage); }

int String::Find(wchar_t ch, int start) const {
  if (start < 0) return -1;
  return toInt(text_.find(ch, static_cast<std::size_t>(start)));
}

int String::Find(const wchar_t* sub, int start) const {
  if (sub == nullptr || start < 0 || start > GetLength()) return -1;
  return toInt(text_.find(sub, static_cast<std::size_t>(start)));
}

int String::ReverseFind(wchar_t ch) const { return toInt(text_.rfind(ch)); }

int String::FindOneOf(const wchar_t* charSet) const {
  if (charSet == nullptr || *charSet == L'\0') return -1;
  return toInt(text_.find_first_of(charSet));
}

String String::Mid(int first) const { return Mid(first, GetLength()); }

String String::Mid(int first, int count) const {
  const std::size_t from = clampedPos(first, text_.size());
  const std::size_t n = count > 0 ? static_cast<std::size_t>(count) : 0U;
  return String(text_.substr(from, n));
}

String String::Left(int count) const { return String(text_.substr(0, clampedPos(count, text_.size()))); }

String String::Right(int count) const {
  const std::size_t n = clampedPos(count, text_.size());
  return String(text_.substr(text_.size() - n));
}

String& String::TrimLeft() { return TrimLeft(kBlanks); }

String& String::TrimLeft(wchar_t target) {
  const wchar_t targets[] = {target, L'\0'};
  return TrimLeft(targets);
}

String& String::TrimLeft(const wchar_t* targets) {
  if (targets == nullptr) return *this;
  const std::size_t first = text_.find_first_not_of(targets);
  text_.erase(0, first == std::wstring::npos ? text_.size() : first);
  return *this;
}

String& String::TrimRight() { return TrimRight(kBlanks); }

String& String::TrimRight(wchar_t target) {
  const wchar_t targets[] = {target, L'\0'};
  return TrimRight(targets);
}

String& String::TrimRight(const wchar_t* targets) {
  if (targets == nullptr) return *this;
  const std::size_t last = text_.find_last_not_of(targets);
  text_.erase(last == std::wstring::npos ? 0 : last + 1);
  return *this;
}

String& String::Trim() { return TrimRight().TrimLeft(); }

int String::Replace(wchar_t oldChar, wchar_t newChar) {
  int count = 0;
  for (wchar_t& ch : text_) {
    if (ch == oldChar) {
      ch = newChar;
      ++count;
    }
  }
  return count;
}

int String::Replace(const wchar_t* oldText, const wchar_t* newText) {
  if (oldText == nullptr || *oldText == L'\0') return 0;
  const std::wstring from(oldText);
  const std::wstring to(newText != nullptr ? newText : L"");
  int count = 0;
  for (std::size_t pos = text_.find(from); pos != std::wstring::npos;
       pos = text_.find(from, pos + to.size())) {
    text_.replace(pos, from.size(), to);
    ++count;
  }
  return count;
}

int String::Insert(int index, wchar_t ch) {
  text_.insert(clampedPos(index, text_.size()), 1, ch);
  return GetLength();
}

int String::Insert(int index, const wchar_t* text) {
  if (text != nullptr) text_.insert(clampedPos(index, text_.size()), text);
  return GetLength();
}

int String::Delete(int index, int count) {
  if (index >= 0 && count > 0 && index < GetLength()) {
    text_.erase(static_cast<std::size_t>(index), static_cast<std::size_t>(count));
  }
  return GetLength();
}

int String::Remove(wchar_t ch) {
  const std::size_t before = text_.size();
  text_.erase(std::remove(text_.begin(), text_.end(), ch), text_.end());
  return static_cast<int>(before - text_.size());
}

int String::Compare(const wchar_t* text) const { return text_.compare(text != nullptr ? text : L""); }

int String::CompareNoCase(const wchar_t* text) const {
  const wchar_t* other = text != nullptr ? text : L"";
  for (std::size_t i = 0;; ++i) {
    const wchar_t a = i < text_.size() ? foldLower(text_[i]) : L'\0';
    const wchar_t b = foldLower(other[i]);
    if (a != b) return a < b ? -1 : 1;
    if (b == L'\0') return i < text_.size() ? 1 : 0;  // equal so far; only text_ may continue
  }
}

String& String::MakeUpper() {
  std::transform(text_.begin(), text_.end(), text_.begin(), foldUpper);
  return *this;
}

String& String::MakeLower() {
  std::transform(text_.begin(), text_.end(), text_.begin(), foldLower);
  return *this;
}

wchar_t* String::GetBuffer(int minLength) {
  if (minLength > GetLength()) text_.resize(static_cast<std::size_t>(minLength), L'\0');
  return &text_[0];
}

void String::ReleaseBuffer(int newLength) {
  if (newLength < 0) {
    text_.resize(std::wcslen(text_.c_str()));
  } else if (static_cast<std::size_t>(newLength) < text_.size()) {
    text_.resize(static_cast<std::size_t>(newLength));
  }
}

}  // namespace svy_text
