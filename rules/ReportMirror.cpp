#include "rules/ReportMirror.h"

#include "platform/tools/QEXFatalError.h"

void ReportMirror::CopyAttribute(const char* name, const char* value) {
  if (value == nullptr) return;
  if (element_ != nullptr) {
    element_->setAttributeValue(name, value);
    return;
  }
  if (attributeCount_ == kMaxPendingAttributes) {
    QEXFatalError("AssertionFailed:attributeCount_ < kMaxPendingAttributes", __FILE__, __LINE__);
  }
  attributes_[attributeCount_++] = {name, value};
}

// The chain of pending ancestors is as long as the walk is deep (six levels
// at most), whatever the documents hold.
QEXVBTXMLNode* ReportMirror::Element() {
  if (element_ != nullptr) return element_;
  if (holder_ != nullptr) {
    *holder_ = QEXVBTXMLNode::CreateNode(tag_);
    element_ = holder_->get();
  } else {
    QEXVBTXMLNode* parent = parent_ != nullptr ? parent_->Element() : nullptr;
    if (parent == nullptr) return nullptr;
    element_ = parent->insertNodeAtEnd(QEXVBTXMLNode::CreateNode(tag_));
  }
  for (size_t i = 0; i < attributeCount_; ++i) {
    element_->setAttributeValue(attributes_[i].name, attributes_[i].value);
  }
  attributeCount_ = 0;
  return element_;
}

ZOR2Error* AddError(ReportMirror& parent, const char* code) {
  QEXVBTXMLNode* element = parent.Element();
  return AddError(element, code);
}

void MirrorMethod(ReportMirror& reportMethod, const MethodInfo& method) {
  reportMethod.CopyAttribute("Name", method.name);
  reportMethod.CopyAttribute("Signature", method.signature);
}
