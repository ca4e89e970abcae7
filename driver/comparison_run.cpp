// Thread model. The main thread runs the whole program and is the only one
// that writes the report, the help page and the standard log. Every other
// thread is a worker of the run's one executor (platform/tools/executor.h),
// started once and sized from the machine's processors; a task that no worker
// has started when the main thread needs its result runs on the main thread
// instead, so the run does all its work even when no thread could be started.
// Tasks only ever read what no thread changes any more and fill what they
// were handed:
// - pair loading (PairReader) reads and prepares each document as a task, the
//   two of the current pair and, while it is compared, those of the next
//   small pairs; each load owns the document it makes;
// - the framework comparison (CompareFrameworks) compares framework pairs on
//   the main thread and on workers, each pair into a report branch and a log
//   of its own, which the main thread appends to the report and replays into
//   the standard log in reference order;
// - the documents of a compared large pair are freed by a task (small ones on
//   the main thread); those of the last pair only once the outputs are
//   written, so that freeing them does not slow the writing;
// - once every finding is final, each export is made and written by a task
//   (WriteExports), from a copy of the summary, while the main thread writes
//   the report.
// No thread ever waits by spinning. So the report and every log line are the
// same, byte for byte, as a single-threaded run's.

#include "driver/comparison_run.h"

#include <sys/stat.h>

#include <cerrno>
#include <csignal>
#include <cstring>
#include <iterator>
#include <memory>
#include <new>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "documents/baseline.h"
#include "documents/help_page.h"
#include "documents/run_summary.h"
#include "driver/export_writing.h"
#include "driver/pair_loading.h"
#include "platform/tools/executor.h"
#include "platform/tools/file_output.h"
#include "platform/tools/log.h"
#include "platform/tools/paths.h"
#include "platform/tools/printable_path.h"
#include "platform/tools/version.h"
#include "platform/xml/output_element.h"
#include "rules/framework_comparison.h"

namespace zor2 {
namespace {

// What an ERROR line names when the findings could not be counted.
constexpr const char* kSummary = "summary";
constexpr const char* kNoMemoryForSummary = "not enough memory to count the findings";

enum class InputMode { kFilePair, kDirectoryPair, kUnusable };

InputMode ChooseInputMode(const std::string& reference, const std::string& checked) {
  if (IsRegularFile(reference) && IsRegularFile(checked)) return InputMode::kFilePair;
  if (IsDirectory(reference) && IsDirectory(checked)) return InputMode::kDirectoryPair;
  return InputMode::kUnusable;
}

// One pass over the inputs: the shared report and whether anything failed.
class ComparisonRun {
 public:
  explicit ComparisonRun(const RunConfiguration& config)
      : config_(config),
        report_("XmlDiff"),
        log_(Log::Standard()),
        collecting_(config.summary || config.baseline_path || !config.export_paths.empty()),
        executor_(Executor::MachineThreads()) {}

  ExitStatus Run() {
    ReadBaseline();
    CompareInputs();
    FinishSummary();
    WriteOutputs();
    // Freed only now: unmapping large documents while the outputs are written
    // would slow the writing down more than it takes.
    last_pair_ = LoadedPair();
    if (config_.summary) WriteSummaryLine();
    if (incomplete_) return ExitStatus::kIncomplete;
    if (config_.fail && summary_.failed) return ExitStatus::kFindingsNotAccepted;
    return ExitStatus::kDone;
  }

 private:
  // Names `path` and why it failed in an "ERROR: " line; the run's result is
  // then incomplete. Every failure of a run is reported here.
  void ReportFailure(const std::string& path, const std::string& reason) {
    log_.Warning() << "ERROR: " << path << ": " << reason;
    incomplete_ = true;
    // The exports state every failure; without the memory to keep it, the
    // run's status still says it.
    try {
      summary_.failures.push_back({path, reason});
    } catch (const std::bad_alloc&) {
    }
  }

  void CompareInputs() {
    switch (ChooseInputMode(config_.reference_path, config_.checked_path)) {
      case InputMode::kFilePair: {
        std::vector<PairReader::Paths> pair;
        pair.push_back(DocumentPair(config_.reference_path, config_.checked_path));
        ComparePairs(std::move(pair));
        return;
      }
      case InputMode::kDirectoryPair:
        CompareDirectories();
        return;
      case InputMode::kUnusable:
        log_.Progress() << " Pb with input (-r or -c) ";
        ReportUnusableInputs();
        incomplete_ = true;
        return;
    }
  }

  // Names `path` when it is neither a file nor a directory; returns whether it
  // is one of them.
  bool CheckInputKind(const std::string& path) {
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
  void ReportUnusableInputs() {
    const std::string& reference = config_.reference_path;
    const std::string& checked = config_.checked_path;
    const bool reference_known = CheckInputKind(reference);
    const bool checked_known = CheckInputKind(checked);
    if (!reference_known || !checked_known) return;
    if (IsDirectory(checked)) {
      ReportFailure(checked,
                    "Is a directory, but the reference " + PrintablePath(reference) + " is a file");
    } else {
      ReportFailure(checked, "Not a directory, but the reference " + PrintablePath(reference) +
                                 " is a directory");
    }
  }

  // Pairs each reference document with the checked document of the same name;
  // a reference document without one is passed over, and only counted for the
  // summary.
  void CompareDirectories() {
    std::vector<PairReader::Paths> pairs;
    summary_.directory_mode = true;
    std::vector<std::string> missing;
    std::string err;
    if (!ListDocumentPairs(config_.reference_path, config_.checked_path, &pairs, &missing, &err)) {
      ReportFailure(config_.reference_path, err);
      return;
    }
    for (std::string& name : missing) summary_.missing_documents.emplace_back(std::move(name));
    ComparePairs(std::move(pairs));
  }

  void ComparePairs(std::vector<PairReader::Paths> pairs) {
    PairReader reader(std::move(pairs), KeepOriginals(), executor_);
    while (reader.HasNext()) {
      LoadedPair pair = reader.Next();
      ComparePair(pair);
      if (reader.HasNext()) {
        Discard(std::move(pair));
      } else {
        last_pair_ = std::move(pair);
      }
    }
  }

  // Both documents are read even when the first fails, so that every fault
  // is reported in one run, the reference document's first.
  void ComparePair(const LoadedPair& pair) {
    ReportLoadFault(pair.reference);
    ReportLoadFault(pair.checked);
    if (pair.reference.document && pair.checked.document) {
      ++summary_.pairs_compared;
      FindingCollector collector(&pair.reference.originals, &pair.checked.originals,
                                 config_.baseline_path.has_value());
      CompareFrameworks(pair.reference.document->root(), pair.checked.document->root(),
                        config_.settings, report_, log_, collecting_ ? &collector : nullptr,
                        &executor_);
      // The findings hold copies of the values they show, never pointers into
      // the documents.
      findings_.insert(findings_.end(), std::make_move_iterator(collector.findings().begin()),
                       std::make_move_iterator(collector.findings().end()));
      summary_.files_checked += collector.files_checked();
      for (std::string& name : collector.missing_frameworks()) {
        summary_.missing_frameworks.emplace_back(std::move(name));
      }
    } else {
      ++summary_.pairs_skipped;
    }
  }

  // Giving the memory of large documents back to the system takes a while, so
  // it is done by a task while the run goes on; a small pair costs less to
  // free than to hand over. The report holds copies of the values it mirrors,
  // never pointers into the documents.
  void Discard(LoadedPair pair) {
    static constexpr uintmax_t kFreedHereBytes = uintmax_t{4} << 20;
    if (pair.bytes < kFreedHereBytes) return;
    // The pair is moved into the task's body, so that it is freed there.
    executor_.Post([pair = std::move(pair)]() mutable { LoadedPair discarded = std::move(pair); });
  }

  void ReportLoadFault(const LoadedDocument& loaded) {
    if (!loaded.document) ReportReadError(loaded.path, loaded.error);
  }

  void ReportReadError(const std::string& path, const xml::ReadError& error) {
    if (error.line > 0) {
      ReportFailure(path + ":" + std::to_string(error.line) + ":" + std::to_string(error.column),
                    error.reason);
    } else {
      ReportFailure(path, error.reason);
    }
  }

  // Only the exports show values, as the documents wrote them.
  bool KeepOriginals() const { return !config_.export_paths.empty(); }

  // A baseline that cannot be read is an input failure, not an empty
  // baseline: the run goes on without it.
  void ReadBaseline() {
    if (!config_.baseline_path) return;
    xml::ReadError error;
    if (baseline_.emplace().Read(*config_.baseline_path, &error)) return;
    baseline_.reset();
    ReportReadError(*config_.baseline_path, error);
  }

  // Marks the findings, documents and frameworks that the baseline accepts,
  // names its entries that match nothing any more, counts, and settles the
  // verdict. Running out of memory here is a failure of the run, not an end.
  void FinishSummary() {
    if (!collecting_) return;
    try {
      summary_.baseline = config_.baseline_path.has_value();
      if (baseline_) {
        baseline_->Accept(&findings_);
        for (Absence& document : summary_.missing_documents) {
          baseline_->Accept("Document", &document);
        }
        for (Absence& framework : summary_.missing_frameworks) {
          baseline_->Accept("Framework", &framework);
        }
        const std::vector<std::string> stale = baseline_->StaleEntries();
        for (const std::string& entry : stale) {
          log_.Warning() << "WARNING: " << *config_.baseline_path << ": no longer found: " << entry;
        }
        summary_.stale_baseline_entries = static_cast<int>(stale.size());
      }
      CountFindings(findings_, &summary_);
      summary_.nothing_checked = summary_.files_checked == 0;
      SettleVerdict(&summary_);
    } catch (const std::bad_alloc&) {
      ReportFailure(kSummary, kNoMemoryForSummary);
    }
    // Without a pair compared, the ERROR lines already say why nothing was.
    if (config_.summary && summary_.nothing_checked &&
        (summary_.pairs_compared > 0 || !incomplete_)) {
      log_.Warning() << "WARNING: nothing was checked: "
                     << NothingCheckedReason(summary_, config_.settings.only_flagged_files);
    }
  }

  void WriteSummaryLine() {
    try {
      log_.Progress() << SummaryLine(summary_);
    } catch (const std::bad_alloc&) {
      ReportFailure(kSummary, kNoMemoryForSummary);
    }
  }

  // Writes the report and the help page here while tasks make and write the
  // exports, which only read the findings: these no longer change.
  void WriteOutputs() {
    run_ = RunDescription{std::string("zor2check ") + kVersion,
                          config_.reference_path,
                          config_.checked_path,
                          config_.output_path,
                          config_.items,
                          config_.export_paths,
                          config_.markdown_full,
                          config_.sarif_base};
    WriteExports(
        config_.export_paths, run_, findings_, &summary_, executor_,
        [this] {
          WriteReport();
          WriteHelpPage();
        },
        [this](const std::string& path, const std::string& reason) {
          ReportFailure(path, reason);
        });
  }

  void WriteReport() {
    std::string err;
    if (!xml::WriteDocument(report_, config_.output_path, &err)) {
      ReportFailure(config_.output_path, err);
    }
  }

  void WriteHelpPage() {
    if (!config_.help_page_path) return;
    const std::string& path = *config_.help_page_path;
    // Written as the report is, so that a failed write leaves any earlier page
    // whole.
    bool opened = false;
    std::string err;
    if (WriteFileAtomically(path, HelpPageText(), &opened, &err)) return;
    // The page's long-standing line comes first when it cannot even be opened.
    if (!opened) log_.Warning() << "Unable to open file " << path;
    ReportFailure(path, err);
  }

  const RunConfiguration& config_;
  xml::OutputElement report_;
  Log& log_;
  const bool collecting_;  // findings are collected for the summary, baseline or exports
  std::vector<Finding> findings_;
  RunSummary summary_;
  std::optional<Baseline> baseline_;
  RunDescription run_;  // what the exports say was run
  bool incomplete_ = false;
  LoadedPair last_pair_;  // freed once the outputs are written
  // Last, so that it ends first: its tasks may use the members above.
  Executor executor_;
};

}  // namespace

ExitStatus RunComparison(const RunConfiguration& config) {
  return ComparisonRun(config).Run();
}

ExitStatus RunProgram(int argc, const char* const* argv) {
  // A log stream whose reader has gone (a closed pipe) fails its writes
  // instead of ending the process: the report is still written.
  std::signal(SIGPIPE, SIG_IGN);
  RemoveTemporaryFilesOnInterrupt();
  RunConfiguration config;
  std::optional<ExitStatus> ended = ReadCommandLine(argc, argv, &config);
  return ended ? *ended : RunComparison(config);
}

}  // namespace zor2
