#include "describe/clang_handles.h"

#include <cctype>

#include "describe/token_text.h"

namespace zor2::describe {

std::string Take(CXString text) {
  const char* chars = clang_getCString(text);
  std::string result = chars != nullptr ? chars : "";
  clang_disposeString(text);
  return result;
}

Tokens::Tokens(CXTranslationUnit unit, CXSourceRange range) : unit_(unit) {
  clang_tokenize(unit, range, &tokens_, &count_);
}

Tokens::~Tokens() {
  clang_disposeTokens(unit_, tokens_, count_);
}

std::string Tokens::Spelling(unsigned i) const {
  return Take(clang_getTokenSpelling(unit_, tokens_[i]));
}

unsigned Tokens::Offset(unsigned i) const {
  unsigned offset = 0;
  clang_getSpellingLocation(clang_getTokenLocation(unit_, tokens_[i]), nullptr, nullptr, nullptr,
                            &offset);
  return offset;
}

std::string Tokens::Join(unsigned begin, unsigned end) const {
  std::vector<std::string> spellings;
  for (unsigned i = begin; i < end && i < count_; ++i) {
    if (Kind(i) != CXToken_Comment) spellings.push_back(Spelling(i));
  }
  return JoinTokens(spellings);
}

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

std::optional<FileKey> KeyOf(CXFile file) {
  CXFileUniqueID id;
  if (file == nullptr || clang_getFileUniqueID(file, &id) != 0) return std::nullopt;
  return FileKey{id.data[0], id.data[1], id.data[2]};
}

CXFile ExpansionFile(CXSourceLocation location, unsigned* line, unsigned* column) {
  CXFile file = nullptr;
  clang_getExpansionLocation(location, &file, line, column, nullptr);
  return file;
}

unsigned LineOf(CXCursor cursor) {
  unsigned line = 0;
  ExpansionFile(clang_getCursorLocation(cursor), &line);
  return line;
}

bool IsInMacroArgument(CXSourceLocation location) {
  CXFile expansion_file = nullptr;
  CXFile written_file = nullptr;
  unsigned expansion_offset = 0;
  unsigned written_offset = 0;
  clang_getExpansionLocation(location, &expansion_file, nullptr, nullptr, &expansion_offset);
  clang_getFileLocation(location, &written_file, nullptr, nullptr, &written_offset);
  return expansion_offset != written_offset || expansion_file != written_file;
}

std::string_view SourceTexts::Of(CXFile file) {
  const auto found = texts_.find(file);
  if (found != texts_.end()) return found->second;
  size_t size = 0;
  const char* text = file != nullptr ? clang_getFileContents(unit_, file, &size) : nullptr;
  const std::string_view view = text != nullptr ? std::string_view(text, size) : "";
  texts_.emplace(file, view);
  return view;
}

bool IsWrittenAt(CXCursor cursor, SourceTexts& texts) {
  const std::string name = Take(clang_getCursorSpelling(cursor));
  if (name.empty()) return false;
  CXFile file = nullptr;
  unsigned offset = 0;
  clang_getFileLocation(clang_getCursorLocation(cursor), &file, nullptr, nullptr, &offset);
  if (file == nullptr) return false;
  const std::string_view text = texts.Of(file);
  if (text.compare(offset, name.size(), name) != 0) return false;
  const size_t after = offset + name.size();
  return after == text.size() ||
         !(std::isalnum(static_cast<unsigned char>(text[after])) != 0 || text[after] == '_');
}

bool FileExtent(CXCursor cursor, CXFile* file, unsigned* begin, unsigned* end) {
  const CXSourceRange extent = clang_getCursorExtent(cursor);
  CXFile end_file = nullptr;
  clang_getExpansionLocation(clang_getRangeStart(extent), file, nullptr, nullptr, begin);
  clang_getExpansionLocation(clang_getRangeEnd(extent), &end_file, nullptr, nullptr, end);
  return *file != nullptr && *file == end_file && *begin <= *end;
}

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

bool HasAttribute(CXCursor cursor, CXCursorKind kind) {
  for (CXCursor child : ChildrenOf(cursor)) {
    if (clang_getCursorKind(child) == kind) return true;
  }
  return false;
}

}  // namespace zor2::describe
