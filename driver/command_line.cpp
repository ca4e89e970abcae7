#include "driver/command_line.h"

#include <cstdio>
#include <cstring>
#include <initializer_list>
#include <string_view>
#include <vector>

#include "documents/exports.h"
#include "driver/output_clash.h"
#include "platform/tools/argument_file.h"
#include "platform/tools/log.h"
#include "platform/tools/printable_path.h"
#include "platform/tools/version.h"
#include "rules/attribute_values.h"

namespace zor2 {
namespace {

constexpr std::string_view kUsage =
    "Options :\n"
    "   -L   : Only process ZOR2 flagged files\n"
    "   -r   : Reference XML file (or directory)\n"
    "   -c   : Checked XML file (or directory)\n"
    "   -htm : Output Help file\n"
    "   -level\t: Morvane Level (ex: M4R11)\n"
    "   -o   : Output file\n";

// The options that the outputs for release engineers add, and the statuses;
// "-h" shows them after the usage text above, which usage errors show alone.
constexpr std::string_view kMoreUsage =
    "   -summary        : Print one line counting the findings\n"
    "   -fail           : Exit with status 3 when the check does not pass (implies -summary)\n"
    "   -baseline FILE  : Accept the findings listed in FILE, an earlier report\n"
    "   -export PATH    : Also write the findings to PATH, as .json, .sarif, .md or .html\n"
    "                     (may be repeated)\n"
    "   -markdown-full  : Write every finding to a .md export, past 65 536 characters\n"
    "   -sarif-base DIR : The folder of the repository that file names are relative to,\n"
    "                     for a .sarif export\n"
    "Exit status : 0 done, 1 usage error, 2 an input or output failed,\n"
    "              3 with -fail, the check did not pass\n";

// Writes the pieces and a line end. Pieces are written by length, so that an
// item read from an argument file is shown whole whatever bytes it holds.
void WriteLine(std::FILE* stream, std::initializer_list<std::string_view> pieces) {
  for (std::string_view piece : pieces) std::fwrite(piece.data(), 1, piece.size(), stream);
  std::fputc('\n', stream);
}

// The options scanned so far, and whether any usage error was seen.
struct OptionScan {
  std::string_view program;
  std::vector<std::string> given;  // "-r", "-c" and "-o", each time one took a value
  std::optional<std::string> level_text;
  bool failed = false;
};

// Fills `items` from the argument file (the arguments "=" and a path), whose
// path then goes to `argument_file`, or else from the arguments themselves.
// False when the argument file cannot be read.
bool CollectItems(int argc, const char* const* argv, std::string_view program,
                  std::vector<std::string>* items, std::optional<std::string>* argument_file) {
  std::string err;
  if (argc == 3 && std::strcmp(argv[1], "=") == 0) {
    if (!ReadArgumentFile(argv[2], items, &err)) {
      WriteLine(stderr, {program, ": unable to read file ", PrintablePath(argv[2])});
      return false;
    }
    if (!items->empty()) *argument_file = argv[2];
  }
  // An argument file without any item counts as no argument file.
  if (items->empty()) {
    for (int i = 1; i < argc; ++i) items->push_back(argv[i]);
  }
  return true;
}

// Takes `value` for `option` when it is one that wants a value.
bool TakeValue(const std::string& option, const std::string& value, OptionScan* scan,
               RunConfiguration* config) {
  std::string* path = nullptr;
  if (option == "-r") path = &config->reference_path;
  if (option == "-c") path = &config->checked_path;
  if (option == "-o") path = &config->output_path;
  if (path != nullptr) {
    scan->given.push_back(option);
    *path = value;
    return true;
  }
  if (option == "-level") {
    scan->level_text = value;
    return true;
  }
  if (option == "-htm") {
    // An empty path, as an unset shell variable gives, asks for no page.
    if (value.empty()) {
      config->help_page_path.reset();
    } else {
      config->help_page_path = value;
    }
    return true;
  }
  if (option == "-baseline") {
    config->baseline_path = value;
    return true;
  }
  if (option == "-sarif-base") {
    config->sarif_base = value;
    return true;
  }
  if (option == "-export") {
    if (!ExportFormatOf(value)) {
      WriteLine(stderr, {scan->program, ": -export ", value,
                         ": unknown format (the path must end in .json, .sarif, .md or .html)"});
      scan->failed = true;
    }
    config->export_paths.push_back(value);
    return true;
  }
  return false;
}

// Scans the items in order. Returns kDone when "-h" was reached (the usage
// text is then written); otherwise nothing, with `scan->failed` telling
// whether a usage error was reported.
std::optional<ExitStatus> ScanOptions(const std::vector<std::string>& items, OptionScan* scan,
                                      RunConfiguration* config) {
  for (size_t i = 0; i < items.size(); ++i) {
    const std::string& item = items[i];
    // A stray word makes the rest of the line meaningless: stop at once.
    if (item.empty() || item[0] != '-') {
      WriteLine(stderr, {scan->program, ": unexpected token [", item, "]"});
      scan->failed = true;
      break;
    }
    if (item == "-h" || item == "--help") {
      WriteLine(stdout, {kUsage, kMoreUsage});
      return ExitStatus::kDone;
    }
    if (item == "--version") {
      WriteLine(stdout, {"zor2check ", kVersion});
      return ExitStatus::kDone;
    }
    if (item == "-L") {
      config->settings.only_flagged_files = true;
      continue;
    }
    if (item == "-markdown-full") {
      config->markdown_full = true;
      continue;
    }
    if (item == "-summary" || item == "-fail") {
      config->summary = true;
      config->fail = config->fail || item == "-fail";
      continue;
    }
    if (i + 1 < items.size() && TakeValue(item, items[i + 1], scan, config)) {
      ++i;
      continue;
    }
    WriteLine(stderr, {scan->program, ": Unknown option or missing arguments ", item});
    scan->failed = true;
  }
  return std::nullopt;
}

// Reports each mandatory option that never took a value, the last one first.
void CheckMandatoryOptions(OptionScan* scan) {
  for (const char* required : {"-o", "-c", "-r"}) {
    bool found = false;
    for (const std::string& given : scan->given) found = found || given == required;
    if (found) continue;
    WriteLine(stderr, {scan->program, ": Option ", required, " missing"});
    scan->failed = true;
  }
}

void AnnounceRun(const RunConfiguration& config, Log& log) {
  log.Progress() << "## Ref : " << config.reference_path;
  log.Progress() << "## Checked : " << config.checked_path;
  log.Progress() << "## Output : " << config.output_path;
}

void FixLevel(const std::optional<std::string>& level_text, CheckSettings* settings, Log& log) {
  if (!level_text) {
    settings->current_level = 99;
    log.Warning() << "WARNING: takes default level: M4R99";
  } else {
    // A typo must not silently change which deprecations are exempt.
    if (!HoldsReleaseAfterR(level_text->c_str())) {
      log.Warning() << "WARNING: -level \"" << *level_text
                    << "\" holds no release number: takes level 0";
    }
    settings->current_level = ReleaseAfterR(level_text->c_str());
    log.Progress() << "## Level : " << settings->current_level;
  }
  log.Progress();
}

}  // namespace

std::optional<ExitStatus> ReadCommandLine(int argc, const char* const* argv,
                                          RunConfiguration* config) {
  OptionScan scan;
  scan.program = argc > 0 && argv[0] != nullptr ? argv[0] : "";

  std::vector<std::string> items;
  if (!CollectItems(argc, argv, scan.program, &items, &config->argument_file_path)) {
    return ExitStatus::kUsageError;
  }
  config->items = items;
  if (std::optional<ExitStatus> help = ScanOptions(items, &scan, config)) return help;
  CheckMandatoryOptions(&scan);
  // An output that names an input would destroy it: refused before anything
  // is read or written.
  if (!scan.failed) {
    if (std::optional<std::string> clash = FindOutputClash(*config)) {
      WriteLine(stderr, {scan.program, ": ", *clash});
      scan.failed = true;
    }
  }
  if (scan.failed) {
    WriteLine(stderr, {kUsage});
    return ExitStatus::kUsageError;
  }

  Log& log = Log::Standard();
  AnnounceRun(*config, log);
  FixLevel(scan.level_text, &config->settings, log);
  return std::nullopt;
}

}  // namespace zor2
