#include "rules/likely_replacements.h"

#include <algorithm>
#include <iterator>

namespace zor2 {
namespace {

bool EndsBefore(std::string_view a, std::string_view b) {
  return std::lexicographical_compare(a.rbegin(), a.rend(), b.rbegin(), b.rend());
}

size_t CommonStart(std::string_view a, std::string_view b) {
  return static_cast<size_t>(std::mismatch(a.begin(), a.end(), b.begin(), b.end()).first -
                             a.begin());
}

size_t CommonEnd(std::string_view a, std::string_view b) {
  return static_cast<size_t>(std::mismatch(a.rbegin(), a.rend(), b.rbegin(), b.rend()).first -
                             a.rbegin());
}

// Appends to `chosen` the places (in `sorted`) of the `count` methods whose
// `common` part with `text` is the longest, walking out from `at`, where
// `text` would stand: the common part only shrinks going away from it.
template <typename Sorted, typename Common>
void Nearest(const Sorted& sorted, size_t at, std::string_view text, size_t count, Common common,
             std::vector<size_t>* chosen) {
  size_t below = at;  // the next one down is below - 1
  size_t above = at;
  while (count-- > 0 && (below > 0 || above < sorted.size())) {
    const bool take_below =
        above == sorted.size() || (below > 0 && common(sorted[below - 1].signature, text) >=
                                                    common(sorted[above].signature, text));
    chosen->push_back(take_below ? --below : above++);
  }
}

}  // namespace

void LikelyReplacements::BuildIndex() {
  indexed_ = true;
  size_t order = 0;
  for (const MethodRecord& method : methods_) {
    if (method.name == nullptr || method.signature == nullptr) continue;
    by_name_[method.name].by_start.push_back({method.signature, order++});
  }
  for (auto& [name, overloads] : by_name_) {
    std::vector<Method>& by_start = overloads.by_start;
    overloads.by_end = by_start;
    std::stable_sort(by_start.begin(), by_start.end(),
                     [](const Method& a, const Method& b) { return a.signature < b.signature; });
    std::stable_sort(
        overloads.by_end.begin(), overloads.by_end.end(),
        [](const Method& a, const Method& b) { return EndsBefore(a.signature, b.signature); });
  }
}

std::string LikelyReplacements::Signatures(const char* name, const char* signature,
                                           const FindingCollector& shown, int* more) {
  *more = 0;
  std::string signatures;
  if (name == nullptr) return signatures;
  if (!indexed_) BuildIndex();
  const auto found = by_name_.find(name);
  if (found == by_name_.end()) return signatures;
  const Overloads& overloads = found->second;

  std::vector<Method> chosen;
  if (overloads.by_start.size() <= kShown) {
    chosen = overloads.by_start;
  } else {
    const std::string_view text = signature != nullptr ? signature : "";
    std::vector<size_t> places;
    const std::vector<Method>& by_start = overloads.by_start;
    const size_t start_at = static_cast<size_t>(
        std::lower_bound(by_start.begin(), by_start.end(), text,
                         [](const Method& m, std::string_view t) { return m.signature < t; }) -
        by_start.begin());
    Nearest(by_start, start_at, text, kShown, CommonStart, &places);
    for (size_t place : places) chosen.push_back(by_start[place]);
    places.clear();
    const std::vector<Method>& by_end = overloads.by_end;
    const size_t end_at =
        static_cast<size_t>(std::lower_bound(by_end.begin(), by_end.end(), text,
                                             [](const Method& m, std::string_view t) {
                                               return EndsBefore(m.signature, t);
                                             }) -
                            by_end.begin());
    Nearest(by_end, end_at, text, kShown, CommonEnd, &places);
    for (size_t place : places) chosen.push_back(by_end[place]);

    // The candidates of both orders, each once, the most alike first and,
    // among equals, the first in the class.
    std::sort(chosen.begin(), chosen.end(),
              [](const Method& a, const Method& b) { return a.order < b.order; });
    chosen.erase(std::unique(chosen.begin(), chosen.end(),
                             [](const Method& a, const Method& b) { return a.order == b.order; }),
                 chosen.end());
    auto alike = [text](const Method& m) {
      return std::min(CommonStart(m.signature, text) + CommonEnd(m.signature, text),
                      std::min(m.signature.size(), text.size()));
    };
    std::stable_sort(chosen.begin(), chosen.end(),
                     [&alike](const Method& a, const Method& b) { return alike(a) > alike(b); });
    chosen.resize(kShown);
    *more = static_cast<int>(by_start.size() - kShown);
  }
  std::sort(chosen.begin(), chosen.end(),
            [](const Method& a, const Method& b) { return a.order < b.order; });
  for (const Method& method : chosen) {
    if (!signatures.empty()) signatures += '\n';
    signatures += shown.AsWritten(method.signature.data());
  }
  return signatures;
}

}  // namespace zor2
