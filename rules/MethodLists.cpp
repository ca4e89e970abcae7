#include "rules/MethodLists.h"

#include <cstring>

#include "platform/tools/ZOROFStream.h"
#include "platform/xml/QEXVBTXMLSearch.h"

namespace {

void LogMissing(const char* attribute, const QEXVBTXMLNode& method, ClassSide side) {
  ZORerr << "  No " << attribute << " found for method "
         << (side == ClassSide::Reference ? "(ref)" : "(check)") << " : "
         << method.getAttributeValue("Name") << endl;
}

bool IsPublicOrProtected(const char* access) {
  return std::strcmp(access, "Public") == 0 || std::strcmp(access, "Protected") == 0;
}

}  // namespace

RecordList<MethodInfo> ComparableMethods(const QEXVBTXMLNode& cls, ClassSide side) {
  QEXVBTXMLSearch query;
  query.setSearch({QEXVBTXMLSearch::SearchChildren, QEXVBTXMLSearch::TagIs, "Method"});
  query.searchStart(&cls);
  RecordList<MethodInfo> methods;
  for (const QEXVBTXMLNode* method : query.matches()) {
    const char* signature = method->getAttributeValue("Signature");
    const char* access = method->getAttributeValue("Access");
    if (signature != nullptr && access != nullptr) {
      if (IsPublicOrProtected(access)) methods.push_back(BuildMethodInfo(*method));
      continue;
    }
    if (signature == nullptr) LogMissing("signature", *method, side);
    if (access == nullptr) LogMissing("Access", *method, side);
  }
  return methods;
}

RecordList<MethodInfo> PureVirtualMethods(const QEXVBTXMLNode& cls, ClassSide side) {
  QEXVBTXMLSearch query;
  query.setSearch({QEXVBTXMLSearch::SearchChildren, QEXVBTXMLSearch::TagIs, "Method"});
  query.searchStart(&cls);
  RecordList<MethodInfo> methods;
  for (const QEXVBTXMLNode* method : query.matches()) {
    const char* signature = method->getAttributeValue("Signature");
    const char* access = method->getAttributeValue("Access");
    const char* type = method->getAttributeValue("Type");
    if (signature != nullptr && access != nullptr && type != nullptr) {
      if (std::strcmp(type, "PureVirtual") == 0) methods.push_back(BuildMethodInfo(*method));
      continue;
    }
    if (signature == nullptr) LogMissing("signature", *method, side);
    if (access == nullptr) LogMissing("Access", *method, side);
    if (type == nullptr) LogMissing("Type", *method, side);
  }
  return methods;
}
