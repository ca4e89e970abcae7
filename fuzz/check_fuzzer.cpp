// libFuzzer target: one input is a reference document and a checked document
// separated by the line "=====" (without it, the input is compared with
// itself). Each input goes through what a run does with a document pair:
// read, prepare, compare and write the report, once without and once with
// "-L". Documents that do not read must say why; a report must read back as a
// well-formed document, and must not change when the documents are prepared
// in two passes (normalise, then decode) instead of the run's one.
//
// The progress log goes to /dev/null. The warning log shares standard error
// with libFuzzer, so long runs pass -close_fd_mask=2 to silence it.

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <string>
#include <string_view>

#include "documents/type_name_normalization.h"
#include "documents/value_preparation.h"
#include "driver/pair_loading.h"
#include "platform/tools/log.h"
#include "platform/tools/xml_escaping.h"
#include "platform/xml/output_element.h"
#include "platform/xml/reader.h"
#include "rules/framework_comparison.h"

namespace {

using namespace zor2;

constexpr std::string_view kSeparator = "\n=====\n";

// Stops the fuzzer on an outcome that is wrong without being a crash.
void Require(bool condition) {
  if (!condition) std::abort();
}

std::unique_ptr<xml::Document> Read(std::string_view text) {
  std::unique_ptr<xml::Document> document;
  xml::ReadError err;
  if (!xml::ReadDocumentText(text, &document, &err)) {
    Require(document == nullptr && !err.reason.empty() && err.line >= 0 && err.column >= 0);
  }
  return document;
}

// The preparation of a run.
void Prepare(xml::Document& document) {
  document.RewriteValues(PrepareValue);
}

// The same preparation in its two steps.
void PrepareInTwoSteps(xml::Document& document) {
  document.RewriteValues(NormalizeTypeNames);
  document.RewriteValues(DecodeXmlReferences);
}

// The written report of one pair; the documents are read anew because
// preparing them rewrites their values.
std::string Compare(std::string_view reference_text, std::string_view checked_text,
                    const CheckSettings& settings, void (*prepare)(xml::Document&)) {
  std::unique_ptr<xml::Document> reference = Read(reference_text);
  std::unique_ptr<xml::Document> checked = Read(checked_text);
  xml::OutputElement report("XmlDiff");
  if (reference && checked) {
    prepare(*reference);
    prepare(*checked);
    CompareFrameworks(reference->root(), checked->root(), settings, report, Log::Standard());
  }
  std::string written;
  xml::AppendDocument(report, &written);
  return written;
}

// One run over the pair with the given settings.
void CheckPair(std::string_view reference_text, std::string_view checked_text,
               const CheckSettings& settings) {
  const std::string written = Compare(reference_text, checked_text, settings, Prepare);
  Require(Read(written) != nullptr);
  Require(Compare(reference_text, checked_text, settings, PrepareInTwoSteps) == written);
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
  CheckPair(reference, checked, CheckSettings{false, 99});
  CheckPair(reference, checked, CheckSettings{true, 20});
  return 0;
}
