#pragma once

#include <string_view>

namespace zor2 {

// Readers of the values of interface description documents (and of the
// "-level" option, which is written like a release).

// The text of `value` before its first blank (" "), or the whole value when it
// has none; empty for an absent (null) value.
inline std::string_view FirstWord(const char* value) {
  if (value == nullptr) return {};
  std::string_view text(value);
  return text.substr(0, text.find(' '));
}

// True when `value` is present and its first word is exactly `word`.
inline bool FirstWordIs(const char* value, std::string_view word) {
  return FirstWord(value) == word;
}

// The release written after the first upper-case "R" of a level such as
// "M4R18" (18), read as atoi would (leading blanks, a sign, digits up to the
// first non-digit) but clamped to the 32-bit range. 0 when the value is null,
// shorter than 4 characters, has no "R", or nothing after it.
int ReleaseAfterR(const char* value);

// True when ReleaseAfterR reads a number from `value`, rather than answering 0
// for want of one ("banana", "R", "M4Rx").
bool HoldsReleaseAfterR(const char* value);

// The release of a method's "Deprecated" value: the number written by the
// characters from the fourth one to the end when they are all decimal digits
// (and there is at least one), clamped to the 32-bit range; 0 otherwise, and
// for a null value.
int ReleaseFromFourthCharacter(const char* value);

}  // namespace zor2
