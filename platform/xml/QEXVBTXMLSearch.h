#pragma once

#include <cstdint>
#include <initializer_list>
#include <vector>

#include "platform/xml/QEXVBTXMLNode.h"

// One item of a query list: a criterion constant or a string operand.
struct QEXVBTXMLSearchTerm {
  QEXVBTXMLSearchTerm(int64_t criterion) : criterion(criterion) {}
  QEXVBTXMLSearchTerm(const char* text) : text(text) {}
  int64_t criterion = 0;
  const char* text = nullptr;
};

// A reusable query over the descendants of a start element. Two shapes of
// query list are supported:
//   SearchChildren, TagIs, tag
//       the direct children with this tag, in document order;
//   SearchChildren, TagIs, "Interfaces", AttrIs, "Name", value,
//   SearchChildren, TagIs, "File" [, HasAttr, attribute]
//       the "File" children of those "Interfaces" children whose "Name" equals
//       value (optionally only those carrying the attribute), in document
//       order.
// More generally, each SearchChildren step descends one level, TagIs filters
// by tag, AttrIs by an attribute's exact value, HasAttr by an attribute's
// presence.
class QEXVBTXMLSearch {
 public:
  static constexpr int64_t SearchChildren = 1;
  static constexpr int64_t TagIs = 2;
  static constexpr int64_t AttrIs = 3;
  static constexpr int64_t HasAttr = 4;

  QEXVBTXMLSearch() = default;
  virtual ~QEXVBTXMLSearch() = default;

  // Sets the query. The strings must outlive every searchStart made with it.
  void setSearch(std::initializer_list<QEXVBTXMLSearchTerm> terms);

  // Runs the query under `start` (may be null: nothing matches) and returns the
  // position of the first match, or null when nothing matches. The matches are
  // kept by the query: a position stays valid until the next searchStart and
  // may be copied to restart the same scan from the beginning.
  QEXVBTXMLPosition searchStart(const QEXVBTXMLNode* start);
  // Returns the match at `position` and moves `position` to the next match
  // (null after the last).
  QEXVBTXMLNode* searchNext(QEXVBTXMLPosition& position) const;

  // All matches of the last searchStart, in order.
  const std::vector<QEXVBTXMLNode*>& matches() const { return matches_; }

 private:
  std::vector<QEXVBTXMLSearchTerm> terms_;
  std::vector<QEXVBTXMLNode*> matches_;
};
