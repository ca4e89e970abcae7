#include "documents/InterfaceDocument.h"

#include <climits>
#include <cstring>

#include "platform/tools/Numbers.h"

int ReleaseAfterR(const char* value) {
  if (value == nullptr || std::strlen(value) < 4) return 0;
  const char* r = std::strchr(value, 'R');
  if (r == nullptr || r[1] == '\0') return 0;
  return SaturatingAtoi(r + 1);
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
