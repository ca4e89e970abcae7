#include "describe/describe_options.h"

#include <cstring>
#include <string_view>

#include "platform/tools/argument_file.h"
#include "platform/tools/printable_path.h"
#include "platform/tools/version.h"

namespace zor2::describe {

const char kDescribeUsage[] =
    "Usage : zor2describe -framework NAME -public DIR [options] -o OUTPUT.xml\n"
    "        zor2describe = ARGUMENT-FILE\n"
    "Options :\n"
    "   -framework NAME     : Framework described\n"
    "   -public DIR         : Directory of the public headers\n"
    "   -protected DIR      : Directory of the protected headers\n"
    "   -I DIR              : Include directory (may be repeated)\n"
    "   -D NAME[=VALUE]     : Macro definition (may be repeated)\n"
    "   -std STANDARD       : Language standard (default: the build's, else c++17)\n"
    "   -p BUILD_DIR        : Take -I, -D and -std from BUILD_DIR/compile_commands.json\n"
    "   -extra-arg ARG      : Hand ARG to clang as it is (may be repeated)\n"
    "   -default-level L1   : @ZOR2Level of headers without the tag (default: L1)\n"
    "   -default-usage U1   : @ZOR2Usage of headers without the tag (default: U2 when\n"
    "                         the header declares a class clients can derive from\n"
    "                         and override, else U1)\n"
    "   -o FILE             : Output file\n"
    "   -h                  : This text\n";

namespace {

// Takes `value` for `option` when it is an option that wants a value.
bool TakeValue(std::string_view option, const std::string& value, DescribeOptions* options,
               std::vector<std::string_view>* given) {
  if (option == "-framework") {
    options->framework = value;
  } else if (option == "-public") {
    options->public_dir = value;
  } else if (option == "-protected") {
    options->protected_dir = value;
  } else if (option == "-I") {
    options->include_dirs.push_back(value);
  } else if (option == "-D") {
    options->defines.push_back(value);
  } else if (option == "-std") {
    options->standard = value;
  } else if (option == "-p") {
    options->build_dir = value;
  } else if (option == "-extra-arg") {
    options->extra_args.push_back(value);
  } else if (option == "-default-level") {
    options->default_level = value;
  } else if (option == "-default-usage") {
    options->default_usage = value;
  } else if (option == "-o") {
    options->output = value;
  } else {
    return false;
  }
  given->push_back(option);
  return true;
}

// "L" and digits.
bool IsLevel(std::string_view level) {
  if (level.size() < 2 || level[0] != 'L') return false;
  for (char c : level.substr(1)) {
    if (c < '0' || c > '9') return false;
  }
  return true;
}

// "U1" to "U5".
bool IsUsage(std::string_view usage) {
  return usage.size() == 2 && usage[0] == 'U' && usage[1] >= '1' && usage[1] <= '5';
}

}  // namespace

bool IsKnownStandard(std::string_view standard) {
  static constexpr std::string_view kVersions[] = {"98", "03", "0x", "11", "1y", "14",
                                                   "1z", "17", "2a", "20", "2b"};
  for (std::string_view dialect : {"c++", "gnu++"}) {
    if (standard.substr(0, dialect.size()) != dialect) continue;
    for (std::string_view version : kVersions) {
      if (standard.substr(dialect.size()) == version) return true;
    }
  }
  return false;
}

std::optional<DescribeStatus> ReadDescribeCommandLine(int argc, const char* const* argv,
                                                      DescribeOptions* options, std::ostream& out,
                                                      std::ostream& err) {
  const std::string program =
      PrintablePath(argc > 0 && argv[0] != nullptr ? argv[0] : "zor2describe");
  std::vector<std::string> items;
  if (argc == 3 && std::strcmp(argv[1], "=") == 0) {
    std::string reason;
    if (!ReadArgumentFile(argv[2], &items, &reason)) {
      err << program << ": unable to read file " << PrintablePath(argv[2]) << ": " << reason
          << '\n';
      return DescribeStatus::kUsageError;
    }
  }
  // An argument file without any item counts as no argument file.
  if (items.empty()) items.assign(argv + (argc > 0 ? 1 : 0), argv + argc);

  bool failed = false;
  std::vector<std::string_view> given;
  for (size_t i = 0; i < items.size(); ++i) {
    const std::string& item = items[i];
    // A stray word makes the rest of the line meaningless: stop at once.
    if (item.empty() || item[0] != '-') {
      err << program << ": unexpected token [" << PrintablePath(item) << "]\n";
      failed = true;
      break;
    }
    if (item == "-h" || item == "--help") {
      out << kDescribeUsage;
      return DescribeStatus::kDone;
    }
    if (item == "--version") {
      out << "zor2describe " << kVersion << '\n';
      return DescribeStatus::kDone;
    }
    if (i + 1 < items.size() && TakeValue(item, items[i + 1], options, &given)) {
      ++i;
      continue;
    }
    err << program << ": Unknown option or missing arguments " << PrintablePath(item) << '\n';
    failed = true;
  }
  for (std::string_view required : {"-framework", "-public", "-o"}) {
    bool found = false;
    for (std::string_view option : given) found = found || option == required;
    if (found) continue;
    err << program << ": Option " << required << " missing\n";
    failed = true;
  }
  if (options->standard && !IsKnownStandard(*options->standard)) {
    err << program << ": -std wants a C++ standard such as c++17, not "
        << PrintablePath(*options->standard) << '\n';
    failed = true;
  }
  if (options->default_level && !IsLevel(*options->default_level)) {
    err << program << ": -default-level wants L and digits such as L1, not "
        << PrintablePath(*options->default_level) << '\n';
    failed = true;
  }
  if (options->default_usage && !IsUsage(*options->default_usage)) {
    err << program << ": -default-usage wants one of U1 to U5, not "
        << PrintablePath(*options->default_usage) << '\n';
    failed = true;
  }
  if (failed) {
    err << kDescribeUsage;
    return DescribeStatus::kUsageError;
  }
  return std::nullopt;
}

}  // namespace zor2::describe
