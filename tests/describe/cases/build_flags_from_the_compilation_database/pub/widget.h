#pragma once
#include <config.h>
#if !defined(LIB_FEATURE)
#error LIB_FEATURE must be defined
#endif
struct Widget {
  lib_size_t Size() const;
  void Resize(lib_size_t size) requires true;
};
