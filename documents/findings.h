#pragma once

#include <array>
#include <string>
#include <vector>

#include "rules/message_types.h"

namespace zor2 {

// One finding, with where it sits and the values the rule compared. Texts are
// as the documents wrote them; a field is empty when its level does not apply
// (no method for a file finding) or when there is no such value.
struct Finding {
  MessageCode code = MessageCode::kFHBD;
  std::string framework;
  std::string group;  // the interface group: "Public" or "Protected"
  std::string file;
  std::string class_name;
  std::string method;     // the method's name
  std::string signature;  // the method's signature
  std::string argument;   // "Arg_" and the argument's position
  // Several values (the likely replacements of a deleted method) are
  // separated by line feeds.
  std::string reference_value;
  std::string checked_value;
  bool accepted = false;  // accepted by the baseline
  std::string reason;     // the baseline's Reason for accepting it
};

// The counts shown at the top of every export.
struct RunSummary {
  std::array<int, kMessageTypes.size()> counts_by_code{};  // in the table's order
  int files = 0;                                           // files that hold at least one finding
  int frameworks = 0;
  int pairs_compared = 0;
  int pairs_skipped = 0;  // document pairs skipped for an error
  // Reference documents without a checked counterpart (directory mode).
  std::vector<std::string> missing_counterparts;
  int accepted = 0;                // findings accepted by the baseline
  int stale_baseline_entries = 0;  // baseline entries that matched no finding
  bool failed = false;             // at least one finding is not accepted by the baseline
};

// What was run: shown in the exports so that a reader knows what they describe.
struct RunDescription {
  std::string tool_version;
  std::string reference;  // the paths given to -r, -c and -o
  std::string checked;
  std::string report;
  std::vector<std::string> options;  // the other options, as given
};

// The number of findings of every code together.
int TotalFindings(const RunSummary& summary);

}  // namespace zor2
