#include "platform/xml/QEXVBTXMLSearch.h"

#include <cstring>

namespace {

using Terms = std::vector<QEXVBTXMLSearchTerm>;

bool IsText(const Terms& terms, size_t i) {
  return i < terms.size() && terms[i].text != nullptr;
}

// The number of terms a criterion takes, operands included; 0 for a term that
// is not a criterion with its operands.
size_t TermLength(const Terms& terms, size_t i) {
  if (terms[i].text != nullptr) return 0;
  switch (terms[i].criterion) {
    case QEXVBTXMLSearch::SearchChildren:
      return 1;
    case QEXVBTXMLSearch::TagIs:
    case QEXVBTXMLSearch::HasAttr:
      return IsText(terms, i + 1) ? 2 : 0;
    case QEXVBTXMLSearch::AttrIs:
      return IsText(terms, i + 1) && IsText(terms, i + 2) ? 3 : 0;
    default:
      return 0;
  }
}

// The query proper: the terms before a terminating 0 criterion, or before the
// end. Empty when a term is malformed, so that such a query matches nothing.
size_t QueryLength(const Terms& terms, bool& valid) {
  valid = true;
  size_t i = 0;
  while (i < terms.size() && !(terms[i].text == nullptr && terms[i].criterion == 0)) {
    size_t length = TermLength(terms, i);
    if (length == 0) {
      valid = false;
      return 0;
    }
    i += length;
  }
  return i;
}

// Whether `node` passes the filters in [from, to), none of them SearchChildren.
bool Passes(const QEXVBTXMLNode* node, const Terms& terms, size_t from, size_t to) {
  for (size_t i = from; i < to; i += TermLength(terms, i)) {
    const QEXVBTXMLSearchTerm& term = terms[i];
    const char* operand = terms[i + 1].text;
    if (term.criterion == QEXVBTXMLSearch::TagIs) {
      if (std::strcmp(node->getTag(), operand) != 0) return false;
    } else if (term.criterion == QEXVBTXMLSearch::HasAttr) {
      if (node->getAttributeValue(operand) == nullptr) return false;
    } else {
      const char* value = node->getAttributeValue(operand);
      if (value == nullptr || std::strcmp(value, terms[i + 2].text) != 0) return false;
    }
  }
  return true;
}

// The index of the next SearchChildren at or after `i`, or `end`.
size_t NextStep(const Terms& terms, size_t i, size_t end) {
  while (i < end && terms[i].criterion != QEXVBTXMLSearch::SearchChildren) {
    i += TermLength(terms, i);
  }
  return i;
}

// Appends the elements that the query from step `step` on selects under
// `node`, in document order. Recursion is bounded by the query's steps, not by
// the tree.
void Collect(const QEXVBTXMLNode* node, const Terms& terms, size_t step, size_t end,
             std::vector<QEXVBTXMLNode*>& matches) {
  size_t filters = step + 1;
  size_t next = NextStep(terms, filters, end);
  QEXVBTXMLPosition position = node->getFirstNodePosition();
  while (QEXVBTXMLNode* child = node->getNextNode(position)) {
    if (!Passes(child, terms, filters, next)) continue;
    if (next == end) {
      matches.push_back(child);
    } else {
      Collect(child, terms, next, end, matches);
    }
  }
}

}  // namespace

void QEXVBTXMLSearch::setSearch(std::initializer_list<QEXVBTXMLSearchTerm> terms) {
  terms_.assign(terms.begin(), terms.end());
  matches_.clear();
}

// Filters before the first SearchChildren apply to the start element itself;
// a query without any SearchChildren selects the start element when it passes.
QEXVBTXMLPosition QEXVBTXMLSearch::searchStart(const QEXVBTXMLNode* start) {
  matches_.clear();
  bool valid = false;
  size_t end = QueryLength(terms_, valid);
  if (start == nullptr || !valid) return nullptr;
  size_t first_step = NextStep(terms_, 0, end);
  if (!Passes(start, terms_, 0, first_step)) return nullptr;
  if (first_step == end) {
    matches_.push_back(const_cast<QEXVBTXMLNode*>(start));
  } else {
    Collect(start, terms_, first_step, end, matches_);
  }
  return matches_.empty() ? nullptr : matches_.data();
}

QEXVBTXMLNode* QEXVBTXMLSearch::searchNext(QEXVBTXMLPosition& position) const {
  if (position == nullptr) return nullptr;
  auto* match = static_cast<QEXVBTXMLNode* const*>(position);
  QEXVBTXMLNode* node = *match++;
  position = match == matches_.data() + matches_.size() ? nullptr : match;
  return node;
}
