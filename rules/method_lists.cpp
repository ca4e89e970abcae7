#include "rules/method_lists.h"

#include <cstring>

namespace zor2 {
namespace {

void LogMissing(const char* attribute, const MethodRecord& method, ClassSide side, Log& log) {
  log.Warning() << "  No " << attribute << " found for method "
                << (side == ClassSide::kReference ? "(ref)" : "(check)") << " : " << method.name;
}

bool IsPublicOrProtected(const char* access) {
  return std::strcmp(access, "Public") == 0 || std::strcmp(access, "Protected") == 0;
}

bool IsPureVirtual(const char* type) {
  return type != nullptr && std::strcmp(type, "PureVirtual") == 0;
}

}  // namespace

std::vector<MethodRecord> ReadClassMethods(const xml::Element& cls) {
  std::vector<MethodRecord> methods;
  for (const xml::Element* child = cls.first_child(); child; child = child->next_sibling()) {
    if (std::strcmp(child->tag(), "Method") != 0) continue;
    methods.push_back(ReadMethodAttributes(*child));
    // Only the methods that a list keeps are compared by their arguments.
    MethodRecord& method = methods.back();
    if (method.signature != nullptr && method.access != nullptr &&
        (IsPublicOrProtected(method.access) || IsPureVirtual(method.type))) {
      ReadArguments(method);
    }
  }
  return methods;
}

std::vector<const MethodRecord*> ComparableMethods(const std::vector<MethodRecord>& methods,
                                                   ClassSide side, Log& log) {
  std::vector<const MethodRecord*> kept;
  for (const MethodRecord& method : methods) {
    if (method.signature != nullptr && method.access != nullptr) {
      if (IsPublicOrProtected(method.access)) kept.push_back(&method);
      continue;
    }
    if (method.signature == nullptr) LogMissing("signature", method, side, log);
    if (method.access == nullptr) LogMissing("Access", method, side, log);
  }
  return kept;
}

std::vector<const MethodRecord*> PureVirtualMethods(const std::vector<MethodRecord>& methods,
                                                    ClassSide side, Log& log) {
  std::vector<const MethodRecord*> kept;
  for (const MethodRecord& method : methods) {
    if (method.signature != nullptr && method.access != nullptr && method.type != nullptr) {
      if (IsPureVirtual(method.type)) kept.push_back(&method);
      continue;
    }
    if (method.signature == nullptr) LogMissing("signature", method, side, log);
    if (method.access == nullptr) LogMissing("Access", method, side, log);
    if (method.type == nullptr) LogMissing("Type", method, side, log);
  }
  return kept;
}

}  // namespace zor2
