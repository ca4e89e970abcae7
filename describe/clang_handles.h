#pragma once

#include <clang-c/Index.h>

#include <array>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace zor2::describe {

// Small owners and readers of libclang's C objects, so that the describer never
// disposes of one by hand.

// The text of `text`, which is disposed of.
std::string Take(CXString text);

struct IndexDeleter {
  void operator()(void* index) const { clang_disposeIndex(index); }
};
struct UnitDeleter {
  void operator()(CXTranslationUnitImpl* unit) const { clang_disposeTranslationUnit(unit); }
};
using IndexHandle = std::unique_ptr<void, IndexDeleter>;
using UnitHandle = std::unique_ptr<CXTranslationUnitImpl, UnitDeleter>;

// The tokens of one source range of a unit.
class Tokens {
 public:
  Tokens(CXTranslationUnit unit, CXSourceRange range);
  ~Tokens();
  Tokens(const Tokens&) = delete;
  Tokens& operator=(const Tokens&) = delete;

  unsigned size() const { return count_; }
  std::string Spelling(unsigned i) const;
  CXTokenKind Kind(unsigned i) const { return clang_getTokenKind(tokens_[i]); }
  // The offset of token `i` in its file.
  unsigned Offset(unsigned i) const;

  // The text of tokens [begin, end), comments left out, spaced the same
  // whatever the layout of the source (see JoinTokens).
  std::string Join(unsigned begin, unsigned end) const;

 private:
  CXTranslationUnit unit_;
  CXToken* tokens_ = nullptr;
  unsigned count_ = 0;
};

// The direct children of `parent`, in order.
std::vector<CXCursor> ChildrenOf(CXCursor parent);

// A file as libclang knows it, whatever path led to it.
using FileKey = std::array<unsigned long long, 3>;
std::optional<FileKey> KeyOf(CXFile file);

// Where the code at `location` ends up after macro expansion: its file, and
// its line and column there when asked for.
CXFile ExpansionFile(CXSourceLocation location, unsigned* line = nullptr,
                     unsigned* column = nullptr);

// The line of the declaration `cursor` in the file it expands into.
unsigned LineOf(CXCursor cursor);

// Whether `location` lies in the argument of a macro: where the argument is
// written differs from where the macro is used. (libclang cannot tell where a
// macro's body was written: see IsWrittenAt.)
bool IsInMacroArgument(CXSourceLocation location);

// The texts of the files of one unit, each asked of libclang once (a lookup
// that grows with the unit).
//
// Thread safety: used by one thread.
class SourceTexts {
 public:
  explicit SourceTexts(CXTranslationUnit unit) : unit_(unit) {}
  std::string_view Of(CXFile file);

 private:
  CXTranslationUnit unit_;
  std::map<CXFile, std::string_view> texts_;
};

// Whether the declaration `cursor` is written where its location says, its
// name standing there in its file (directly, or in a macro's argument); false
// for a declaration that a macro's body makes, or an unnamed one.
bool IsWrittenAt(CXCursor cursor, SourceTexts& texts);

// The offsets in its file where the extent of `cursor` begins and ends, after
// macro expansion; false when they are in two files or the wrong way round.
bool FileExtent(CXCursor cursor, CXFile* file, unsigned* begin, unsigned* end);

// An extern "C" block, which libclang may show as an unexposed declaration:
// what it holds belongs to the enclosing namespace.
bool IsLinkageKind(CXCursorKind kind);

bool IsClassKind(CXCursorKind kind);

bool IsMemberFunctionKind(CXCursorKind kind);

// Whether `cursor` carries the attribute of kind `kind` (CXCursor_CXXFinalAttr ...).
bool HasAttribute(CXCursor cursor, CXCursorKind kind);

}  // namespace zor2::describe
