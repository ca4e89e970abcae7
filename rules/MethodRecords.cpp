#include "rules/MethodRecords.h"

#include <cstring>

#include "documents/InterfaceDocument.h"
#include "platform/xml/QEXVBTXMLSearch.h"

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

}  // namespace

ArgInfo BuildArgInfo(const QEXVBTXMLNode& arg) {
  ArgInfo info;
  info.element = &arg;
  info.type = arg.getAttributeValue("Type");
  info.name = arg.getAttributeValue("Name");
  info.value = arg.getAttributeValue("Value");
  info.retval = arg.getAttributeValue("Retval");
  return info;
}

MethodInfo BuildMethodInfo(const QEXVBTXMLNode& method) {
  MethodInfo info;
  info.element = &method;
  info.name = method.getAttributeValue("Name");
  info.access = method.getAttributeValue("Access");
  info.returnedType = method.getAttributeValue("ReturnedType");
  info.signature = method.getAttributeValue("Signature");
  if (method.getAttributeValue("@nodoc") != nullptr) info.nodoc = 1;
  if (const char* property = method.getAttributeValue("Property")) info.property = property[0];
  info.deprecated = ReleaseFromFourthCharacter(method.getAttributeValue("Deprecated"));

  QEXVBTXMLSearch search;
  search.setSearch({QEXVBTXMLSearch::SearchChildren, QEXVBTXMLSearch::TagIs, "Arg"});
  search.searchStart(&method);
  info.args.reserve(search.matches().size());
  for (const QEXVBTXMLNode* arg : search.matches()) info.args.push_back(BuildArgInfo(*arg));
  return info;
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
