#pragma once
namespace lib {
class B {
 public:
  virtual ~B();
  virtual void Run() = 0;
};
}  // namespace lib
