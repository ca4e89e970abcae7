#pragma once

#include "driver/CommandLine.h"
#include "driver/ExitStatus.h"

// Compares every document pair named by `config` into one report: a reference
// document and a checked document, or each document of the reference directory
// and the same-named document of the checked directory. Then prunes and writes
// the report and, when asked, the help page. A document that cannot be read
// skips its pair only; a failure is reported on the error log stream and makes
// the result kIncomplete, otherwise the result is kDone whatever was found.
ExitStatus RunComparison(const RunConfiguration& config);

// The whole program: reads the command line (`argc` and `argv` as main gets
// them) and, unless it ends the process, runs the comparison. Flushes the log
// streams and returns the exit status.
ExitStatus RunProgram(int argc, const char* const* argv);
