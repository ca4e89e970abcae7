#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "rules/finding.h"
#include "rules/method_records.h"

namespace zor2 {

// The likely replacements of a deleted method: the methods of the checked
// class that bear its name, as a finding shows them. A class may hold
// thousands of overloads of one name, each deleted one asking: the list is
// capped at kShown signatures, the most alike, and counts the rest, so that
// time, memory and the exports grow with the findings, not with their
// product. The index is built on the first question, which only runs that
// collect findings ask.
//
// Thread safety: used by one thread; reads the records it is given and their
// document, which must outlive it.
class LikelyReplacements {
 public:
  static constexpr size_t kShown = 10;

  // `checked_methods`: the records of the checked class's "Method" children,
  // in document order (ReadClassMethods).
  explicit LikelyReplacements(const std::vector<MethodRecord>& checked_methods)
      : methods_(checked_methods) {}
  LikelyReplacements(const LikelyReplacements&) = delete;
  LikelyReplacements& operator=(const LikelyReplacements&) = delete;

  // The signatures (as `shown` writes them) of the checked methods named
  // `name`, one per line in document order: all of them when there are at
  // most kShown, else the kShown that share the longest beginning or end with
  // `signature` (the two lengths added), and in `*more` how many others there
  // are (0 when none). Empty for a null `name`.
  std::string Signatures(const char* name, const char* signature, const FindingCollector& shown,
                         int* more);

 private:
  // A checked method: its signature and its place among the class's methods.
  struct Method {
    std::string_view signature;
    size_t order;
  };
  // The methods of one name, sorted by signature, and sorted by signature
  // read backwards: the methods that share the longest beginning (end) with
  // any text stand around its place in the first (second) order.
  struct Overloads {
    std::vector<Method> by_start;
    std::vector<Method> by_end;
  };
  void BuildIndex();

  const std::vector<MethodRecord>& methods_;
  bool indexed_ = false;
  std::unordered_map<std::string_view, Overloads> by_name_;
};

}  // namespace zor2
