#pragma once

#include <string>
#include <vector>

#include "platform/xml/document.h"
#include "platform/xml/output_element.h"
#include "rules/message_types.h"

namespace zor2 {

// One finding of a run, with where it sits and the values the rule compared,
// as the outputs other than the report show it.
struct Finding {
  MessageCode code;
  // The chain of reference elements that leads to it; empty where it does not
  // reach (a file finding has no class).
  std::string framework, group, file, class_name, method, signature, argument;
  // What the rule compared, as the documents wrote it; empty when none.
  std::string reference_value, checked_value;
  bool accepted = false;  // accepted by a baseline, with its reason
  std::string reason;
  xml::OutputElement* report_error = nullptr;  // the finding's "Error" in the report
  // Where the finding's "Error" stands in the report, as ReportStep writes
  // each element of its chain, followed by its ID: what a baseline matches
  // (filled only for a run with a baseline).
  std::string report_path;
  // MHBDM: how many more checked methods of the same name there are than
  // the likely replacements the checked value shows.
  int more_replacements = 0;
  // The 1-based line, in the checked file, of the declaration the finding is
  // about, or of the innermost one still there (the class of a deleted
  // method): the "Line" of the checked element; 0 when none says.
  int line = 0;
};

// One step of a report path: `tag`, its "Name" and, for a "Method", its
// "Signature", as the report holds them (null for an absent attribute).
std::string ReportStep(std::string_view tag, const char* name, const char* signature);

// Where the rules record findings while they compare one pair of documents,
// besides the report. Values of the documents are shown as written there,
// before type names were normalised.
//
// Thread safety: one collector per framework pair, used by one thread at a time.
class FindingCollector {
 public:
  // `reference` and `checked` hold the original text of the values that
  // preparation changed in each document (either may be null); with
  // `report_paths`, each finding also gets its report path, which only a
  // baseline needs.
  FindingCollector(const xml::OriginalValues* reference, const xml::OriginalValues* checked,
                   bool report_paths)
      : reference_(reference), checked_(checked), report_paths_(report_paths) {}

  // The text of a document value as the document wrote it (entity references
  // decoded, type names as spelled); empty for a null value.
  std::string AsWritten(const char* value) const;

  std::vector<Finding>& findings() { return findings_; }
  bool report_paths() const { return report_paths_; }

  // What was checked beside the findings: the reference files that passed
  // the file filter, and the reference frameworks without counterpart (by
  // name, as written).
  void CountCheckedFiles(int count) { files_checked_ += count; }
  int files_checked() const { return files_checked_; }
  void NoteMissingFramework(const char* name) { missing_frameworks_.push_back(AsWritten(name)); }
  std::vector<std::string>& missing_frameworks() { return missing_frameworks_; }

  // A collector for part of the same comparison, with the same documents.
  FindingCollector Part() const { return FindingCollector(reference_, checked_, report_paths_); }

 private:
  const xml::OriginalValues* reference_;
  const xml::OriginalValues* checked_;
  bool report_paths_;
  std::vector<Finding> findings_;
  int files_checked_ = 0;
  std::vector<std::string> missing_frameworks_;
};

}  // namespace zor2
