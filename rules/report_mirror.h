#pragma once

#include <array>
#include <cstddef>
#include <memory>
#include <string>
#include <utility>

#include "platform/xml/output_element.h"
#include "rules/finding.h"
#include "rules/message_types.h"
#include "rules/method_records.h"

namespace zor2 {

// The mirror, in the report, of a reference element that the walk compares.
// The report element is created only when a finding is recorded under it or
// under one of its mirrored descendants, and its pending ancestors are created
// first. The walk runs depth first, so elements are appended in the order in
// which the walk mirrored them, and the report holds exactly the branches that
// lead to a finding: a comparison without findings costs no report element.
class ReportMirror {
 public:
  // An existing report element, such as the report root.
  explicit ReportMirror(xml::OutputElement* element) : element_(element) {}
  // A pending element `tag` (a literal) to go under `parent`, which must
  // outlive this mirror.
  ReportMirror(ReportMirror& parent, const char* tag) : parent_(&parent), tag_(tag) {}
  // A pending element `tag` that is created into `*holder` instead of under a
  // parent, for the caller to hand to the report later; the findings recorded
  // under it also go to `collector` unless it is null. `holder` and
  // `collector` must outlive this mirror.
  ReportMirror(std::unique_ptr<xml::OutputElement>* holder, const char* tag,
               FindingCollector* collector)
      : holder_(holder), collector_(collector), tag_(tag) {}
  ReportMirror(const ReportMirror&) = delete;
  ReportMirror& operator=(const ReportMirror&) = delete;

  // Gives the element attribute `name` with a copy of `value`; does nothing
  // when `value` is null, so an absent attribute stays absent.
  // REQUIRES: until the element is created both strings stay valid (document
  // values and literals do); a pending element takes at most four attributes
  // (a "File" has the most).
  void CopyAttribute(const char* name, const char* value);

  // The report element, created now with its pending ancestors if it does
  // not exist yet.
  xml::OutputElement* Element();

  // The checked element that the mirrored element pairs with (or, for a new
  // element, the checked element itself), whose "Line" places the findings
  // under it, when nothing below says better. `checked` must outlive the
  // mirror.
  void SetCounterpart(const xml::Element* checked) { counterpart_ = checked; }

  // Where findings recorded under this mirror are collected, or null.
  FindingCollector* collector() const;
  // Fills the location of `finding` from this mirror and its ancestors.
  void Locate(Finding* finding) const;

 private:
  struct Attribute {
    const char* name;
    const char* value;
  };
  static constexpr size_t kMaxPendingAttributes = 4;

  ReportMirror* parent_ = nullptr;
  std::unique_ptr<xml::OutputElement>* holder_ = nullptr;
  FindingCollector* collector_ = nullptr;
  const char* tag_ = nullptr;
  const char* name_ = nullptr;       // its "Name", for findings
  const char* signature_ = nullptr;  // its "Signature", for findings
  const xml::Element* counterpart_ = nullptr;
  xml::OutputElement* element_ = nullptr;
  std::array<Attribute, kMaxPendingAttributes> pending_{};
  size_t pending_count_ = 0;
};

// What a rule compared for a finding, as the documents wrote it.
struct ComparedValues {
  ComparedValues(std::string reference_value, std::string checked_value, int more = 0)
      : reference(std::move(reference_value)),
        checked(std::move(checked_value)),
        more_checked(more) {}

  std::string reference;
  std::string checked;
  int more_checked;  // checked values left out of `checked`, as counted
};

// Records a finding of type `code` under `parent`: an "Error" element with
// "ID", "FullName" and "Help", appended as its last child; and, when the walk
// collects findings, a Finding, which is returned (null otherwise).
Finding* AddError(ReportMirror& parent, MessageCode code);

// The same, for a rule that compared values: `describe(collector)` gives them
// as a ComparedValues, and is only called when findings are collected.
template <typename Describe>
void AddError(ReportMirror& parent, MessageCode code, Describe describe) {
  if (Finding* finding = AddError(parent, code)) {
    ComparedValues values = describe(*parent.collector());
    finding->reference_value = std::move(values.reference);
    finding->checked_value = std::move(values.checked);
    finding->more_replacements = values.more_checked;
  }
}

// Gives a "Method" mirror the "Name" and then the "Signature" of `method`.
void MirrorMethod(ReportMirror& report_method, const MethodRecord& method);

}  // namespace zor2
