#include "describe/compile_database.h"

#include <clang-c/CXCompilationDatabase.h>

#include <filesystem>
#include <string_view>

#include "describe/clang_handles.h"

namespace zor2::describe {
namespace {

std::string Absolute(const std::string& path, const std::string& directory) {
  if (path.empty() || path[0] == '/' || directory.empty()) return path;
  return (std::filesystem::path(directory) / path).lexically_normal().string();
}

// Standards newer than this libclang knows, by the name it knows them under.
std::string KnownStandard(std::string standard) {
  for (const auto& [newer, known] :
       {std::pair<std::string_view, std::string_view>{"c++23", "c++2b"},
        {"gnu++23", "gnu++2b"},
        {"c++26", "c++2b"},
        {"gnu++26", "gnu++2b"},
        {"c++2c", "c++2b"},
        {"gnu++2c", "gnu++2b"}}) {
    if (standard == newer) return std::string(known);
  }
  return standard;
}

size_t CommonDirectoryLength(const std::string& a, const std::string& b) {
  size_t common = 0;
  for (size_t i = 0; i < a.size() && i < b.size() && a[i] == b[i]; ++i) {
    if (a[i] == '/') common = i + 1;
  }
  return common;
}

}  // namespace

BuildFlags FlagsOfCommand(const std::vector<std::string>& command, const std::string& directory) {
  // Options whose value names a path, written apart ("-I dir") or joined ("-Idir").
  static constexpr std::string_view kPathOptions[] = {"-isystem", "-iquote",  "-idirafter",
                                                      "-include", "-imacros", "-I"};
  static constexpr std::string_view kValueOptions[] = {"-D", "-U"};
  static constexpr std::string_view kKeptFlags[] = {
      "-nostdinc", "-nostdinc++",    "-fno-exceptions", "-fexceptions",  "-fno-rtti", "-frtti",
      "-fchar8_t", "-fno-char8_t",   "-funsigned-char", "-fsigned-char", "-pthread",  "-m32",
      "-m64",      "-fms-extensions"};
  BuildFlags flags;
  for (size_t i = 1; i < command.size(); ++i) {
    const std::string& item = command[i];
    bool taken = false;
    for (std::string_view option : kPathOptions) {
      if (item.compare(0, option.size(), option) != 0) continue;
      std::string value = item.substr(option.size());
      // "-include-pch" is another option; only directories come joined.
      if (!value.empty() && (option == "-include" || option == "-imacros")) break;
      if (value.empty()) {
        if (i + 1 >= command.size()) break;
        value = command[++i];
      }
      flags.arguments.push_back(std::string(option));
      flags.arguments.push_back(Absolute(value, directory));
      taken = true;
      break;
    }
    if (taken) continue;
    for (std::string_view option : kValueOptions) {
      if (item.compare(0, option.size(), option) != 0) continue;
      std::string value = item.substr(option.size());
      if (value.empty()) {
        if (i + 1 >= command.size()) break;
        value = command[++i];
      }
      flags.arguments.push_back(std::string(option) + value);
      taken = true;
      break;
    }
    if (taken) continue;
    if (item.compare(0, 5, "-std=") == 0) {
      flags.standard = KnownStandard(item.substr(5));
    } else if (item.compare(0, 10, "--sysroot=") == 0) {
      flags.arguments.push_back("--sysroot=" + Absolute(item.substr(10), directory));
    } else {
      for (std::string_view kept : kKeptFlags) {
        if (item == kept) flags.arguments.push_back(item);
      }
    }
  }
  return flags;
}

bool ReadBuildFlags(const std::string& build_dir, const std::string& headers_dir, BuildFlags* flags,
                    std::string* err) {
  CXCompilationDatabase_Error code = CXCompilationDatabase_NoError;
  CXCompilationDatabase database =
      clang_CompilationDatabase_fromDirectory(build_dir.c_str(), &code);
  if (code != CXCompilationDatabase_NoError || database == nullptr) {
    *err = build_dir + ": no compile_commands.json that can be read";
    return false;
  }
  CXCompileCommands commands = clang_CompilationDatabase_getAllCompileCommands(database);
  const unsigned count = clang_CompileCommands_getSize(commands);
  std::error_code ignored;
  const std::string near = std::filesystem::weakly_canonical(headers_dir, ignored).string() + "/";
  size_t best_length = 0;
  std::vector<std::string> best_command;
  std::string best_directory;
  bool found = false;
  for (unsigned c = 0; c < count; ++c) {
    CXCompileCommand command = clang_CompileCommands_getCommand(commands, c);
    const std::string directory = Take(clang_CompileCommand_getDirectory(command));
    const std::string file = Absolute(Take(clang_CompileCommand_getFilename(command)), directory);
    const size_t length = CommonDirectoryLength(file, near);
    if (found && length <= best_length) continue;
    found = true;
    best_length = length;
    best_directory = directory;
    best_command.clear();
    for (unsigned a = 0; a < clang_CompileCommand_getNumArgs(command); ++a) {
      best_command.push_back(Take(clang_CompileCommand_getArg(command, a)));
    }
  }
  clang_CompileCommands_dispose(commands);
  clang_CompilationDatabase_dispose(database);
  if (!found) {
    *err = build_dir + "/compile_commands.json: no compile command in it";
    return false;
  }
  *flags = FlagsOfCommand(best_command, best_directory);
  return true;
}

}  // namespace zor2::describe
