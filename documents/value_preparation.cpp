#include "documents/value_preparation.h"

#include <algorithm>
#include <array>

#include "platform/tools/word_replace.h"
#include "platform/tools/xml_escaping.h"

namespace zor2 {
namespace {

constexpr size_t npos = std::string_view::npos;

bool IsBlank(char c) {
  return c == ' ' || c == '\t' || c == '\r' || c == '\n';
}

// Whether a word of `text` starts at `pos`.
bool StartsWord(std::string_view text, size_t pos) {
  return pos == 0 || !IsWordCharacter(text[pos - 1]);
}

// Whether the whole word of `text` that starts at `pos` is `word`.
bool WordIs(std::string_view text, size_t pos, std::string_view word) {
  return text.compare(pos, word.size(), word) == 0 &&
         (pos + word.size() == text.size() || !IsWordCharacter(text[pos + word.size()]));
}

// Whether the text before `end`, from `floor` on, ends with the whole word
// `word`.
bool WordEndsAt(std::string_view text, size_t floor, size_t end, std::string_view word) {
  return end >= floor + word.size() && StartsWord(text, end - word.size()) &&
         text.compare(end - word.size(), word.size(), word) == 0;
}

// The characters that a candidate starts with: a reference's "&", and the
// first letters of "long" and "QEXDOUBLE128".
constexpr std::array<bool, 256> kCandidateStarts = [] {
  std::array<bool, 256> starts{};
  starts['&'] = starts['l'] = starts['Q'] = true;
  return starts;
}();

inline bool MayStartCandidate(char c) {
  return kCandidateStarts[static_cast<unsigned char>(c)];
}

// The first candidate of `text` at or after `from`: an "&", or the whole word
// "long" or "QEXDOUBLE128"; npos when there is none. Table look-ups, four
// characters at a time, since most values are short and hold none.
size_t NextCandidate(std::string_view text, size_t from) {
  const char* p = text.data() + from;
  const char* const end = text.data() + text.size();
  for (;; ++p) {
    while (end - p >= 4 && !(MayStartCandidate(p[0]) || MayStartCandidate(p[1]) ||
                             MayStartCandidate(p[2]) || MayStartCandidate(p[3]))) {
      p += 4;
    }
    while (p < end && !MayStartCandidate(*p)) ++p;
    if (p == end) return npos;
    const size_t at = p - text.data();
    if (*p == '&') return at;
    if (StartsWord(text, at) &&
        (*p == 'l' ? WordIs(text, at, "long") : WordIs(text, at, "QEXDOUBLE128"))) {
      return at;
    }
  }
}

// The start of the word after the blanks at `pos`, or npos when no blank is
// there.
size_t AfterBlanks(std::string_view text, size_t pos) {
  size_t after = pos;
  while (after < text.size() && IsBlank(text[after])) ++after;
  return after == pos ? npos : after;
}

// A spelling of a long integer type and what replaces it.
struct Spelling {
  size_t begin;
  size_t end;
  std::string_view replacement;
};

// The spelling around the whole word "long" at `at`, as the rows of
// NormalizeTypeNames, applied one after the other, would replace it: a sign
// word before it (from `floor` on), and "long", "int" or (unsigned) "double"
// after it, each across blanks. Left to right, the first candidate always
// wins: no row can match inside a longer one that starts earlier.
Spelling LongSpellingAt(std::string_view text, size_t floor, size_t at) {
  Spelling spelling{at, at + 4, {}};
  enum { kNone, kSigned, kUnsigned } sign = kNone;
  size_t before = at;
  while (before > floor && IsBlank(text[before - 1])) --before;
  if (before < at) {
    if (WordEndsAt(text, floor, before, "unsigned")) {
      sign = kUnsigned;
      spelling.begin = before - 8;
    } else if (WordEndsAt(text, floor, before, "signed")) {
      sign = kSigned;
      spelling.begin = before - 6;
    }
  }
  const size_t next = AfterBlanks(text, at + 4);
  if (next != npos && WordIs(text, next, "long")) {
    spelling.end = next + 4;
    spelling.replacement = sign == kUnsigned ? "QEXULONG64" : "QEXLONG64";
  } else if (next != npos && WordIs(text, next, "int")) {
    spelling.end = next + 3;
    spelling.replacement = sign == kUnsigned ? "QEXULONG32" : "QEXLONG32";
  } else if (sign == kNone && next != npos && WordIs(text, next, "double")) {
    // Parked and restored by the rows: a change all the same, to one blank.
    spelling.end = next + 6;
    spelling.replacement = "long double";
  } else {
    spelling.replacement = sign == kUnsigned ? "QEXULONG32" : "QEXLONG32";
  }
  return spelling;
}

}  // namespace

bool PrepareValue(std::string_view value, std::string* rewritten) {
  size_t at = NextCandidate(value, 0);
  if (at == npos) return false;  // nearly every value
  bool changed = false;
  size_t copied = 0;  // the value before this position is in `rewritten`
  auto replace = [&](size_t begin, size_t end, std::string_view replacement) {
    if (!changed) {
      rewritten->clear();
      changed = true;
    }
    rewritten->append(value, copied, begin - copied);
    rewritten->append(replacement);
    copied = end;
  };
  for (; at != npos; at = NextCandidate(value, std::max(copied, at + 1))) {
    if (value[at] == '&') {
      std::string decoded;  // at most four bytes: never allocates
      const size_t length = AppendDecodedReference(value.substr(at + 1), &decoded);
      if (length != 0) replace(at, at + 1 + length, decoded);
    } else if (value[at] == 'l') {
      const Spelling spelling = LongSpellingAt(value, copied, at);
      replace(spelling.begin, spelling.end, spelling.replacement);
    } else {
      replace(at, at + 12, "long double");
    }
  }
  if (!changed) return false;
  rewritten->append(value, copied, npos);
  return true;
}

}  // namespace zor2
