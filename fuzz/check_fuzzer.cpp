// libFuzzer target: one input is a reference document and a checked document
// separated by the line "=====" (without it, the input is compared with
// itself). Each input goes through what a run does with a document pair:
// load, prepare, compare, prune and write the report, once without and once
// with "-L". Documents that do not load must say why; a report must read back
// as a well-formed document, and must not change when the documents are
// prepared piecewise, in two passes (normalise, then decode) instead of the
// run's one.
//
// The progress log goes to /dev/null. The warning log shares standard error
// with libFuzzer, so long runs pass -close_fd_mask=2 to silence it.

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <string>
#include <string_view>

#include "documents/ReportDocument.h"
#include "documents/TypeNameNormalization.h"
#include "driver/PairLoading.h"
#include "platform/tools/XMLString.h"
#include "platform/xml/QEXVBTXMLNode.h"
#include "rules/CheckSettings.h"
#include "rules/FrameworkComparison.h"

namespace {

constexpr std::string_view kSeparator = "\n=====\n";

// Stops the fuzzer on an outcome that is wrong without being a crash.
void Require(bool condition) {
  if (!condition) std::abort();
}

std::unique_ptr<QEXVBTXMLNode> Load(std::string_view text) {
  XMLReadError error;
  std::unique_ptr<QEXVBTXMLNode> document = QEXVBTXMLNode::CreateFromText(text, error);
  if (!document) Require(!error.reason.empty() && error.line >= 0 && error.column >= 0);
  return document;
}

// The preparation of a run.
void Prepare(QEXVBTXMLNode& document) {
  changeAttributeValues(&document, PrepareValue);
}

// The same preparation in its two steps, one subtree of the root at a time: a
// pass over part of a document keeps grown values in the elements rather than
// in the document's storage, so the rules read them by another path. The
// root's own values are never read by the rules.
void PrepareByParts(QEXVBTXMLNode& document) {
  QEXVBTXMLPosition position = document.getFirstNodePosition();
  while (QEXVBTXMLNode* child = document.getNextNode(position)) {
    changeAttributeValues(child, NormalizeTypeNames);
    changeAttributeValues(child, decodeXMLString);
  }
}

// The report of one pair, not yet finished; the documents
// are read anew because preparing them rewrites their values.
std::unique_ptr<QEXVBTXMLNode> Compare(std::string_view reference_text,
                                       std::string_view checked_text,
                                       void (*prepare)(QEXVBTXMLNode&)) {
  std::unique_ptr<QEXVBTXMLNode> reference = Load(reference_text);
  std::unique_ptr<QEXVBTXMLNode> checked = Load(checked_text);
  std::unique_ptr<QEXVBTXMLNode> report = QEXVBTXMLNode::CreateNode("XmlDiff");
  if (reference && checked) {
    prepare(*reference);
    prepare(*checked);
    QEXVBTXMLNode* root = report.get();
    CompareFrameworks(reference.get(), checked.get(), root);
  }
  return report;
}

std::string Written(const QEXVBTXMLNode& report) {
  std::string text;
  report.writeTo(text);
  return text;
}

// One run over the pair with the given settings.
void CheckPair(std::string_view reference_text, std::string_view checked_text, int flagged,
               int level) {
  OnlyFlaggedFiles = flagged;
  CurrentLevel = level;
  std::unique_ptr<QEXVBTXMLNode> report = Compare(reference_text, checked_text, Prepare);
  // /dev/null is written in place, so no temporary file is ever left.
  std::string reason;
  Require(FinishReport(*report, "/dev/null", reason) == 0);
  const std::string written = Written(*report);
  XMLReadError error;
  Require(QEXVBTXMLNode::CreateFromText(written, error) != nullptr);

  std::unique_ptr<QEXVBTXMLNode> by_parts = Compare(reference_text, checked_text, PrepareByParts);
  Require(FinishReport(*by_parts, "/dev/null", reason) == 0);
  Require(Written(*by_parts) == written);
}

}  // namespace

extern "C" int LLVMFuzzerInitialize(int*, char***) {
  Require(std::freopen("/dev/null", "w", stdout) != nullptr);
  return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  std::string_view input(reinterpret_cast<const char*>(data), size);
  std::string_view reference = input;
  std::string_view checked = input;
  if (size_t at = input.find(kSeparator); at != std::string_view::npos) {
    reference = input.substr(0, at);
    checked = input.substr(at + kSeparator.size());
  }
  CheckPair(reference, checked, 0, 99);
  CheckPair(reference, checked, 1, 20);
  OnlyFlaggedFiles = 0;
  CurrentLevel = 99;
  return 0;
}
