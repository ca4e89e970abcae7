#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace zor2::describe {

// The order in which a unit includes the headers of a group (indexes into
// `headers`, paths relative to `dir`): first those that no other header of
// the group includes, then the others, each part sorted as `headers` is, and
// in each part the implementation parts of other headers ("-inl.h",
// "_impl.hpp") last. A header meant to be reached only through another one
// (an "-inl.h" part that its header includes at its end, and that includes
// its header in return) is then compiled as its users see it. The
// #include lines of each header are read for this order only; a target is
// looked for beside its header and under each of `roots`.
std::vector<size_t> IncludeOrder(const std::string& dir, const std::vector<std::string>& headers,
                                 const std::vector<std::string>& roots);

// The targets of the #include directives of the C++ text `source`, as written
// between the quotes or the angle brackets, in order; comments are skipped.
std::vector<std::string> IncludedNames(std::string_view source);

}  // namespace zor2::describe
