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

// Calls `visit` with the record of each "Method" child of `cls`, in order,
// holding its attributes only: the arguments of a method that is kept are
// read then.
template <typename Visit>
void ForEachMethod(const xml::Element& cls, Visit visit) {
  for (const xml::Element* child = cls.first_child(); child; child = child->next_sibling()) {
    if (std::strcmp(child->tag(), "Method") == 0) visit(ReadMethodAttributes(*child));
  }
}

void Keep(std::vector<MethodRecord>& methods, MethodRecord&& method) {
  ReadArguments(method);
  methods.push_back(std::move(method));
}

}  // namespace

std::vector<MethodRecord> ComparableMethods(const xml::Element& cls, ClassSide side, Log& log) {
  std::vector<MethodRecord> methods;
  ForEachMethod(cls, [&](MethodRecord&& method) {
    if (method.signature != nullptr && method.access != nullptr) {
      if (IsPublicOrProtected(method.access)) Keep(methods, std::move(method));
      return;
    }
    if (method.signature == nullptr) LogMissing("signature", method, side, log);
    if (method.access == nullptr) LogMissing("Access", method, side, log);
  });
  return methods;
}

std::vector<MethodRecord> PureVirtualMethods(const xml::Element& cls, ClassSide side, Log& log) {
  std::vector<MethodRecord> methods;
  ForEachMethod(cls, [&](MethodRecord&& method) {
    if (method.signature != nullptr && method.access != nullptr && method.type != nullptr) {
      if (std::strcmp(method.type, "PureVirtual") == 0) Keep(methods, std::move(method));
      return;
    }
    if (method.signature == nullptr) LogMissing("signature", method, side, log);
    if (method.access == nullptr) LogMissing("Access", method, side, log);
    if (method.type == nullptr) LogMissing("Type", method, side, log);
  });
  return methods;
}

}  // namespace zor2
