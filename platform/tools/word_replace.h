#pragma once

#include <array>
#include <span>
#include <string>
#include <string_view>

namespace zor2 {

// The characters that words are made of: ASCII letters, digits and "_". Bytes
// of multi-byte UTF-8 sequences end a word rather than extend it.
inline constexpr std::array<bool, 256> kWordCharacters = [] {
  std::array<bool, 256> word{};
  for (int c = 0; c < 256; ++c) {
    word[c] =
        (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') || c == '_';
  }
  return word;
}();

inline bool IsWordCharacter(char c) {
  return kWordCharacters[static_cast<unsigned char>(c)];
}

// Replaces in `text` every occurrence of the sequence `words` (one to three
// non-empty words) by `replacement`, scanning left to right without overlap.
// A word of the sequence matches only a whole word of the text (a maximal run
// of letters, digits and "_"); consecutive words of the sequence match words
// separated by white space; the span from the first matched word to the last
// is replaced and the rest of the text is kept. True when at least one
// replacement was made.
bool ReplaceWordSequence(std::string* text, std::span<const std::string_view> words,
                         std::string_view replacement);

}  // namespace zor2
