#include "driver/output_clash.h"

#include <sys/stat.h>

#include <filesystem>
#include <system_error>
#include <vector>

#include "driver/pair_loading.h"
#include "platform/tools/file_output.h"
#include "platform/tools/paths.h"
#include "platform/tools/printable_path.h"

namespace zor2 {
namespace {

// A file of the run, and what tells it apart from another.
struct RunFile {
  std::string path;
  const char* role;    // "the report", "the reference document", ...
  const char* option;  // the option that names it, or the directory it is in
  bool exists = false;
  bool regular = false;
  dev_t device = 0;
  ino_t inode = 0;
  std::string destination;  // for a file that does not exist: where it would be
};

// Where a file that does not exist yet would be written: its links followed
// as the writer follows them, then its directory resolved, and its name; so
// that "out.md", "$PWD/out.md" and "here/out.md" with "here -> ." are one.
std::string Destination(const std::string& path) {
  if (path.empty()) return path;
  std::string target;
  if (!FinalTarget(path, &target)) target = path;
  std::error_code error;
  const std::filesystem::path absolute = std::filesystem::absolute(target, error);
  if (error) return std::filesystem::path(target).lexically_normal();
  const std::filesystem::path resolved = std::filesystem::weakly_canonical(absolute, error);
  return error ? absolute.lexically_normal().string() : resolved.string();
}

RunFile Identify(const std::string& path, const char* role, const char* option) {
  RunFile file{path, role, option, false, false, 0, 0, {}};
  struct stat status;
  if (::stat(path.c_str(), &status) == 0) {
    file.exists = true;
    file.regular = S_ISREG(status.st_mode);
    file.device = status.st_dev;
    file.inode = status.st_ino;
  } else {
    file.destination = Destination(path);
  }
  return file;
}

bool SameFile(const RunFile& a, const RunFile& b) {
  if (a.exists && b.exists) return a.device == b.device && a.inode == b.inode;
  return !a.exists && !b.exists && a.destination == b.destination;
}

std::string Describe(const RunFile& file) {
  return std::string(file.role) + " " + PrintablePath(file.path) + " (" + file.option + ")";
}

}  // namespace

std::optional<std::string> FindOutputClash(const RunConfiguration& config) {
  std::vector<RunFile> outputs;
  outputs.push_back(Identify(config.output_path, "the report", "-o"));
  if (config.help_page_path) {
    outputs.push_back(Identify(*config.help_page_path, "the help page", "-htm"));
  }
  for (const std::string& path : config.export_paths) {
    outputs.push_back(Identify(path, "the export", "-export"));
  }
  std::erase_if(outputs, [](const RunFile& output) { return output.exists && !output.regular; });

  std::vector<RunFile> inputs;
  inputs.push_back(Identify(config.reference_path, "the reference document", "-r"));
  inputs.push_back(Identify(config.checked_path, "the checked document", "-c"));
  if (config.baseline_path) {
    inputs.push_back(Identify(*config.baseline_path, "the baseline", "-baseline"));
  }
  if (config.argument_file_path) {
    inputs.push_back(Identify(*config.argument_file_path, "the argument file", "="));
  }
  if (IsDirectory(config.reference_path) && IsDirectory(config.checked_path)) {
    std::vector<PairReader::Paths> pairs;
    // A directory that cannot be listed is reported by the run.
    std::string ignored;
    ListDocumentPairs(config.reference_path, config.checked_path, &pairs, nullptr, &ignored);
    for (const PairReader::Paths& pair : pairs) {
      inputs.push_back(Identify(pair.reference, "the reference document", "-r"));
      inputs.push_back(Identify(pair.checked, "the checked document", "-c"));
    }
  }

  for (const RunFile& output : outputs) {
    for (const RunFile& input : inputs) {
      if (SameFile(output, input)) return Describe(output) + " would replace " + Describe(input);
    }
  }
  for (size_t later = 1; later < outputs.size(); ++later) {
    for (size_t earlier = 0; earlier < later; ++earlier) {
      if (SameFile(outputs[later], outputs[earlier])) {
        return Describe(outputs[later]) + " would replace " + Describe(outputs[earlier]);
      }
    }
  }
  return std::nullopt;
}

}  // namespace zor2
