#include "rules/framework_comparison.h"

#include <algorithm>
#include <atomic>
#include <iterator>
#include <memory>
#include <optional>
#include <vector>

#include "rules/child_elements.h"
#include "rules/file_comparison.h"
#include "rules/pairing_index.h"
#include "rules/report_mirror.h"

namespace zor2 {
namespace {

// One framework pair, compared apart from the report and the run's log so
// that pairs can be compared on two threads: the mirror of the reference
// framework (created only when it holds a finding) and the pair's log lines
// wait here until the pairs before them are in.
struct FrameworkPair {
  const xml::Element* reference = nullptr;
  const xml::Element* checked = nullptr;
  std::unique_ptr<xml::OutputElement> mirror;
  Log log;
  std::optional<FindingCollector> findings;
  std::atomic<bool> done{false};  // set by the thread that compared it, last
};

void ComparePair(FrameworkPair& pair, const CheckSettings& settings) {
  const char* name = pair.reference->FindAttribute("Name");
  ReportMirror report_framework(&pair.mirror, "Framework",
                                pair.findings ? &*pair.findings : nullptr);
  report_framework.CopyAttribute("Name", name);
  pair.log.Progress() << "Checking : " << name;
  CompareInterfaceFiles(*pair.reference, *pair.checked, "Public", settings, report_framework,
                        pair.log);
  CompareInterfaceFiles(*pair.reference, *pair.checked, "Protected", settings, report_framework,
                        pair.log);
  pair.done.store(true, std::memory_order_release);
}

// Hands the pairs from `committed` on to the report and the log, in reference
// order, as far as they are done, so that the result is that of comparing one
// pair after the other while progress lines come as soon as they can. Only the
// thread that called CompareFrameworks commits.
void CommitDone(std::vector<FrameworkPair>& pairs, size_t& committed, xml::OutputElement& report,
                Log& log, FindingCollector* collector) {
  for (; committed < pairs.size() && pairs[committed].done.load(std::memory_order_acquire);
       ++committed) {
    FrameworkPair& pair = pairs[committed];
    pair.log.ReplayInto(log);
    if (pair.mirror != nullptr) report.AddChild(std::move(pair.mirror));
    if (collector != nullptr) {
      collector->CountCheckedFiles(pair.findings->files_checked());
      std::vector<Finding>& found = pair.findings->findings();
      collector->findings().insert(collector->findings().end(),
                                   std::make_move_iterator(found.begin()),
                                   std::make_move_iterator(found.end()));
    }
  }
}

}  // namespace

void CompareFrameworks(const xml::Element& reference, const xml::Element& checked,
                       const CheckSettings& settings, xml::OutputElement& report, Log& log,
                       FindingCollector* collector, Executor* executor) {
  const NameIndex checked_frameworks(ChildElements(checked, "Framework"));
  std::vector<const xml::Element*> references;
  std::vector<const xml::Element*> counterparts;
  for (const xml::Element* framework : ChildElements(reference, "Framework")) {
    const char* name = framework->FindAttribute("Name");
    const xml::Element* counterpart = checked_frameworks.Find(name);
    if (counterpart == nullptr) {
      if (collector != nullptr) collector->NoteMissingFramework(name);
      continue;
    }
    references.push_back(framework);
    counterparts.push_back(counterpart);
  }
  std::vector<FrameworkPair> pairs(references.size());
  for (size_t i = 0; i < pairs.size(); ++i) {
    pairs[i].reference = references[i];
    pairs[i].checked = counterparts[i];
    if (collector != nullptr) pairs[i].findings.emplace(collector->Part());
  }

  // Each thread takes the next pair not yet taken; the pairs only read the
  // documents, which are shared.
  std::atomic<size_t> next{0};
  auto work = [&pairs, &next, &settings] {
    for (size_t i; (i = next++) < pairs.size();) ComparePair(pairs[i], settings);
  };
  // As many helpers as the machine has other processors; a helper that no
  // worker has started by the end runs here and finds nothing left.
  std::vector<Executor::Handle<void>> helpers;
  if (executor != nullptr) {
    const size_t wanted =
        pairs.size() > 1 ? std::min(Executor::MachineThreads(), pairs.size()) - 1 : 0;
    for (size_t h = 0; h < std::min(wanted, executor->threads()); ++h) {
      helpers.push_back(executor->Submit(work));
    }
  }
  size_t committed = 0;
  for (size_t i; (i = next++) < pairs.size();) {
    ComparePair(pairs[i], settings);
    CommitDone(pairs, committed, report, log, collector);
  }
  for (Executor::Handle<void>& helper : helpers) helper.Get();
  CommitDone(pairs, committed, report, log, collector);
}

}  // namespace zor2
