#include "documents/ReportDocument.h"

#include <cstring>
#include <vector>

#include "platform/tools/XMLString.h"

namespace {

bool HasChildren(const QEXVBTXMLNode& element) {
  return element.getFirstNodePosition() != nullptr;
}

bool IsError(const QEXVBTXMLNode& element) {
  return std::strcmp(element.getTag(), "Error") == 0;
}

// An element whose children are being examined, with where the examination
// stands and whether a child has stayed so far.
struct Visit {
  QEXVBTXMLNode* element;
  QEXVBTXMLPosition next;
  bool keep;
};

}  // namespace

// A depth-first walk with an explicit stack: an element's answer is known once
// all its children have answered, and a child that answers false is removed at
// once. A removed child has already lost all its own children, so discarding
// it never walks a deep subtree.
bool PruneReport(QEXVBTXMLNode* element) {
  if (!HasChildren(*element)) return IsError(*element);

  std::vector<Visit> stack;
  stack.push_back({element, element->getFirstNodePosition(), false});
  for (;;) {
    Visit& visit = stack.back();
    if (visit.next != nullptr) {
      QEXVBTXMLNode* child = visit.element->getNextNode(visit.next);
      if (HasChildren(*child)) {
        stack.push_back({child, child->getFirstNodePosition(), false});
      } else if (IsError(*child)) {
        visit.keep = true;
      } else {
        visit.element->removeNode(child);
      }
      continue;
    }
    const bool keep = visit.keep;
    QEXVBTXMLNode* finished = visit.element;
    stack.pop_back();
    if (stack.empty()) return keep;
    if (keep) {
      stack.back().keep = true;
    } else {
      stack.back().element->removeNode(finished);
    }
  }
}

int FinishReport(QEXVBTXMLNode& root, const char* path, std::string& error) {
  QEXVBTXMLPosition position = root.getFirstNodePosition();
  while (position != nullptr) {
    QEXVBTXMLNode* child = root.getNextNode(position);
    if (!PruneReport(child)) root.removeNode(child);
  }
  changeAttributeValues(&root, encodeXMLString);
  return root.writeInFile(path, error);
}
