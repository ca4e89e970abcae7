#include "describe/comment_tags.h"

#include <cctype>

namespace zor2::describe {
namespace {

bool IsIdentifierChar(char c) {
  return std::isalnum(static_cast<unsigned char>(c)) != 0 || c == '_';
}

bool IsBlank(char c) {
  return c == ' ' || c == '\t' || c == '\r' || c == '\f' || c == '\v';
}

// Whether the '"' at `quote` opens a raw string literal: R"( with no prefix or
// with an encoding prefix (u8R, uR, UR, LR).
bool OpensRawString(std::string_view source, size_t quote) {
  if (quote == 0 || source[quote - 1] != 'R') return false;
  size_t start = quote - 1;
  for (std::string_view prefix : {"u8", "u", "U", "L"}) {
    if (start >= prefix.size() && source.substr(start - prefix.size(), prefix.size()) == prefix) {
      start -= prefix.size();
      break;
    }
  }
  return start == 0 || !IsIdentifierChar(source[start - 1]);
}

// The position just past the literal that starts with the quote at `open`
// (a string or a character literal, which ends at its line's end when it is
// not closed).
size_t SkipQuoted(std::string_view source, size_t open) {
  const char quote = source[open];
  size_t i = open + 1;
  while (i < source.size() && source[i] != quote && source[i] != '\n') {
    i += source[i] == '\\' ? 2 : 1;
  }
  return i < source.size() && source[i] == quote ? i + 1 : i;
}

// The position just past the raw string literal whose quote is at `open`.
size_t SkipRawString(std::string_view source, size_t open) {
  const size_t paren = source.find('(', open + 1);
  if (paren == std::string_view::npos) return source.size();
  std::string closing(1, ')');
  closing.append(source.substr(open + 1, paren - open - 1));
  closing.push_back('"');
  const size_t end = source.find(closing, paren + 1);
  return end == std::string_view::npos ? source.size() : end + closing.size();
}

// The end of the line comment that starts at `start`: its line end, or a
// later one when the line ends with a backslash.
size_t LineCommentEnd(std::string_view source, size_t start) {
  size_t end = source.find('\n', start);
  while (end != std::string_view::npos) {
    size_t last = end;
    if (last > start && source[last - 1] == '\r') --last;
    if (last == start || source[last - 1] != '\\') break;
    end = source.find('\n', end + 1);
  }
  if (end == std::string_view::npos) return source.size();
  return end > start && source[end - 1] == '\r' ? end - 1 : end;
}

// A digit separator (1'000) is not the start of a character literal.
bool IsDigitSeparator(std::string_view source, size_t quote) {
  return quote > 0 && quote + 1 < source.size() &&
         std::isdigit(static_cast<unsigned char>(source[quote - 1])) != 0 &&
         std::isxdigit(static_cast<unsigned char>(source[quote + 1])) != 0;
}

// The word that starts at `start` on the same line, after blanks; it ends at
// a blank, a line end or the end of a block comment.
std::string_view NextWord(std::string_view text, size_t start) {
  size_t i = start;
  while (i < text.size() && IsBlank(text[i])) ++i;
  size_t end = i;
  while (end < text.size() && !IsBlank(text[end]) && text[end] != '\n' &&
         text.substr(end, 2) != "*/") {
    ++end;
  }
  return text.substr(i, end - i);
}

bool IsRelease(std::string_view word) {
  size_t i = 0;
  auto skip = [&word, &i](int (*is)(int)) {
    const size_t from = i;
    while (i < word.size() && is(static_cast<unsigned char>(word[i])) != 0) ++i;
    return i > from;
  };
  if (!skip(std::isalpha) || !skip(std::isdigit)) return false;
  // The letters may end with the "R" itself only when digits came between.
  if (i >= word.size() || word[i] != 'R') return false;
  ++i;
  return skip(std::isdigit) && i == word.size();
}

// Looks for the tag `name` as a word from `from` on; answers the position
// just past it, or npos, and sets `value` as FindTag does.
size_t FindTagFrom(std::string_view comment, std::string_view name, size_t from,
                   std::string* value) {
  for (size_t at = comment.find(name, from); at != std::string_view::npos;
       at = comment.find(name, at + 1)) {
    const size_t end = at + name.size();
    const bool starts_word = at == 0 || !IsIdentifierChar(comment[at - 1]);
    const bool ends_word = end == comment.size() || !IsIdentifierChar(comment[end]);
    if (!starts_word || !ends_word) continue;
    std::string_view word = NextWord(comment, end);
    if (!word.empty() && word[0] == '@') word = {};
    if (value != nullptr) *value = std::string(word);
    return end;
  }
  return std::string_view::npos;
}

}  // namespace

std::vector<std::string_view> CommentsIn(std::string_view source) {
  std::vector<std::string_view> comments;
  size_t i = 0;
  while (i < source.size()) {
    const char c = source[i];
    if (c == '/' && i + 1 < source.size() && source[i + 1] == '/') {
      const size_t end = LineCommentEnd(source, i);
      comments.push_back(source.substr(i, end - i));
      i = end;
    } else if (c == '/' && i + 1 < source.size() && source[i + 1] == '*') {
      const size_t close = source.find("*/", i + 2);
      const size_t end = close == std::string_view::npos ? source.size() : close + 2;
      comments.push_back(source.substr(i, end - i));
      i = end;
    } else if (c == '"') {
      i = OpensRawString(source, i) ? SkipRawString(source, i) : SkipQuoted(source, i);
    } else if (c == '\'' && !IsDigitSeparator(source, i)) {
      i = SkipQuoted(source, i);
    } else {
      ++i;
    }
  }
  return comments;
}

bool FindTag(std::string_view comment, std::string_view name, std::string* value) {
  return FindTagFrom(comment, name, 0, value) != std::string_view::npos;
}

std::optional<std::string> FindRelease(std::string_view text) {
  size_t i = 0;
  while (i < text.size()) {
    while (i < text.size() && !IsIdentifierChar(text[i])) ++i;
    size_t end = i;
    while (end < text.size() && IsIdentifierChar(text[end])) ++end;
    const std::string_view word = text.substr(i, end - i);
    if (IsRelease(word)) return std::string(word);
    i = end;
  }
  return std::nullopt;
}

FileTags ReadFileTags(std::string_view source) {
  FileTags tags;
  std::string value;
  for (std::string_view comment : CommentsIn(source)) {
    if (!tags.level && FindTag(comment, "@ZOR2Level", &value)) tags.level = value;
    if (!tags.usage && FindTag(comment, "@ZOR2Usage", &value)) tags.usage = value;
    if (FindTag(comment, "@ZOR2NoAut", nullptr)) tags.not_automation = true;
  }
  return tags;
}

DeclarationTags ReadDeclarationTags(std::string_view comment) {
  DeclarationTags tags;
  if (comment.empty()) return tags;
  std::string value;
  tags.automation = FindTag(comment, "@ZOR2Aut", nullptr);
  tags.nodoc = FindTag(comment, "@nodoc", nullptr);
  if (FindTag(comment, "@ZOR2Property", &value) && !value.empty()) tags.property = value;
  if (FindTag(comment, "@deprecated", &value)) {
    tags.deprecated = true;
    if (IsRelease(value)) tags.deprecated_release = value;
  }
  // Each @ZOR2Retval names one argument; a method may name several.
  for (size_t at = FindTagFrom(comment, "@ZOR2Retval", 0, &value); at != std::string_view::npos;
       at = FindTagFrom(comment, "@ZOR2Retval", at, &value)) {
    if (!value.empty()) tags.retval_names.push_back(value);
  }
  return tags;
}

}  // namespace zor2::describe
