#include "describe/token_text.h"

#include <cctype>
#include <string_view>

namespace zor2::describe {
namespace {

bool IsWordChar(char c) {
  return std::isalnum(static_cast<unsigned char>(c)) != 0 || c == '_';
}

bool IsQuote(char c) {
  return c == '"' || c == '\'';
}

// Whether `previous` and `next`, written without a blank, could be read as
// other tokens.
bool WouldRunTogether(const std::string& previous, const std::string& next) {
  const char last = previous.back();
  const char first = next.front();
  // Words, numbers, and literals with their prefixes and suffixes.
  if ((IsWordChar(last) || IsQuote(last)) && (IsWordChar(first) || IsQuote(first))) return true;
  // Two punctuators that would make a longer one ("->", ">>", "<:" ...), or a comment.
  static constexpr std::string_view kPairs[] = {
      "::", "->", "++", "--", "<<", ">>", "<=", ">=", "==", "!=", "&&", "||", "+=", "-=", "*=",
      "/=", "%=", "&=", "|=", "^=", "##", "<:", ":>", "<%", "%>", "%:", ".*", "..", "//", "/*"};
  const char pair[] = {last, first};
  for (std::string_view known : kPairs) {
    if (known == std::string_view(pair, 2)) return true;
  }
  return false;
}

}  // namespace

std::string JoinTokens(const std::vector<std::string>& tokens) {
  std::string text;
  for (size_t i = 0; i < tokens.size(); ++i) {
    if (tokens[i].empty()) continue;
    if (!text.empty() && (tokens[i - 1] == "," || WouldRunTogether(text, tokens[i]))) text += ' ';
    text += tokens[i];
  }
  return text;
}

}  // namespace zor2::describe
