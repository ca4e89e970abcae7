#pragma once

#include <array>
#include <string>

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

// Replaces in `text` every occurrence of the word sequence `first` [`second`
// [`third`]] by `replacement`. A word of the sequence matches only a whole
// word of the text (a maximal run of letters, digits and "_"); consecutive
// words of the sequence match words separated by white space; the span from
// the first matched word to the last is replaced and the rest of the text is
// kept. `second` and `third` may be null for shorter sequences (`third` must be
// null when `second` is). Returns 1 when at least one replacement was made.
int replace(std::string& text, const char* first, const char* second, const char* third,
            const char* replacement);
