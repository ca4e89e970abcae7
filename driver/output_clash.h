#pragma once

#include <optional>
#include <string>

#include "driver/command_line.h"

namespace zor2 {

// Looks, before anything is read or written, for an output of the run (the
// report, the help page, the exports) that is the same file as a file the run
// reads (a document, the baseline, the argument file) or as another output:
// same device and inode when both exist, else the same destination (links
// followed, directory resolved, same name) when neither does. An output that
// exists and is not a regular file (a device, a pipe) is written in place and
// clashes with nothing. Returns the message that names both files, or
// nothing.
std::optional<std::string> FindOutputClash(const RunConfiguration& config);

}  // namespace zor2
