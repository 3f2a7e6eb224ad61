#include "svyutils/utf_codec.h"

#include <cstddef>
#include <cstdint>

#include "svyutils/svy_string.h"

namespace svy_text {
namespace detail {
namespace {

constexpr char32_t kReplacement = 0xFFFD;
constexpr char32_t kMaxCodePoint = 0x10FFFF;
constexpr bool kUtf16Wide = sizeof(wchar_t) == 2;

bool isSurrogate(char32_t cp) { return cp >= 0xD800 && cp <= 0xDFFF; }
bool isContinuation(unsigned char byte) { return (byte & 0xC0U) == 0x80U; }

void appendWide(std::wstring& out, char32_t cp) {
  if (kUtf16Wide && cp > 0xFFFF) {
    const char32_t v = cp - 0x10000;
    out += static_cast<wchar_t>(0xD800 + (v >> 10));
    out += static_cast<wchar_t>(0xDC00 + (v & 0x3FFU));
  } else {
    out += static_cast<wchar_t>(cp);
  }
}

// Decodes one UTF-8 sequence at text[i] and advances i past it; a malformed or overlong sequence gives
// U+FFFD and advances by one byte, so decoding always ends.
char32_t decodeUtf8(const unsigned char* text, std::size_t& i) {
  const unsigned char lead = text[i];
  std::size_t extra = 0;
  char32_t cp = 0;
  char32_t minimum = 0;
  if (lead < 0x80U) {
    ++i;
    return lead;
  } else if ((lead & 0xE0U) == 0xC0U) {
    extra = 1;
    cp = lead & 0x1FU;
    minimum = 0x80;
  } else if ((lead & 0xF0U) == 0xE0U) {
    extra = 2;
    cp = lead & 0x0FU;
    minimum = 0x800;
  } else if ((lead & 0xF8U) == 0xF0U) {
    extra = 3;
    cp = lead & 0x07U;
    minimum = 0x10000;
  } else {
    ++i;
    return kReplacement;
  }
  for (std::size_t k = 1; k <= extra; ++k) {
    // The terminating zero is no continuation byte, so this never reads past the text.
    if (!isContinuation(text[i + k])) {
      ++i;
      return kReplacement;
    }
    cp = (cp << 6) | (text[i + k] & 0x3FU);
  }
  if (cp < minimum || cp > kMaxCodePoint || isSurrogate(cp)) {
    ++i;
    return kReplacement;
  }
  i += extra + 1;
  return cp;
}

void appendUtf8(std::string& out, char32_t cp) {
  if (cp < 0x80) {
    out += static_cast<char>(cp);
  } else if (cp < 0x800) {
    out += static_cast<char>(0xC0 | (cp >> 6));
    out += static_cast<char>(0x80 | (cp & 0x3F));
  } else if (cp < 0x10000) {
    out += static_cast<char>(0xE0 | (cp >> 12));
    out += static_cast<char>(0x80 | ((cp >> 6) & 0x3F));
    out += static_cast<char>(0x80 | (cp & 0x3F));
  } else {
    out += static_cast<char>(0xF0 | (cp >> 18));
    out += static_cast<char>(0x80 | ((cp >> 12) & 0x3F));
    out += static_cast<char>(0x80 | ((cp >> 6) & 0x3F));
    out += static_cast<char>(0x80 | (cp & 0x3F));
  }
}

// The code point at text[i] (joining a UTF-16 surrogate pair), advancing i past it.
char32_t nextCodePoint(const std::wstring& text, std::size_t& i) {
  const char32_t unit = static_cast<char32_t>(text[i++]);
  if (kUtf16Wide && unit >= 0xD800 && unit <= 0xDBFF && i < text.size()) {
    const char32_t low = static_cast<char32_t>(text[i]);
    if (low >= 0xDC00 && low <= 0xDFFF) {
      ++i;
      return 0x10000 + ((unit - 0xD800) << 10) + (low - 0xDC00);
    }
  }
  if (unit > kMaxCodePoint || isSurrogate(unit)) return kReplacement;
  return unit;
}

}  // namespace

std::wstring decodeNarrow(const char* text, unsigned codePage) {
  const auto* bytes = reinterpret_cast<const unsigned char*>(text);
  std::wstring out;
  if (codePage == kCodePageUtf8) {
    for (std::size_t i = 0; bytes[i] != 0;) appendWide(out, decodeUtf8(bytes, i));
  } else {
    for (std::size_t i = 0; bytes[i] != 0; ++i) out += static_cast<wchar_t>(bytes[i]);
  }
  return out;
}

std::string encodeNarrow(const std::wstring& text, unsigned codePage) {
  std::string out;
  for (std::size_t i = 0; i < text.size();) {
    const char32_t cp = nextCodePoint(text, i);
    if (codePage == kCodePageUtf8) {
      appendUtf8(out, cp);
    } else {
      out += cp <= 0xFF ? static_cast<char>(static_cast<unsigned char>(cp)) : '?';
    }
  }
  return out;
}

}  // namespace detail
}  // namespace svy_text
