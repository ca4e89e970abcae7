#pragma once

#include "platform/xml/QEXVBTXMLNode.h"
#include "rules/MessageTypes.h"

// An "Error" element of the report: one finding. Built from a known code it
// carries "ID", "FullName" and "Help"; from a null or unknown code it carries
// no attribute, and a line saying so goes to the standard log stream.
class ZOR2Error : public QEXVBTXMLNode {
 public:
  explicit ZOR2Error(const char* code);
  ~ZOR2Error() override;
  // The message type, or null for a null or unknown code.
  const ZOR2ErrorType* type() const { return type_; }

 private:
  const ZOR2ErrorType* type_ = nullptr;
};

// Records a finding: appends a new ZOR2Error for `code` as the last child of
// `parent` and returns it (owned by `parent`). With a null `parent` nothing is
// created, nothing is logged and null is returned.
ZOR2Error* AddError(QEXVBTXMLNode*& parent, const char* code);
