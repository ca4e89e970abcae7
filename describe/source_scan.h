#pragma once

#include <functional>
#include <string>
#include <string_view>

namespace zor2::describe {

// What the preprocessor sees first in C++ source text, read to order and check
// the compilation, never to describe: comments and directives.

// Calls `on_directive`, when given, with each preprocessor directive of
// `source` (what follows its '#', to the end of its line); returns whether
// `source` holds anything but comments and directives, that is, declares
// something of its own.
bool ScanDirectives(std::string_view source,
                    const std::function<void(std::string_view)>& on_directive = nullptr);

// The target of the #include directive `directive` (what follows the '#'), as
// written: "<vector>", "\"dep/x.h\""; empty for another directive,
// #include_next or a macro.
std::string IncludeTarget(std::string_view directive);

// The directive on the line of `source` that holds `offset` (what follows the
// '#'), or empty when that line holds none.
std::string_view DirectiveAt(std::string_view source, size_t offset);

}  // namespace zor2::describe
