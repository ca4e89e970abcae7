#pragma once

#include <optional>
#include <string>
#include <vector>

namespace zor2::describe {

// The flags of a build's compilation database that matter for reading its
// headers: include directories, macro definitions, the language standard and
// the few options that change what the language accepts.
struct BuildFlags {
  std::vector<std::string> arguments;   // -I, -isystem, -D, -U, -include ... with absolute paths
  std::optional<std::string> standard;  // "c++20", as -std= gives it
};

// Reads `build_dir`/compile_commands.json and takes the flags of the command
// whose source file lies nearest `headers_dir` (the longest common directory;
// the first such command on a tie). False with the reason in `err` when there
// is no database or it holds no command.
bool ReadBuildFlags(const std::string& build_dir, const std::string& headers_dir, BuildFlags* flags,
                    std::string* err);

// The flags of one compiler command line (`command[0]` is the compiler), run in
// `directory`: the ones clang needs to read the headers as the build does,
// paths made absolute; every other flag (optimisation, warnings, outputs, a
// flag only one compiler knows) is left out.
BuildFlags FlagsOfCommand(const std::vector<std::string>& command, const std::string& directory);

}  // namespace zor2::describe
