#include "rules/report_mirror.h"

#include <climits>
#include <cstdlib>
#include <cstring>
#include <string>
#include <vector>

namespace zor2 {

void ReportMirror::CopyAttribute(const char* name, const char* value) {
  if (value == nullptr) return;
  if (std::strcmp(name, "Name") == 0) name_ = value;
  if (std::strcmp(name, "Signature") == 0) signature_ = value;
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

FindingCollector* ReportMirror::collector() const {
  const ReportMirror* top = this;
  while (top->parent_ != nullptr) top = top->parent_;
  return top->collector_;
}

namespace {

// A "Line" value: a positive decimal number that fits, else 0.
int LineNumber(const char* text) {
  if (text == nullptr || *text == '\0') return 0;
  int line = 0;
  for (const char* c = text; *c != '\0'; ++c) {
    if (*c < '0' || *c > '9' || line > (INT_MAX - (*c - '0')) / 10) return 0;
    line = line * 10 + (*c - '0');
  }
  return line;
}

}  // namespace

void ReportMirror::Locate(Finding* finding) const {
  const FindingCollector* shown = collector();
  std::vector<std::string> steps;  // from this mirror up
  for (const ReportMirror* mirror = this; mirror != nullptr; mirror = mirror->parent_) {
    if (finding->line == 0 && mirror->counterpart_ != nullptr) {
      finding->line = LineNumber(mirror->counterpart_->FindAttribute("Line"));
    }
    if (mirror->tag_ == nullptr) continue;  // the report root
    const std::string_view tag = mirror->tag_;
    std::string name = shown->AsWritten(mirror->name_);
    if (tag == "Framework") finding->framework = name;
    if (tag == "Interfaces") finding->group = name;
    if (tag == "File") finding->file = name;
    if (tag == "Class") finding->class_name = name;
    if (tag == "Arg") finding->argument = name;
    if (tag == "Method") {
      finding->method = name;
      finding->signature = shown->AsWritten(mirror->signature_);
    }
    if (shown->report_paths()) steps.push_back(ReportStep(tag, mirror->name_, mirror->signature_));
  }
  if (!shown->report_paths()) return;
  for (auto step = steps.rbegin(); step != steps.rend(); ++step) finding->report_path += *step;
  finding->report_path += MessageTypeOf(finding->code).id;
}

Finding* AddError(ReportMirror& parent, MessageCode code) {
  const MessageType& type = MessageTypeOf(code);
  xml::OutputElement* error = parent.Element()->AddChild("Error");
  error->SetAttribute("ID", type.id);
  error->SetAttribute("FullName", type.full_name);
  error->SetAttribute("Help", type.help);
  FindingCollector* collector = parent.collector();
  if (collector == nullptr) return nullptr;
  Finding& finding = collector->findings().emplace_back();
  finding.code = code;
  finding.report_error = error;
  parent.Locate(&finding);
  return &finding;
}

void MirrorMethod(ReportMirror& report_method, const MethodRecord& method) {
  report_method.CopyAttribute("Name", method.name);
  report_method.CopyAttribute("Signature", method.signature);
}

}  // namespace zor2
