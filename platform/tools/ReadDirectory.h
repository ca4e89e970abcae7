#pragma once

#include "platform/tools/TAFileName.h"

// Appends to `files` the full paths of the regular files (links to regular
// files included) of the directory named by `pattern`, sorted by byte-wise
// name. `pattern` is a directory path followed by the component "*", as built
// by TAFileName's "+"; sub-directories are not listed. Returns 0, or non-zero
// when the directory cannot be read (nothing is appended then).
int ReadDirectory(const TAFileName& pattern, QEXListValTAFileName& files);
