#pragma once
#include <lib/b.h>
#include "lib/c.h"

namespace lib {
class A : public B {
 public:
  C Make() const;
};
}  // namespace lib
