#include "rules/MethodRecords.h"

#include <cstring>
#include <string_view>

#include "documents/InterfaceDocument.h"

namespace {

// Equality of two optional texts: absent equals absent, and an absent text
// differs from any present one.
bool SameOptionalText(const char* a, const char* b) {
  if (a == nullptr || b == nullptr) return a == b;
  return std::strcmp(a, b) == 0;
}

bool IsArg(const QEXVBTXMLNode& element) {
  return std::strcmp(element.getTag(), "Arg") == 0;
}

// Equality of two texts that must both be present.
bool SamePresentText(const char* a, const char* b) {
  return a != nullptr && b != nullptr && std::strcmp(a, b) == 0;
}

}  // namespace

ArgInfo BuildArgInfo(const QEXVBTXMLNode& arg) {
  enum { kType, kName, kValue, kRetval, kCount };
  static constexpr std::string_view kNames[kCount] = {"Type", "Name", "Value", "Retval"};
  const char* values[kCount];
  arg.getAttributeValues(kNames, values);
  ArgInfo info;
  info.element = &arg;
  info.type = values[kType];
  info.name = values[kName];
  info.value = values[kValue];
  info.retval = values[kRetval];
  return info;
}

MethodInfo BuildMethodInfo(const QEXVBTXMLNode& method) {
  MethodInfo info = ReadMethodAttributes(method);
  ReadArguments(info);
  return info;
}

MethodInfo ReadMethodAttributes(const QEXVBTXMLNode& method) {
  // Asked for in the order in which documents hold them, which is what
  // getAttributeValues is quickest with.
  enum { kName, kAccess, kReturnedType, kSignature, kType, kNodoc, kProperty, kDeprecated, kCount };
  static constexpr std::string_view kNames[kCount] = {
      "Name", "Access", "ReturnedType", "Signature", "Type", "@nodoc", "Property", "Deprecated"};
  const char* values[kCount];
  method.getAttributeValues(kNames, values);
  MethodInfo info;
  info.element = &method;
  info.name = values[kName];
  info.access = values[kAccess];
  info.returnedType = values[kReturnedType];
  info.signature = values[kSignature];
  info.type = values[kType];
  if (values[kNodoc] != nullptr) info.nodoc = 1;
  if (const char* property = values[kProperty]) info.property = property[0];
  info.deprecated = ReleaseFromFourthCharacter(values[kDeprecated]);
  return info;
}

void ReadArguments(MethodInfo& method) {
  const QEXVBTXMLNode& element = *method.element;
  // The "Arg" children, counted first so that the list is allocated once.
  size_t count = 0;
  for (QEXVBTXMLPosition p = element.getFirstNodePosition(); p != nullptr;) {
    if (IsArg(*element.getNextNode(p))) ++count;
  }
  method.args.clear();
  method.args.reserve(count);
  for (QEXVBTXMLPosition p = element.getFirstNodePosition(); p != nullptr;) {
    const QEXVBTXMLNode& child = *element.getNextNode(p);
    if (IsArg(child)) method.args.push_back(BuildArgInfo(child));
  }
}

bool SameArgType(const ArgInfo& a, const ArgInfo& b) {
  return SameOptionalText(a.type, b.type);
}

bool HasRetval(const ArgInfo& a) {
  return a.retval != nullptr;
}

bool SameDefaultValue(const ArgInfo& a, const ArgInfo& b) {
  return SameOptionalText(a.value, b.value);
}

bool SameReturnedType(const MethodInfo& m, const MethodInfo& n) {
  return SameOptionalText(m.returnedType, n.returnedType);
}

bool SameMethod(const MethodInfo& m, const MethodInfo& n) {
  if (!SamePresentText(m.name, n.name)) return false;
  if (!SamePresentText(m.access, n.access)) return false;
  if (m.args.size() != n.args.size()) return false;
  for (size_t i = 0; i < m.args.size(); ++i) {
    if (!SameArgType(m.args[i], n.args[i])) return false;
  }
  return true;
}
