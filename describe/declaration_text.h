#pragma once

#include <clang-c/Index.h>

#include <optional>
#include <string>
#include <vector>

#include "describe/clang_handles.h"
#include "describe/interface_model.h"
#include "describe/type_spelling.h"

namespace zor2::describe {

// The texts of a function declaration that a person reads: its template head,
// its signature and its arguments' default values, each printed from the
// syntax tree or from the declaration's own tokens, never from a range of raw
// source that a macro could stretch.

// "template <typename T, int N> " for a function template, empty otherwise:
// each parameter's kind ("typename", a type, "template <...> class"), "..." for
// a pack, and its name as declared; default arguments are left out.
// `children` are those of `function`.
std::string TemplateHead(CXTranslationUnit unit, CXCursor function,
                         const std::vector<CXCursor>& children);

// The one-line signature of `function` (see docs/input-format.md): its
// template head, "static " or "virtual ", the returned type, the name and the
// argument types as written (no parameter names, top-level const dropped),
// then its qualifiers (" const", " volatile", " &", " &&") and " = 0".
// `method` holds the name, type and returned type already described.
// Template parameters are written with their declared names. `children` are
// those of `function`; `texts` holds the unit's file texts.
std::string Signature(CXTranslationUnit unit, CXCursor function,
                      const std::vector<CXCursor>& children, const MethodDescription& method,
                      const TemplateParameters& parameters, SourceTexts& texts);

// The declared type of a parameter as written, less a top-level const or
// volatile (which is not part of the function's type).
std::string WrittenParameterType(CXCursor parameter);

// The default argument of `parameter` of `function`: its tokens as written,
// from the '=' to the end of the argument (a macro call whole), spaced as
// JoinTokens spaces them; the compiler's own text of it when the parameter
// comes from a macro's body; "nullptr" for any null pointer constant given to
// a pointer; template parameters named by their position, as in types.
// Nothing when the parameter has no default argument.
// `siblings` are the children of `function`; `texts` holds the unit's file
// texts.
std::optional<std::string> DefaultValue(CXTranslationUnit unit, CXCursor function,
                                        const std::vector<CXCursor>& siblings, CXCursor parameter,
                                        const TemplateParameters& parameters, SourceTexts& texts);

}  // namespace zor2::describe
