#pragma once

#include <optional>

#include "driver/ExitStatus.h"
#include "platform/tools/TAFileName.h"

// What a run is asked to do, as read from the command line.
struct RunConfiguration {
  TAFileName referencePath;  // "-r": a document or a directory of documents
  TAFileName checkedPath;    // "-c": likewise
  TAFileName outputPath;     // "-o": the report
  TAFileName helpPagePath;   // "-htm": null when no help page is asked for
};

// Reads the program's arguments (`argv[0]` is the program name; `argv` holds
// `argc` entries), or the items of the argument file named by the two
// arguments "=" and a path. Usage errors go to standard error, the "-h" text to
// standard output. When the run may go on, fills `config`, sets
// OnlyFlaggedFiles and CurrentLevel, writes the banner and the level to the log
// streams and returns nothing; otherwise returns the status the process must
// end with (a usage error, an unreadable argument file, or "-h").
std::optional<ExitStatus> ReadCommandLine(int argc, const char* const* argv,
                                          RunConfiguration& config);
