#pragma once

#include <string>
#include <unordered_map>
#include <vector>

#include "documents/run_summary.h"
#include "platform/xml/read_error.h"
#include "rules/finding.h"

namespace zor2 {

// The findings a team has accepted: an earlier report of this program, whose
// "Error" elements each accept the finding with the same ID at the same place
// (the chain of Framework, Interfaces, File, Class, Method and Arg by "Name",
// a Method by "Signature" too). An "Error" may carry a "Reason", written by
// hand, that travels with the findings it accepts. A reference document or
// framework without counterpart, which the report does not hold, is accepted
// by an entry written by hand: an "Error" with the ID kNoCounterpart under a
// "Document" or a "Framework" element of its name, right under the root.
class Baseline {
 public:
  // Reads the report at `path`. False with `err` filled when it cannot be
  // read, is not well-formed, or is not a report of this program.
  bool Read(const std::string& path, xml::ReadError* err);

  // Marks each of `findings` that an entry accepts (and its "Error" in the
  // report, with Accepted="Y" and the entry's Reason).
  void Accept(std::vector<Finding>* findings);

  // Marks `absence`, of a reference "Document" or "Framework" (`tag`), as
  // accepted when an entry accepts it, with the entry's Reason.
  void Accept(std::string_view tag, Absence* absence);

  // The entries that accepted no finding, as readable paths.
  std::vector<std::string> StaleEntries() const;

 private:
  struct Entry {
    std::string reason;
    bool has_reason = false;
    bool matched = false;
  };
  std::unordered_map<std::string, Entry> entries_;
  std::vector<std::string> order_;  // the entries' paths, in document order
};

// The ID of a baseline entry that accepts a document or framework without
// counterpart.
inline constexpr char kNoCounterpart[] = "NoCounterpart";

// A report path (Finding::report_path) as a reader wants to see it:
// "Framework F / Interfaces Public / File A.h / ... : MHBDM".
std::string ReadablePath(const std::string& report_path);

}  // namespace zor2
