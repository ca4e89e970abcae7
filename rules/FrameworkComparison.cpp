#include "rules/FrameworkComparison.h"

#include <atomic>
#include <memory>
#include <system_error>
#include <thread>
#include <utility>
#include <vector>

#include "platform/tools/ZOROFStream.h"
#include "rules/ChildElements.h"
#include "rules/FileComparison.h"
#include "rules/PairingIndex.h"
#include "rules/ReportMirror.h"

namespace {

// One framework pair, compared apart from the report and the log streams so
// that pairs can be compared on two threads: the mirror of the reference
// framework (created only when it holds a finding) and the log lines wait
// here until the pairs before them are in.
struct FrameworkPair {
  const QEXVBTXMLNode* reference = nullptr;
  const QEXVBTXMLNode* checked = nullptr;
  std::unique_ptr<QEXVBTXMLNode> mirror;
  ZORLog log;
  std::atomic<bool> done{false};  // set by the thread that compared it, last
};

void ComparePair(FrameworkPair& pair, bool mirrored) {
  {
    ZORLogCapture capture(pair.log);
    const char* name = pair.reference->getAttributeValue("Name");
    ReportMirror reportFramework(mirrored ? &pair.mirror : nullptr, "Framework");
    reportFramework.CopyAttribute("Name", name);
    ZORout << "Checking : " << name << endl;
    CompareInterfaceFiles(pair.reference, pair.checked, reportFramework, "Public");
    CompareInterfaceFiles(pair.reference, pair.checked, reportFramework, "Protected");
  }
  pair.done.store(true, std::memory_order_release);
}

// Hands the pairs from `committed` on to the report and the log streams, in
// reference order, as far as they are done: the result is the one of a
// comparison of one pair after the other, and progress lines come as soon as
// they can. Only the thread that called CompareFrameworks commits.
void CommitDone(std::vector<FrameworkPair>& pairs, size_t& committed, QEXVBTXMLNode* report) {
  for (; committed < pairs.size() && pairs[committed].done.load(std::memory_order_acquire);
       ++committed) {
    FrameworkPair& pair = pairs[committed];
    pair.log.Replay();
    if (pair.mirror != nullptr) report->insertNodeAtEnd(std::move(pair.mirror));
  }
}

// Compares every pair, on this thread and one more when there are several:
// each thread takes the next pair not yet taken. The pairs only read the
// documents, which are shared. Should no thread be available, this one
// compares them all.
void CompareAll(std::vector<FrameworkPair>& pairs, QEXVBTXMLNode* report) {
  const bool mirrored = report != nullptr;
  std::atomic<size_t> next{0};
  auto work = [&pairs, &next, mirrored] {
    for (size_t i; (i = next++) < pairs.size();) ComparePair(pairs[i], mirrored);
  };
  std::thread helper;
  if (pairs.size() > 1) {
    try {
      helper = std::thread(work);
    } catch (const std::system_error&) {
    }
  }
  size_t committed = 0;
  for (size_t i; (i = next++) < pairs.size();) {
    ComparePair(pairs[i], mirrored);
    CommitDone(pairs, committed, report);
  }
  if (helper.joinable()) helper.join();
  CommitDone(pairs, committed, report);
}

}  // namespace

int CompareFrameworks(const QEXVBTXMLNode* reference, const QEXVBTXMLNode* checked,
                      QEXVBTXMLNode*& report) {
  const std::vector<QEXVBTXMLNode*> referenceFrameworks = ChildElements(reference, "Framework");
  if (referenceFrameworks.empty()) return 0;

  // A framework without counterpart is passed over: its mirror would hold no
  // finding and never reach the report.
  const NameIndex checkedFrameworks(ChildElements(checked, "Framework"));
  std::vector<std::pair<const QEXVBTXMLNode*, const QEXVBTXMLNode*>> found;
  for (const QEXVBTXMLNode* framework : referenceFrameworks) {
    const QEXVBTXMLNode* counterpart = checkedFrameworks.Find(framework->getAttributeValue("Name"));
    if (counterpart != nullptr) found.emplace_back(framework, counterpart);
  }
  std::vector<FrameworkPair> pairs(found.size());
  for (size_t i = 0; i < found.size(); ++i) {
    pairs[i].reference = found[i].first;
    pairs[i].checked = found[i].second;
  }
  CompareAll(pairs, report);
  return 0;
}
