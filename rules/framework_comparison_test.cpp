#include "rules/framework_comparison.h"

#include <gtest/gtest.h>

#include <string>

#include "tests/test_util.h"

namespace zor2 {
namespace {

// Framework pairs may be compared on several threads: the report and the log
// lines must still come in reference order.
TEST(FrameworkComparisonTest, KeepsReferenceOrderAcrossManyFrameworks) {
  std::string reference = "<W>";
  std::string checked = "<W>";
  std::string expected_log;
  std::string expected_names;
  for (int i = 0; i < 40; ++i) {
    const std::string name = std::to_string(i);
    // Every framework but each fifth has a counterpart and a deleted file.
    reference.append("<Framework Name=\"F").append(name).append("\">");
    reference.append("<Interfaces Name=\"Public\"><File Name=\"F").append(name);
    reference.append(".h\" Aut=\"Y\"/></Interfaces></Framework>");
    if (i % 5 == 4) continue;
    checked.append("<Framework Name=\"F").append(name).append("\"/>");
    expected_log.append("Checking : F").append(name).append("\n");
    expected_names.append("F").append(name);
  }
  auto reference_document = testing::Parse(reference + "</W>");
  auto checked_document = testing::Parse(checked + "</W>");
  xml::OutputElement report("XmlDiff");
  Log log;
  Executor executor(4);
  CompareFrameworks(reference_document->root(), checked_document->root(), CheckSettings(), report,
                    log, nullptr, &executor);
  ::testing::internal::CaptureStdout();
  log.ReplayInto(Log::Standard());
  EXPECT_EQ(::testing::internal::GetCapturedStdout(), expected_log);
  std::string names;
  for (const auto& framework : report.children()) names += *framework->FindAttribute("Name");
  EXPECT_EQ(names, expected_names);
}

}  // namespace
}  // namespace zor2
