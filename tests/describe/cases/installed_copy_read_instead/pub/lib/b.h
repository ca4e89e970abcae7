#pragma once
namespace lib {
struct B {
  int Value() const;
};
}  // namespace lib
