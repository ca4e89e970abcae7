#include "driver/ComparisonRun.h"

#include <sys/stat.h>

#include <cerrno>
#include <cstring>
#include <memory>
#include <optional>
#include <string>
#include <system_error>
#include <thread>
#include <utility>
#include <vector>

#include "documents/HelpPage.h"
#include "documents/ReportDocument.h"
#include "driver/PairLoading.h"
#include "platform/tools/ReadDirectory.h"
#include "platform/tools/ZOROFStream.h"
#include "platform/xml/QEXVBTXMLNode.h"
#include "rules/FrameworkComparison.h"

namespace {

enum class InputMode { kFilePair, kDirectoryPair, kUnusable };

InputMode ChooseInputMode(const TAFileName& reference, const TAFileName& checked) {
  if (reference.IsFile() && checked.IsFile()) return InputMode::kFilePair;
  if (reference.IsDirectory() && checked.IsDirectory()) return InputMode::kDirectoryPair;
  return InputMode::kUnusable;
}

void ReportFailure(const TAFileName& path, const std::string& reason) {
  ZORerr << "ERROR: " << path.str() << ": " << reason << endl;
}

// Names `path` on the error log stream when it is neither a file nor a
// directory; returns whether it is one of them.
bool CheckInputKind(const TAFileName& path) {
  struct stat status;
  if (::stat(path.c_str(), &status) != 0) {
    ReportFailure(path, std::strerror(errno));
    return false;
  }
  if (S_ISREG(status.st_mode) || S_ISDIR(status.st_mode)) return true;
  ReportFailure(path, "Not a regular file or directory");
  return false;
}

// Says which input path makes the pair unusable, so that the user need not
// guess from the progress line alone.
void ReportUnusableInputs(const TAFileName& reference, const TAFileName& checked) {
  const bool referenceKnown = CheckInputKind(reference);
  const bool checkedKnown = CheckInputKind(checked);
  if (!referenceKnown || !checkedKnown) return;
  if (checked.IsDirectory()) {
    ReportFailure(checked, "Is a directory, but the reference " + reference.str() + " is a file");
  } else {
    ReportFailure(checked,
                  "Not a directory, but the reference " + reference.str() + " is a directory");
  }
}

// One pass over the inputs: the shared report and whether anything failed.
class ComparisonRun {
 public:
  explicit ComparisonRun(const RunConfiguration& config)
      : config_(config), report_(QEXVBTXMLNode::CreateNode("XmlDiff")) {}
  ~ComparisonRun() {
    if (discarding_.joinable()) discarding_.join();
  }

  ExitStatus Run() {
    CompareInputs();
    WriteReport();
    WriteHelpPage();
    return incomplete_ ? ExitStatus::kIncomplete : ExitStatus::kDone;
  }

 private:
  void CompareInputs() {
    switch (ChooseInputMode(config_.referencePath, config_.checkedPath)) {
      case InputMode::kFilePair:
        ComparePair(LoadPair(config_.referencePath, config_.checkedPath));
        return;
      case InputMode::kDirectoryPair:
        CompareDirectories();
        return;
      case InputMode::kUnusable:
        ZORout << " Pb with input (-r or -c) " << endl;
        ReportUnusableInputs(config_.referencePath, config_.checkedPath);
        incomplete_ = true;
        return;
    }
  }

  // Pairs each reference document with the checked document of the same name;
  // a reference document without one is passed over silently.
  void CompareDirectories() {
    QEXListValTAFileName entries;
    if (ReadDirectory(config_.referencePath + "*", entries) != 0) {
      ReportFailure(config_.referencePath, "cannot list the directory");
      incomplete_ = true;
      return;
    }
    std::vector<PairReader::Paths> pairs;
    for (int i = 1; i <= entries.Size(); ++i) {
      TAFileName checked = config_.checkedPath + entries[i].basename(1);
      if (checked.IsFile()) pairs.emplace_back(entries[i], std::move(checked));
    }
    PairReader reader(std::move(pairs));
    while (reader.HasNext()) ComparePair(reader.Next());
  }

  // Both documents are read even when the first fails, so that every fault
  // is reported in one run, the reference document's first.
  void ComparePair(LoadedPair pair) {
    ReportLoadFault(pair.reference);
    ReportLoadFault(pair.checked);
    if (pair.reference.root && pair.checked.root) {
      QEXVBTXMLNode* report = report_.get();
      CompareFrameworks(pair.reference.root.get(), pair.checked.root.get(), report);
    }
    Discard(std::move(pair));
  }

  // Giving the memory of large documents back to the system takes a while, so
  // it is done on another thread while the run goes on (or here, should no
  // thread be available). The report holds copies of the values it mirrors,
  // never pointers into the documents.
  void Discard(LoadedPair pair) {
    if (discarding_.joinable()) discarding_.join();
    try {
      discarding_ = std::thread(
          [pair = std::move(pair)]() mutable { LoadedPair discarded(std::move(pair)); });
    } catch (const std::system_error&) {
    }
  }

  void ReportLoadFault(const LoadedDocument& document) {
    if (document.root) return;
    incomplete_ = true;
    const XMLReadError& error = document.error;
    if (error.line > 0) {
      ZORerr << "ERROR: " << document.path.str() << ":" << error.line << ":" << error.column << ": "
             << error.reason << endl;
    } else {
      ReportFailure(document.path, error.reason);
    }
  }

  void WriteReport() {
    std::string reason;
    if (FinishReport(*report_, config_.outputPath.c_str(), reason) == 0) return;
    ReportFailure(config_.outputPath, reason);
    incomplete_ = true;
  }

  void WriteHelpPage() {
    if (config_.helpPagePath.IsNull()) return;
    if (WriteHelpFile(config_.helpPagePath.c_str()) != 0) incomplete_ = true;
  }

  const RunConfiguration& config_;
  std::unique_ptr<QEXVBTXMLNode> report_;
  bool incomplete_ = false;
  std::thread discarding_;  // discards the documents of the last pair
};

}  // namespace

ExitStatus RunComparison(const RunConfiguration& config) {
  return ComparisonRun(config).Run();
}

ExitStatus RunProgram(int argc, const char* const* argv) {
  RunConfiguration config;
  std::optional<ExitStatus> ended = ReadCommandLine(argc, argv, config);
  ExitStatus status = ended ? *ended : RunComparison(config);
  ZORout.flush();
  ZORerr.flush();
  return status;
}
