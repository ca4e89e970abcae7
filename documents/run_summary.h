#pragma once

#include <array>
#include <string>
#include <vector>

#include "rules/finding.h"
#include "rules/message_types.h"

namespace zor2 {

// The counts that the summary line and every export show at their top.
struct RunSummary {
  std::array<int, kMessageTypes.size()> counts_by_code{};
  int files = 0;       // files that hold at least one finding
  int frameworks = 0;  // frameworks that hold at least one finding
  int pairs_compared = 0;
  int pairs_skipped = 0;  // for a document that could not be read
  bool directory_mode = false;
  // Reference documents that had no checked counterpart (directory mode).
  std::vector<std::string> missing_counterparts;
  bool baseline = false;  // a baseline was given
  int accepted = 0;
  int stale_baseline_entries = 0;
  int not_accepted = 0;
  bool failed = false;  // the verdict: a finding is not accepted (what -fail fails on)
};

// What was run, for the exports.
struct RunDescription {
  std::string tool_version;
  std::string reference, checked, report;
  std::vector<std::string> options;  // the command line's items
};

// Counts `findings` into `summary` (codes, files, frameworks, accepted).
void CountFindings(const std::vector<Finding>& findings, RunSummary* summary);

// The one summary line: counts by code in the table's order, where they sit,
// the pairs compared and skipped, and, when they apply, the reference
// documents without counterpart and what the baseline accepted.
std::string SummaryLine(const RunSummary& summary);

}  // namespace zor2
