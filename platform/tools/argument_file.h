#pragma once

#include <string>
#include <vector>

namespace zor2 {

// Appends the items of the argument file at `path` to `items`. Items are
// separated by white space (space, tab, CR, LF); a double-quoted run keeps its
// blanks inside one item, the quotes removed ("a b"c gives `a bc`; "" alone is
// an empty item; an unterminated quote runs to the end of the file). A file of
// white space only gives no item. The file is read as documents are
// (ReadRegularFile): only a regular file, never waiting. False with the
// reason in `err` when it cannot be read or does not fit in memory (nothing is
// appended then).
bool ReadArgumentFile(const std::string& path, std::vector<std::string>* items, std::string* err);

}  // namespace zor2
