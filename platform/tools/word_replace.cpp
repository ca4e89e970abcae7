#include "platform/tools/word_replace.h"

#include <cstddef>

namespace zor2 {
namespace {

bool IsSpace(char c) {
  return c == ' ' || c == '\t' || c == '\r' || c == '\n';
}

size_t WordEnd(std::string_view text, size_t pos) {
  while (pos < text.size() && IsWordCharacter(text[pos])) ++pos;
  return pos;
}

// Matches `words` against `text` starting at the word that begins at `start`:
// the first word there, each further one after at least one white-space
// character and nothing else. Returns the end of the last matched word, or
// npos.
size_t MatchSequence(std::string_view text, size_t start, std::span<const std::string_view> words) {
  size_t pos = start;
  for (size_t i = 0; i < words.size(); ++i) {
    if (i > 0) {
      size_t after_blanks = pos;
      while (after_blanks < text.size() && IsSpace(text[after_blanks])) ++after_blanks;
      if (after_blanks == pos) return std::string_view::npos;
      pos = after_blanks;
    }
    size_t end = WordEnd(text, pos);
    if (text.substr(pos, end - pos) != words[i]) return std::string_view::npos;
    pos = end;
  }
  return pos;
}

}  // namespace

bool ReplaceWordSequence(std::string* text, std::span<const std::string_view> words,
                         std::string_view replacement) {
  if (words.empty()) return false;
  for (std::string_view word : words) {
    if (word.empty()) return false;  // no word of the text is empty
  }
  // Jump from one occurrence of the first word to the next (most texts hold
  // none); an occurrence counts only where a word of the text starts. A failed
  // match moves on past that word, a successful one resumes after the replaced
  // span, so the scan stays linear.
  std::string_view view(*text);
  std::string out;
  size_t copied = 0;  // text before this position is already in `out`
  bool changed = false;
  size_t pos = 0;
  while ((pos = view.find(words[0], pos)) != std::string_view::npos) {
    if (pos > 0 && IsWordCharacter(view[pos - 1])) {
      pos = WordEnd(view, pos + 1);
      continue;
    }
    size_t end = MatchSequence(view, pos, words);
    if (end == std::string_view::npos) {
      pos = WordEnd(view, pos + 1);
      continue;
    }
    out.append(view, copied, pos - copied);
    out.append(replacement);
    copied = pos = end;
    changed = true;
  }
  if (!changed) return false;
  out.append(view, copied, std::string_view::npos);
  *text = std::move(out);
  return true;
}

}  // namespace zor2
