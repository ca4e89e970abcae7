#include "rules/attribute_values.h"

#include <cctype>
#include <climits>
#include <cstdint>
#include <cstring>

namespace zor2 {
namespace {

// atoi's reading, with a value beyond the 32-bit range clamped to INT_MIN or
// INT_MAX instead of overflowing; `read_digits` tells whether a digit was
// read at all.
int SaturatingAtoi(const char* text, bool* read_digits) {
  const char* p = text;
  while (std::isspace(static_cast<unsigned char>(*p))) ++p;
  bool negative = false;
  if (*p == '+' || *p == '-') negative = (*p++ == '-');
  // The magnitude stops growing once past the 32-bit range, so that
  // arbitrarily long digit runs cannot overflow.
  const int64_t limit = negative ? -static_cast<int64_t>(INT32_MIN) : INT32_MAX;
  int64_t magnitude = 0;
  *read_digits = *p >= '0' && *p <= '9';
  for (; *p >= '0' && *p <= '9'; ++p) {
    if (magnitude <= limit) magnitude = magnitude * 10 + (*p - '0');
  }
  if (magnitude > limit) magnitude = limit;
  return static_cast<int>(negative ? -magnitude : magnitude);
}

// Reads the release after the first "R" of `value`; `read_digits` tells
// whether there was a number to read.
int ReadReleaseAfterR(const char* value, bool* read_digits) {
  *read_digits = false;
  if (value == nullptr || std::strlen(value) < 4) return 0;
  const char* r = std::strchr(value, 'R');
  if (r == nullptr) return 0;
  return SaturatingAtoi(r + 1, read_digits);
}

}  // namespace

int ReleaseAfterR(const char* value) {
  bool read_digits;
  return ReadReleaseAfterR(value, &read_digits);
}

bool HoldsReleaseAfterR(const char* value) {
  bool read_digits;
  ReadReleaseAfterR(value, &read_digits);
  return read_digits;
}

int ReleaseFromFourthCharacter(const char* value) {
  if (value == nullptr || std::strlen(value) < 4) return 0;
  long long release = 0;
  for (const char* p = value + 3; *p != '\0'; ++p) {
    if (*p < '0' || *p > '9') return 0;
    if (release < INT_MAX) release = release * 10 + (*p - '0');
  }
  return release > INT_MAX ? INT_MAX : static_cast<int>(release);
}

}  // namespace zor2
