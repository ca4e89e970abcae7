#include "platform/xml/text_encoding.h"

#include <iconv.h>
#include <sys/eventfd.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <climits>
#include <cstring>
#include <optional>
#include <string>
#include <string_view>

namespace zor2::xml {
namespace {

bool EqualsIgnoringCase(std::string_view text, std::string_view other) {
  return text.size() == other.size() &&
         std::equal(text.begin(), text.end(), other.begin(), [](char a, char b) {
           return (a >= 'a' && a <= 'z' ? a - 32 : a) == (b >= 'a' && b <= 'z' ? b - 32 : b);
         });
}

bool StartsWithIgnoringCase(std::string_view text, std::string_view prefix) {
  return text.size() >= prefix.size() && EqualsIgnoringCase(text.substr(0, prefix.size()), prefix);
}

// Encodings whose documents are already what the reader parses.
bool IsUTF8Name(std::string_view name) {
  return EqualsIgnoringCase(name, "UTF-8") || EqualsIgnoringCase(name, "UTF8") ||
         EqualsIgnoringCase(name, "US-ASCII") || EqualsIgnoringCase(name, "ASCII");
}

// Encodings of more than one byte per ASCII character: a declaration that
// could be read as ASCII cannot be written in one of them.
bool IsWideName(std::string_view name) {
  for (std::string_view prefix :
       {"UTF-16", "UTF16", "UTF-32", "UTF32", "UCS-2", "UCS2", "UCS-4", "UCS4"}) {
    if (StartsWithIgnoringCase(name, prefix)) return true;
  }
  return false;
}

// An XML encoding name: [A-Za-z] ([A-Za-z0-9._] | '-')*. Anything else never
// reaches iconv, whose names may carry options.
bool IsEncodingName(std::string_view name) {
  auto letter = [](char c) { return (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z'); };
  if (name.empty() || !letter(name[0])) return false;
  return std::all_of(name.begin(), name.end(), [&letter](char c) {
    return letter(c) || (c >= '0' && c <= '9') || c == '.' || c == '_' || c == '-';
  });
}

bool IsSpace(char c) {
  return c == ' ' || c == '\t' || c == '\n' || c == '\r';
}

struct Declaration {
  std::string_view encoding;
  size_t offset;  // of the encoding name in the text
};

// The encoding named by the XML declaration at the start of `text`, if any.
std::optional<Declaration> DeclaredEncoding(std::string_view text) {
  if (text.size() < 6 || text.substr(0, 5) != "<?xml" || !IsSpace(text[5])) return std::nullopt;
  std::string_view declaration = text.substr(0, text.find("?>"));
  for (size_t at = declaration.find("encoding"); at != std::string_view::npos;
       at = declaration.find("encoding", at + 1)) {
    if (!IsSpace(declaration[at - 1])) continue;
    size_t p = at + 8;
    while (p < declaration.size() && IsSpace(declaration[p])) ++p;
    if (p == declaration.size() || declaration[p] != '=') continue;
    ++p;
    while (p < declaration.size() && IsSpace(declaration[p])) ++p;
    if (p == declaration.size() || (declaration[p] != '"' && declaration[p] != '\'')) continue;
    size_t close = declaration.find(declaration[p], p + 1);
    if (close == std::string_view::npos) return std::nullopt;
    return Declaration{declaration.substr(p + 1, close - p - 1), p + 1};
  }
  return std::nullopt;
}

bool Refuse(ReadError* err, std::string reason, std::string_view text, size_t offset) {
  err->reason = std::move(reason);
  LocateInText(text.data(), text.data() + offset, &err->line, &err->column);
  return false;
}

class IconvHandle {
 public:
  explicit IconvHandle(iconv_t handle) : handle_(handle) {}
  IconvHandle(const IconvHandle&) = delete;
  IconvHandle& operator=(const IconvHandle&) = delete;
  ~IconvHandle() {
    if (valid()) iconv_close(handle_);
  }
  bool valid() const { return handle_ != reinterpret_cast<iconv_t>(-1); }
  iconv_t get() const { return handle_; }

 private:
  iconv_t handle_;
};

// A growing output buffer for iconv.
class Output {
 public:
  explicit Output(size_t capacity)
      : text_(TextBuffer::Allocate(capacity, capacity / 4)), next_(text_.data()), left_(capacity) {}
  char** next() { return &next_; }
  size_t* left() { return &left_; }
  const char* begin() const { return text_.data(); }
  const char* end() const { return next_; }
  void Grow() {
    size_t used = next_ - text_.data();
    size_t capacity = (used + left_) * 2;
    TextBuffer larger = TextBuffer::Allocate(capacity, capacity / 4);
    std::memcpy(larger.data(), text_.data(), used);
    text_ = std::move(larger);
    next_ = text_.data() + used;
    left_ = capacity - used;
  }
  TextBuffer Finish() {
    text_.size = next_ - text_.data();
    text_.bytes[text_.size] = '\0';
    return std::move(text_);
  }

 private:
  TextBuffer text_;
  char* next_;
  size_t left_;
};

// Why no conversion at all can be set up, or nothing when conversions work.
// glibc's iconv_open answers EINVAL both for a name it does not know and when
// it cannot load its conversion tables, as with no file descriptor left
// (after which it keeps failing for the whole process): a descriptor taken
// and given back, and a conversion that always exists, tell these apart.
std::optional<std::string> ConversionsUnavailable() {
  const int probe = ::eventfd(0, EFD_CLOEXEC);
  if (probe < 0) return std::strerror(errno);
  ::close(probe);
  IconvHandle known(iconv_open("UTF-8", "UTF-16LE"));
  if (!known.valid()) return "the system's conversion tables cannot be loaded";
  return std::nullopt;
}

// A converter from `encoding` could not be set up; iconv_open's errno tells
// why.
bool SetupFailed(const std::string& encoding, std::string_view bytes, size_t name_offset,
                 ReadError* err) {
  const int reason = errno;
  std::optional<std::string> unavailable =
      reason == EINVAL ? ConversionsUnavailable() : std::strerror(reason);
  if (!unavailable) return Refuse(err, "unknown encoding \"" + encoding + "\"", bytes, name_offset);
  // The system's failure, not the document's: no position.
  err->reason = "cannot convert from encoding \"" + encoding + "\": " + *unavailable;
  err->line = err->column = 0;
  return false;
}

bool ConversionFailed(ReadError* err, const std::string& encoding, const Output& output) {
  if (errno == EILSEQ) {
    err->reason = "byte sequence not valid in encoding \"" + encoding + "\"";
  } else if (errno == EINVAL) {
    err->reason = "incomplete character at the end of the document";
  } else {
    err->reason = std::strerror(errno);
  }
  LocateInText(output.begin(), output.end(), &err->line, &err->column);
  return false;
}

// Converts the bytes of `text` after the first `skip` ones from `encoding` to
// UTF-8. `name_offset` locates the encoding's name for an unknown encoding.
bool Transcode(const std::string& encoding, size_t unit, TextBuffer* text, size_t skip,
               size_t name_offset, ReadError* err) {
  std::string_view bytes(text->data(), text->size);
  IconvHandle converter(iconv_open("UTF-8", encoding.c_str()));
  if (!converter.valid()) return SetupFailed(encoding, bytes, name_offset, err);
  char* in = text->data() + skip;
  size_t in_left = text->size - skip;
  Output output(in_left / unit + in_left / (8 * unit) + 64);
  while (in_left > 0) {
    if (iconv(converter.get(), &in, &in_left, output.next(), output.left()) != size_t(-1)) continue;
    if (errno != E2BIG) return ConversionFailed(err, encoding, output);
    output.Grow();
  }
  // Ends a stateful encoding's last shift sequence.
  while (iconv(converter.get(), nullptr, nullptr, output.next(), output.left()) == size_t(-1)) {
    if (errno != E2BIG) return ConversionFailed(err, encoding, output);
    output.Grow();
  }
  *text = output.Finish();
  return true;
}

bool HasPrefix(std::string_view bytes, std::string_view prefix) {
  return bytes.substr(0, prefix.size()) == prefix;
}

}  // namespace

bool ConvertToUtf8(TextBuffer* text, size_t* start, ReadError* err) {
  std::string_view bytes(text->data(), text->size);
  *start = 0;
  if (HasPrefix(bytes, "\xEF\xBB\xBF")) {
    *start = 3;
    return true;
  }
  // UTF-32 first: its little-endian mark begins like UTF-16's.
  if (HasPrefix(bytes, std::string_view("\xFF\xFE\0\0", 4))) {
    return Transcode("UTF-32LE", 4, text, 4, 0, err);
  }
  if (HasPrefix(bytes, std::string_view("\0\0\xFE\xFF", 4))) {
    return Transcode("UTF-32BE", 4, text, 4, 0, err);
  }
  if (HasPrefix(bytes, "\xFF\xFE")) return Transcode("UTF-16LE", 2, text, 2, 0, err);
  if (HasPrefix(bytes, "\xFE\xFF")) return Transcode("UTF-16BE", 2, text, 2, 0, err);

  std::optional<Declaration> declared = DeclaredEncoding(bytes);
  if (!declared || IsUTF8Name(declared->encoding)) return true;
  std::string name(declared->encoding);
  if (!IsEncodingName(name)) {
    return Refuse(err, "invalid encoding name \"" + name + "\"", bytes, declared->offset);
  }
  if (IsWideName(name)) {
    return Refuse(err, "encoding \"" + name + "\" declared without a byte-order mark", bytes,
                  declared->offset);
  }
  return Transcode(name, 1, text, 0, declared->offset, err);
}

bool IsPlainUtf8(std::string_view head, bool whole) {
  if (HasPrefix(head, "\xEF\xBB\xBF")) return true;
  if (!whole && head.size() < 4) return false;
  for (std::string_view mark : {std::string_view("\xFF\xFE"), std::string_view("\xFE\xFF"),
                                std::string_view("\0\0\xFE\xFF", 4)}) {
    if (HasPrefix(head, mark)) return false;
  }
  // The declaration must be whole to be read.
  if (HasPrefix(head, "<?xml") && !whole && head.find("?>") == std::string_view::npos) {
    return false;
  }
  const std::optional<Declaration> declared = DeclaredEncoding(head);
  return !declared || IsUTF8Name(declared->encoding);
}

void LocateInText(const char* begin, const char* position, int* line, int* column) {
  size_t lines = 0;
  const char* line_start = begin;
  for (const char* p = begin; p < position; ++p) {
    if (*p != '\n' && *p != '\r') continue;
    if (*p == '\r' && p + 1 < position && p[1] == '\n') ++p;
    ++lines;
    line_start = p + 1;
  }
  // A character is counted at its first byte: UTF-8 continuation bytes are
  // 10xxxxxx.
  size_t characters = std::count_if(
      line_start, position, [](char c) { return (static_cast<unsigned char>(c) & 0xC0) != 0x80; });
  *line = static_cast<int>(std::min<size_t>(lines + 1, INT_MAX));
  *column = static_cast<int>(std::min<size_t>(characters + 1, INT_MAX));
}

}  // namespace zor2::xml
