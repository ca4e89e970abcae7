#include "rules/method_records.h"

#include <cstring>
#include <string_view>

#include "rules/attribute_values.h"

namespace zor2 {
namespace {

// Equality of two optional texts: absent equals absent, and an absent text
// differs from any present one.
bool SameOptionalText(const char* a, const char* b) {
  if (a == nullptr || b == nullptr) return a == b;
  return std::strcmp(a, b) == 0;
}

// Equality of two texts that must both be present.
bool SamePresentText(const char* a, const char* b) {
  return a != nullptr && b != nullptr && std::strcmp(a, b) == 0;
}

bool IsArg(const xml::Element& element) {
  return std::strcmp(element.tag(), "Arg") == 0;
}

ArgumentRecord ReadArgument(const xml::Element& arg) {
  enum { kType, kName, kValue, kRetval, kCount };
  static constexpr std::string_view kNames[kCount] = {"Type", "Name", "Value", "Retval"};
  const char* values[kCount];
  arg.FindAttributes(kNames, values);
  return {values[kType], values[kName], values[kValue], values[kRetval]};
}

}  // namespace

MethodRecord ReadMethodAttributes(const xml::Element& method) {
  // Asked for in the order in which documents hold them, which is what
  // FindAttributes is quickest with.
  enum { kName, kAccess, kReturnedType, kSignature, kType, kNodoc, kProperty, kDeprecated, kCount };
  static constexpr std::string_view kNames[kCount] = {
      "Name", "Access", "ReturnedType", "Signature", "Type", "@nodoc", "Property", "Deprecated"};
  const char* values[kCount];
  method.FindAttributes(kNames, values);
  MethodRecord record;
  record.element = &method;
  record.name = values[kName];
  record.access = values[kAccess];
  record.returned_type = values[kReturnedType];
  record.signature = values[kSignature];
  record.type = values[kType];
  record.nodoc = values[kNodoc] != nullptr;
  if (const char* property = values[kProperty]) record.property = property[0];
  record.deprecated = ReleaseFromFourthCharacter(values[kDeprecated]);
  return record;
}

void ReadArguments(MethodRecord& method) {
  const xml::Element& element = *method.element;
  // Counted first, so that the list is allocated once.
  size_t count = 0;
  for (const xml::Element* child = element.first_child(); child; child = child->next_sibling()) {
    if (IsArg(*child)) ++count;
  }
  method.args.clear();
  method.args.reserve(count);
  for (const xml::Element* child = element.first_child(); child; child = child->next_sibling()) {
    if (IsArg(*child)) method.args.push_back(ReadArgument(*child));
  }
}

MethodRecord ReadMethod(const xml::Element& method) {
  MethodRecord record = ReadMethodAttributes(method);
  ReadArguments(record);
  return record;
}

bool SameArgType(const ArgumentRecord& a, const ArgumentRecord& b) {
  return SameOptionalText(a.type, b.type);
}

bool SameDefaultValue(const ArgumentRecord& a, const ArgumentRecord& b) {
  return SameOptionalText(a.value, b.value);
}

bool SameReturnedType(const MethodRecord& m, const MethodRecord& n) {
  return SameOptionalText(m.returned_type, n.returned_type);
}

bool SameMethod(const MethodRecord& m, const MethodRecord& n) {
  if (!SamePresentText(m.name, n.name)) return false;
  if (!SamePresentText(m.access, n.access)) return false;
  if (m.args.size() != n.args.size()) return false;
  for (size_t i = 0; i < m.args.size(); ++i) {
    if (!SameArgType(m.args[i], n.args[i])) return false;
  }
  return true;
}

}  // namespace zor2
