#pragma once
namespace lib {
struct B {
  long Value() const;
};
}  // namespace lib
