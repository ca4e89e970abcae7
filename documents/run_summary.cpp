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

bool AnyNotAccepted(const std::vector<Absence>& absences) {
  for (const Absence& absence : absences) {
    if (!absence.accepted) return true;
  }
  return false;
}

// "1 file", "2 files".
std::string Counted(size_t count, const std::string& noun) {
  return std::to_string(count) + " " + noun + (count == 1 ? "" : "s");
}

// "; 2 reference documents without counterpart: a.xml, b.xml (accepted)".
std::string AbsencesPart(const std::vector<Absence>& absences, const std::string& noun) {
  std::string part = "; " + Counted(absences.size(), noun) + " without counterpart";
  for (size_t i = 0; i < absences.size(); ++i) {
    part += (i == 0 ? ": " : ", ") + absences[i].name;
    if (absences[i].accepted) part += " (accepted)";
  }
  return part;
}

}  // namespace

void SettleVerdict(RunSummary* summary) {
  summary->failed = summary->not_accepted > 0 || summary->nothing_checked ||
                    AnyNotAccepted(summary->missing_documents) ||
                    AnyNotAccepted(summary->missing_frameworks);
}

Verdict VerdictOf(const RunSummary& summary) {
  if (!summary.failures.empty()) return Verdict::kError;
  return summary.failed ? Verdict::kFailed : Verdict::kPassed;
}

const char* VerdictName(Verdict verdict) {
  switch (verdict) {
    case Verdict::kPassed:
      return "passed";
    case Verdict::kFailed:
      return "failed";
    case Verdict::kError:
      return "error";
  }
  return "error";
}

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
  if (summary.directory_mode) line += AbsencesPart(summary.missing_documents, "reference document");
  if (!summary.missing_frameworks.empty()) {
    line += AbsencesPart(summary.missing_frameworks, "reference framework");
  }
  if (summary.baseline) {
    line += "; baseline: " + std::to_string(summary.accepted) + " accepted, " +
            std::to_string(summary.stale_baseline_entries) + " no longer found";
  }
  return line;
}

std::string NothingCheckedReason(const RunSummary& summary, bool only_flagged_files) {
  if (summary.pairs_compared == 0) return "no document pair was compared";
  return only_flagged_files
             ? "no reference file of a compared framework has @ZOR2Level \"L1\" and Aut \"Y\" (-L)"
             : "no reference file of a compared framework has Aut \"Y\"";
}

}  // namespace zor2
