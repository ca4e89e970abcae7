#include "driver/CommandLine.h"

#include <cstdio>
#include <cstring>
#include <initializer_list>
#include <string>
#include <string_view>

#include "documents/InterfaceDocument.h"
#include "platform/tools/QEXListVal.h"
#include "platform/tools/ReadFile.h"
#include "platform/tools/ZOROFStream.h"
#include "rules/CheckSettings.h"

namespace {

constexpr std::string_view kUsage =
    "Options :\n"
    "   -L   : Only process ZOR2 flagged files\n"
    "   -r   : Reference XML file (or directory)\n"
    "   -c   : Checked XML file (or directory)\n"
    "   -htm : Output Help file\n"
    "   -level\t: Morvane Level (ex: M4R11)\n"
    "   -o   : Output file\n";

// Writes the pieces and a line end. Pieces are written by length, so that an
// item read from an argument file is shown whole whatever bytes it holds.
void WriteLine(std::FILE* stream, std::initializer_list<std::string_view> pieces) {
  for (std::string_view piece : pieces) std::fwrite(piece.data(), 1, piece.size(), stream);
  std::fputc('\n', stream);
}

// The options scanned so far, and whether any usage error was seen.
struct OptionScan {
  std::string_view program;
  QEXListValQEXString given;  // "-r", "-c" and "-o", each time one took a value
  std::optional<std::string> levelText;
  bool failed = false;
};

// Fills `items` from the argument file (the arguments "=" and a path) or else
// from the arguments themselves. False when the argument file cannot be read.
bool CollectItems(int argc, const char* const* argv, QEXListValQEXString& items,
                  std::string_view program) {
  if (argc == 3 && std::strcmp(argv[1], "=") == 0 && ReadFile(argv[2], items) != 0) {
    WriteLine(stderr, {program, ": unable to read file ", argv[2]});
    return false;
  }
  // An argument file without any item counts as no argument file.
  if (items.Size() == 0) {
    for (int i = 1; i < argc; ++i) items.Append(argv[i]);
  }
  return true;
}

// Takes `value` for the option `option` when it is one that wants a value.
bool TakeValue(const std::string& option, const std::string& value, OptionScan& scan,
               RunConfiguration& config) {
  TAFileName* path = nullptr;
  if (option == "-r") path = &config.referencePath;
  if (option == "-c") path = &config.checkedPath;
  if (option == "-o") path = &config.outputPath;
  if (path != nullptr) {
    scan.given.Append(option);
    *path = value;
    return true;
  }
  if (option == "-level") {
    scan.levelText = value;
    return true;
  }
  if (option == "-htm") {
    config.helpPagePath = value;
    return true;
  }
  return false;
}

// Scans the items in order. Returns kDone when "-h" was reached (the usage
// text is then written); otherwise nothing, with `scan.failed` telling whether
// a usage error was reported.
std::optional<ExitStatus> ScanOptions(const QEXListValQEXString& items, OptionScan& scan,
                                      RunConfiguration& config) {
  const int count = items.Size();
  for (int i = 1; i <= count; ++i) {
    const std::string& item = items[i];
    // A stray word makes the rest of the line meaningless: stop at once.
    if (item.empty() || item[0] != '-') {
      WriteLine(stderr, {scan.program, ": unexpected token [", item, "]"});
      scan.failed = true;
      break;
    }
    if (item == "-h") {
      WriteLine(stdout, {kUsage});
      return ExitStatus::kDone;
    }
    if (item == "-L") {
      OnlyFlaggedFiles = 1;
      continue;
    }
    if (i < count && TakeValue(item, items[i + 1], scan, config)) {
      ++i;
      continue;
    }
    WriteLine(stderr, {scan.program, ": Unknown option or missing arguments ", item});
    scan.failed = true;
  }
  return std::nullopt;
}

// Reports each mandatory option that never took a value, the last one first.
void CheckMandatoryOptions(OptionScan& scan) {
  QEXListValQEXString required;
  required.Append("-r");
  required.Append("-c");
  required.Append("-o");
  for (int r = required.Size(); r >= 1; --r) {
    bool found = false;
    for (int g = scan.given.Size(); g >= 1 && !found; --g) found = scan.given[g] == required[r];
    if (found) continue;
    WriteLine(stderr, {scan.program, ": Option ", required[r], " missing"});
    scan.failed = true;
  }
}

void AnnounceRun(const RunConfiguration& config) {
  ZORout << "## Ref : " << config.referencePath.str() << endl;
  ZORout << "## Checked : " << config.checkedPath.str() << endl;
  ZORout << "## Output : " << config.outputPath.str() << endl;
}

void FixLevel(const std::optional<std::string>& levelText) {
  if (!levelText) {
    CurrentLevel = 99;
    ZORerr << "WARNING: takes default level: M4R99" << endl;
  } else {
    CurrentLevel = ReleaseAfterR(levelText->c_str());
    ZORout << "## Level : " << CurrentLevel << endl;
  }
  ZORout << endl;
}

}  // namespace

std::optional<ExitStatus> ReadCommandLine(int argc, const char* const* argv,
                                          RunConfiguration& config) {
  OnlyFlaggedFiles = 0;
  OptionScan scan;
  scan.program = argc > 0 && argv[0] != nullptr ? argv[0] : "";

  QEXListValQEXString items;
  if (!CollectItems(argc, argv, items, scan.program)) return ExitStatus::kUsageError;
  if (std::optional<ExitStatus> help = ScanOptions(items, scan, config)) return help;
  CheckMandatoryOptions(scan);
  if (scan.failed) {
    WriteLine(stderr, {kUsage});
    return ExitStatus::kUsageError;
  }

  AnnounceRun(config);
  FixLevel(scan.levelText);
  return std::nullopt;
}
