#include "describe/describe_run.h"

#include <sys/stat.h>
#include <unistd.h>

#include <csignal>
#include <filesystem>
#include <future>
#include <optional>
#include <string_view>
#include <thread>
#include <vector>

#include "describe/compile_database.h"
#include "describe/header_describer.h"
#include "describe/header_listing.h"
#include "describe/interface_document.h"
#include "platform/tools/background.h"
#include "platform/tools/file_output.h"
#include "platform/tools/printable_path.h"

namespace zor2::describe {
namespace {

// As many threads as the machine has cores for this process.
unsigned MachineThreads() {
  const unsigned cores = std::thread::hardware_concurrency();
  return cores == 0 ? 1 : cores;
}

std::string IncludePath(const std::string& dir, const std::string& header) {
  if (dir.empty()) return header;
  return dir.back() == '/' ? dir + header : dir + "/" + header;
}

// The described header that the output `output` would replace (the same file,
// or, while the output does not exist yet, the same place), or nothing.
std::optional<std::string> OutputClash(const std::string& output,
                                       const std::vector<GroupInput>& inputs) {
  namespace fs = std::filesystem;
  struct stat output_status;
  const bool exists = ::stat(output.c_str(), &output_status) == 0;
  // A device or a pipe is written in place and replaces nothing.
  if (exists && !S_ISREG(output_status.st_mode)) return std::nullopt;
  std::error_code code;
  const fs::path place = fs::weakly_canonical(output, code);
  for (const GroupInput& input : inputs) {
    for (const std::string& header : input.headers) {
      const std::string path = IncludePath(input.dir, header);
      struct stat header_status;
      if (::stat(path.c_str(), &header_status) != 0) continue;
      const bool same = exists ? header_status.st_dev == output_status.st_dev &&
                                     header_status.st_ino == output_status.st_ino
                               : !code && fs::weakly_canonical(path, code) == place;
      if (same) return input.name + " header " + path;
    }
  }
  return std::nullopt;
}

// What clang is given besides the include roots: the -I directories, the
// build's flags, the definitions, the standard and the extra arguments, in
// that order.
bool ComposeArguments(const DescribeOptions& options, std::vector<std::string>* arguments,
                      std::string* err) {
  BuildFlags build;
  if (options.build_dir && !ReadBuildFlags(*options.build_dir, options.public_dir, &build, err)) {
    return false;
  }
  for (const std::string& dir : options.include_dirs) arguments->push_back("-I" + dir);
  arguments->insert(arguments->end(), build.arguments.begin(), build.arguments.end());
  for (const std::string& define : options.defines) arguments->push_back("-D" + define);
  std::string standard = "c++17";
  if (build.standard && IsKnownStandard(*build.standard)) standard = *build.standard;
  if (options.standard) standard = *options.standard;
  arguments->push_back("-std=" + standard);
  arguments->insert(arguments->end(), options.extra_args.begin(), options.extra_args.end());
  return true;
}

}  // namespace

DescribeStatus RunDescribe(int argc, const char* const* argv, std::ostream& out,
                           std::ostream& err) {
  std::signal(SIGPIPE, SIG_IGN);
  NameTemporaryFilesAfter("zor2describe");
  RemoveTemporaryFilesOnInterrupt();
  DescribeOptions options;
  if (std::optional<DescribeStatus> status =
          ReadDescribeCommandLine(argc, argv, &options, out, err)) {
    return *status;
  }
  const std::string program = "zor2describe";
  bool complete = true;

  std::vector<GroupInput> inputs = {{"Public", options.public_dir, {}}};
  if (options.protected_dir) inputs.push_back({"Protected", *options.protected_dir, {}});
  for (GroupInput& input : inputs) {
    std::string reason;
    if (!ListHeaders(input.dir, &input.headers, &reason)) {
      err << program << ": cannot list the " << input.name << " headers: " << PrintablePath(reason)
          << '\n';
      complete = false;
    }
  }
  if (std::optional<std::string> clash = OutputClash(options.output, inputs)) {
    err << program << ": the output " << PrintablePath(options.output) << " (-o) would replace the "
        << PrintablePath(*clash) << '\n'
        << kDescribeUsage;
    return DescribeStatus::kUsageError;
  }

  CompileSettings settings;
  settings.roots.push_back(options.public_dir);
  if (options.protected_dir) settings.roots.push_back(*options.protected_dir);
  settings.walk = {options.default_level, options.default_usage};
  std::string reason;
  if (!ComposeArguments(options, &settings.arguments, &reason)) {
    err << "ERROR: " << PrintablePath(reason) << '\n';
    return DescribeStatus::kIncomplete;
  }

  const unsigned threads = MachineThreads();
  ProgressLine progress(program, ::isatty(STDERR_FILENO) != 0);
  // The groups are compiled side by side.
  std::vector<GroupOutcome> outcomes(inputs.size());
  std::vector<std::future<void>> helpers;
  for (size_t g = 1; g < inputs.size(); ++g) {
    helpers.push_back(RunInBackground(
        [&, g] { outcomes[g] = DescribeGroup(inputs[g], settings, threads, &progress); }));
  }
  outcomes[0] = DescribeGroup(inputs[0], settings, threads, &progress);
  for (std::future<void>& helper : helpers) helper.get();

  FrameworkDescription framework{options.framework, {}};
  for (GroupOutcome& outcome : outcomes) {
    for (const std::string& warning : outcome.warnings) err << PrintablePath(warning) << '\n';
    for (const std::string& stand_in : outcome.stand_ins) {
      err << program << ": " << PrintablePath(stand_in) << ": the " << outcome.group.name
          << " headers must be read from their own directory\n";
      complete = false;
    }
    for (const HeaderFailure& failure : outcome.failures) {
      for (const std::string& line : failure.diagnostics) err << PrintablePath(line) << '\n';
      err << program << ": " << outcome.group.name << " header " << PrintablePath(failure.header)
          << " does not compile: left out of the document\n";
      complete = false;
    }
    framework.groups.push_back(std::move(outcome.group));
  }

  if (!xml::WriteDocument(*BuildDocument(framework), options.output, &reason)) {
    err << "ERROR: " << PrintablePath(options.output) << ": " << reason << '\n';
    return DescribeStatus::kIncomplete;
  }
  return complete ? DescribeStatus::kDone : DescribeStatus::kIncomplete;
}

}  // namespace zor2::describe
