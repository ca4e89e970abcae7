#include "describe/source_scan.h"

#include <algorithm>

namespace zor2::describe {
namespace {

std::string_view WithoutLeadingBlanks(std::string_view text) {
  while (!text.empty() && (text.front() == ' ' || text.front() == '\t')) text.remove_prefix(1);
  return text;
}

}  // namespace

bool ScanDirectives(std::string_view source,
                    const std::function<void(std::string_view)>& on_directive) {
  bool holds_code = false;
  bool line_start = true;
  size_t pos = 0;
  while (pos < source.size()) {
    const char c = source[pos];
    if (c == '\n') {
      line_start = true;
      ++pos;
    } else if (c == ' ' || c == '\t' || c == '\r' || c == '\f' || c == '\v') {
      ++pos;
    } else if (source.compare(pos, 2, "//") == 0) {
      while (pos < source.size() && source[pos] != '\n') ++pos;
    } else if (source.compare(pos, 2, "/*") == 0) {
      const size_t end = source.find("*/", pos + 2);
      pos = end == std::string_view::npos ? source.size() : end + 2;
    } else if (c == '#' && line_start) {
      // A directive runs to the end of its line, continued lines included.
      const size_t begin = pos + 1;
      while (pos < source.size() && source[pos] != '\n') {
        pos += source[pos] == '\\' && pos + 1 < source.size() ? 2 : 1;
      }
      if (on_directive) on_directive(source.substr(begin, pos - begin));
    } else {
      holds_code = true;
      line_start = false;
      if (!on_directive) return true;
      ++pos;
    }
  }
  return holds_code;
}

std::string IncludeTarget(std::string_view directive) {
  directive = WithoutLeadingBlanks(directive);
  if (directive.substr(0, 7) != "include" || directive.substr(0, 12) == "include_next") return "";
  directive = WithoutLeadingBlanks(directive.substr(7));
  if (directive.empty()) return "";
  const char close = directive.front() == '<' ? '>' : directive.front() == '"' ? '"' : 0;
  if (close == 0) return "";
  const size_t closing = directive.find(close, 1);
  if (closing == std::string_view::npos) return "";
  return std::string(directive.substr(0, closing + 1));
}

std::string_view DirectiveAt(std::string_view source, size_t offset) {
  if (offset > source.size()) return "";
  const size_t newline = source.rfind('\n', offset == 0 ? 0 : offset - 1);
  const size_t begin = newline == std::string_view::npos || offset == 0 ? 0 : newline + 1;
  const size_t end = std::min(source.find('\n', begin), source.size());
  std::string_view line = WithoutLeadingBlanks(source.substr(begin, end - begin));
  if (line.empty() || line.front() != '#') return "";
  return line.substr(1);
}

}  // namespace zor2::describe
