#include "rules/report_mirror.h"

#include <cstdlib>

namespace zor2 {

void ReportMirror::CopyAttribute(const char* name, const char* value) {
  if (value == nullptr) return;
  if (element_ != nullptr) {
    element_->SetAttribute(name, value);
    return;
  }
  // Every mirror of the walk sets a known, small number of attributes.
  if (pending_count_ == kMaxPendingAttributes) std::abort();
  pending_[pending_count_++] = {name, value};
}

// The chain of pending ancestors is as long as the walk is deep (six levels
// at most), whatever the documents hold.
xml::OutputElement* ReportMirror::Element() {
  if (element_ != nullptr) return element_;
  if (holder_ != nullptr) {
    *holder_ = std::make_unique<xml::OutputElement>(tag_);
    element_ = holder_->get();
  } else {
    element_ = parent_->Element()->AddChild(tag_);
  }
  for (size_t i = 0; i < pending_count_; ++i) {
    element_->SetAttribute(pending_[i].name, pending_[i].value);
  }
  pending_count_ = 0;
  return element_;
}

void AddError(ReportMirror& parent, MessageCode code) {
  const MessageType& type = MessageTypeOf(code);
  xml::OutputElement* error = parent.Element()->AddChild("Error");
  error->SetAttribute("ID", type.id);
  error->SetAttribute("FullName", type.full_name);
  error->SetAttribute("Help", type.help);
}

void MirrorMethod(ReportMirror& report_method, const MethodRecord& method) {
  report_method.CopyAttribute("Name", method.name);
  report_method.CopyAttribute("Signature", method.signature);
}

}  // namespace zor2
