#include "rules/pairing_index.h"

#include <algorithm>
#include <cstring>

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

// Equal for records that SameMethod pairs: the whole identity goes in (name,
// access, argument count and types), so that overloads of one name, however
// many, fall into runs of their own and pairing stays linear.
size_t IdentityHash(const MethodRecord& m) {
  size_t hash = 14695981039346656037ULL;  // FNV-1a
  auto add = [&hash](unsigned char byte) { hash = (hash ^ byte) * 1099511628211ULL; };
  auto add_text = [&add](const char* text) {
    for (const char* c = text; *c != '\0'; ++c) add(*c);
    add('\0');
  };
  add_text(m.name);
  add_text(m.access);
  for (const ArgumentRecord& arg : m.args) {
    // An absent type differs from every present one, the empty one included.
    if (arg.type != nullptr) add_text(arg.type);
    add(arg.type != nullptr ? '\1' : '\2');
  }
  return hash ^ m.args.size();
}

bool SameSignature(const MethodRecord& m, const MethodRecord& n) {
  return m.signature != nullptr && n.signature != nullptr &&
         std::strcmp(m.signature, n.signature) == 0;
}

}  // namespace

MethodIndex::MethodIndex(const std::vector<const MethodRecord*>& methods) : methods_(methods) {
  entries_.reserve(methods.size());
  for (size_t i = 0; i < methods.size(); ++i) {
    if (HasIdentity(*methods[i])) entries_.push_back({IdentityHash(*methods[i]), i});
  }
  std::sort(entries_.begin(), entries_.end());
}

size_t MethodIndex::Find(const MethodRecord& m) const {
  if (!HasIdentity(m)) return npos;
  const size_t hash = IdentityHash(m);
  auto entry = std::lower_bound(entries_.begin(), entries_.end(), Entry{hash, 0});
  size_t first = npos;
  for (; entry != entries_.end() && entry->hash == hash; ++entry) {
    const MethodRecord& n = *methods_[entry->position];
    if (!SameMethod(m, n)) continue;
    if (SameSignature(m, n)) return entry->position;
    if (first == npos) first = entry->position;
  }
  return first;
}

}  // namespace zor2
