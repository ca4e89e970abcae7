#pragma once

#include <cstddef>
#include <string>
#include <vector>

// An ordered list whose positions count from 1, as the callers of the tools
// component expect. A thin wrapper over std::vector.
template <typename T>
class QEXListVal {
 public:
  void Append(T value) { items_.push_back(std::move(value)); }
  int Size() const { return static_cast<int>(items_.size()); }
  // Position i runs from 1 to Size(); anything else is a programming error.
  const T& operator[](int i) const { return items_[static_cast<size_t>(i - 1)]; }
  T& operator[](int i) { return items_[static_cast<size_t>(i - 1)]; }

 private:
  std::vector<T> items_;
};

using QEXListValQEXString = QEXListVal<std::string>;
