#pragma once
namespace lib {
struct C {
  int value;
};
}  // namespace lib
