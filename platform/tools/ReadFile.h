#pragma once

#include "platform/tools/QEXListVal.h"

// Appends the items of the text file `path` to `items`. Items are separated by
// white space (space, tab, CR, LF); a double-quoted run keeps its blanks inside
// one item, the quotes removed. A file of white space only gives no item.
// Returns 0, or non-zero when the file cannot be read (nothing is appended).
int ReadFile(const char* path, QEXListValQEXString& items);
