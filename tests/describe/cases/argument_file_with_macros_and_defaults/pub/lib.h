#pragma once
#include "limits_config.h"

class LIB_EXPORT Engine {
 public:
  void Start(int iLimit = LIMIT);
#ifdef WITH_EXTRA
  void Extra();
#endif
#ifdef WITHOUT_EXTRA
  void NotDescribed();
#endif
  template <typename T>
    requires(sizeof(T) > 1)
  void Take(T iValue);
};
