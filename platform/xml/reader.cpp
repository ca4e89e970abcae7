#include "platform/xml/reader.h"

#include <strings.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdint>
#include <cstring>
#include <string>
#include <unordered_set>
#include <vector>

#include "platform/tools/file_descriptor.h"
#include "platform/tools/file_input.h"
#include "platform/xml/text_encoding.h"
#include "platform/xml/xml_characters.h"

namespace zor2::xml {
namespace {

enum CharacterClass : unsigned char {
  kSpace = 1,
  kNameStart = 2,
  kNameChar = 4,
  kAsciiNameChar = 8,
};

// XML names, with "@" allowed anywhere; every byte of a multi-byte UTF-8
// character counts as a name character, but for kAsciiNameChar.
constexpr std::array<unsigned char, 256> kClasses = [] {
  std::array<unsigned char, 256> classes{};
  for (int c = 0; c < 256; ++c) {
    bool ascii_start =
        (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || c == '_' || c == ':' || c == '@';
    bool ascii_name = ascii_start || (c >= '0' && c <= '9') || c == '-' || c == '.';
    bool space = c == ' ' || c == '\t' || c == '\n' || c == '\r';
    classes[c] = (space ? kSpace : 0) | (ascii_start || c >= 0x80 ? kNameStart : 0) |
                 (ascii_name || c >= 0x80 ? kNameChar : 0) | (ascii_name ? kAsciiNameChar : 0);
  }
  return classes;
}();

inline bool Is(char c, CharacterClass kind) {
  return (kClasses[static_cast<unsigned char>(c)] & kind) != 0;
}

inline char* SkipSpace(char* p) {
  while (Is(*p, kSpace)) ++p;
  return p;
}

inline char* SkipName(char* p) {
  while (Is(*p, kNameChar)) ++p;
  return p;
}

// Where the scan of an attribute value stops: at its closing quote, at "<"
// (not allowed in a value), at a zero byte (the end sentinel, or a zero in the
// text), and at what must be examined before the value may reach a report: a
// reference, a control character and the first byte of a non-ASCII character.
template <char kQuote>
constexpr std::array<bool, 256> kValueStops = [] {
  std::array<bool, 256> stops{};
  stops[static_cast<unsigned char>(kQuote)] = stops['<'] = stops['&'] = true;
  for (int c = 0; c < 0x20; ++c) stops[c] = c != '\t' && c != '\n' && c != '\r';
  for (int c = 0x80; c < 0x100; ++c) stops[c] = true;
  return stops;
}();

template <char kQuote>
char* ScanValue(char* p) {
  const std::array<bool, 256>& stops = kValueStops<kQuote>;
  for (;; p += 4) {
    if (stops[static_cast<unsigned char>(p[0])]) return p;
    if (stops[static_cast<unsigned char>(p[1])]) return p + 1;
    if (stops[static_cast<unsigned char>(p[2])]) return p + 2;
    if (stops[static_cast<unsigned char>(p[3])]) return p + 3;
  }
}

bool HasPrefix(const char* p, const char* end, std::string_view prefix) {
  return static_cast<size_t>(end - p) >= prefix.size() &&
         std::memcmp(p, prefix.data(), prefix.size()) == 0;
}

char* Find(char* from, char* end, std::string_view text) {
  return static_cast<char*>(memmem(from, end - from, text.data(), text.size()));
}

int DigitValue(char c, int base) {
  if (c >= '0' && c <= '9') return c - '0';
  if (base == 16 && c >= 'a' && c <= 'f') return c - 'a' + 10;
  if (base == 16 && c >= 'A' && c <= 'F') return c - 'A' + 10;
  return -1;
}

// Up to this many attributes, an element's names are compared pairwise; past
// it a hash set keeps the duplicate check linear.
constexpr size_t kPairwiseLimit = 16;

}  // namespace

// One pass over a document's text, in one window or in several read one after
// the other. Within a window the parser writes into the text only inside
// start tags, and never moves a byte other than the tag's, so a position
// keeps its line and column; the only line ends it overwrites (after an
// attribute name) are remembered in hidden_line_ends_ and put back before a
// fault is located. Once a window is parsed, the blocks of its elements are
// written compactly (document_storage.h), their values prepared, over the text
// already parsed.
class Parser {
 public:
  // Parses the whole of `text` into a new document.
  static bool Read(TextBuffer text, const ReadPreparation& preparation,
                   std::unique_ptr<Document>* document, ReadError* err) {
    size_t start = 0;
    if (!ConvertToUtf8(&text, &start, err)) return false;
    auto parsed = std::make_unique<Document>(Document::ReaderKey(), std::move(text));
    Parser parser(*parsed, preparation);
    char* const data = parsed->text_.data();
    if (!parser.ParseWindow(data + start, data + parsed->text_.size, false)) {
      parser.Locate(data + start, err);
      return false;
    }
    parser.Finish();
    *document = std::move(parsed);
    return true;
  }

  // Reads the regular file `file`, of `size` bytes, window after window into
  // a buffer of that size, so that the blocks the document keeps grow from the
  // front while the text still to parse follows them. False when the file
  // must be read whole instead: its encoding is not UTF-8, it is not
  // well-formed (the whole text is needed to say where), it changed size, or
  // it could not be read (`err` then says why).
  static bool ReadWindows(int file, size_t size, const ReadPreparation& preparation,
                          std::unique_ptr<Document>* document, ReadError* err);

 private:
  Parser(Document& document, const ReadPreparation& preparation)
      : document_(document), preparation_(preparation), out_(document.text_.data()) {
    if (preparation.originals != nullptr) preparation.originals->Clear();
  }

  // Parses [begin, end) (*end is zero); `more` tells whether text follows the
  // window, which must then end just before a "<", so that parsing stops
  // there between two pieces of markup. False with the fault set.
  bool ParseWindow(char* begin, char* end, bool more);
  // Sets `err` from the fault, in the text that starts at `begin`.
  void Locate(char* begin, ReadError* err) {
    err->reason = std::move(reason_);
    for (const HiddenLineEnd& hidden : hidden_line_ends_) begin[hidden.offset] = hidden.byte;
    LocateInText(begin, fault_, &err->line, &err->column);
  }
  // Writes the blocks of the window's elements compactly, with their values
  // prepared, from out_ on and ending by `limit`, where text still to parse
  // begins (or in the block arena when one would reach it).
  void CompactBlocks(const char* limit);
  void Finish() {
    if (preparation_.originals != nullptr) preparation_.originals->Seal();
  }

  bool ParseMarkup(char* lt);
  bool ParseStartTag(char* lt);
  bool ParseAttribute();
  template <char kQuote>
  char* ScanCheckedValue(char* value);
  bool CheckValueStop(char*& p);
  bool CheckReference(const char* amp);
  char* ScanName(char* p);
  bool SkipNonAscii(char*& p);
  bool RememberAttributeName(std::string_view name);
  bool ParseEndTag(char* lt);
  bool ParseDeclaration(char* lt);
  bool SkipDoctype(char* lt);
  char* SkipInternalSubset(char* p);
  char* SkipQuoted(char* p);
  bool ParseProcessingInstruction(char* lt);

  bool Fail(const char* at, std::string reason) {
    fault_ = at;
    reason_ = std::move(reason);
    return false;
  }
  // A fault at `at`, which may be the end of the text.
  bool Expected(const char* at, const std::string& what) {
    return Fail(at, (at == end_ ? "unexpected end of document, expected " : "expected ") + what);
  }

  Document& document_;
  const ReadPreparation& preparation_;
  char* begin_ = nullptr;
  char* end_ = nullptr;  // *end_ is the zero sentinel
  bool first_window_ = true;
  char* p_ = nullptr;
  // An element whose end tag is to come, by its index (elements move as the
  // store grows).
  static constexpr size_t kNone = static_cast<size_t>(-1);
  struct Open {
    size_t element;
    size_t last_child;  // kNone before the first child
  };
  std::vector<Open> open_;
  bool root_seen_ = false;
  bool root_closed_ = false;
  bool doctype_seen_ = false;
  std::vector<std::string_view> attribute_names_;
  std::unordered_set<std::string_view> attribute_set_;
  bool attribute_set_used_ = false;
  struct HiddenLineEnd {
    size_t offset;
    char byte;
  };
  std::vector<HiddenLineEnd> hidden_line_ends_;
  const char* fault_ = nullptr;
  std::string reason_;
  // The elements of the window, whose blocks are still where they were read.
  std::vector<size_t> fresh_;
  char* out_;  // where the next compact block goes
  std::string block_;
  std::string rewritten_;
  struct Kept {
    size_t offset;         // of the value in block_
    std::string original;  // copied: its text may be overwritten by the block
  };
  std::vector<Kept> kept_;
};

bool Parser::ParseWindow(char* begin, char* end, bool more) {
  begin_ = begin;
  end_ = end;
  hidden_line_ends_.clear();
  p_ = begin_;
  for (;;) {
    char* p = SkipSpace(p_);
    char* lt = p;
    if (*p != '<') {
      if (p == end_ && more) break;
      if (open_.empty()) {
        if (p == end_) break;
        return Fail(p,
                    root_closed_ ? "text after the root element" : "text before the root element");
      }
      // Text content is skipped, not examined.
      lt = static_cast<char*>(std::memchr(p, '<', end_ - p));
      if (lt == nullptr) break;
    }
    if (!ParseMarkup(lt)) return false;
  }
  first_window_ = false;
  if (!more) {
    if (!open_.empty()) {
      return Fail(end_, "unexpected end of document, element <" +
                            std::string(document_.elements_[open_.back().element].tag()) +
                            "> is not closed");
    }
    if (!root_seen_) return Fail(end_, begin_ == end_ ? "empty document" : "no root element");
  }
  CompactBlocks(end_);
  return true;
}

void Parser::CompactBlocks(const char* limit) {
  const ReadPreparation& prep = preparation_;
  for (size_t i = 0; i < fresh_.size(); ++i) {
    Element& element = document_.elements_[fresh_[i]];
    // The block as the window left it: the tag, then each attribute as
    //   separators name \0 [blanks] [=] [blanks] quote value \0
    // and ">" or "/".
    const char* p = element.block();
    const size_t tag_size = std::strlen(p) + 1;
    block_.assign(p, tag_size);
    kept_.clear();
    for (p += tag_size;;) {
      while (*p == '\0' || Is(*p, kSpace)) ++p;
      if (*p == '>' || *p == '/') break;
      const std::string_view name(p);
      block_.append(name.data(), name.size() + 1);
      p += name.size();
      while (*p != '"' && *p != '\'') ++p;
      const std::string_view value(p + 1);
      p = value.data() + value.size() + 1;
      std::string_view text = value;
      if (prep.rewrite != nullptr) {
        rewritten_.clear();
        if (prep.rewrite(value, &rewritten_)) {
          text = std::string_view(rewritten_.c_str());  // up to its first zero byte
          if (prep.originals != nullptr && prep.originals->WorthKeeping(value)) {
            kept_.push_back({block_.size(), std::string(value)});
          }
        }
      }
      block_.append(text.data(), text.size());
      block_.push_back('\0');
    }
    block_.push_back(kBlockEnd);
    // Up to where the next block of the window begins, or the text after it.
    const char* block_limit =
        i + 1 < fresh_.size() ? document_.elements_[fresh_[i + 1]].block() : limit;
    char* const place = document_.PlaceBlock(block_, out_, block_limit);
    element.set_block(place);
    for (const Kept& k : kept_) {
      prep.originals->Add(place + k.offset, k.original, place + block_.size() == out_);
    }
  }
  fresh_.clear();
}

bool Parser::ParseMarkup(char* lt) {
  switch (lt[1]) {
    case '/':
      return ParseEndTag(lt);
    case '!':
      return ParseDeclaration(lt);
    case '?':
      return ParseProcessingInstruction(lt);
    default:
      return ParseStartTag(lt);
  }
}

bool Parser::ParseStartTag(char* lt) {
  if (root_closed_) return Fail(lt, "more than one root element");
  char* name = lt + 1;
  if (!Is(*name, kNameStart)) return Expected(name, "an element name after '<'");
  char* name_end = ScanName(name);
  if (name_end == nullptr) return false;
  // The tag moves one byte left, over the "<", so that its zero terminator
  // does not overwrite the character after it.
  size_t length = name_end - name;
  std::memmove(lt, name, length);
  lt[length] = '\0';
  const size_t element = document_.elements_.Add(lt);
  fresh_.push_back(element);
  if (!root_seen_) {
    root_seen_ = true;
  } else {
    Open& parent = open_.back();
    ElementStore& elements = document_.elements_;
    if (parent.last_child != kNone) {
      elements[parent.last_child].links_ |= static_cast<uint32_t>(element - parent.last_child) << 1;
    } else {
      elements[parent.element].links_ |= 1;  // its first child follows it
    }
    parent.last_child = element;
  }

  attribute_names_.clear();
  if (attribute_set_used_) {
    attribute_set_ = {};  // a fresh set: clearing a large one costs its buckets
    attribute_set_used_ = false;
  }
  p_ = name_end;
  for (;;) {
    char* space = p_;
    p_ = SkipSpace(p_);
    if (*p_ == '>') {
      ++p_;
      open_.push_back({element, kNone});
      return true;
    }
    if (*p_ == '/') {
      if (p_[1] != '>') return Expected(p_ + 1, "'>' after '/'");
      p_ += 2;
      if (open_.empty()) root_closed_ = true;
      return true;
    }
    if (!Is(*p_, kNameStart)) {
      return Expected(p_, "an attribute name, '>' or '/>' in start tag <" + std::string(lt) + ">");
    }
    if (p_ == space) return Fail(p_, "white space expected before an attribute name");
    if (!ParseAttribute()) return false;
  }
}

bool Parser::ParseAttribute() {
  char* name = p_;
  char* name_end = ScanName(name);
  if (name_end == nullptr) return false;
  std::string_view name_text(name, name_end - name);
  char* p = SkipSpace(name_end);
  if (*p != '=') return Expected(p, "'=' after attribute name \"" + std::string(name_text) + "\"");
  p = SkipSpace(p + 1);
  char quote = *p;
  if (quote != '"' && quote != '\'') return Expected(p, "a quoted attribute value");
  char* value = p + 1;
  char* close = quote == '"' ? ScanCheckedValue<'"'>(value) : ScanCheckedValue<'\''>(value);
  if (close == nullptr) return false;
  if (!RememberAttributeName(name_text)) {
    return Fail(name, "duplicate attribute \"" + std::string(name_text) + "\"");
  }
  if (*name_end == '\n' || *name_end == '\r') {
    hidden_line_ends_.push_back({static_cast<size_t>(name_end - begin_), *name_end});
  }
  *name_end = '\0';
  *close = '\0';
  p_ = close + 1;
  return true;
}

// Returns the closing quote of the value that starts at `value`, or null
// with the fault set.
template <char kQuote>
char* Parser::ScanCheckedValue(char* value) {
  char* p = ScanValue<kQuote>(value);
  while (*p != kQuote) {
    if (!CheckValueStop(p)) return nullptr;
    p = ScanValue<kQuote>(p);
  }
  return p;
}

// At a stop of the value scan other than the closing quote: fails, or moves
// `p` past what it examined.
bool Parser::CheckValueStop(char*& p) {
  const unsigned char c = static_cast<unsigned char>(*p);
  if (c == '<') return Fail(p, "'<' is not allowed in an attribute value");
  if (c == 0) return Expected(p, "the closing quote of the attribute value");
  if (c == '&') return CheckReference(p++);
  if (c < 0x20) return Fail(p, "character " + CodePointName(c) + " is not allowed in XML");
  return SkipNonAscii(p);
}

// A character reference to a character that XML does not allow is a fault;
// anything else after "&" is left to the decoding of values, as written.
bool Parser::CheckReference(const char* amp) {
  if (amp[1] != '#') return true;
  const char* p = amp + 2;
  int base = 10;
  if (*p == 'x') {
    base = 16;
    ++p;
  }
  const char* digits = p;
  char32_t code_point = 0;
  bool too_large = false;
  for (int digit; (digit = DigitValue(*p, base)) >= 0; ++p) {
    // Past the Unicode range the value is only marked, so it cannot overflow.
    if (!too_large) code_point = code_point * base + digit;
    if (code_point > 0x10FFFF) too_large = true;
  }
  if (p == digits || *p != ';') return true;
  if (too_large) return Fail(amp, "character reference beyond U+10FFFF is not allowed in XML");
  if (IsXmlCharacter(code_point)) return true;
  return Fail(amp,
              "character reference to " + CodePointName(code_point) + " is not allowed in XML");
}

// Returns the end of the name that starts at `p` (whose first character was
// checked), or null with the fault set when a non-ASCII character of it is
// not well-formed UTF-8 or not allowed in XML.
char* Parser::ScanName(char* p) {
  for (;;) {
    while (Is(*p, kAsciiNameChar)) ++p;
    if (static_cast<unsigned char>(*p) < 0x80) return p;
    if (!SkipNonAscii(p)) return nullptr;
  }
}

// Moves `p` past the non-ASCII character there, or fails.
bool Parser::SkipNonAscii(char*& p) {
  char32_t code_point;
  const size_t length = DecodeUtf8(std::string_view(p, end_ - p), &code_point);
  if (length == 0) return Fail(p, "invalid UTF-8 byte sequence");
  if (!IsXmlCharacter(code_point)) {
    return Fail(p, "character " + CodePointName(code_point) + " is not allowed in XML");
  }
  p += length;
  return true;
}

bool Parser::RememberAttributeName(std::string_view name) {
  if (attribute_set_used_) return attribute_set_.insert(name).second;
  for (std::string_view seen : attribute_names_) {
    // Names of one element mostly differ in length or first character.
    if (seen.size() == name.size() && seen[0] == name[0] &&
        std::memcmp(seen.data(), name.data(), name.size()) == 0) {
      return false;
    }
  }
  attribute_names_.push_back(name);
  if (attribute_names_.size() > kPairwiseLimit) {
    attribute_set_.insert(attribute_names_.begin(), attribute_names_.end());
    attribute_set_used_ = true;
  }
  return true;
}

bool Parser::ParseEndTag(char* lt) {
  char* name = lt + 2;
  if (open_.empty()) {
    return Fail(lt,
                root_closed_ ? "end tag after the root element" : "end tag without a start tag");
  }
  const char* tag = document_.elements_[open_.back().element].tag();
  const char* expected = tag;
  char* p = name;
  while (*expected != '\0' && *expected == *p) {
    ++expected;
    ++p;
  }
  if (*expected != '\0' || Is(*p, kNameChar)) {
    char* found_end = SkipName(name);
    if (found_end == end_) return Expected(end_, "end tag </" + std::string(tag) + ">");
    return Fail(name, "end tag </" + std::string(name, found_end) + "> does not match start tag <" +
                          std::string(tag) + ">");
  }
  p = SkipSpace(p);
  if (*p != '>') return Expected(p, "'>' to close end tag </" + std::string(tag) + ">");
  p_ = p + 1;
  open_.pop_back();
  if (open_.empty()) root_closed_ = true;
  return true;
}

// "<!": a comment, a CDATA section or the DOCTYPE declaration, all skipped.
bool Parser::ParseDeclaration(char* lt) {
  char* p = lt + 2;
  if (HasPrefix(p, end_, "--")) {
    char* close = Find(p + 2, end_, "-->");
    if (close == nullptr) return Fail(lt, "comment is not closed");
    p_ = close + 3;
    return true;
  }
  if (HasPrefix(p, end_, "[CDATA[")) {
    if (open_.empty()) return Fail(lt, "CDATA section outside the root element");
    char* close = Find(p + 7, end_, "]]>");
    if (close == nullptr) return Fail(lt, "CDATA section is not closed");
    p_ = close + 3;
    return true;
  }
  if (HasPrefix(p, end_, "DOCTYPE") && Is(p[7], kSpace)) return SkipDoctype(lt);
  return Expected(p, "a comment, a CDATA section or DOCTYPE after '<!'");
}

// The DOCTYPE is skipped whole, internal subset included: the entities it
// declares are never expanded.
bool Parser::SkipDoctype(char* lt) {
  if (root_seen_) return Fail(lt, "DOCTYPE after the root element");
  if (doctype_seen_) return Fail(lt, "more than one DOCTYPE");
  char* p = lt + 9;
  while (*p != '>') {
    if (p == end_) return Fail(lt, "DOCTYPE is not closed");
    if (*p == '"' || *p == '\'') {
      p = SkipQuoted(p);
    } else if (*p == '[') {
      p = SkipInternalSubset(p + 1);
    } else {
      ++p;
    }
    if (p == nullptr) return Fail(lt, "DOCTYPE is not closed");
  }
  doctype_seen_ = true;
  p_ = p + 1;
  return true;
}

// Returns the position after the "]" that closes the subset, or null.
char* Parser::SkipInternalSubset(char* p) {
  while (p != nullptr && *p != ']') {
    if (p == end_) return nullptr;
    if (*p == '"' || *p == '\'') {
      p = SkipQuoted(p);
    } else if (HasPrefix(p, end_, "<!--")) {
      char* close = Find(p + 4, end_, "-->");
      p = close != nullptr ? close + 3 : nullptr;
    } else if (HasPrefix(p, end_, "<?")) {
      char* close = Find(p + 2, end_, "?>");
      p = close != nullptr ? close + 2 : nullptr;
    } else {
      ++p;
    }
  }
  return p != nullptr ? p + 1 : nullptr;
}

// Returns the position after the quote that closes the literal at `p`, or
// null.
char* Parser::SkipQuoted(char* p) {
  void* close = std::memchr(p + 1, *p, end_ - p - 1);
  return close != nullptr ? static_cast<char*>(close) + 1 : nullptr;
}

bool Parser::ParseProcessingInstruction(char* lt) {
  char* target = lt + 2;
  if (!Is(*target, kNameStart)) return Expected(target, "a processing instruction target");
  char* target_end = SkipName(target + 1);
  if (target_end - target == 3 && strncasecmp(target, "xml", 3) == 0 &&
      (lt != begin_ || !first_window_)) {
    return Fail(lt, "XML declaration not at the start of the document");
  }
  char* close = Find(target_end, end_, "?>");
  if (close == nullptr) return Fail(lt, "processing instruction is not closed");
  p_ = close + 2;
  return true;
}

namespace {

bool Refuse(ReadError* err, int error_number) {
  err->reason = std::strerror(error_number);
  return false;
}

// A window of text read at once: large enough that reading costs few calls,
// small enough to add little to what a document holds.
constexpr size_t kWindowBytes = size_t{1} << 20;

// Opens the regular file at `path` and sets `size`, by the rules of every
// input file (OpenRegularFile).
bool OpenDocument(const std::string& path, uintmax_t memory_limit, FileDescriptor* file,
                  size_t* size, ReadError* err) {
  FileReadError error;
  if (OpenRegularFile(path, memory_limit, file, size, &error)) return true;
  // A document that could never be held is refused before any of it is read.
  err->reason = error.too_large ? kNotEnoughMemory : std::move(error.reason);
  return false;
}

// Reads `file`, of `size` bytes when it was opened, in one piece into `text`.
bool ReadWhole(int file, size_t size, TextBuffer* text, ReadError* err) {
  TextBuffer buffer;
  const ReadRoom room = [&buffer](size_t room_size, size_t kept) {
    TextBuffer larger = TextBuffer::Allocate(room_size);
    if (kept > 0) std::memcpy(larger.data(), buffer.data(), kept);
    buffer = std::move(larger);
    return buffer.data();
  };
  size_t length = 0;
  FileReadError error;
  if (!ReadOpenFile(file, size, room, &length, &error)) {
    err->reason = std::move(error.reason);
    return false;
  }
  buffer.size = length;
  buffer.bytes[length] = '\0';
  *text = std::move(buffer);
  return true;
}

// Reads from `file` into [*end, limit), up to `wanted` bytes; sets `eof` when
// the file ended. False with errno set when it cannot be read.
bool ReadSome(int file, char*& end, const char* limit, size_t wanted, bool& eof) {
  for (;;) {
    const ssize_t got = ::read(file, end, std::min<size_t>(wanted, limit - end));
    if (got < 0 && errno == EINTR) continue;
    if (got < 0) return false;
    eof = got == 0;
    end += got;
    return true;
  }
}

}  // namespace

bool Parser::ReadWindows(int file, size_t size, const ReadPreparation& preparation,
                         std::unique_ptr<Document>* document, ReadError* err) {
  auto parsed = std::make_unique<Document>(Document::ReaderKey(), TextBuffer::Allocate(size));
  char* const data = parsed->text_.data();
  char* const capacity_end = data + size;
  Parser parser(*parsed, preparation);
  char* window = data;  // the text still to parse
  char* read_end = data;
  bool eof = false;
  size_t wanted = kWindowBytes;
  for (bool first = true;;) {
    while (!eof && static_cast<size_t>(read_end - window) < wanted) {
      if (read_end == capacity_end) {
        // All the bytes the file had when opened are read: it must end here.
        char probe;
        char* probe_end = &probe;
        if (!ReadSome(file, probe_end, &probe + 1, 1, eof)) return Refuse(err, errno);
        if (!eof) return false;  // it grew: read whole
        break;
      }
      if (!ReadSome(file, read_end, capacity_end, kWindowBytes, eof)) return Refuse(err, errno);
    }
    if (first) {
      const std::string_view head(data, read_end - data);
      if (!IsPlainUtf8(head, eof)) return false;
      if (head.starts_with("\xEF\xBB\xBF")) window += 3;
      first = false;
    }
    // A window ends just before its last "<", between two pieces of markup
    // (or, should the "<" stand in a comment, with a fault that has the file
    // read whole).
    char* cut = read_end;
    if (!eof) {
      cut = read_end - window > 1
                ? static_cast<char*>(::memrchr(window + 1, '<', read_end - window - 1))
                : nullptr;
      if (cut == nullptr) {
        wanted *= 2;
        continue;
      }
    }
    const char saved = *cut;
    *cut = '\0';
    const bool parsed_window = parser.ParseWindow(window, cut, !eof);
    *cut = saved;
    if (!parsed_window) return false;
    if (eof) break;
    // The rest follows the blocks, and the next window reads after it.
    const size_t rest = read_end - cut;
    std::memmove(parser.out_, cut, rest);
    window = parser.out_;
    read_end = window + rest;
    wanted = kWindowBytes;
  }
  parser.Finish();
  *document = std::move(parsed);
  return true;
}

bool ReadDocumentFile(const std::string& path, std::unique_ptr<Document>* document,
                      ReadError* err) {
  return ReadDocumentFile(path, MemoryLimit(), ReadPreparation(), document, err);
}

bool ReadDocumentFile(const std::string& path, uintmax_t memory_limit,
                      const ReadPreparation& preparation, std::unique_ptr<Document>* document,
                      ReadError* err) {
  *err = ReadError{};
  FileDescriptor file(-1);
  size_t size = 0;
  if (!OpenDocument(path, memory_limit, &file, &size, err)) return false;
  // A small document costs little more than its size read whole.
  if (size > 2 * kWindowBytes) {
    if (Parser::ReadWindows(file.get(), size, preparation, document, err)) return true;
    if (!err->reason.empty()) return false;
    // Read again from the start, whole.
    if (::lseek(file.get(), 0, SEEK_SET) != 0) return Refuse(err, errno);
  }
  TextBuffer text;
  if (!ReadWhole(file.get(), size, &text, err)) return false;
  return Parser::Read(std::move(text), preparation, document, err);
}

bool ReadDocumentText(std::string_view text, std::unique_ptr<Document>* document, ReadError* err) {
  *err = ReadError{};
  TextBuffer copy = TextBuffer::Allocate(text.size());
  if (!text.empty()) std::memcpy(copy.data(), text.data(), text.size());
  return Parser::Read(std::move(copy), ReadPreparation(), document, err);
}

}  // namespace zor2::xml
