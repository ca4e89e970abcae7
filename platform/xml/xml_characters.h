#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace zor2::xml {

// Whether XML 1.0 allows `code_point` in a document (its Char production).
constexpr bool IsXmlCharacter(char32_t code_point) {
  return code_point == 0x9 || code_point == 0xA || code_point == 0xD ||
         (code_point >= 0x20 && code_point <= 0xD7FF) ||
         (code_point >= 0xE000 && code_point <= 0xFFFD) ||
         (code_point >= 0x10000 && code_point <= 0x10FFFF);
}

// Decodes the UTF-8 sequence at the start of `text` into `code_point` and
// returns its length, or returns 0 when the bytes there are not well-formed
// UTF-8 (a stray continuation byte, an overlong form, a surrogate, a code
// point beyond U+10FFFF, a sequence cut short by a byte or by the end).
// REQUIRES: `text` is not empty.
inline size_t DecodeUtf8(std::string_view text, char32_t* code_point) {
  const auto* p = reinterpret_cast<const unsigned char*>(text.data());
  const unsigned char lead = p[0];
  if (lead < 0x80) {
    *code_point = lead;
    return 1;
  }
  size_t length;
  char32_t value;
  // The range of the second byte; the first byte rules out overlong forms,
  // surrogates and code points beyond U+10FFFF through it.
  unsigned char low = 0x80;
  unsigned char high = 0xBF;
  if (lead >= 0xC2 && lead <= 0xDF) {
    length = 2;
    value = lead & 0x1F;
  } else if (lead >= 0xE0 && lead <= 0xEF) {
    length = 3;
    value = lead & 0x0F;
    if (lead == 0xE0) low = 0xA0;
    if (lead == 0xED) high = 0x9F;
  } else if (lead >= 0xF0 && lead <= 0xF4) {
    length = 4;
    value = lead & 0x07;
    if (lead == 0xF0) low = 0x90;
    if (lead == 0xF4) high = 0x8F;
  } else {
    return 0;
  }
  if (length > text.size()) return 0;
  for (size_t i = 1; i < length; ++i) {
    if (p[i] < low || p[i] > high) return 0;
    low = 0x80;
    high = 0xBF;
    value = (value << 6) | (p[i] & 0x3F);
  }
  *code_point = value;
  return length;
}

// "U+0001", "U+FFFE", "U+10FFFF": a code point as messages name it.
inline std::string CodePointName(char32_t code_point) {
  std::string digits;
  for (; code_point != 0 || digits.size() < 4; code_point >>= 4) {
    digits.insert(digits.begin(), "0123456789ABCDEF"[code_point & 0xF]);
  }
  return "U+" + digits;
}

}  // namespace zor2::xml
