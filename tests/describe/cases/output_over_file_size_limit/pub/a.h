#pragma once
struct A {
  void F();
};
