#include "describe/class_facts.h"

#include <set>
#include <string>
#include <utility>

#include "describe/clang_handles.h"

namespace zor2::describe {
namespace {

bool IsConstructor(CXCursor cursor) {
  return clang_getCursorKind(cursor) == CXCursor_Constructor ||
         (clang_getCursorKind(cursor) == CXCursor_FunctionTemplate &&
          clang_getTemplateCursorKind(cursor) == CXCursor_Constructor);
}

bool IsUsable(CXCursor member) {
  return clang_getCursorAvailability(member) != CXAvailability_NotAvailable &&
         clang_getCXXAccessSpecifier(member) != CX_CXXPrivate;
}

// The class definition that `type` names, or a null cursor. A template's
// implicit instantiation shows none of its members: its template's stand in.
CXCursor DefinitionOf(CXType type) {
  const CXCursor declaration = clang_getTypeDeclaration(clang_getCanonicalType(type));
  if (clang_Cursor_isNull(declaration)) return declaration;
  const CXCursor definition = clang_getCursorDefinition(declaration);
  if (clang_Cursor_isNull(definition) || !ChildrenOf(definition).empty()) return definition;
  const CXCursor pattern = clang_getSpecializedCursorTemplate(definition);
  return clang_Cursor_isNull(pattern) ? definition : pattern;
}

// The class's own name, without template arguments.
std::string ShortName(CXCursor definition) {
  std::string name = Take(clang_getCursorSpelling(definition));
  const size_t angle = name.find('<');
  if (angle != std::string::npos) name.erase(angle);
  return name;
}

// The type of the class `definition` itself: its identity and how a person
// writes it.
struct SelfType {
  std::string identity;
  std::string written;
};

SelfType SelfTypeOf(CXCursor definition, const TemplateParameters& parameters) {
  const CXType type = clang_getCursorType(definition);
  if (type.kind != CXType_Invalid) {
    return {TypeIdentity(type, parameters), parameters.Written(Take(clang_getTypeSpelling(type)))};
  }
  // A class template's own type is its name with its parameters.
  SelfType self{ShortName(definition) + "<", ShortName(definition) + "<"};
  bool first = true;
  for (const TemplateParameters::Parameter& parameter : parameters.Innermost()) {
    if (!first) {
      self.identity += ", ";
      self.written += ", ";
    }
    first = false;
    self.identity += parameter.positional;
    self.written += parameter.declared.empty() ? parameter.positional : parameter.declared;
    if (parameter.pack) {
      self.identity += "...";
      self.written += "...";
    }
  }
  self.identity += ">";
  self.written += ">";
  return self;
}

// Whether `parameter` is a reference of kind `kind` to the class whose
// identity is `self` (or, with CXType_Record, the class itself by value).
bool IsOfClass(CXCursor parameter, CXTypeKind kind, const std::string& self,
               const TemplateParameters& parameters) {
  const CXType type = clang_getCanonicalType(clang_getCursorType(parameter));
  const bool by_value = kind == CXType_Record;
  if (!by_value && type.kind != kind) return false;
  std::string identity = TypeIdentity(by_value ? type : clang_getPointeeType(type), parameters);
  if (identity.compare(0, 6, "const ") == 0) identity.erase(0, 6);
  return identity == self;
}

std::vector<CXCursor> ParametersOf(CXCursor function) {
  std::vector<CXCursor> parameters;
  for (CXCursor child : ChildrenOf(function)) {
    if (clang_getCursorKind(child) == CXCursor_ParmDecl) parameters.push_back(child);
  }
  return parameters;
}

DeclaredMembers ReadDeclaredMembers(CXCursor definition) {
  DeclaredMembers declared;
  const TemplateParameters parameters = TemplateParameters::Around(definition);
  const std::string self = SelfTypeOf(definition, parameters).identity;
  for (CXCursor child : ChildrenOf(definition)) {
    const CXCursorKind kind = clang_getCursorKind(child);
    if (IsConstructor(child)) {
      declared.any_constructor = true;
      if (clang_getCXXAccessSpecifier(child) != CX_CXXPrivate &&
          clang_getCursorAvailability(child) != CXAvailability_NotAvailable) {
        declared.public_or_protected_constructor = true;
      }
      if (kind != CXCursor_Constructor) continue;
      if (clang_CXXConstructor_isDefaultConstructor(child)) {
        declared.default_constructor = true;
        declared.usable_default_constructor = IsUsable(child);
      } else if (clang_CXXConstructor_isCopyConstructor(child)) {
        declared.copy_constructor = true;
        declared.usable_copy_constructor = IsUsable(child);
      } else if (clang_CXXConstructor_isMoveConstructor(child)) {
        declared.move_constructor = true;
      }
    } else if (kind == CXCursor_Destructor) {
      declared.destructor = true;
      if (clang_CXXMethod_isVirtual(child)) declared.virtual_destructor = true;
    } else if (kind == CXCursor_CXXMethod && Take(clang_getCursorSpelling(child)) == "operator=") {
      const std::vector<CXCursor> arguments = ParametersOf(child);
      if (arguments.size() != 1) continue;
      if (IsOfClass(arguments[0], CXType_RValueReference, self, parameters)) {
        declared.move_assignment = true;
      } else if (IsOfClass(arguments[0], CXType_LValueReference, self, parameters) ||
                 IsOfClass(arguments[0], CXType_Record, self, parameters)) {
        declared.copy_assignment = true;
        declared.usable_copy_assignment = IsUsable(child);
      }
    }
    if ((kind == CXCursor_CXXMethod || kind == CXCursor_Destructor ||
         kind == CXCursor_ConversionFunction) &&
        clang_CXXMethod_isVirtual(child)) {
      declared.virtual_function = true;
    }
  }
  return declared;
}

// Whether `type` depends on a template parameter: which class it names is
// then known only where the template is used.
bool IsDependent(CXType type) {
  return Take(clang_getTypeSpelling(clang_getCanonicalType(type))).find("type-parameter-") !=
         std::string::npos;
}

// The class definitions that `definition` derives from directly, those that
// depend on its template parameters left out.
std::vector<CXCursor> BasesOf(CXCursor definition) {
  std::vector<CXCursor> bases;
  for (CXCursor child : ChildrenOf(definition)) {
    if (clang_getCursorKind(child) != CXCursor_CXXBaseSpecifier) continue;
    if (IsDependent(clang_getCursorType(child))) continue;
    const CXCursor base = DefinitionOf(clang_getCursorType(child));
    if (!clang_Cursor_isNull(base)) bases.push_back(base);
  }
  return bases;
}

// The direct bases of `definition` with the access through which each is
// inherited, those that depend on its template parameters left out.
std::vector<std::pair<CXCursor, CX_CXXAccessSpecifier>> BasesWithAccess(CXCursor definition) {
  std::vector<std::pair<CXCursor, CX_CXXAccessSpecifier>> bases;
  for (CXCursor child : ChildrenOf(definition)) {
    if (clang_getCursorKind(child) != CXCursor_CXXBaseSpecifier) continue;
    if (IsDependent(clang_getCursorType(child))) continue;
    const CXCursor base = DefinitionOf(clang_getCursorType(child));
    if (!clang_Cursor_isNull(base)) bases.emplace_back(base, clang_getCXXAccessSpecifier(child));
  }
  return bases;
}

// The narrower of two accesses.
CX_CXXAccessSpecifier Narrower(CX_CXXAccessSpecifier a, CX_CXXAccessSpecifier b) {
  auto rank = [](CX_CXXAccessSpecifier access) {
    return access == CX_CXXPrivate ? 2 : access == CX_CXXProtected ? 1 : 0;
  };
  return rank(a) >= rank(b) ? a : b;
}

// Adds to `covered` the functions that `method` overrides, at any depth.
void CoverOverridden(CXCursor method, std::set<std::string>* covered) {
  std::vector<CXCursor> pending = {method};
  while (!pending.empty()) {
    const CXCursor at = pending.back();
    pending.pop_back();
    CXCursor* overridden = nullptr;
    unsigned count = 0;
    clang_getOverriddenCursors(at, &overridden, &count);
    for (unsigned i = 0; i < count; ++i) {
      if (covered->insert(Take(clang_getCursorUSR(overridden[i]))).second) {
        pending.push_back(overridden[i]);
      }
    }
    clang_disposeOverriddenCursors(overridden);
  }
}

bool IsVirtualMember(CXCursor cursor) {
  const CXCursorKind kind = clang_getCursorKind(cursor);
  return (kind == CXCursor_CXXMethod || kind == CXCursor_ConversionFunction) &&
         clang_CXXMethod_isVirtual(cursor) != 0;
}

}  // namespace

std::vector<InheritedVirtual> InheritedVirtuals(CXCursor definition) {
  std::vector<InheritedVirtual> inherited;
  if (BasesWithAccess(definition).empty()) return inherited;
  std::set<std::string> covered;  // functions that a nearer class overrides
  std::set<std::string> seen;     // classes walked
  // Nearest first: the class itself, then its bases in order, then theirs.
  std::vector<std::pair<CXCursor, CX_CXXAccessSpecifier>> level = {{definition, CX_CXXPublic}};
  while (!level.empty()) {
    std::vector<std::pair<CXCursor, CX_CXXAccessSpecifier>> next;
    for (const auto& [at, path_access] : level) {
      if (!seen.insert(Take(clang_getCursorUSR(at))).second) continue;
      const bool own = clang_equalCursors(at, definition) != 0;
      for (CXCursor member : ChildrenOf(at)) {
        if (!IsVirtualMember(member)) continue;
        const bool overridden = !covered.insert(Take(clang_getCursorUSR(member))).second;
        CoverOverridden(member, &covered);
        if (own || overridden) continue;
        const CX_CXXAccessSpecifier access =
            Narrower(clang_getCXXAccessSpecifier(member), path_access);
        if (access != CX_CXXPrivate) inherited.push_back({member, access});
      }
      for (const auto& [base, base_access] : BasesWithAccess(at)) {
        next.emplace_back(base, own ? base_access : Narrower(base_access, path_access));
      }
    }
    level = std::move(next);
  }
  return inherited;
}

// The bases are walked with a list of their own, each once.
bool ClassFacts::InheritsVirtual(CXCursor definition, bool destructor_only) {
  std::vector<CXCursor> pending = {definition};
  std::set<std::string> seen;
  while (!pending.empty()) {
    const CXCursor at = pending.back();
    pending.pop_back();
    if (!seen.insert(Take(clang_getCursorUSR(at))).second) continue;
    const DeclaredMembers& declared = Declared(at);
    if (destructor_only ? declared.virtual_destructor : declared.virtual_function) return true;
    for (CXCursor base : BasesOf(at)) pending.push_back(base);
  }
  return false;
}

namespace {

bool HasInitializer(CXCursor field) {
  int expressions = 0;
  for (CXCursor child : ChildrenOf(field)) {
    if (clang_isExpression(clang_getCursorKind(child))) ++expressions;
  }
  return expressions > (clang_Cursor_isBitField(field) ? 1 : 0);
}

}  // namespace

const DeclaredMembers& ClassFacts::Declared(CXCursor definition) {
  std::string usr = Take(clang_getCursorUSR(definition));
  const auto found = declared_.find(usr);
  if (found != declared_.end()) return found->second;
  return declared_.emplace(std::move(usr), ReadDeclaredMembers(definition)).first->second;
}

void ClassFacts::AddClassObstacles(CXCursor definition, int depth, Obstacles* obstacles) {
  if (clang_Cursor_isNull(definition)) return;
  const DeclaredMembers& declared = Declared(definition);
  // What the class does not declare, the compiler declares for it, unless
  // its own members and bases stand in the way; past a few levels of members
  // of members, they are taken to be usable.
  Obstacles own;
  if (depth < 8) own = ObstaclesOf(definition, depth + 1);
  const bool moves = declared.move_constructor || declared.move_assignment;
  if (declared.any_constructor ? !declared.usable_default_constructor : own.default_constructor) {
    obstacles->default_constructor = true;
  }
  if (declared.copy_constructor ? !declared.usable_copy_constructor
                                : moves || own.copy_constructor) {
    obstacles->copy_constructor = true;
  }
  if (declared.copy_assignment ? !declared.usable_copy_assignment : moves || own.copy_assignment) {
    obstacles->copy_assignment = true;
  }
}

const ClassFacts::Obstacles& ClassFacts::ObstaclesOf(CXCursor definition, int depth) {
  std::string usr = Take(clang_getCursorUSR(definition));
  const auto found = obstacles_.find(usr);
  if (found != obstacles_.end()) return found->second;
  Obstacles obstacles = FindObstacles(definition, depth);
  return obstacles_.emplace(std::move(usr), obstacles).first->second;
}

ClassFacts::Obstacles ClassFacts::FindObstacles(CXCursor definition, int depth) {
  Obstacles obstacles;
  for (CXCursor base : BasesOf(definition)) AddClassObstacles(base, depth, &obstacles);
  for (CXCursor child : ChildrenOf(definition)) {
    if (clang_getCursorKind(child) != CXCursor_FieldDecl) continue;
    const CXType type = clang_getCanonicalType(clang_getCursorType(child));
    if (IsDependent(type)) continue;
    const bool initialized = HasInitializer(child);
    if (type.kind == CXType_LValueReference || type.kind == CXType_RValueReference) {
      if (!initialized) obstacles.default_constructor = true;
      obstacles.copy_assignment = true;
      if (type.kind == CXType_RValueReference) obstacles.copy_constructor = true;
      continue;
    }
    CXType element = type;
    while (element.kind == CXType_ConstantArray) element = clang_getArrayElementType(element);
    const CXCursor member_class = DefinitionOf(element);
    if (clang_isConstQualifiedType(element) != 0) {
      obstacles.copy_assignment = true;
      if (!initialized && clang_Cursor_isNull(member_class)) obstacles.default_constructor = true;
    }
    if (!clang_Cursor_isNull(member_class) && IsClassKind(clang_getCursorKind(member_class))) {
      Obstacles of_member;
      AddClassObstacles(member_class, depth, &of_member);
      if (initialized) of_member.default_constructor = false;
      obstacles.default_constructor |= of_member.default_constructor;
      obstacles.copy_constructor |= of_member.copy_constructor;
      obstacles.copy_assignment |= of_member.copy_assignment;
    }
  }
  return obstacles;
}

namespace {

MethodDescription ImplicitMember(std::string name, std::string signature) {
  MethodDescription method;
  method.name = std::move(name);
  method.access = "Public";
  method.type = "NonVirtual";
  method.signature = std::move(signature);
  method.implicit = true;
  return method;
}

}  // namespace

void ClassFacts::AddImplicitMembers(CXCursor definition, const TemplateParameters& parameters,
                                    ClassDescription* described) {
  const DeclaredMembers& declared = Declared(definition);
  const Obstacles& obstacles = ObstaclesOf(definition, 0);
  const std::string name = ShortName(definition);
  const SelfType self = SelfTypeOf(definition, parameters);
  const std::string& written = self.written;
  const std::string& identity = self.identity;
  const bool moves = declared.move_constructor || declared.move_assignment;

  if (!declared.any_constructor && !obstacles.default_constructor) {
    described->methods.push_back(ImplicitMember(name, name + "()"));
  }
  if (!declared.copy_constructor && !moves && !obstacles.copy_constructor) {
    MethodDescription copy = ImplicitMember(name, name + "(const " + written + " &)");
    copy.args.push_back({"const " + identity + " &", "", std::nullopt, false});
    described->methods.push_back(std::move(copy));
  }
  if (!declared.copy_assignment && !moves && !obstacles.copy_assignment) {
    MethodDescription assign =
        ImplicitMember("operator=", written + " & operator=(const " + written + " &)");
    assign.returned_type = identity + " &";
    assign.args.push_back({"const " + identity + " &", "", std::nullopt, false});
    described->methods.push_back(std::move(assign));
  }
  if (!declared.destructor) {
    MethodDescription destructor = ImplicitMember("~" + name, "~" + name + "()");
    if (InheritsVirtual(definition, true)) {
      destructor.type = "Virtual";
      destructor.signature = "virtual " + destructor.signature;
    }
    described->methods.push_back(std::move(destructor));
  }
}

bool ClassFacts::IsDerivablePolymorphic(CXCursor definition) {
  if (HasAttribute(definition, CXCursor_CXXFinalAttr)) return false;
  const DeclaredMembers& declared = Declared(definition);
  if (declared.any_constructor && !declared.public_or_protected_constructor) return false;
  return InheritsVirtual(definition, false);
}

}  // namespace zor2::describe
