#pragma once

#include <string>
#include <unordered_map>
#include <vector>

// A string-keyed index of untyped pointers that keeps the order of Append.
// The index does not own the pointees.
class TAIndex {
 public:
  // Appends (key, value) as the last entry. A key already present is appended
  // again; IsIn keeps answering the first entry of that key.
  void Append(const std::string& key, void* value);
  // The position (from 0) of the first entry with `key`, or -1 when absent.
  int IsIn(const std::string& key) const;
  int Count() const { return static_cast<int>(entries_.size()); }
  // Position from 0 to Count() - 1.
  void* ValueAt(int position) const { return entries_[static_cast<size_t>(position)].value; }
  const std::string& KeyAt(int position) const {
    return entries_[static_cast<size_t>(position)].key;
  }

 private:
  struct Entry {
    std::string key;
    void* value;
  };
  std::vector<Entry> entries_;
  std::unordered_map<std::string, int> positions_;
};
