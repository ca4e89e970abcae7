#pragma once

#include <optional>
#include <string>
#include <vector>

#include "describe/interface_model.h"

namespace zor2::describe {

// How the headers are compiled and what untagged headers get.
struct CompileSettings {
  std::vector<std::string> include_dirs;
  std::vector<std::string> defines;
  std::string standard = "c++17";
  std::optional<std::string> default_level;
  std::optional<std::string> default_usage;
};

// The headers of one interface group: `dir` as given on the command line and
// the header paths relative to it, sorted.
struct GroupInput {
  std::string name;
  std::string dir;
  std::vector<std::string> headers;
};

// A header that does not compile: its name and clang's error diagnostics,
// one line each ("path:line:column: error: message").
struct HeaderFailure {
  std::string header;
  std::vector<std::string> diagnostics;
};

struct GroupOutcome {
  GroupDescription group;               // every header that compiles, in input order
  std::vector<HeaderFailure> failures;  // in input order
  std::vector<std::string> warnings;    // tags that name nothing, one line each
};

// Describes the headers of `input` with libclang: one translation unit that
// includes them all, each declaration attributed to the header it is written
// in. A header with errors is left out of the description and named among the
// failures. When an error cannot be attributed to one header (a header that
// leaves a brace open swallows the next ones), each header is compiled on its
// own instead, on up to `threads` threads.
GroupOutcome DescribeGroup(const GroupInput& input, const CompileSettings& settings,
                           unsigned threads);

}  // namespace zor2::describe
