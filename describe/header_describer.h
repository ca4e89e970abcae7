#pragma once

#include <optional>
#include <string>
#include <vector>

#include "describe/interface_model.h"
#include "describe/progress_line.h"
#include "describe/unit_walk.h"

namespace zor2::describe {

// How the headers are compiled and what untagged headers get.
struct CompileSettings {
  // The described directories (-public, -protected): include roots searched
  // before every other directory.
  std::vector<std::string> roots;
  // Everything else handed to clang, in order: -I, -D, -std and the rest.
  std::vector<std::string> arguments;
  WalkSettings walk;
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
  std::vector<std::string> stand_ins;   // files read in place of a described header
  std::vector<std::string> warnings;    // tags that name nothing, one line each
};

// Describes the headers of `input` with libclang: one translation unit that
// includes them all, each declaration charged to the header it is written in.
// A header with errors is left out of the description and named among the
// failures. When an error cannot be charged to one header (a header that
// leaves a brace open swallows the next ones), each header is compiled on its
// own instead, on up to `threads` threads, after what the headers include from
// elsewhere has been compiled once into a precompiled header; so is a header
// that the unit left empty though it declares something (its include guard
// was taken, or it was reached under another name). `progress` counts the
// headers compiled one by one.
GroupOutcome DescribeGroup(const GroupInput& input, const CompileSettings& settings,
                           unsigned threads, ProgressLine* progress);

}  // namespace zor2::describe
