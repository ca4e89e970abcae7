#include "platform/tools/QEXFatalError.h"

#include <cstdio>
#include <cstdlib>

void QEXFatalError(const char* text, const char* file, int line) {
  // abort() does not flush stdio: push out what the log streams already hold
  // first, so the fatal line comes after them.
  std::fflush(nullptr);
  std::fprintf(stderr, "FATAL: %s (%s:%d)\n", text ? text : "", file ? file : "", line);
  std::fflush(stderr);
  std::abort();
}
