#include "documents/run_summary.h"

#include <set>
#include <tuple>

namespace zor2 {

void CountFindings(const std::vector<Finding>& findings, RunSummary* summary) {
  std::set<std::tuple<std::string, std::string, std::string>> files;
  std::set<std::string> frameworks;
  for (const Finding& finding : findings) {
    ++summary->counts_by_code[static_cast<size_t>(finding.code)];
    frameworks.insert(finding.framework);
    if (!finding.file.empty()) files.insert({finding.framework, finding.group, finding.file});
    if (finding.accepted) {
      ++summary->accepted;
    } else {
      ++summary->not_accepted;
    }
  }
  summary->files = static_cast<int>(files.size());
  summary->frameworks = static_cast<int>(frameworks.size());
}

namespace {

// "1 file", "2 files".
std::string Counted(size_t count, const std::string& noun) {
  return std::to_string(count) + " " + noun + (count == 1 ? "" : "s");
}

}  // namespace

std::string SummaryLine(const RunSummary& summary) {
  int total = 0;
  for (int count : summary.counts_by_code) total += count;
  std::string line = "Summary: " + Counted(total, "finding") + " (";
  for (const MessageType& type : kMessageTypes) {
    if (type.code != MessageCode::kFHBD) line += ", ";
    line.append(type.id).append(" ");
    line += std::to_string(summary.counts_by_code[static_cast<size_t>(type.code)]);
  }
  line += ") in " + Counted(summary.files, "file") + " of " +
          Counted(summary.frameworks, "framework") + "; " +
          Counted(summary.pairs_compared, "document pair") + " compared, " +
          std::to_string(summary.pairs_skipped) + " skipped";
  if (summary.directory_mode) {
    line += "; " + Counted(summary.missing_counterparts.size(), "reference document") +
            " without counterpart";
    for (size_t i = 0; i < summary.missing_counterparts.size(); ++i) {
      line += (i == 0 ? ": " : ", ") + summary.missing_counterparts[i];
    }
  }
  if (summary.baseline) {
    line += "; baseline: " + std::to_string(summary.accepted) + " accepted, " +
            std::to_string(summary.stale_baseline_entries) + " no longer found";
  }
  return line;
}

}  // namespace zor2
