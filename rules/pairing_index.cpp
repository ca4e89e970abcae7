#include "rules/pairing_index.h"

#include <algorithm>

namespace zor2 {

NameIndex::NameIndex(const std::vector<const xml::Element*>& elements) {
  first_.reserve(elements.size());
  for (const xml::Element* element : elements) {
    const char* name = element->FindAttribute("Name");
    if (name != nullptr) first_.try_emplace(name, element);  // keeps the first
  }
}

const xml::Element* NameIndex::Find(const char* name) const {
  if (name == nullptr) return nullptr;
  auto found = first_.find(name);
  return found == first_.end() ? nullptr : found->second;
}

namespace {

// A method without name or access is the same as no method, not even itself,
// so it must stay out of the index.
bool HasIdentity(const MethodRecord& m) {
  return m.name != nullptr && m.access != nullptr;
}

// Equal for records that SameMethod pairs. Only the name, the access and the
// argument count go in: one pass over two short texts, while the few
// overloads that share all three are told apart by SameMethod.
size_t IdentityHash(const MethodRecord& m) {
  size_t hash = 14695981039346656037ULL;  // FNV-1a
  auto add = [&hash](unsigned char byte) { hash = (hash ^ byte) * 1099511628211ULL; };
  for (const char* c = m.name; *c != '\0'; ++c) add(*c);
  add('\0');
  for (const char* c = m.access; *c != '\0'; ++c) add(*c);
  return hash ^ m.args.size();
}

}  // namespace

MethodIndex::MethodIndex(const std::vector<MethodRecord>& methods) : methods_(methods) {
  entries_.reserve(methods.size());
  for (size_t i = 0; i < methods.size(); ++i) {
    if (HasIdentity(methods[i])) entries_.push_back({IdentityHash(methods[i]), i});
  }
  std::sort(entries_.begin(), entries_.end());
}

size_t MethodIndex::Find(const MethodRecord& m) const {
  if (!HasIdentity(m)) return npos;
  const size_t hash = IdentityHash(m);
  auto entry = std::lower_bound(entries_.begin(), entries_.end(), Entry{hash, 0});
  for (; entry != entries_.end() && entry->hash == hash; ++entry) {
    if (SameMethod(m, methods_[entry->position])) return entry->position;
  }
  return npos;
}

}  // namespace zor2
