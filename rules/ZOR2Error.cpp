#include "rules/ZOR2Error.h"

#include <memory>

#include "platform/tools/ZOROFStream.h"

ZOR2Error::ZOR2Error(const char* code) : QEXVBTXMLNode("Error") {
  if (code == nullptr) {
    ZORout << " ZOR2Error::ZOR2Error, type is null" << endl;
    return;
  }
  type_ = MessageTypeRegistry::Get().Find(code);
  if (type_ == nullptr) {
    ZORout << " ZOR2Error::ZOR2Error, type not known : " << code << endl;
    return;
  }
  setAttributeValue("ID", code);
  setAttributeValue("FullName", type_->fullName);
  setAttributeValue("Help", type_->help);
}

ZOR2Error::~ZOR2Error() = default;

ZOR2Error* AddError(QEXVBTXMLNode*& parent, const char* code) {
  if (parent == nullptr) return nullptr;
  auto error = std::make_unique<ZOR2Error>(code);
  ZOR2Error* added = error.get();
  parent->insertNodeAtEnd(std::move(error));
  return added;
}
