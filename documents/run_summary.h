#pragma once

#include <array>
#include <string>
#include <utility>
#include <vector>

#include "rules/finding.h"
#include "rules/message_types.h"

namespace zor2 {

// Something the run was asked to do and could not: an input that could not be
// read or listed, an output that could not be written. The run's status is
// then 2, and its verdict an error.
struct RunFailure {
  std::string path;  // what failed: a path, or the option of what failed
  std::string reason;
};

// A reference document (directory mode) or framework that has no counterpart
// in the checked release: nothing of it was compared, so it fails the verdict
// unless a baseline entry accepts it.
struct Absence {
  explicit Absence(std::string absent) : name(std::move(absent)) {}

  std::string name;
  bool accepted = false;
  std::string reason;  // the accepting entry's Reason
};

// The counts that the summary line and every export show at their top.
struct RunSummary {
  std::array<int, kMessageTypes.size()> counts_by_code{};
  int files = 0;       // files that hold at least one finding
  int frameworks = 0;  // frameworks that hold at least one finding
  int pairs_compared = 0;
  int pairs_skipped = 0;  // for a document that could not be read
  int files_checked = 0;  // reference files that passed the file filter
  // No reference file passed the file filter in any document pair: nothing
  // was checked, which is no pass.
  bool nothing_checked = false;
  bool directory_mode = false;
  // Reference documents that had no checked counterpart (directory mode), and
  // reference frameworks that had none.
  std::vector<Absence> missing_documents;
  std::vector<Absence> missing_frameworks;
  bool baseline = false;  // a baseline was given
  int accepted = 0;
  int stale_baseline_entries = 0;
  int not_accepted = 0;
  // The check did not pass (what -fail fails on): a finding is not accepted,
  // a reference document or framework without counterpart is not accepted,
  // or nothing was checked.
  bool failed = false;
  std::vector<RunFailure> failures;  // in the order they were reported
};

// What the exports say of a run: it passed, it failed, or it could not do
// all it was asked (a failure, whatever was found).
enum class Verdict { kPassed, kFailed, kError };
Verdict VerdictOf(const RunSummary& summary);
// "passed", "failed" or "error".
const char* VerdictName(Verdict verdict);

// What was run, for the exports.
struct RunDescription {
  std::string tool_version;
  std::string reference, checked, report;
  std::vector<std::string> options;  // the command line's items
  // The exports of the run, in the order asked, for an export that names
  // where the findings it leaves out are.
  std::vector<std::string> exports;
  bool markdown_full = false;  // the Markdown export holds every finding
  std::string sarif_base;      // the folder that file names are relative to
};

// Counts `findings` into `summary` (codes, files, frameworks, accepted).
void CountFindings(const std::vector<Finding>& findings, RunSummary* summary);

// Sets `summary->failed` from what was counted and accepted.
void SettleVerdict(RunSummary* summary);

// The one summary line: counts by code in the table's order, where they sit,
// the pairs compared and skipped, and, when they apply, the reference
// documents and frameworks without counterpart and what the baseline
// accepted.
std::string SummaryLine(const RunSummary& summary);

// Why nothing was checked, for a warning: no pair was compared, or no
// reference file passed the filter (`only_flagged_files` tells which).
std::string NothingCheckedReason(const RunSummary& summary, bool only_flagged_files);

}  // namespace zor2
