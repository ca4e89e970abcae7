#include "describe/declaration_text.h"

#include <algorithm>
#include <string_view>

#include "describe/clang_handles.h"
#include "describe/token_text.h"
#include "describe/type_spelling.h"

namespace zor2::describe {
namespace {

bool IsTemplateParameterKind(CXCursorKind kind) {
  return kind == CXCursor_TemplateTypeParameter || kind == CXCursor_NonTypeTemplateParameter ||
         kind == CXCursor_TemplateTemplateParameter;
}

// Where the code at `location` is written in a file: for a macro's argument,
// where the argument is written; for a macro's body, where the macro is used.
void FileLocation(CXSourceLocation location, CXFile* file, unsigned* offset) {
  clang_getFileLocation(location, file, nullptr, nullptr, offset);
}

// One template parameter as the head shows it. Template template parameters
// nest as deep as the source does; past a few levels the inner heads are
// abbreviated, so that no declaration makes this recurse without bound.
std::string TemplateParameterText(CXTranslationUnit unit, CXCursor parameter, int nesting) {
  const CXCursorKind kind = clang_getCursorKind(parameter);
  const std::string name = Take(clang_getCursorSpelling(parameter));
  const std::string pack = IsTemplateParameterPack(parameter) ? "..." : "";
  std::string text;
  if (kind == CXCursor_TemplateTypeParameter) {
    text = "typename" + pack;
  } else if (kind == CXCursor_NonTypeTemplateParameter) {
    text = Take(clang_getTypeSpelling(clang_getCursorType(parameter))) + pack;
  } else {
    std::string inner;
    if (nesting < 4) {
      for (CXCursor child : ChildrenOf(parameter)) {
        if (!IsTemplateParameterKind(clang_getCursorKind(child))) continue;
        if (!inner.empty()) inner += ", ";
        inner += TemplateParameterText(unit, child, nesting + 1);
      }
    } else {
      inner = "...";
    }
    text = "template <" + inner + "> class" + pack;
  }
  return name.empty() ? text : text + " " + name;
}

// Whether `text` is a null pointer constant as the compiler prints it.
bool IsNullPointerText(std::string_view text) {
  static constexpr std::string_view kNulls[] = {
      "nullptr", "0",    "0L",     "0U",         "0UL",         "0LL",
      "0ULL",    "NULL", "__null", "(void *)0",  "((void *)0)", "std::nullptr_t()",
      "{}",      "0l",   "0ul",    "nullptr_t()"};
  for (std::string_view null : kNulls) {
    if (text == null) return true;
  }
  return false;
}

bool IsPointerLike(CXType type) {
  const CXTypeKind kind = clang_getCanonicalType(type).kind;
  return kind == CXType_Pointer || kind == CXType_MemberPointer || kind == CXType_NullPtr ||
         kind == CXType_BlockPointer;
}

// The default argument as the compiler prints the parameter ("int x = 3"):
// what follows the first " = " outside literals, or nothing.
std::optional<std::string> PrintedDefault(CXCursor parameter) {
  CXPrintingPolicy policy = clang_getCursorPrintingPolicy(parameter);
  const std::string printed = Take(clang_getCursorPrettyPrinted(parameter, policy));
  clang_PrintingPolicy_dispose(policy);
  char quote = 0;
  for (size_t i = 0; i + 3 <= printed.size(); ++i) {
    const char c = printed[i];
    if (quote != 0) {
      if (c == '\\') {
        ++i;
      } else if (c == quote) {
        quote = 0;
      }
      continue;
    }
    if (c == '"' || c == '\'') {
      quote = c;
    } else if (printed.compare(i, 3, " = ") == 0) {
      return printed.substr(i + 3);
    }
  }
  return std::nullopt;
}

// The default argument among `tokens`, those of the parameter and maybe what
// follows it: from the first '=' outside brackets, every token up to the
// offset `end` where its expression ends, and past it as long as a bracket
// opened inside is still open (the closing parenthesis of a macro call whose
// argument ends the expression); nothing when the tokens end first.
std::optional<std::string> DefaultTokens(const Tokens& tokens, unsigned end) {
  unsigned i = 0;
  for (int depth = 0; i < tokens.size(); ++i) {
    const std::string spelling = tokens.Spelling(i);
    if (spelling == "(" || spelling == "[" || spelling == "{") ++depth;
    if (spelling == ")" || spelling == "]" || spelling == "}") --depth;
    if (depth == 0 && spelling == "=") break;
  }
  std::vector<std::string> kept;
  int depth = 0;
  for (++i; i < tokens.size(); ++i) {
    if (tokens.Kind(i) == CXToken_Comment) continue;
    const std::string spelling = tokens.Spelling(i);
    const bool opening = spelling == "(" || spelling == "[" || spelling == "{";
    const bool closing = spelling == ")" || spelling == "]" || spelling == "}";
    const bool past_end = tokens.Offset(i) > end;
    if (past_end && depth == 0) return JoinTokens(kept);
    if (closing && depth == 0) return JoinTokens(kept);
    if (opening) ++depth;
    if (closing) --depth;
    kept.push_back(spelling);
  }
  if (depth == 0 && !kept.empty()) return JoinTokens(kept);
  return std::nullopt;
}

}  // namespace

std::string TemplateHead(CXTranslationUnit unit, CXCursor function,
                         const std::vector<CXCursor>& children) {
  if (clang_getCursorKind(function) != CXCursor_FunctionTemplate) return "";
  std::string parameters;
  for (CXCursor child : children) {
    if (!IsTemplateParameterKind(clang_getCursorKind(child))) continue;
    if (!parameters.empty()) parameters += ", ";
    parameters += TemplateParameterText(unit, child, 0);
  }
  return "template <" + parameters + "> ";
}

std::string WrittenParameterType(CXCursor parameter) {
  const CXType type = clang_getCursorType(parameter);
  std::string text = Take(clang_getTypeSpelling(type));
  if (clang_isConstQualifiedType(type) == 0 && clang_isVolatileQualifiedType(type) == 0) {
    return text;
  }
  return WithoutTopLevelQualifiers(
      std::move(text), type.kind == CXType_Pointer || type.kind == CXType_MemberPointer);
}

std::string Signature(CXTranslationUnit unit, CXCursor function,
                      const std::vector<CXCursor>& children, const MethodDescription& method,
                      const TemplateParameters& parameters, SourceTexts& texts) {
  std::string signature = TemplateHead(unit, function, children);
  if (method.type == "Static") signature += "static ";
  if (method.type == "Virtual" || method.type == "PureVirtual") signature += "virtual ";
  const bool conversion = clang_getCursorKind(function) == CXCursor_ConversionFunction ||
                          clang_getTemplateCursorKind(function) == CXCursor_ConversionFunction;
  if (method.returned_type && !conversion) {
    signature += Take(clang_getTypeSpelling(clang_getCursorResultType(function))) + " ";
  }
  signature += method.name + "(";
  bool first = true;
  for (CXCursor child : children) {
    if (clang_getCursorKind(child) != CXCursor_ParmDecl) continue;
    if (!first) signature += ", ";
    first = false;
    signature += WrittenParameterType(child);
  }
  const CXType type = clang_getCursorType(function);
  if (clang_isFunctionTypeVariadic(type) != 0) signature += first ? "..." : ", ...";
  signature += ")";
  if (clang_CXXMethod_isConst(function)) signature += " const";
  // libclang tells no volatile member function; the function's type says it,
  // spelled only when its declaration holds the word at all.
  CXFile file = nullptr;
  unsigned begin = 0;
  unsigned end = 0;
  if (FileExtent(function, &file, &begin, &end) &&
      texts.Of(file).substr(begin, end - begin).find("volatile") != std::string_view::npos) {
    const std::string type_text = Take(clang_getTypeSpelling(type));
    if (type_text.find(") volatile") != std::string::npos ||
        type_text.find(") const volatile") != std::string::npos) {
      signature += " volatile";
    }
  }
  switch (clang_Type_getCXXRefQualifier(type)) {
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
  return parameters.Written(signature);
}

std::optional<std::string> DefaultValue(CXTranslationUnit unit, CXCursor function,
                                        const std::vector<CXCursor>& siblings, CXCursor parameter,
                                        const TemplateParameters& parameters, SourceTexts& texts) {
  CXCursor expression = clang_getNullCursor();
  for (CXCursor child : ChildrenOf(parameter)) {
    if (clang_isExpression(clang_getCursorKind(child))) expression = child;
  }
  if (clang_Cursor_isNull(expression)) return std::nullopt;
  // The compiler's text says whether there is a default at all where the
  // expression could be something else (an array's size), which null
  // pointer it is, and what a parameter without tokens of its own holds.
  const bool pointer = IsPointerLike(clang_getCursorType(parameter));
  const bool written = IsWrittenAt(parameter, texts);
  std::optional<std::string> printed;
  if (pointer || !written) {
    printed = PrintedDefault(parameter);
    if (!printed) return std::nullopt;
    printed = parameters.Rename(*printed);
    if (pointer && IsNullPointerText(*printed)) return std::string("nullptr");
  }
  // A parameter that a macro's body declares (or an unnamed one) has no
  // tokens of its own to read: the compiler's text is the one there is.
  if (!written) return printed;

  // The parameter's own tokens, read where they are written (a macro's
  // argument included); when its default ends inside a macro call, up to the
  // next parameter or the end of the declaration.
  CXFile end_file = nullptr;
  unsigned end = 0;
  FileLocation(clang_getRangeEnd(clang_getCursorExtent(expression)), &end_file, &end);
  const CXSourceRange own = clang_getCursorExtent(parameter);
  std::optional<std::string> text = DefaultTokens(Tokens(unit, own), end);
  if (!text) {
    CXSourceLocation bound = clang_getRangeEnd(clang_getCursorExtent(function));
    bool after = false;
    for (CXCursor sibling : siblings) {
      if (after && clang_getCursorKind(sibling) == CXCursor_ParmDecl) {
        bound = clang_getCursorLocation(sibling);
        break;
      }
      after = after || clang_equalCursors(sibling, parameter);
    }
    text = DefaultTokens(Tokens(unit, clang_getRange(clang_getRangeStart(own), bound)), end);
  }
  if (text && !text->empty()) return parameters.Rename(*text);
  if (!printed) {
    printed = PrintedDefault(parameter);
    if (printed) printed = parameters.Rename(*printed);
  }
  return printed;
}

}  // namespace zor2::describe
