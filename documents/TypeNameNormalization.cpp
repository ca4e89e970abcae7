#include "documents/TypeNameNormalization.h"

#include <array>
#include <iterator>

#include "platform/tools/WordReplace.h"

namespace {

struct Rewrite {
  const char* first;
  const char* second;
  const char* third;
  const char* replacement;
};

// Longer sequences come before their shorter tails. "long double" is parked as
// "QEXDOUBLE128" so that the lone "long" row leaves it alone, then restored.
constexpr Rewrite kRewrites[] = {
    {"unsigned", "long", "long", "QEXULONG64"},
    {"signed", "long", "long", "QEXLONG64"},
    {"long", "long", nullptr, "QEXLONG64"},
    {"unsigned", "long", "int", "QEXULONG32"},
    {"signed", "long", "int", "QEXLONG32"},
    {"long", "int", nullptr, "QEXLONG32"},
    {"unsigned", "long", nullptr, "QEXULONG32"},
    {"signed", "long", nullptr, "QEXLONG32"},
    {"long", "double", nullptr, "QEXDOUBLE128"},
    {"long", nullptr, nullptr, "QEXLONG32"},
    {"QEXDOUBLE128", nullptr, nullptr, "long double"},
};

// Every row needs "long" in the text, except the last, which needs
// "QEXDOUBLE128"; nearly every attribute value has neither.
bool MayNeedRewriting(std::string_view value) {
  return value.find("long") != std::string_view::npos ||
         value.find("QEXDOUBLE128") != std::string_view::npos;
}

// The words that the rows look for, one bit each in a word set.
constexpr std::string_view kRowWords[] = {"long", "unsigned", "signed",
                                          "int",  "double",   "QEXDOUBLE128"};

// The bit of a row word, or 0 for any other word.
unsigned RowWordBit(std::string_view word) {
  for (size_t i = 0; i < std::size(kRowWords); ++i) {
    const std::string_view row_word = kRowWords[i];
    if (word.size() == row_word.size() && word[0] == row_word[0] && word == row_word) {
      return 1u << i;
    }
  }
  return 0;
}

// Where the row words of a text are: the set of those it holds as whole
// words, and the span from the start of the first to the end of the last.
struct RowWordSpan {
  unsigned held = 0;
  size_t begin = 0;
  size_t end = 0;
};

RowWordSpan FindRowWords(std::string_view text) {
  RowWordSpan span;
  size_t pos = 0;
  while (pos < text.size()) {
    if (!IsWordCharacter(text[pos])) {
      ++pos;
      continue;
    }
    size_t end = pos + 1;
    while (end < text.size() && IsWordCharacter(text[end])) ++end;
    if (const unsigned bit = RowWordBit(text.substr(pos, end - pos))) {
      if (span.held == 0) span.begin = pos;
      span.held |= bit;
      span.end = end;
    }
    pos = end;
  }
  return span;
}

// The words each row needs, in the order of kRewrites.
const std::array<unsigned, std::size(kRewrites)>& RowWordsNeeded() {
  static const auto needed = [] {
    std::array<unsigned, std::size(kRewrites)> words{};
    for (size_t i = 0; i < words.size(); ++i) {
      for (const char* word : {kRewrites[i].first, kRewrites[i].second, kRewrites[i].third}) {
        if (word != nullptr) words[i] |= RowWordBit(word);
      }
    }
    return words;
  }();
  return needed;
}

}  // namespace

// Two shortcuts keep the result that applying every row to the whole value
// gives. A match is made of row words and the blanks between them, so the
// rows only need to see the span from the first row word to the end of the
// last: the text around it is kept as it is. And a row can only match when
// the span holds each of its words, so rows whose words are missing are
// passed over. A replacement may bring row words in ("long double" is parked
// and restored), which then count as held.
int NormalizeTypeNames(std::string_view value, std::string& rewritten) {
  if (!MayNeedRewriting(value)) return 0;
  const RowWordSpan span = FindRowWords(value);
  if (span.held == 0) return 0;
  std::string text(value.substr(span.begin, span.end - span.begin));
  unsigned held = span.held;
  int changed = 0;
  for (size_t i = 0; i < std::size(kRewrites); ++i) {
    const Rewrite& r = kRewrites[i];
    const unsigned needed = RowWordsNeeded()[i];
    if ((held & needed) != needed) continue;
    if (replace(text, r.first, r.second, r.third, r.replacement) == 0) continue;
    changed = 1;
    held |= FindRowWords(r.replacement).held;
  }
  if (changed == 0) return 0;
  rewritten.assign(value.substr(0, span.begin));
  rewritten += text;
  rewritten += value.substr(span.end);
  return 1;
}
