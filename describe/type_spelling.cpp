#include "describe/type_spelling.h"

#include <algorithm>
#include <cctype>
#include <string_view>
#include <utility>
#include <vector>

#include "describe/clang_handles.h"

namespace zor2::describe {
namespace {

bool IsIdentifierStart(char c) {
  return std::isalpha(static_cast<unsigned char>(c)) != 0 || c == '_';
}

bool IsIdentifierChar(char c) {
  return std::isalnum(static_cast<unsigned char>(c)) != 0 || c == '_';
}

bool IsTemplateKind(CXCursorKind kind) {
  return kind == CXCursor_ClassTemplate || kind == CXCursor_ClassTemplatePartialSpecialization ||
         kind == CXCursor_FunctionTemplate || kind == CXCursor_TypeAliasTemplateDecl;
}

bool IsTemplateParameterKind(CXCursorKind kind) {
  return kind == CXCursor_TemplateTypeParameter || kind == CXCursor_NonTypeTemplateParameter ||
         kind == CXCursor_TemplateTemplateParameter;
}

// Whether the identifier that starts at `pos` is reached through "::", "." or
// "->", that is, names a member rather than something in scope.
bool IsMemberAccess(std::string_view text, size_t pos) {
  size_t at = pos;
  while (at > 0 && text[at - 1] == ' ') --at;
  if (at >= 1 && text[at - 1] == '.') return true;
  if (at >= 2 && text.substr(at - 2, 2) == "::") return true;
  return at >= 2 && text.substr(at - 2, 2) == "->";
}

// Reads clang's "type-parameter-D-I" at `pos`; its length, or 0.
size_t ReadCanonicalParameter(std::string_view text, size_t pos, unsigned* depth, unsigned* index) {
  constexpr std::string_view kPrefix = "type-parameter-";
  if (text.substr(pos, kPrefix.size()) != kPrefix) return 0;
  size_t at = pos + kPrefix.size();
  auto read_number = [&](unsigned* value) {
    const size_t start = at;
    *value = 0;
    while (at < text.size() && std::isdigit(static_cast<unsigned char>(text[at])) != 0 &&
           at - start < 6) {
      *value = *value * 10 + static_cast<unsigned>(text[at] - '0');
      ++at;
    }
    return at > start;
  };
  if (!read_number(depth) || at >= text.size() || text[at] != '-') return 0;
  ++at;
  if (!read_number(index)) return 0;
  if (at < text.size() && IsIdentifierChar(text[at])) return 0;
  return at - pos;
}

bool IsArrayKind(CXTypeKind kind) {
  return kind == CXType_ConstantArray || kind == CXType_IncompleteArray ||
         kind == CXType_VariableArray || kind == CXType_DependentSizedArray;
}

bool IsPointerKind(CXTypeKind kind) {
  return kind == CXType_Pointer || kind == CXType_MemberPointer || kind == CXType_BlockPointer ||
         kind == CXType_ObjCObjectPointer;
}

}  // namespace

std::string WithoutTopLevelQualifiers(std::string text, bool pointer) {
  static constexpr std::string_view kQualifiers[] = {"const", "volatile", "restrict", "__restrict"};
  for (bool changed = true; changed;) {
    changed = false;
    for (std::string_view qualifier : kQualifiers) {
      if (pointer) {
        if (text.size() > qualifier.size() &&
            text.compare(text.size() - qualifier.size(), qualifier.size(), qualifier) == 0 &&
            !IsIdentifierChar(text[text.size() - qualifier.size() - 1])) {
          text.erase(text.size() - qualifier.size());
          while (!text.empty() && text.back() == ' ') text.pop_back();
          changed = true;
        }
      } else if (text.size() > qualifier.size() &&
                 text.compare(0, qualifier.size(), qualifier) == 0 &&
                 text[qualifier.size()] == ' ') {
        text.erase(0, qualifier.size() + 1);
        changed = true;
      }
    }
  }
  return text;
}

bool IsTemplateParameterPack(CXCursor parameter) {
  // What a macro writes is not read: its tokens are the macro's use, and a
  // range that a macro stretches could be long.
  const CXSourceRange extent = clang_getCursorExtent(parameter);
  CXFile file = nullptr;
  unsigned begin = 0;
  unsigned end = 0;
  if (IsInMacroArgument(clang_getRangeStart(extent)) ||
      IsInMacroArgument(clang_getRangeEnd(extent)) || !FileExtent(parameter, &file, &begin, &end) ||
      end - begin > 4096) {
    return false;
  }
  const std::string name = Take(clang_getCursorSpelling(parameter));
  const Tokens tokens(clang_Cursor_getTranslationUnit(parameter), extent);
  int depth = 0;
  for (unsigned i = 0; i < tokens.size(); ++i) {
    const std::string spelling = tokens.Spelling(i);
    if (spelling == "<" || spelling == "(") ++depth;
    if (spelling == ">" || spelling == ")") --depth;
    if (depth != 0) continue;
    if (spelling == "...") return true;
    if (spelling == "=" || (!name.empty() && spelling == name)) return false;
  }
  return false;
}

TemplateParameters::TemplateParameters(std::vector<std::vector<Parameter>> levels)
    : levels_(std::move(levels)) {
  for (const std::vector<Parameter>& level : levels_) {
    for (const Parameter& parameter : level) {
      if (!parameter.declared.empty()) {
        positional_of_declared_[parameter.declared] = parameter.positional;
      }
    }
  }
}

TemplateParameters TemplateParameters::Around(CXCursor declaration) {
  // The templates from the innermost out; depths count from the outermost.
  std::vector<std::vector<CXCursor>> templates;
  for (CXCursor at = declaration; !clang_Cursor_isNull(at);
       at = clang_getCursorSemanticParent(at)) {
    const CXCursorKind kind = clang_getCursorKind(at);
    if (kind == CXCursor_TranslationUnit || clang_isInvalid(kind)) break;
    if (!IsTemplateKind(kind)) continue;
    std::vector<CXCursor> parameters;
    for (CXCursor child : ChildrenOf(at)) {
      if (IsTemplateParameterKind(clang_getCursorKind(child))) parameters.push_back(child);
    }
    templates.push_back(std::move(parameters));
  }
  std::vector<std::vector<Parameter>> levels;
  for (auto level = templates.rbegin(); level != templates.rend(); ++level) {
    const auto depth = static_cast<unsigned>(levels.size());
    std::vector<Parameter> parameters;
    for (CXCursor parameter : *level) {
      const auto index = static_cast<unsigned>(parameters.size());
      parameters.push_back({Take(clang_getCursorSpelling(parameter)), PositionalName(depth, index),
                            IsTemplateParameterPack(parameter)});
    }
    levels.push_back(std::move(parameters));
  }
  return TemplateParameters(std::move(levels));
}

TemplateParameters TemplateParameters::With(CXCursor function) const {
  if (clang_getCursorKind(function) != CXCursor_FunctionTemplate) return *this;
  std::vector<std::vector<Parameter>> levels = levels_;
  const auto depth = static_cast<unsigned>(levels.size());
  std::vector<Parameter> parameters;
  for (CXCursor child : ChildrenOf(function)) {
    if (!IsTemplateParameterKind(clang_getCursorKind(child))) continue;
    const auto index = static_cast<unsigned>(parameters.size());
    parameters.push_back({Take(clang_getCursorSpelling(child)), PositionalName(depth, index),
                          IsTemplateParameterPack(child)});
  }
  levels.push_back(std::move(parameters));
  return TemplateParameters(std::move(levels));
}

const TemplateParameters::Parameter* TemplateParameters::At(unsigned depth, unsigned index) const {
  if (depth >= levels_.size() || index >= levels_[depth].size()) return nullptr;
  return &levels_[depth][index];
}

const std::vector<TemplateParameters::Parameter>& TemplateParameters::Innermost() const {
  static const std::vector<Parameter> kNone;
  return levels_.empty() ? kNone : levels_.back();
}

std::string TemplateParameters::PositionalName(unsigned depth, unsigned index) {
  static constexpr std::string_view kLetters = "TUVWXYZ";
  std::string name(1, depth < kLetters.size() ? kLetters[depth] : 'T');
  if (depth >= kLetters.size()) name.append(std::to_string(depth + 1)).append("_");
  return name.append(std::to_string(index + 1));
}

std::string TemplateParameters::Written(std::string_view text) const {
  if (text.find("type-parameter-") == std::string_view::npos) return std::string(text);
  std::string written;
  written.reserve(text.size());
  size_t pos = 0;
  while (pos < text.size()) {
    unsigned depth = 0;
    unsigned index = 0;
    const bool word_start = pos == 0 || !IsIdentifierChar(text[pos - 1]);
    const size_t length = word_start ? ReadCanonicalParameter(text, pos, &depth, &index) : 0;
    if (length == 0) {
      written += text[pos++];
      continue;
    }
    const Parameter* parameter = At(depth, index);
    written += parameter != nullptr && !parameter->declared.empty() ? parameter->declared
                                                                    : PositionalName(depth, index);
    pos += length;
  }
  return written;
}

std::string TemplateParameters::Rename(std::string_view text) const {
  if (positional_of_declared_.empty() && text.find("type-parameter-") == std::string_view::npos) {
    return std::string(text);
  }
  std::string renamed;
  renamed.reserve(text.size());
  size_t pos = 0;
  while (pos < text.size()) {
    const char c = text[pos];
    // String and character literals of expressions are kept as they are.
    if (c == '"' || c == '\'') {
      size_t end = pos + 1;
      while (end < text.size() && text[end] != c) end += text[end] == '\\' ? 2 : 1;
      end = std::min(end + 1, text.size());
      renamed.append(text.substr(pos, end - pos));
      pos = end;
      continue;
    }
    if (!IsIdentifierChar(c)) {
      renamed += c;
      ++pos;
      continue;
    }
    unsigned depth = 0;
    unsigned index = 0;
    if (const size_t length = ReadCanonicalParameter(text, pos, &depth, &index)) {
      renamed += PositionalName(depth, index);
      pos += length;
      continue;
    }
    size_t end = pos + 1;
    while (end < text.size() && IsIdentifierChar(text[end])) ++end;
    const std::string_view word = text.substr(pos, end - pos);
    const auto found =
        IsIdentifierStart(c) ? positional_of_declared_.find(word) : positional_of_declared_.end();
    if (found != positional_of_declared_.end() && !IsMemberAccess(text, pos)) {
      renamed += found->second;
    } else {
      renamed.append(word);
    }
    pos = end;
  }
  return renamed;
}

std::string WithStandardNames(std::string text) {
  if (text.find("std::") == std::string::npos && text.find("_IO_FILE") == std::string::npos) {
    return text;
  }
  // The library's own inline namespaces, which clang prints where leaving
  // them out would be ambiguous.
  for (std::string_view inner : {"std::__cxx11::", "std::__1::"}) {
    for (size_t at = text.find(inner); at != std::string::npos; at = text.find(inner, at)) {
      text.erase(at + 5, inner.size() - 5);
    }
  }
  static const std::pair<std::string_view, std::string_view> kNames[] = {
      {"std::basic_string<char>", "std::string"},
      {"std::basic_string<wchar_t>", "std::wstring"},
      {"std::basic_string<char8_t>", "std::u8string"},
      {"std::basic_string<char16_t>", "std::u16string"},
      {"std::basic_string<char32_t>", "std::u32string"},
      {"std::basic_string_view<char>", "std::string_view"},
      {"std::basic_string_view<wchar_t>", "std::wstring_view"},
      {"std::basic_string_view<char8_t>", "std::u8string_view"},
      {"std::basic_string_view<char16_t>", "std::u16string_view"},
      {"std::basic_string_view<char32_t>", "std::u32string_view"},
      {"std::basic_ostream<char>", "std::ostream"},
      {"std::basic_istream<char>", "std::istream"},
      {"std::basic_iostream<char>", "std::iostream"},
      {"std::basic_ios<char>", "std::ios"},
      {"std::basic_streambuf<char>", "std::streambuf"},
      {"std::basic_ostringstream<char>", "std::ostringstream"},
      {"std::basic_istringstream<char>", "std::istringstream"},
      {"std::basic_stringstream<char>", "std::stringstream"},
      {"std::basic_ofstream<char>", "std::ofstream"},
      {"std::basic_ifstream<char>", "std::ifstream"},
      {"std::basic_fstream<char>", "std::fstream"},
      {"std::basic_ostream<wchar_t>", "std::wostream"},
      {"std::basic_istream<wchar_t>", "std::wistream"},
      {"_IO_FILE", "FILE"},
  };
  for (const auto& [long_name, usual_name] : kNames) {
    for (size_t at = text.find(long_name); at != std::string::npos; at = text.find(long_name, at)) {
      if (at > 0 && (IsIdentifierChar(text[at - 1]) || text[at - 1] == ':')) {
        at += long_name.size();
        continue;
      }
      text.replace(at, long_name.size(), usual_name);
      at += usual_name.size();
    }
  }
  return text;
}

namespace {

// `text` with the dynamic extent of each std::span, its default argument,
// left out as the other defaults are: "std::span<int, 18446744073709551615>"
// is "std::span<int>".
std::string WithoutDynamicExtents(std::string text) {
  constexpr std::string_view kSpan = "std::span<";
  constexpr std::string_view kDynamic = ", 18446744073709551615>";
  for (size_t at = text.find(kSpan); at != std::string::npos; at = text.find(kSpan, at + 1)) {
    int depth = 0;
    for (size_t i = at + kSpan.size() - 1; i < text.size(); ++i) {
      if (text[i] == '<') ++depth;
      if (text[i] != '>' || --depth != 0) continue;
      const size_t tail = i + 1 - kDynamic.size();
      if (i + 1 >= kDynamic.size() && text.compare(tail, kDynamic.size(), kDynamic) == 0) {
        text.erase(tail, kDynamic.size() - 1);
      }
      break;
    }
  }
  return text;
}

}  // namespace

std::string TypeIdentity(CXType type, const TemplateParameters& parameters) {
  const CXType canonical = clang_getCanonicalType(type);
  std::string text = parameters.Rename(Take(clang_getTypeSpelling(canonical)));
  if (text.find("std::span<") != std::string::npos) text = WithoutDynamicExtents(std::move(text));
  return WithStandardNames(std::move(text));
}

std::string ParameterTypeIdentity(CXType type, const TemplateParameters& parameters) {
  const CXType canonical = clang_getCanonicalType(type);
  const CXTypeKind kind = canonical.kind;
  if (IsArrayKind(kind)) {
    std::string element = TypeIdentity(clang_getArrayElementType(canonical), parameters);
    // A pointer to an array is spelled around it: "int (*)[4]".
    const size_t bracket = element.find('[');
    if (bracket != std::string::npos) return element.insert(bracket, "(*)");
    return element + " *";
  }
  std::string spelled = TypeIdentity(canonical, parameters);
  const bool qualified = clang_isConstQualifiedType(canonical) != 0 ||
                         clang_isVolatileQualifiedType(canonical) != 0 ||
                         clang_isRestrictQualifiedType(canonical) != 0;
  if (!qualified) return spelled;
  return WithoutTopLevelQualifiers(std::move(spelled), IsPointerKind(kind));
}

}  // namespace zor2::describe
