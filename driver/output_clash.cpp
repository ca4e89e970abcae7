#include "driver/output_clash.h"

#include <sys/stat.h>

#include <filesystem>
#include <vector>

#include "driver/pair_loading.h"
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
};

RunFile Identify(const std::string& path, const char* role, const char* option) {
  RunFile file{path, role, option};
  struct stat status;
  if (::stat(path.c_str(), &status) == 0) {
    file.exists = true;
    file.regular = S_ISREG(status.st_mode);
    file.device = status.st_dev;
    file.inode = status.st_ino;
  }
  return file;
}

bool SameFile(const RunFile& a, const RunFile& b) {
  if (a.exists && b.exists) return a.device == b.device && a.inode == b.inode;
  return std::filesystem::path(a.path).lexically_normal() ==
         std::filesystem::path(b.path).lexically_normal();
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
