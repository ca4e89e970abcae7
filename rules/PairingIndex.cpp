#include "rules/PairingIndex.h"

#include <functional>

NameIndex::NameIndex(const std::vector<QEXVBTXMLNode*>& elements) {
  first_.reserve(elements.size());
  for (const QEXVBTXMLNode* element : elements) {
    const char* name = element->getAttributeValue("Name");
    if (name != nullptr) first_.try_emplace(name, element);  // keeps the first
  }
}

const QEXVBTXMLNode* NameIndex::Find(const char* name) const {
  if (name == nullptr) return nullptr;
  auto found = first_.find(name);
  return found == first_.end() ? nullptr : found->second;
}

namespace {

// A method without name or access is the same as no method, not even itself,
// so it must stay out of the identity map.
bool HasIdentity(const MethodInfo& m) {
  return m.name != nullptr && m.access != nullptr;
}

size_t Combine(size_t seed, size_t value) {
  return seed ^ (value + 0x9e3779b97f4a7c15ULL + (seed << 6) + (seed >> 2));
}

}  // namespace

size_t MethodIndex::IdentityHash::operator()(const MethodInfo* m) const {
  std::hash<std::string_view> text;
  size_t seed = Combine(text(m->name), text(m->access));
  seed = Combine(seed, m->args.size());
  for (const ArgInfo& arg : m->args) {
    // An absent type must hash apart from an empty one, as SameArgType tells
    // them apart.
    seed = Combine(seed, arg.type == nullptr ? 0x5bd1e995 : text(arg.type));
  }
  return seed;
}

MethodIndex::MethodIndex(const RecordList<MethodInfo>& methods) {
  first_.reserve(methods.size());
  for (size_t i = 0; i < methods.size(); ++i) {
    if (HasIdentity(methods[i])) first_.try_emplace(&methods[i], i);  // keeps the first
  }
}

size_t MethodIndex::Find(const MethodInfo& m) const {
  if (!HasIdentity(m)) return npos;
  auto found = first_.find(&m);
  return found == first_.end() ? npos : found->second;
}
