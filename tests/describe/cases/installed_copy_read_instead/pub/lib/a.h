#pragma once
#include <lib/b.h>
namespace lib {
struct A {
  B Make();
};
}  // namespace lib
