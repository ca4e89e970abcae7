#include "rules/ReportMirror.h"

QEXVBTXMLNode* MirrorElement(QEXVBTXMLNode* parent, const char* tag) {
  if (parent == nullptr) return nullptr;
  return parent->insertNodeAtEnd(QEXVBTXMLNode::CreateNode(tag));
}

void MirrorAttribute(QEXVBTXMLNode* element, const char* name, const char* value) {
  if (element == nullptr || value == nullptr) return;
  element->setAttributeValue(name, value);
}

QEXVBTXMLNode* MirrorMethod(QEXVBTXMLNode* reportClass, const MethodInfo& method) {
  QEXVBTXMLNode* reportMethod = MirrorElement(reportClass, "Method");
  MirrorAttribute(reportMethod, "Name", method.name);
  MirrorAttribute(reportMethod, "Signature", method.signature);
  return reportMethod;
}
