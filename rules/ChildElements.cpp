#include "rules/ChildElements.h"

#include "platform/xml/QEXVBTXMLSearch.h"

std::vector<QEXVBTXMLNode*> ChildElements(const QEXVBTXMLNode* parent, const char* tag) {
  QEXVBTXMLSearch query;
  query.setSearch({QEXVBTXMLSearch::SearchChildren, QEXVBTXMLSearch::TagIs, tag});
  query.searchStart(parent);
  return query.matches();
}
