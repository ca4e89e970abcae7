#include "platform/tools/xml_escaping.h"

#include <cstdint>

namespace zor2 {
namespace {

const char* EntityFor(char c) {
  switch (c) {
    case '&':
      return "&amp;";
    case '<':
      return "&lt;";
    case '>':
      return "&gt;";
    case '"':
      return "&quot;";
    case '\'':
      return "&apos;";
    case '\t':
      return "&#9;";
    case '\n':
      return "&#10;";
    case '\r':
      return "&#13;";
    default:
      return nullptr;
  }
}

void AppendUtf8(uint32_t cp, std::string* out) {
  if (cp < 0x80) {
    out->push_back(static_cast<char>(cp));
  } else if (cp < 0x800) {
    out->push_back(static_cast<char>(0xC0 | (cp >> 6)));
    out->push_back(static_cast<char>(0x80 | (cp & 0x3F)));
  } else if (cp < 0x10000) {
    out->push_back(static_cast<char>(0xE0 | (cp >> 12)));
    out->push_back(static_cast<char>(0x80 | ((cp >> 6) & 0x3F)));
    out->push_back(static_cast<char>(0x80 | (cp & 0x3F)));
  } else {
    out->push_back(static_cast<char>(0xF0 | (cp >> 18)));
    out->push_back(static_cast<char>(0x80 | ((cp >> 12) & 0x3F)));
    out->push_back(static_cast<char>(0x80 | ((cp >> 6) & 0x3F)));
    out->push_back(static_cast<char>(0x80 | (cp & 0x3F)));
  }
}

int DigitValue(char c, int base) {
  if (c >= '0' && c <= '9') return c - '0';
  if (base == 16 && c >= 'a' && c <= 'f') return c - 'a' + 10;
  if (base == 16 && c >= 'A' && c <= 'F') return c - 'A' + 10;
  return -1;
}

// Decodes "#NNN;" or "#xHHH;" (the text after "&"). Returns the length of the
// reference's text, or 0 when it is malformed or names no Unicode scalar value.
size_t DecodeCharacterReference(std::string_view ref, std::string* out) {
  size_t pos = 1;  // past '#'
  int base = 10;
  if (pos < ref.size() && ref[pos] == 'x') {
    base = 16;
    ++pos;
  }
  const size_t digits_start = pos;
  uint32_t cp = 0;
  bool too_big = false;
  for (int d; pos < ref.size() && (d = DigitValue(ref[pos], base)) >= 0; ++pos) {
    // Once past the Unicode range the value is only marked, never grown, so
    // a long digit run cannot overflow.
    if (!too_big) cp = cp * base + d;
    if (cp > 0x10FFFF) too_big = true;
  }
  if (pos == digits_start || pos >= ref.size() || ref[pos] != ';') return 0;
  if (too_big || cp == 0 || (cp >= 0xD800 && cp <= 0xDFFF)) return 0;
  AppendUtf8(cp, out);
  return pos + 1;
}

}  // namespace

size_t AppendDecodedReference(std::string_view ref, std::string* out) {
  static const struct {
    std::string_view name;
    char c;
  } kNamed[] = {{"amp;", '&'}, {"lt;", '<'}, {"gt;", '>'}, {"quot;", '"'}, {"apos;", '\''}};
  if (!ref.empty() && ref[0] == '#') return DecodeCharacterReference(ref, out);
  for (const auto& named : kNamed) {
    if (ref.substr(0, named.name.size()) == named.name) {
      out->push_back(named.c);
      return named.name.size();
    }
  }
  return 0;
}

void AppendEscaped(std::string_view value, std::string* out) {
  // Most values hold nothing to escape: they are appended in one piece.
  size_t plain = 0;
  for (size_t pos = 0; pos < value.size(); ++pos) {
    const char* entity = EntityFor(value[pos]);
    if (entity == nullptr) continue;
    out->append(value, plain, pos - plain);
    out->append(entity);
    plain = pos + 1;
  }
  out->append(value, plain, std::string_view::npos);
}

bool DecodeXmlReferences(std::string_view value, std::string* rewritten) {
  size_t amp = value.find('&');
  if (amp == std::string_view::npos) return false;  // nearly every value
  std::string out;
  out.reserve(value.size());  // a reference is longer than what it stands for
  size_t copied = 0;          // value before this position is already in `out`
  bool changed = false;
  for (size_t from = amp; (amp = value.find('&', from)) != std::string_view::npos;) {
    std::string decoded;
    const size_t length = AppendDecodedReference(value.substr(amp + 1), &decoded);
    if (length == 0) {
      from = amp + 1;
      continue;
    }
    out.append(value, copied, amp - copied);
    out.append(decoded);
    copied = from = amp + 1 + length;
    changed = true;
  }
  if (!changed) return false;
  out.append(value, copied, std::string_view::npos);
  *rewritten = std::move(out);
  return true;
}

}  // namespace zor2
