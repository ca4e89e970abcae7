#include "describe/header_describer.h"

#include <clang-c/Index.h>

#include <algorithm>
#include <array>
#include <atomic>
#include <future>
#include <map>
#include <memory>
#include <set>
#include <utility>

#include "describe/comment_tags.h"
#include "describe/token_text.h"
#include "platform/tools/background.h"

namespace zor2::describe {
namespace {

// --- libclang helpers -------------------------------------------------------------------------

std::string Take(CXString text) {
  const char* chars = clang_getCString(text);
  std::string result = chars != nullptr ? chars : "";
  clang_disposeString(text);
  return result;
}

struct IndexDeleter {
  void operator()(void* index) const { clang_disposeIndex(index); }
};
struct UnitDeleter {
  void operator()(CXTranslationUnitImpl* unit) const { clang_disposeTranslationUnit(unit); }
};
using IndexHandle = std::unique_ptr<void, IndexDeleter>;
using UnitHandle = std::unique_ptr<CXTranslationUnitImpl, UnitDeleter>;

// The tokens of one source range.
class Tokens {
 public:
  Tokens(CXTranslationUnit unit, CXSourceRange range) : unit_(unit) {
    clang_tokenize(unit, range, &tokens_, &count_);
  }
  ~Tokens() { clang_disposeTokens(unit_, tokens_, count_); }
  Tokens(const Tokens&) = delete;
  Tokens& operator=(const Tokens&) = delete;

  unsigned size() const { return count_; }
  std::string Spelling(unsigned i) const { return Take(clang_getTokenSpelling(unit_, tokens_[i])); }

  // The text of tokens [begin, end), spaced the same whatever the layout of
  // the source (see JoinTokens).
  std::string Join(unsigned begin, unsigned end) const {
    std::vector<std::string> spellings;
    for (unsigned i = begin; i < end; ++i) {
      if (clang_getTokenKind(tokens_[i]) != CXToken_Comment) spellings.push_back(Spelling(i));
    }
    return JoinTokens(spellings);
  }

 private:
  CXTranslationUnit unit_;
  CXToken* tokens_ = nullptr;
  unsigned count_ = 0;
};

std::vector<CXCursor> ChildrenOf(CXCursor parent) {
  std::vector<CXCursor> children;
  clang_visitChildren(
      parent,
      [](CXCursor child, CXCursor, CXClientData data) {
        static_cast<std::vector<CXCursor>*>(data)->push_back(child);
        return CXChildVisit_Continue;
      },
      &children);
  return children;
}

// A file as libclang knows it, whatever path led to it.
using FileKey = std::array<unsigned long long, 3>;

std::optional<FileKey> KeyOf(CXFile file) {
  CXFileUniqueID id;
  if (file == nullptr || clang_getFileUniqueID(file, &id) != 0) return std::nullopt;
  return FileKey{id.data[0], id.data[1], id.data[2]};
}

CXFile ExpansionFile(CXSourceLocation location, unsigned* line = nullptr,
                     unsigned* column = nullptr) {
  CXFile file = nullptr;
  clang_getExpansionLocation(location, &file, line, column, nullptr);
  return file;
}

// An extern "C" block, which libclang may show as an unexposed declaration:
// what it holds belongs to the enclosing namespace.
bool IsLinkageKind(CXCursorKind kind) {
  return kind == CXCursor_LinkageSpec || kind == CXCursor_UnexposedDecl;
}

bool IsClassKind(CXCursorKind kind) {
  return kind == CXCursor_ClassDecl || kind == CXCursor_StructDecl || kind == CXCursor_UnionDecl ||
         kind == CXCursor_ClassTemplate || kind == CXCursor_ClassTemplatePartialSpecialization;
}

bool IsMemberFunctionKind(CXCursorKind kind) {
  return kind == CXCursor_CXXMethod || kind == CXCursor_Constructor ||
         kind == CXCursor_Destructor || kind == CXCursor_ConversionFunction ||
         kind == CXCursor_FunctionTemplate;
}

// A class's own part of its qualified name: its name, or, for a
// specialization, its name with the template arguments as written.
std::string ClassPart(CXCursor cursor) {
  const bool specialization =
      clang_getCursorKind(cursor) == CXCursor_ClassTemplatePartialSpecialization ||
      !clang_Cursor_isNull(clang_getSpecializedCursorTemplate(cursor));
  return Take(specialization ? clang_getCursorDisplayName(cursor)
                             : clang_getCursorSpelling(cursor));
}

// The qualified name of a namespace or class, without a leading "::" (empty
// for the translation unit); nothing for what is local to a function, an
// anonymous namespace or an unnamed class, which no other header can name.
std::optional<std::string> QualifiedName(CXCursor cursor) {
  std::vector<std::string> parts;
  for (CXCursor at = cursor;; at = clang_getCursorSemanticParent(at)) {
    const CXCursorKind kind = clang_getCursorKind(at);
    if (kind == CXCursor_TranslationUnit) break;
    if (clang_Cursor_isNull(at) || clang_isInvalid(kind)) return std::nullopt;
    if (IsLinkageKind(kind)) continue;
    std::string part;
    if (kind == CXCursor_Namespace) {
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
  while (IsLinkageKind(clang_getCursorKind(parent))) {
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

// The text of "template <...> " for a function template, empty otherwise.
std::string TemplateHeader(CXTranslationUnit unit, const std::vector<CXCursor>& children) {
  std::string parameters;
  for (CXCursor child : children) {
    const CXCursorKind kind = clang_getCursorKind(child);
    if (kind != CXCursor_TemplateTypeParameter && kind != CXCursor_NonTypeTemplateParameter &&
        kind != CXCursor_TemplateTemplateParameter) {
      continue;
    }
    const Tokens tokens(unit, clang_getCursorExtent(child));
    if (!parameters.empty()) parameters += ", ";
    parameters += tokens.Join(0, tokens.size());
  }
  return "template <" + parameters + "> ";
}

// The default argument of a parameter, as its source text.
std::optional<std::string> DefaultValue(CXTranslationUnit unit, CXCursor parameter) {
  const Tokens tokens(unit, clang_getCursorExtent(parameter));
  int depth = 0;
  for (unsigned i = 0; i < tokens.size(); ++i) {
    const std::string spelling = tokens.Spelling(i);
    if (spelling == "(" || spelling == "[" || spelling == "{") ++depth;
    if (spelling == ")" || spelling == "]" || spelling == "}") --depth;
    if (depth == 0 && spelling == "=") {
      if (i + 1 == tokens.size()) return std::nullopt;
      return tokens.Join(i + 1, tokens.size());
    }
  }
  return std::nullopt;
}

// --- One translation unit ---------------------------------------------------------------------

// What one translation unit tells about the headers it includes.
struct UnitOutcome {
  // An error that belongs to no single header: the headers must be compiled
  // one by one.
  bool unattributed_errors = false;
  // Per header: its description, or nothing when it has errors.
  std::vector<std::optional<FileDescription>> files;
  // Per header: its error diagnostics.
  std::vector<std::vector<std::string>> diagnostics;
  std::vector<std::string> warnings;
};

std::string IncludePath(const std::string& dir, const std::string& header) {
  if (dir.empty()) return header;
  return dir.back() == '/' ? dir + header : dir + "/" + header;
}

std::vector<std::string> CompilerArguments(const CompileSettings& settings) {
  std::vector<std::string> arguments = {"-x", "c++", "-std=" + settings.standard,
                                        "-fparse-all-comments"};
  for (const std::string& dir : settings.include_dirs) arguments.push_back("-I" + dir);
  for (const std::string& define : settings.defines) arguments.push_back("-D" + define);
  return arguments;
}

// The made-up main file of a unit of several headers: a relative name puts
// it in the working directory, against which the header paths are resolved
// as given.
constexpr char kMainName[] = "zor2describe-headers.cpp";

// The error diagnostic and its notes, as clang writes them, less the notes
// that point into the made-up main file ("in file included from").
std::vector<std::string> FormatDiagnostic(CXDiagnostic diagnostic) {
  const unsigned options =
      CXDiagnostic_DisplaySourceLocation | CXDiagnostic_DisplayColumn | CXDiagnostic_DisplayOption;
  std::vector<std::string> lines = {Take(clang_formatDiagnostic(diagnostic, options))};
  CXDiagnosticSet notes = clang_getChildDiagnostics(diagnostic);
  for (unsigned i = 0; i < clang_getNumDiagnosticsInSet(notes); ++i) {
    CXDiagnostic note = clang_getDiagnosticInSet(notes, i);
    CXFile file = ExpansionFile(clang_getDiagnosticLocation(note));
    if (file != nullptr && Take(clang_getFileName(file)) != kMainName) {
      lines.push_back(Take(clang_formatDiagnostic(note, options)));
    }
    clang_disposeDiagnostic(note);
  }
  return lines;
}

// Walks one translation unit and describes the headers it includes.
class UnitDescriber {
 public:
  UnitDescriber(CXTranslationUnit unit, const std::string& dir,
                const std::vector<std::string>& headers, const CompileSettings& settings,
                UnitOutcome* outcome)
      : unit_(unit), dir_(dir), headers_(headers), settings_(settings), outcome_(outcome) {}

  void Run() {
    IndexHeaders();
    AttributeErrors();
    if (outcome_->unattributed_errors) return;
    DescribeFiles();
    Walk();
    for (size_t h = 0; h < headers_.size(); ++h) {
      if (!described_[h]) continue;
      FileDescription& file = *outcome_->files[h];
      for (auto& [name, methods] : free_functions_[h]) {
        file.classes.push_back({name, "N", std::nullopt, std::move(methods)});
      }
    }
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
    for (size_t h = 0; h < headers_.size(); ++h) {
      const std::string path = IncludePath(dir_, headers_[h]);
      CXFile file = clang_getFile(unit_, path.c_str());
      files_.push_back(file);
      if (std::optional<FileKey> key = KeyOf(file)) {
        header_of_key_.emplace(*key, static_cast<int>(h));
      }
    }
    // Every other file is charged to the header through which the unit first
    // included it.
    clang_getInclusions(
        unit_,
        [](CXFile included, CXSourceLocation* stack, unsigned depth, CXClientData data) {
          auto* self = static_cast<UnitDescriber*>(data);
          if (depth < 2) return;
          const std::optional<FileKey> key = KeyOf(included);
          const int top = self->HeaderOfFile(ExpansionFile(stack[depth - 2]));
          if (key && top >= 0) self->top_header_of_key_.emplace(*key, top);
        },
        this);
  }

  void AttributeErrors() {
    outcome_->files.resize(headers_.size());
    outcome_->diagnostics.resize(headers_.size());
    const unsigned count = clang_getNumDiagnostics(unit_);
    for (unsigned i = 0; i < count; ++i) {
      CXDiagnostic diagnostic = clang_getDiagnostic(unit_, i);
      const CXDiagnosticSeverity severity = clang_getDiagnosticSeverity(diagnostic);
      if (severity == CXDiagnostic_Error || severity == CXDiagnostic_Fatal) {
        const int header = ErrorHeader(clang_getDiagnosticLocation(diagnostic));
        if (header < 0) {
          outcome_->unattributed_errors = true;
        } else {
          std::vector<std::string> lines = FormatDiagnostic(diagnostic);
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
    if (headers_.size() == 1) return 0;
    CXFile file = ExpansionFile(location);
    const int header = HeaderOfFile(file);
    if (header >= 0) return header;
    const std::optional<FileKey> key = KeyOf(file);
    if (!key) return -1;
    const auto found = top_header_of_key_.find(*key);
    return found == top_header_of_key_.end() ? -1 : found->second;
  }

  void DescribeFiles() {
    described_.assign(headers_.size(), false);
    free_functions_.resize(headers_.size());
    seen_functions_.resize(headers_.size());
    for (size_t h = 0; h < headers_.size(); ++h) {
      if (!outcome_->diagnostics[h].empty()) continue;
      size_t size = 0;
      const char* text =
          files_[h] != nullptr ? clang_getFileContents(unit_, files_[h], &size) : nullptr;
      const FileTags tags = ReadFileTags(text != nullptr ? std::string_view(text, size) : "");
      FileDescription file;
      file.name = headers_[h];
      file.aut = tags.not_automation ? "N" : "Y";
      file.level = tags.level ? tags.level : settings_.default_level;
      file.usage = tags.usage ? tags.usage : settings_.default_usage;
      outcome_->files[h] = std::move(file);
      described_[h] = true;
    }
  }

  // The walk keeps its own stack of open scopes, so that the nesting of the
  // headers never bounds it.
  struct Scope {
    std::vector<CXCursor> children;
    size_t next = 0;
    int header = -1;  // the header of the class being walked; -1 in a namespace
    size_t class_index = 0;
  };

  void Walk() {
    std::vector<Scope> open;
    open.push_back({ChildrenOf(clang_getTranslationUnitCursor(unit_))});
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
        if (std::optional<Scope> inner = EnterClass(cursor)) open.push_back(std::move(*inner));
      } else if (in_class && IsMemberFunctionKind(kind)) {
        ClassDescription& owner = ClassAt(scope);
        if (std::optional<MethodDescription> method = DescribeMethod(cursor, owner, true)) {
          owner.methods.push_back(std::move(*method));
        }
      } else if (!in_class && (kind == CXCursor_Namespace || IsLinkageKind(kind))) {
        if (HeaderOf(cursor) >= 0) open.push_back({ChildrenOf(cursor)});
      } else if (!in_class &&
                 (kind == CXCursor_FunctionDecl || kind == CXCursor_FunctionTemplate)) {
        AddFreeFunction(cursor);
      }
    }
  }

  ClassDescription& ClassAt(const Scope& scope) {
    return outcome_->files[scope.header]->classes[scope.class_index];
  }

  // Describes a class that a header defines and opens its scope.
  std::optional<Scope> EnterClass(CXCursor cursor) {
    if (!clang_isCursorDefinition(cursor)) return std::nullopt;
    const int header = HeaderOf(cursor);
    if (header < 0) return std::nullopt;
    std::optional<std::string> name = QualifiedName(cursor);
    if (!name) return std::nullopt;
    const DeclarationTags tags = TagsOf(cursor);
    std::vector<ClassDescription>& classes = outcome_->files[header]->classes;
    classes.push_back(
        {std::move(*name), tags.automation ? "Y" : "N", Deprecation(cursor, tags), {}});
    return Scope{ChildrenOf(cursor), 0, header, classes.size() - 1};
  }

  void AddFreeFunction(CXCursor cursor) {
    const int header = HeaderOf(cursor);
    if (header < 0) return;
    std::optional<std::string> holder = FreeFunctionClass(cursor);
    if (!holder) return;
    // A function declared again (or defined) further down the same header is
    // described once.
    if (!seen_functions_[header].insert(Take(clang_getCursorUSR(cursor))).second) return;
    ClassDescription owner{*holder, "N", std::nullopt, {}};
    std::optional<MethodDescription> method = DescribeMethod(cursor, owner, false);
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
                                                  bool member) {
    if (clang_getCursorAvailability(cursor) == CXAvailability_NotAvailable) return std::nullopt;
    const CXCursorKind kind = clang_getCursorKind(cursor);
    const std::vector<CXCursor> children = ChildrenOf(cursor);
    const DeclarationTags tags = TagsOf(cursor);

    MethodDescription method;
    method.name = Take(clang_getCursorSpelling(cursor));
    const bool structor = kind == CXCursor_Constructor || kind == CXCursor_Destructor;
    // A constructor of a class template is spelled with the template's
    // parameters; it is named after its class.
    if (structor && method.name.back() == '>') method.name.erase(method.name.find('<'));
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
      method.returned_type = Take(clang_getTypeSpelling(clang_getCursorResultType(cursor)));
    }
    method.nodoc = tags.nodoc;
    method.deprecated = Deprecation(cursor, tags);

    std::set<std::string> retval_names(tags.retval_names.begin(), tags.retval_names.end());
    for (CXCursor child : children) {
      if (clang_getCursorKind(child) != CXCursor_ParmDecl) continue;
      ArgDescription arg;
      arg.type = Take(clang_getTypeSpelling(clang_getCursorType(child)));
      arg.name = Take(clang_getCursorSpelling(child));
      arg.value = DefaultValue(unit_, child);
      arg.retval = !arg.name.empty() && retval_names.erase(arg.name) > 0;
      method.args.push_back(std::move(arg));
    }
    for (const std::string& name : retval_names) Warn(cursor, owner, method, name);

    method.signature = Signature(cursor, kind, children, method);
    return method;
  }

  std::string Signature(CXCursor cursor, CXCursorKind kind, const std::vector<CXCursor>& children,
                        const MethodDescription& method) const {
    std::string signature;
    if (kind == CXCursor_FunctionTemplate) signature += TemplateHeader(unit_, children);
    if (method.type == "Static") signature += "static ";
    if (method.type == "Virtual" || method.type == "PureVirtual") signature += "virtual ";
    if (method.returned_type && kind != CXCursor_ConversionFunction) {
      signature += *method.returned_type + " ";
    }
    signature += method.name + "(";
    for (size_t i = 0; i < method.args.size(); ++i) {
      if (i > 0) signature += ", ";
      signature += method.args[i].type;
      if (!method.args[i].name.empty()) signature += " " + method.args[i].name;
    }
    if (clang_isFunctionTypeVariadic(clang_getCursorType(cursor)) != 0) {
      signature += method.args.empty() ? "..." : ", ...";
    }
    signature += ")";
    if (clang_CXXMethod_isConst(cursor)) signature += " const";
    switch (clang_Type_getCXXRefQualifier(clang_getCursorType(cursor))) {
      case CXRefQualifier_LValue:
        signature += " &";
        break;
      case CXRefQualifier_RValue:
        signature += " &&";
        break;
      default:
        break;
    }
    if (method.type == "PureVirtual") signature += " = 0";
    return signature;
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

  CXTranslationUnit unit_;
  const std::string& dir_;
  const std::vector<std::string>& headers_;
  const CompileSettings& settings_;
  UnitOutcome* outcome_;

  std::vector<CXFile> files_;
  std::map<FileKey, int> header_of_key_;
  std::map<FileKey, int> top_header_of_key_;
  std::vector<bool> described_;
  // Per header: the classes of its free functions, in the order they first
  // appear, and the functions already described.
  std::vector<std::vector<std::pair<std::string, std::vector<MethodDescription>>>> free_functions_;
  std::vector<std::set<std::string>> seen_functions_;
};

// Compiles `headers` (relative to `dir`) as one translation unit and
// describes them.
UnitOutcome DescribeUnit(const std::string& dir, const std::vector<std::string>& headers,
                         const CompileSettings& settings) {
  UnitOutcome outcome;
  outcome.files.resize(headers.size());
  outcome.diagnostics.resize(headers.size());
  // A single header is compiled as the main file itself, so that every
  // diagnostic points into it; several are included by a made-up main file.
  std::string main_text;
  for (size_t h = 0; h < headers.size(); ++h) {
    const std::string path = IncludePath(dir, headers[h]);
    if (path.find_first_of("\"\n") != std::string::npos) {
      outcome.diagnostics[h].push_back(path +
                                       ": a path holding a quote or a line end cannot be "
                                       "included");
      continue;
    }
    main_text += "#include \"" + path + "\"\n";
  }
  const bool solo = headers.size() == 1;
  if (solo && !outcome.diagnostics[0].empty()) return outcome;
  const std::string solo_path = solo ? IncludePath(dir, headers[0]) : "";

  const std::vector<std::string> arguments = CompilerArguments(settings);
  std::vector<const char*> argv;
  for (const std::string& argument : arguments) argv.push_back(argument.c_str());
  CXUnsavedFile main_file = {kMainName, main_text.data(),
                             static_cast<unsigned long>(main_text.size())};
  IndexHandle index(clang_createIndex(0, 0));
  CXTranslationUnit raw_unit = nullptr;
  const CXErrorCode code = clang_parseTranslationUnit2(
      index.get(), solo ? solo_path.c_str() : kMainName, argv.data(), static_cast<int>(argv.size()),
      solo ? nullptr : &main_file, solo ? 0 : 1,
      CXTranslationUnit_SkipFunctionBodies | CXTranslationUnit_KeepGoing, &raw_unit);
  UnitHandle unit(raw_unit);
  if (code != CXError_Success || unit == nullptr) {
    for (size_t h = 0; h < headers.size(); ++h) {
      outcome.diagnostics[h].push_back(IncludePath(dir, headers[h]) +
                                       ": libclang could not parse it (error " +
                                       std::to_string(static_cast<int>(code)) + ")");
    }
    return outcome;
  }
  std::vector<std::vector<std::string>> refused = std::move(outcome.diagnostics);
  outcome.diagnostics.clear();
  UnitDescriber(unit.get(), dir, headers, settings, &outcome).Run();
  for (size_t h = 0; h < headers.size(); ++h) {
    if (refused[h].empty()) continue;
    outcome.files[h].reset();
    outcome.diagnostics[h] = std::move(refused[h]);
  }
  return outcome;
}

}  // namespace

GroupOutcome DescribeGroup(const GroupInput& input, const CompileSettings& settings,
                           unsigned threads) {
  // One unit for the whole group, or else one per header.
  std::vector<UnitOutcome> units;
  if (!input.headers.empty()) units.push_back(DescribeUnit(input.dir, input.headers, settings));
  const bool per_header = !units.empty() && units[0].unattributed_errors;
  if (per_header) {
    units.clear();
    units.resize(input.headers.size());
    std::atomic<size_t> next{0};
    auto work = [&]() {
      for (size_t h = next++; h < input.headers.size(); h = next++) {
        units[h] = DescribeUnit(input.dir, {input.headers[h]}, settings);
      }
    };
    std::vector<std::future<void>> helpers;
    for (unsigned t = 1; t < threads && t < input.headers.size(); ++t) {
      helpers.push_back(RunInBackground(work));
    }
    work();
    for (std::future<void>& helper : helpers) helper.get();
  }

  GroupOutcome outcome;
  outcome.group.name = input.name;
  for (size_t h = 0; h < input.headers.size(); ++h) {
    UnitOutcome& unit = per_header ? units[h] : units[0];
    const size_t slot = per_header ? 0 : h;
    if (unit.files[slot]) {
      outcome.group.files.push_back(std::move(*unit.files[slot]));
    } else {
      outcome.failures.push_back({input.headers[h], std::move(unit.diagnostics[slot])});
    }
  }
  for (UnitOutcome& unit : units) {
    outcome.warnings.insert(outcome.warnings.end(), unit.warnings.begin(), unit.warnings.end());
  }
  return outcome;
}

}  // namespace zor2::describe
