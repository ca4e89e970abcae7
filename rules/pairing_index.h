#pragma once

#include <cstddef>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "platform/xml/document.h"
#include "rules/method_records.h"

namespace zor2 {

// Indexes of the checked side of one pairing level. Each answers what a scan
// of the checked elements from the first one would find for a reference
// element: a match, never marked as taken, so that one checked element can
// pair with several reference elements. Built once per level, so that
// pairing costs time proportional to the size of the level. An index points
// into what it was built from, which must outlive it and stay unchanged.

// Pairs elements by their exact "Name".
class NameIndex {
 public:
  // Elements without "Name" are left out, since they pair with nothing.
  explicit NameIndex(const std::vector<const xml::Element*>& elements);
  // The first element whose "Name" equals `name`, or null (always null for a
  // null `name`).
  const xml::Element* Find(const char* name) const;

 private:
  std::unordered_map<std::string_view, const xml::Element*> first_;
};

// Pairs method records by SameMethod.
class MethodIndex {
 public:
  static constexpr size_t npos = static_cast<size_t>(-1);

  explicit MethodIndex(const std::vector<const MethodRecord*>& methods);
  // The position (from 0) of the record n of the list that m pairs with: among
  // those for which SameMethod(m, n) holds, the first whose "Signature" is
  // m's own, else the first; npos when there is none. Const twins
  // ("T* F()" and "const T* F() const") share an identity, and each pairs
  // with its own twin.
  size_t Find(const MethodRecord& m) const;
  bool Contains(const MethodRecord& m) const { return Find(m) != npos; }

 private:
  // A record with an identity: the hash of its identity and its position.
  struct Entry {
    size_t hash;
    size_t position;
    bool operator<(const Entry& other) const {
      return hash != other.hash ? hash < other.hash : position < other.position;
    }
  };
  const std::vector<const MethodRecord*>& methods_;
  // Ordered by hash, then by position: the records that may be the same
  // method as a given one are a run of equal hashes, in list order. One
  // allocation per index, where a hash map would make one per record.
  std::vector<Entry> entries_;
};

}  // namespace zor2
