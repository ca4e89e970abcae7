#include "documents/type_name_normalization.h"

#include <array>
#include <iterator>

#include "platform/tools/word_replace.h"

namespace zor2 {
namespace {

// One row: a sequence of one to three words and what replaces it.
struct Rewrite {
  std::array<std::string_view, 3> words;
  size_t word_count;
  std::string_view replacement;
};

// Longer sequences come before their shorter tails. "long double" is parked as
// "QEXDOUBLE128" so that the lone "long" row leaves it alone, then restored.
constexpr Rewrite kRewrites[] = {
    {{"unsigned", "long", "long"}, 3, "QEXULONG64"},
    {{"signed", "long", "long"}, 3, "QEXLONG64"},
    {{"long", "long"}, 2, "QEXLONG64"},
    {{"unsigned", "long", "int"}, 3, "QEXULONG32"},
    {{"signed", "long", "int"}, 3, "QEXLONG32"},
    {{"long", "int"}, 2, "QEXLONG32"},
    {{"unsigned", "long"}, 2, "QEXULONG32"},
    {{"signed", "long"}, 2, "QEXLONG32"},
    {{"long", "double"}, 2, "QEXDOUBLE128"},
    {{"long"}, 1, "QEXLONG32"},
    {{"QEXDOUBLE128"}, 1, "long double"},
};

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
      for (size_t w = 0; w < kRewrites[i].word_count; ++w) {
        words[i] |= RowWordBit(kRewrites[i].words[w]);
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
bool NormalizeTypeNames(std::string_view value, std::string* rewritten) {
  if (!MayNormalizeTypeNames(value)) return false;
  const RowWordSpan span = FindRowWords(value);
  if (span.held == 0) return false;
  std::string text(value.substr(span.begin, span.end - span.begin));
  unsigned held = span.held;
  bool changed = false;
  for (size_t i = 0; i < std::size(kRewrites); ++i) {
    const Rewrite& r = kRewrites[i];
    const unsigned needed = RowWordsNeeded()[i];
    if ((held & needed) != needed) continue;
    if (!ReplaceWordSequence(&text, std::span(r.words.data(), r.word_count), r.replacement)) {
      continue;
    }
    changed = true;
    held |= FindRowWords(r.replacement).held;
  }
  if (!changed) return false;
  rewritten->assign(value.substr(0, span.begin));
  *rewritten += text;
  *rewritten += value.substr(span.end);
  return true;
}

// Every row needs "long" in the text, except the last, which needs
// "QEXDOUBLE128"; nearly every attribute value has neither.
bool MayNormalizeTypeNames(std::string_view value) {
  return value.find("long") != std::string_view::npos ||
         value.find("QEXDOUBLE128") != std::string_view::npos;
}

bool MayHoldNormalizedTypeNames(std::string_view value) {
  return value.find("QEX") != std::string_view::npos ||
         value.find("long") != std::string_view::npos;
}

}  // namespace zor2
