#pragma once

#include "driver/command_line.h"
#include "driver/exit_status.h"

namespace zor2 {

// Compares every document pair named by `config` into one report: a reference
// document and a checked document, or each document of the reference directory
// and the same-named document of the checked directory. Then writes the report
// and, when asked, the help page. A document that cannot be read skips its
// pair only; every failure is named in an "ERROR: " line on the standard log
// and makes the result kIncomplete, otherwise the result is kDone whatever
// was found.
ExitStatus RunComparison(const RunConfiguration& config);

// The whole program: reads the command line (`argc` and `argv` as main gets
// them) and, unless that ends the process, runs the comparison. Returns the
// exit status.
ExitStatus RunProgram(int argc, const char* const* argv);

}  // namespace zor2
