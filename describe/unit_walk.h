#pragma once

#include <clang-c/Index.h>

#include <optional>
#include <string>
#include <vector>

#include "describe/interface_model.h"

namespace zor2::describe {

// What untagged headers get, and which directories hold the described headers.
struct WalkSettings {
  std::optional<std::string> default_level;  // else "L1"
  std::optional<std::string> default_usage;  // else chosen from the header's classes
};

// The headers a unit describes: paths relative to `dir` ("" when they are
// given as they are).
struct UnitHeaders {
  std::string dir;
  std::vector<std::string> headers;
};

// What one translation unit tells about the headers it includes.
struct UnitOutcome {
  // An error that belongs to no single header: the headers must be compiled
  // one by one.
  bool unattributed_errors = false;
  // Per header: its description, or nothing when it has errors.
  std::vector<std::optional<FileDescription>> files;
  // Per header: its error diagnostics.
  std::vector<std::vector<std::string>> diagnostics;
  // Per header: it holds declarations but the unit left it empty (its include
  // guard was already defined, or it was reached under another name first):
  // it must be compiled on its own.
  std::vector<bool> needs_own_unit;
  // Files that took the place of a described header of the same relative
  // path, one line each ("... was read in place of ...").
  std::vector<std::string> stand_ins;
  // The directives, as written ("<vector>"), by which the described headers
  // include files from outside the described directories, in order, once each.
  std::vector<std::string> outside_includes;
  std::vector<std::string> warnings;
};

// Describes the headers of `headers` that the parsed unit `unit` includes.
// `roots` are the described directories (a file under them is not "outside").
UnitOutcome WalkUnit(CXTranslationUnit unit, const UnitHeaders& headers,
                     const std::vector<std::string>& roots, const WalkSettings& settings,
                     const std::string& main_name);

}  // namespace zor2::describe
