#include "describe/unit_walk.h"

#include <algorithm>
#include <filesystem>
#include <map>
#include <set>
#include <string_view>
#include <tuple>
#include <utility>

#include "describe/clang_handles.h"
#include "describe/class_facts.h"
#include "describe/comment_tags.h"
#include "describe/declaration_text.h"
#include "describe/header_listing.h"
#include "describe/source_scan.h"
#include "describe/type_spelling.h"

namespace zor2::describe {
namespace {

// A class's own part of its qualified name: its name, or, for a
// specialization, its name with the template arguments as written.
std::string ClassPart(CXCursor cursor) {
  const bool specialization =
      clang_getCursorKind(cursor) == CXCursor_ClassTemplatePartialSpecialization ||
      !clang_Cursor_isNull(clang_getSpecializedCursorTemplate(cursor));
  return Take(specialization ? clang_getCursorDisplayName(cursor)
                             : clang_getCursorSpelling(cursor));
}

// The qualified name of a namespace or class as users write it, without a
// leading "::" and without inline namespaces (empty for the translation unit);
// nothing for what is local to a function, an anonymous namespace or an
// unnamed class, which no other header can name.
std::optional<std::string> QualifiedName(CXCursor cursor) {
  std::vector<std::string> parts;
  for (CXCursor at = cursor;; at = clang_getCursorSemanticParent(at)) {
    const CXCursorKind kind = clang_getCursorKind(at);
    if (kind == CXCursor_TranslationUnit) break;
    if (clang_Cursor_isNull(at) || clang_isInvalid(kind)) return std::nullopt;
    if (IsLinkageKind(kind)) continue;
    std::string part;
    if (kind == CXCursor_Namespace) {
      if (clang_Cursor_isInlineNamespace(at) != 0) continue;
      part = Take(clang_getCursorSpelling(at));
    } else if (IsClassKind(kind)) {
      part = ClassPart(at);
    } else {
      return std::nullopt;
    }
    if (part.empty()) return std::nullopt;
    parts.push_back(std::move(part));
  }
  std::string name;
  for (auto part = parts.rbegin(); part != parts.rend(); ++part) {
    if (!name.empty()) name += "::";
    name += *part;
  }
  return name;
}

// The namespace that holds a free function, as the name of the class that
// describes its free functions; nothing when the function is not in a
// namespace (an out-of-class member definition) or is in an anonymous one.
std::optional<std::string> FreeFunctionClass(CXCursor function) {
  CXCursor parent = clang_getCursorSemanticParent(function);
  while (IsLinkageKind(clang_getCursorKind(parent)) ||
         (clang_getCursorKind(parent) == CXCursor_Namespace &&
          clang_Cursor_isInlineNamespace(parent) != 0)) {
    parent = clang_getCursorSemanticParent(parent);
  }
  const CXCursorKind kind = clang_getCursorKind(parent);
  if (kind == CXCursor_TranslationUnit) return std::string(kGlobalNamespaceClass);
  if (kind != CXCursor_Namespace) return std::nullopt;
  return QualifiedName(parent);
}

// The value of "Deprecated": the release of a @deprecated tag, else the
// release in the [[deprecated]] message, else "Y" for a deprecation that
// names no release.
std::optional<std::string> Deprecation(CXCursor cursor, const DeclarationTags& tags) {
  int always_deprecated = 0;
  int always_unavailable = 0;
  CXString message;
  CXString unavailable_message;
  clang_getCursorPlatformAvailability(cursor, &always_deprecated, &message, &always_unavailable,
                                      &unavailable_message, nullptr, 0);
  const std::string text = Take(message);
  clang_disposeString(unavailable_message);
  if (tags.deprecated_release) return tags.deprecated_release;
  if (always_deprecated != 0) {
    if (std::optional<std::string> release = FindRelease(text)) return release;
  }
  if (always_deprecated != 0 || tags.deprecated) return std::string("Y");
  return std::nullopt;
}

DeclarationTags TagsOf(CXCursor cursor) {
  return ReadDeclarationTags(Take(clang_Cursor_getRawCommentText(cursor)));
}

std::string AccessOf(CXCursor cursor) {
  switch (clang_getCXXAccessSpecifier(cursor)) {
    case CX_CXXProtected:
      return "Protected";
    case CX_CXXPrivate:
      return "Private";
    default:
      return "Public";
  }
}

// The error diagnostic and its notes, as clang writes them, less the notes
// that point into the made-up main file ("in file included from").
std::vector<std::string> FormatDiagnostic(CXDiagnostic diagnostic, const std::string& main_name) {
  const unsigned options =
      CXDiagnostic_DisplaySourceLocation | CXDiagnostic_DisplayColumn | CXDiagnostic_DisplayOption;
  std::vector<std::string> lines = {Take(clang_formatDiagnostic(diagnostic, options))};
  CXDiagnosticSet notes = clang_getChildDiagnostics(diagnostic);
  for (unsigned i = 0; i < clang_getNumDiagnosticsInSet(notes); ++i) {
    CXDiagnostic note = clang_getDiagnosticInSet(notes, i);
    CXFile file = ExpansionFile(clang_getDiagnosticLocation(note));
    if (file != nullptr && Take(clang_getFileName(file)) != main_name) {
      lines.push_back(Take(clang_formatDiagnostic(note, options)));
    }
    clang_disposeDiagnostic(note);
  }
  return lines;
}

std::string Canonical(const std::string& path) {
  std::error_code code;
  const std::filesystem::path canonical = std::filesystem::weakly_canonical(path, code);
  return code ? path : canonical.string();
}

bool IsUnder(const std::string& path, const std::vector<std::string>& roots) {
  for (const std::string& root : roots) {
    if (path.size() > root.size() && path.compare(0, root.size(), root) == 0 &&
        (root.back() == '/' || path[root.size()] == '/')) {
      return true;
    }
  }
  return false;
}

// Walks one translation unit and describes the headers it includes.
class UnitWalker {
 public:
  UnitWalker(CXTranslationUnit unit, const UnitHeaders& headers,
             const std::vector<std::string>& roots, const WalkSettings& settings,
             const std::string& main_name, UnitOutcome* outcome)
      : unit_(unit),
        headers_(headers),
        settings_(settings),
        main_name_(main_name),
        outcome_(outcome) {
    for (const std::string& root : roots) roots_.push_back(Canonical(root));
    for (size_t h = 0; h < headers_.headers.size(); ++h) {
      header_of_name_.emplace(headers_.headers[h], static_cast<int>(h));
    }
  }

  void Run() {
    const size_t count = headers_.headers.size();
    outcome_->files.resize(count);
    outcome_->diagnostics.resize(count);
    outcome_->needs_own_unit.assign(count, false);
    IndexHeaders();
    AttributeErrors();
    if (outcome_->unattributed_errors) return;
    DescribeFiles();
    Walk();
    FinishFiles();
  }

 private:
  // The header of a file included by the unit, or -1.
  int HeaderOfFile(CXFile file) const {
    const std::optional<FileKey> key = KeyOf(file);
    if (!key) return -1;
    const auto found = header_of_key_.find(*key);
    return found == header_of_key_.end() ? -1 : found->second;
  }

  // The header a declaration is written in, when it is one being described.
  int HeaderOf(CXCursor cursor) const {
    const int header = HeaderOfFile(ExpansionFile(clang_getCursorLocation(cursor)));
    return header >= 0 && described_[header] ? header : -1;
  }

  void IndexHeaders() {
    for (size_t h = 0; h < headers_.headers.size(); ++h) {
      const std::string path = HeaderPath(headers_.dir, headers_.headers[h]);
      CXFile file = clang_getFile(unit_, path.c_str());
      files_.push_back(file);
      if (std::optional<FileKey> key = KeyOf(file)) {
        header_of_key_.emplace(*key, static_cast<int>(h));
      }
    }
    clang_getInclusions(
        unit_,
        [](CXFile included, CXSourceLocation* stack, unsigned depth, CXClientData data) {
          static_cast<UnitWalker*>(data)->NoteInclusion(included, stack, depth);
        },
        this);
  }

  void NoteInclusion(CXFile included, CXSourceLocation* stack, unsigned depth) {
    if (depth == 0) return;
    const std::optional<FileKey> key = KeyOf(included);
    // Every other file is charged to the header through which the unit first
    // included it.
    if (depth >= 2) {
      const int top = HeaderOfFile(ExpansionFile(stack[depth - 2]));
      if (key && top >= 0) top_header_of_key_.emplace(*key, top);
    }
    if (HeaderOfFile(included) >= 0) return;
    const std::string name = Take(clang_getFileName(included));
    const std::string path = Canonical(name);
    if (IsUnder(path, roots_)) return;
    const int includer = HeaderOfFile(ExpansionFile(stack[0]));
    NoteStandIn(name, path, includer >= 0);
    if (includer < 0) return;
    CXFile includer_file = nullptr;
    unsigned offset = 0;
    clang_getFileLocation(stack[0], &includer_file, nullptr, nullptr, &offset);
    std::string target = IncludeTarget(DirectiveAt(texts_.Of(includer_file), offset));
    if (!target.empty() && outside_seen_.insert(target).second) {
      outcome_->outside_includes.push_back(std::move(target));
    }
  }

  // A file from outside the described directories whose path ends like a
  // described header's took its place: an installed copy of another release.
  void NoteStandIn(const std::string& name, const std::string& path, bool included_by_described) {
    for (size_t slash = path.find('/'); slash != std::string::npos;
         slash = path.find('/', slash + 1)) {
      const std::string tail = path.substr(slash + 1);
      const auto found = header_of_name_.find(tail);
      if (found == header_of_name_.end()) continue;
      // A bare name could be any library's; only a described header's own
      // include of it says that it was meant.
      if (tail.find('/') == std::string::npos && !included_by_described) continue;
      outcome_->stand_ins.push_back(name + " was read in place of " +
                                    HeaderPath(headers_.dir, headers_.headers[found->second]));
      return;
    }
  }

  void AttributeErrors() {
    const unsigned count = clang_getNumDiagnostics(unit_);
    for (unsigned i = 0; i < count; ++i) {
      CXDiagnostic diagnostic = clang_getDiagnostic(unit_, i);
      const CXDiagnosticSeverity severity = clang_getDiagnosticSeverity(diagnostic);
      if (severity == CXDiagnostic_Error || severity == CXDiagnostic_Fatal) {
        const int header = ErrorHeader(clang_getDiagnosticLocation(diagnostic));
        if (header < 0) {
          outcome_->unattributed_errors = true;
        } else {
          std::vector<std::string> lines = FormatDiagnostic(diagnostic, main_name_);
          std::vector<std::string>& into = outcome_->diagnostics[header];
          into.insert(into.end(), lines.begin(), lines.end());
        }
      }
      clang_disposeDiagnostic(diagnostic);
    }
  }

  // The header an error belongs to, or -1.
  int ErrorHeader(CXSourceLocation location) const {
    // A unit of one header charges it with every error.
    if (headers_.headers.size() == 1) return 0;
    CXFile file = ExpansionFile(location);
    const int header = HeaderOfFile(file);
    if (header >= 0) return header;
    const std::optional<FileKey> key = KeyOf(file);
    if (!key) return -1;
    const auto found = top_header_of_key_.find(*key);
    return found == top_header_of_key_.end() ? -1 : found->second;
  }

  void DescribeFiles() {
    const size_t count = headers_.headers.size();
    described_.assign(count, false);
    derivable_.assign(count, false);
    free_functions_.resize(count);
    seen_functions_.resize(count);
    for (size_t h = 0; h < count; ++h) {
      if (!outcome_->diagnostics[h].empty()) continue;
      const FileTags tags = ReadFileTags(TextOf(h));
      FileDescription file;
      file.name = headers_.headers[h];
      file.aut = tags.not_automation ? "N" : "Y";
      file.level = tags.level ? tags.level : settings_.default_level;
      if (!file.level) file.level = "L1";
      file.usage = tags.usage ? tags.usage : settings_.default_usage;
      outcome_->files[h] = std::move(file);
      described_[h] = true;
    }
  }

  std::string_view TextOf(size_t h) { return texts_.Of(files_[h]); }

  // The walk keeps its own stack of open scopes, so that the nesting of the
  // headers never bounds it.
  struct Scope {
    std::vector<CXCursor> children;
    size_t next = 0;
    int header = -1;  // the header of the class being walked; -1 in a namespace
    size_t class_index = 0;
    TemplateParameters parameters;  // those the class's members see
  };

  static Scope NamespaceScope(CXCursor cursor) {
    Scope scope;
    scope.children = ChildrenOf(cursor);
    return scope;
  }

  void Walk() {
    std::vector<Scope> open;
    open.push_back(NamespaceScope(clang_getTranslationUnitCursor(unit_)));
    for (CXCursor top : open.back().children) {
      const int header = HeaderOfFile(ExpansionFile(clang_getCursorLocation(top)));
      if (header >= 0) declares_.insert(header);
    }
    while (!open.empty()) {
      if (open.back().next == open.back().children.size()) {
        open.pop_back();
        continue;
      }
      const Scope& scope = open.back();
      const CXCursor cursor = scope.children[open.back().next++];
      const CXCursorKind kind = clang_getCursorKind(cursor);
      const bool in_class = scope.header >= 0;
      if (IsClassKind(kind)) {
        // What a private section declares, users cannot name.
        if (in_class && clang_getCXXAccessSpecifier(cursor) == CX_CXXPrivate) continue;
        if (std::optional<Scope> inner = EnterClass(cursor)) open.push_back(std::move(*inner));
      } else if (in_class && IsMemberFunctionKind(kind)) {
        ClassDescription& owner = ClassAt(scope);
        if (std::optional<MethodDescription> method =
                DescribeMethod(cursor, owner, true, scope.parameters.With(cursor))) {
          owner.methods.push_back(std::move(*method));
        }
      } else if (!in_class && (kind == CXCursor_Namespace || IsLinkageKind(kind))) {
        if (HeaderOf(cursor) >= 0) open.push_back(NamespaceScope(cursor));
      } else if (!in_class &&
                 (kind == CXCursor_FunctionDecl || kind == CXCursor_FunctionTemplate)) {
        AddFreeFunction(cursor);
      }
    }
  }

  ClassDescription& ClassAt(const Scope& scope) {
    return outcome_->files[scope.header]->classes[scope.class_index];
  }

  // Describes a class that a header defines, with the members the compiler
  // declares for it, and opens its scope.
  std::optional<Scope> EnterClass(CXCursor cursor) {
    if (!clang_isCursorDefinition(cursor)) return std::nullopt;
    const int header = HeaderOf(cursor);
    if (header < 0) return std::nullopt;
    std::optional<std::string> name = QualifiedName(cursor);
    if (!name) return std::nullopt;
    const DeclarationTags tags = TagsOf(cursor);
    std::vector<ClassDescription>& classes = outcome_->files[header]->classes;
    ClassDescription described{std::move(*name),
                               tags.automation ? "Y" : "N",
                               Deprecation(cursor, tags),
                               {},
                               LineOf(cursor)};
    if (class_facts_.IsDerivablePolymorphic(cursor)) derivable_[header] = true;
    std::vector<CXCursor> children = ChildrenOf(cursor);
    classes.push_back(std::move(described));
    TemplateParameters parameters = TemplateParameters::Around(cursor);
    implicit_pending_.push_back({header, classes.size() - 1, cursor, parameters});
    return Scope{std::move(children), 0, header, classes.size() - 1, std::move(parameters)};
  }

  void AddFreeFunction(CXCursor cursor) {
    const int header = HeaderOf(cursor);
    if (header < 0) return;
    std::optional<std::string> holder = FreeFunctionClass(cursor);
    if (!holder) return;
    // A function declared again (or defined) further down the same header is
    // described once.
    if (!seen_functions_[header].insert(Take(clang_getCursorUSR(cursor))).second) return;
    ClassDescription owner{*holder, "N", std::nullopt, {}, 0};
    std::optional<MethodDescription> method =
        DescribeMethod(cursor, owner, false, TemplateParameters::Around(cursor));
    if (!method) return;
    auto& holders = free_functions_[header];
    auto found = std::find_if(holders.begin(), holders.end(),
                              [&holder](const auto& entry) { return entry.first == *holder; });
    if (found == holders.end()) {
      holders.emplace_back(*holder, std::vector<MethodDescription>());
      found = holders.end() - 1;
    }
    found->second.push_back(std::move(*method));
  }

  // Describes a member function of `owner` or, when `member` is false, a free
  // function; nothing for a deleted one, which nobody can call.
  std::optional<MethodDescription> DescribeMethod(CXCursor cursor, const ClassDescription& owner,
                                                  bool member,
                                                  const TemplateParameters& parameters) {
    if (clang_getCursorAvailability(cursor) == CXAvailability_NotAvailable) return std::nullopt;
    const CXCursorKind kind = clang_getCursorKind(cursor);
    const CXCursorKind function_kind =
        kind == CXCursor_FunctionTemplate ? clang_getTemplateCursorKind(cursor) : kind;
    const DeclarationTags tags = TagsOf(cursor);

    MethodDescription method;
    method.name = Take(clang_getCursorSpelling(cursor));
    const bool structor =
        function_kind == CXCursor_Constructor || function_kind == CXCursor_Destructor;
    // A constructor of a class template is spelled with the template's
    // parameters; it is named after its class.
    if (structor && !method.name.empty() && method.name.back() == '>') {
      method.name.erase(method.name.find('<'));
    }
    method.access = member ? AccessOf(cursor) : "Public";
    if (!member) {
      method.type = "NonVirtual";
    } else if (clang_CXXMethod_isPureVirtual(cursor)) {
      method.type = "PureVirtual";
    } else if (clang_CXXMethod_isVirtual(cursor)) {
      method.type = "Virtual";
    } else if (clang_CXXMethod_isStatic(cursor)) {
      method.type = "Static";
    } else {
      method.type = "NonVirtual";
    }
    method.property = tags.property;
    if (!structor) {
      method.returned_type = TypeIdentity(clang_getCursorResultType(cursor), parameters);
    }
    method.nodoc = tags.nodoc;
    method.deprecated = Deprecation(cursor, tags);
    method.line = LineOf(cursor);

    std::set<std::string> retval_names(tags.retval_names.begin(), tags.retval_names.end());
    const std::vector<CXCursor> children = ChildrenOf(cursor);
    for (CXCursor child : children) {
      if (clang_getCursorKind(child) != CXCursor_ParmDecl) continue;
      ArgDescription arg;
      arg.type = ParameterTypeIdentity(clang_getCursorType(child), parameters);
      arg.name = Take(clang_getCursorSpelling(child));
      arg.value = DefaultValue(unit_, cursor, children, child, parameters, texts_);
      arg.retval = !arg.name.empty() && retval_names.erase(arg.name) > 0;
      method.args.push_back(std::move(arg));
    }
    for (const std::string& name : retval_names) Warn(cursor, owner, method, name);

    method.signature = Signature(unit_, cursor, children, method, parameters, texts_);
    return method;
  }

  void Warn(CXCursor cursor, const ClassDescription& owner, const MethodDescription& method,
            const std::string& name) {
    unsigned line = 0;
    unsigned column = 0;
    CXFile file = ExpansionFile(clang_getCursorLocation(cursor), &line, &column);
    const std::string scope = owner.name == kGlobalNamespaceClass ? "" : owner.name;
    outcome_->warnings.push_back(Take(clang_getFileName(file)) + ":" + std::to_string(line) + ":" +
                                 std::to_string(column) + ": warning: @ZOR2Retval " + name +
                                 " names no argument of " + scope + "::" + method.name);
  }

  // A virtual function that a class inherits without overriding it is part
  // of its interface as much as an override: described among its methods, so
  // that an override removed where the base keeps the function is no change.
  void AddInheritedVirtuals(CXCursor definition, ClassDescription* described) {
    for (const InheritedVirtual& base_function : InheritedVirtuals(definition)) {
      std::optional<MethodDescription> method = DescribeMethod(
          base_function.method, *described, true, TemplateParameters::Around(base_function.method));
      if (!method) continue;
      method->access = base_function.access == CX_CXXProtected ? "Protected" : "Public";
      method->line = 0;
      method->inherited = true;
      described->methods.push_back(std::move(*method));
    }
  }

  // The free functions go last in their files, the members the compiler
  // declares last in their classes; untagged headers get their usage; and a
  // header that holds code but got nothing from the unit is to be compiled on
  // its own.
  void FinishFiles() {
    for (const PendingClass& pending : implicit_pending_) {
      ClassDescription& described = outcome_->files[pending.header]->classes[pending.index];
      AddInheritedVirtuals(pending.definition, &described);
      class_facts_.AddImplicitMembers(pending.definition, pending.parameters, &described);
    }
    for (size_t h = 0; h < headers_.headers.size(); ++h) {
      if (!described_[h]) continue;
      FileDescription& file = *outcome_->files[h];
      for (auto& [name, methods] : free_functions_[h]) {
        file.classes.push_back({name, "N", std::nullopt, std::move(methods), 0});
      }
      if (!file.usage) file.usage = derivable_[h] ? "U2" : "U1";
      if (declares_.count(static_cast<int>(h)) == 0 &&
          (files_[h] == nullptr || ScanDirectives(TextOf(h)))) {
        outcome_->needs_own_unit[h] = true;
      }
    }
  }

  CXTranslationUnit unit_;
  const UnitHeaders& headers_;
  const WalkSettings& settings_;
  const std::string& main_name_;
  UnitOutcome* outcome_;
  std::vector<std::string> roots_;
  ClassFacts class_facts_;
  SourceTexts texts_{unit_};

  std::vector<CXFile> files_;
  std::map<std::string, int> header_of_name_;
  std::map<FileKey, int> header_of_key_;
  std::map<FileKey, int> top_header_of_key_;
  std::set<std::string> outside_seen_;
  std::vector<bool> described_;
  std::vector<bool> derivable_;
  std::set<int> declares_;  // headers with a declaration of their own in the unit
  // The classes described, to be given the members the compiler declares.
  struct PendingClass {
    int header;
    size_t index;
    CXCursor definition;
    TemplateParameters parameters;
  };
  std::vector<PendingClass> implicit_pending_;
  // Per header: the classes of its free functions, in the order they first
  // appear, and the functions already described.
  std::vector<std::vector<std::pair<std::string, std::vector<MethodDescription>>>> free_functions_;
  std::vector<std::set<std::string>> seen_functions_;
};

}  // namespace

UnitOutcome WalkUnit(CXTranslationUnit unit, const UnitHeaders& headers,
                     const std::vector<std::string>& roots, const WalkSettings& settings,
                     const std::string& main_name) {
  UnitOutcome outcome;
  UnitWalker(unit, headers, roots, settings, main_name, &outcome).Run();
  return outcome;
}

}  // namespace zor2::describe
