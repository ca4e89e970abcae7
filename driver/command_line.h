#pragma once

#include <optional>
#include <string>
#include <vector>

#include "driver/exit_status.h"
#include "rules/check_settings.h"

namespace zor2 {

// What a run is asked to do, as read from the command line.
struct RunConfiguration {
  std::string reference_path;                 // "-r": a document or a directory of documents
  std::string checked_path;                   // "-c": likewise
  std::string output_path;                    // "-o": the report
  std::optional<std::string> help_page_path;  // "-htm", unless given ""
  CheckSettings settings;                     // "-L" and "-level"
  bool summary = false;                       // "-summary", also set by "-fail"
  bool fail = false;                          // "-fail": status 3 when the check does not pass
  std::optional<std::string> baseline_path;   // "-baseline"
  std::vector<std::string> export_paths;      // "-export", in their order
  bool markdown_full = false;      // "-markdown-full": the Markdown export holds every finding
  std::string sarif_base;          // "-sarif-base": the folder file names are relative to
  std::vector<std::string> items;  // the command line as read, for the exports
  std::optional<std::string> argument_file_path;  // "= PATH", when its items were read
};

// Reads the program's arguments (`argv[0]` is the program name; `argv` holds
// `argc` entries), or the items of the argument file named by the two
// arguments "=" and a path. Usage errors go to standard error, the "-h" (or
// "--help") text and the "--version" line to standard output. An output that
// is the same file as an input document or as the other output is a usage
// error. When the run may go on, fills `config`, writes the banner and the
// level to the standard log and returns nothing; otherwise returns the status
// the process must end with (a usage error, an unreadable argument file,
// "-h", "--help" or "--version").
std::optional<ExitStatus> ReadCommandLine(int argc, const char* const* argv,
                                          RunConfiguration* config);

}  // namespace zor2
