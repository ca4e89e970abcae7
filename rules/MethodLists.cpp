#include "rules/MethodLists.h"

#include <cstring>

#include "platform/tools/ZOROFStream.h"

namespace {

void LogMissing(const char* attribute, const MethodInfo& method, ClassSide side) {
  ZORerr << "  No " << attribute << " found for method "
         << (side == ClassSide::Reference ? "(ref)" : "(check)") << " : " << method.name << endl;
}

bool IsPublicOrProtected(const char* access) {
  return std::strcmp(access, "Public") == 0 || std::strcmp(access, "Protected") == 0;
}

// Calls `visit` with the record of each "Method" child of `cls`, in order,
// holding its attributes only: the arguments of a method that is kept are
// read then.
template <typename Visit>
void ForEachMethod(const QEXVBTXMLNode& cls, Visit visit) {
  for (QEXVBTXMLPosition p = cls.getFirstNodePosition(); p != nullptr;) {
    const QEXVBTXMLNode& child = *cls.getNextNode(p);
    if (std::strcmp(child.getTag(), "Method") == 0) visit(ReadMethodAttributes(child));
  }
}

void Keep(RecordList<MethodInfo>& methods, MethodInfo&& method) {
  ReadArguments(method);
  methods.push_back(std::move(method));
}

}  // namespace

RecordList<MethodInfo> ComparableMethods(const QEXVBTXMLNode& cls, ClassSide side) {
  RecordList<MethodInfo> methods;
  ForEachMethod(cls, [&methods, side](MethodInfo&& method) {
    if (method.signature != nullptr && method.access != nullptr) {
      if (IsPublicOrProtected(method.access)) Keep(methods, std::move(method));
      return;
    }
    if (method.signature == nullptr) LogMissing("signature", method, side);
    if (method.access == nullptr) LogMissing("Access", method, side);
  });
  return methods;
}

RecordList<MethodInfo> PureVirtualMethods(const QEXVBTXMLNode& cls, ClassSide side) {
  RecordList<MethodInfo> methods;
  ForEachMethod(cls, [&methods, side](MethodInfo&& method) {
    if (method.signature != nullptr && method.access != nullptr && method.type != nullptr) {
      if (std::strcmp(method.type, "PureVirtual") == 0) Keep(methods, std::move(method));
      return;
    }
    if (method.signature == nullptr) LogMissing("signature", method, side);
    if (method.access == nullptr) LogMissing("Access", method, side);
    if (method.type == nullptr) LogMissing("Type", method, side);
  });
  return methods;
}
