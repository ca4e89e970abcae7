#include "platform/tools/TAIndex.h"

void TAIndex::Append(const std::string& key, void* value) {
  // emplace keeps an existing mapping, so a repeated key still answers its
  // first entry.
  positions_.emplace(key, static_cast<int>(entries_.size()));
  entries_.push_back(Entry{key, value});
}

int TAIndex::IsIn(const std::string& key) const {
  auto found = positions_.find(key);
  return found == positions_.end() ? -1 : found->second;
}
