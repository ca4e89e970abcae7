#include "describe/describe_run.h"

#include <future>
#include <string_view>
#include <vector>

#include "describe/header_describer.h"
#include "describe/header_listing.h"
#include "describe/interface_document.h"
#include "platform/tools/background.h"

namespace zor2::describe {
namespace {

// The most threads a run uses: the machine this is built for has two cores.
constexpr unsigned kThreads = 2;

}  // namespace

DescribeStatus RunDescribe(int argc, const char* const* argv, std::ostream& out,
                           std::ostream& err) {
  DescribeOptions options;
  if (std::optional<DescribeStatus> status =
          ReadDescribeCommandLine(argc, argv, &options, out, err)) {
    return *status;
  }
  const std::string_view program = argc > 0 && argv[0] != nullptr ? argv[0] : "zor2describe";
  bool complete = true;

  std::vector<GroupInput> inputs = {{"Public", options.public_dir, {}}};
  if (options.protected_dir) inputs.push_back({"Protected", *options.protected_dir, {}});
  for (GroupInput& input : inputs) {
    std::string reason;
    if (!ListHeaders(input.dir, &input.headers, &reason)) {
      err << program << ": cannot list the " << input.name << " headers: " << reason << '\n';
      complete = false;
    }
  }

  const CompileSettings settings{options.include_dirs, options.defines, options.standard,
                                 options.default_level, options.default_usage};
  // The groups are compiled side by side, one thread each.
  std::vector<GroupOutcome> outcomes(inputs.size());
  std::vector<std::future<void>> helpers;
  for (size_t g = 1; g < inputs.size(); ++g) {
    helpers.push_back(
        RunInBackground([&, g] { outcomes[g] = DescribeGroup(inputs[g], settings, kThreads); }));
  }
  outcomes[0] = DescribeGroup(inputs[0], settings, kThreads);
  for (std::future<void>& helper : helpers) helper.get();

  FrameworkDescription framework{options.framework, {}};
  for (GroupOutcome& outcome : outcomes) {
    for (const std::string& warning : outcome.warnings) err << warning << '\n';
    for (const HeaderFailure& failure : outcome.failures) {
      for (const std::string& line : failure.diagnostics) err << line << '\n';
      err << program << ": " << outcome.group.name << " header " << failure.header
          << " does not compile: left out of the document\n";
      complete = false;
    }
    framework.groups.push_back(std::move(outcome.group));
  }

  std::string reason;
  if (!xml::WriteDocument(*BuildDocument(framework), options.output, &reason)) {
    err << program << ": cannot write " << options.output << ": " << reason << '\n';
    return DescribeStatus::kIncomplete;
  }
  return complete ? DescribeStatus::kDone : DescribeStatus::kIncomplete;
}

}  // namespace zor2::describe
