#pragma once

#include <optional>
#include <ostream>
#include <string>
#include <string_view>
#include <vector>

namespace zor2::describe {

// The exit statuses of zor2describe, as zor2check's.
enum class DescribeStatus : int {
  kDone = 0,        // every header described, or "-h", "--help", "--version"
  kUsageError = 1,  // nothing was done
  kIncomplete = 2,  // a header did not compile, a directory could not be read, or the
                    // document could not be written
};

// What a run is asked to describe, as read from the command line.
struct DescribeOptions {
  std::string framework;
  std::string public_dir;
  std::optional<std::string> protected_dir;
  std::vector<std::string> include_dirs;     // -I, in order
  std::vector<std::string> defines;          // -D NAME or NAME=VALUE, in order
  std::optional<std::string> standard;       // -std; else the build's, else c++17
  std::optional<std::string> build_dir;      // -p: where compile_commands.json is
  std::vector<std::string> extra_args;       // -extra-arg, handed to clang last, in order
  std::optional<std::string> default_level;  // for headers without @ZOR2Level (else L1)
  std::optional<std::string> default_usage;  // for headers without @ZOR2Usage
  std::string output;
};

// The usage text, ended by a line end.
extern const char kDescribeUsage[];

// Whether clang knows `standard` as a C++ language standard ("c++17", "gnu++20").
bool IsKnownStandard(std::string_view standard);

// Reads the program's arguments (`argv[0]` is the program name), or the items
// of the argument file named by the two arguments "=" and a path. Fills
// `options` and returns nothing when the run may go on; otherwise returns the
// status to end with, having written the usage errors and the usage text to
// `err` (or, for "-h" and "--help", the usage text to `out`; for "--version",
// the program's name and release).
std::optional<DescribeStatus> ReadDescribeCommandLine(int argc, const char* const* argv,
                                                      DescribeOptions* options, std::ostream& out,
                                                      std::ostream& err);

}  // namespace zor2::describe
