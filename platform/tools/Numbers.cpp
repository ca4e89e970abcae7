#include "platform/tools/Numbers.h"

#include <cctype>
#include <cstdint>

int SaturatingAtoi(const char* text) {
  const char* p = text;
  while (std::isspace(static_cast<unsigned char>(*p))) ++p;
  bool negative = false;
  if (*p == '+' || *p == '-') negative = (*p++ == '-');

  // Accumulate the magnitude in 64 bits and stop growing it once it is past the
  // 32-bit range, so that arbitrarily long digit runs cannot overflow.
  const int64_t limit = negative ? -static_cast<int64_t>(INT32_MIN) : INT32_MAX;
  int64_t magnitude = 0;
  for (; *p >= '0' && *p <= '9'; ++p) {
    if (magnitude <= limit) magnitude = magnitude * 10 + (*p - '0');
  }
  if (magnitude > limit) magnitude = limit;
  return static_cast<int>(negative ? -magnitude : magnitude);
}

std::string toString(int n) {
  return std::to_string(n);
}
