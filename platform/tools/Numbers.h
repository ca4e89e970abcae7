#pragma once

#include <string>

// Reads a decimal integer the way atoi does (leading white space, an optional
// sign, then digits up to the first non-digit; 0 when there is none), but a
// value beyond the 32-bit range is clamped to INT32_MIN or INT32_MAX instead
// of overflowing. `text` must not be null.
int SaturatingAtoi(const char* text);

// The decimal text of `n`.
std::string toString(int n);
