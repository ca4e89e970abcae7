#include "platform/tools/WordReplace.h"

#include <cstddef>
#include <string_view>

namespace {

bool IsSpace(char c) {
  return c == ' ' || c == '\t' || c == '\r' || c == '\n';
}

size_t WordEnd(std::string_view text, size_t pos) {
  while (pos < text.size() && IsWordCharacter(text[pos])) ++pos;
  return pos;
}

// Matches `words` (`count` of them) against `text` starting at the word that
// begins at `start`: the first word there, each further one after at least one
// white-space character and nothing else. Returns the end of the last matched
// word, or npos.
size_t MatchSequence(std::string_view text, size_t start, const std::string_view* words,
                     int count) {
  size_t pos = start;
  for (int i = 0; i < count; ++i) {
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

int replace(std::string& text, const char* first, const char* second, const char* third,
            const char* replacement) {
  if (first == nullptr || *first == '\0') return 0;
  std::string_view words[3] = {first};
  int count = 1;
  if (second != nullptr) {
    words[count++] = second;
    if (third != nullptr) words[count++] = third;
  }
  for (int i = 0; i < count; ++i) {
    if (words[i].empty()) return 0;  // no word of the text is empty
  }
  std::string_view with = replacement ? replacement : "";

  // Jump from one occurrence of the first word to the next (most texts hold
  // none); an occurrence counts only where a word of the text starts. A failed
  // match moves on past that word, a successful one resumes after the replaced
  // span, so the scan stays linear.
  std::string_view view(text);
  std::string out;
  size_t copied = 0;  // text before this position is already in `out`
  bool changed = false;
  size_t pos = 0;
  while ((pos = view.find(words[0], pos)) != std::string_view::npos) {
    if (pos > 0 && IsWordCharacter(view[pos - 1])) {
      pos = WordEnd(view, pos + 1);
      continue;
    }
    size_t end = MatchSequence(view, pos, words, count);
    if (end == std::string_view::npos) {
      pos = WordEnd(view, pos + 1);
      continue;
    }
    out.append(view, copied, pos - copied);
    out.append(with);
    copied = pos = end;
    changed = true;
  }
  if (!changed) return 0;
  out.append(view, copied, std::string_view::npos);
  text = std::move(out);
  return 1;
}
