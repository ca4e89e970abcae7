#include "documents/export_text.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace zor2 {
namespace {

std::string ValidUtf8(std::string_view text) {
  std::string out;
  AppendValidUtf8(text, &out);
  return out;
}

TEST(ValidUtf8Test, KeepsUtf8AndReplacesEveryOtherByte) {
  const std::string replacement = "\xEF\xBF\xBD";
  // Two-, three- and four-byte characters and the highest code point stay.
  EXPECT_EQ(ValidUtf8("Gr\xC3\xB6\xC3\x9F"
                      "e \xE2\x82\xAC \xF0\x9F\x98\x80 \xF4\x8F\xBF\xBF"),
            "Gr\xC3\xB6\xC3\x9F"
            "e \xE2\x82\xAC \xF0\x9F\x98\x80 \xF4\x8F\xBF\xBF");
  const std::pair<std::string, std::string> rejected[] = {
      {"a\x80z", "a" + replacement + "z"},                        // stray continuation byte
      {"\xC0\xAF", replacement + replacement},                    // overlong "/"
      {"\xE0\x80\xAF", replacement + replacement + replacement},  // overlong, three bytes
      {"\xED\xA0\x80", replacement + replacement + replacement},  // a surrogate
      {"\xF4\x90\x80\x80", replacement + replacement + replacement + replacement},  // > U+10FFFF
      {"\xFF\xFE", replacement + replacement},
      {"end \xE2\x82", "end " + replacement + replacement},  // cut short at the end
  };
  for (const auto& [input, expected] : rejected) {
    EXPECT_EQ(ValidUtf8(input), expected) << input;
  }
}

TEST(HelpAsTextTest, TurnsTheHelpMarkupIntoLineBreaks) {
  EXPECT_EQ(HelpAsText(MessageTypeOf(MessageCode::kUHC).help),
            "@ZOR2Usage has either disappeared or changed in a wrong way.\nThe following changes "
            "are only allowed :\n\n     U1 -> U2 \n     U3 -> U4 \n     U3 -> U5");
}

Finding At(std::string framework, std::string group, std::string file, MessageCode code) {
  return {code,
          std::move(framework),
          std::move(group),
          std::move(file),
          "",
          "",
          "",
          "",
          "",
          "",
          false,
          "",
          nullptr,
          ""};
}

TEST(GroupByFrameworkAndFileTest, GathersEachFileOnceInTheOrderOfItsFirstFinding) {
  // Two documents of a directory can hold the same framework, so findings of
  // one file need not be adjacent; a file of the same name in the other group
  // is another file.
  const std::vector<Finding> findings = {
      At("Geo", "Public", "B.h", MessageCode::kMRTHC),
      At("Doc", "Public", "A.h", MessageCode::kCHBD),
      At("Geo", "Public", "A.h", MessageCode::kFHBD),
      At("Geo", "Protected", "B.h", MessageCode::kLHC),
      At("Geo", "Public", "B.h", MessageCode::kADVHC),
  };
  const std::vector<FrameworkFindings> groups = GroupByFrameworkAndFile(findings);
  ASSERT_EQ(groups.size(), 2u);
  EXPECT_EQ(groups[0].framework, "Geo");
  EXPECT_EQ(groups[1].framework, "Doc");
  std::vector<std::string> files;
  for (const FileFindings& file : groups[0].files) {
    files.push_back(file.group + "/" + file.file + ":" + std::to_string(file.findings.size()));
  }
  EXPECT_EQ(files, (std::vector<std::string>{"Public/B.h:2", "Public/A.h:1", "Protected/B.h:1"}));
  EXPECT_EQ(groups[0].files[0].findings[0], &findings[0]);
  EXPECT_EQ(groups[0].files[0].findings[1], &findings[4]);
}

TEST(VerdictLineTest, NamesTheFindingsThatCountAgainstTheRun) {
  RunSummary summary;
  EXPECT_EQ(VerdictLine(summary), "PASSED: no finding");
  summary.counts_by_code[static_cast<size_t>(MessageCode::kMHBDM)] = 3;
  summary.accepted = 2;
  summary.failed = true;
  EXPECT_EQ(VerdictLine(summary), "FAILED: 1 new finding (2 accepted by the baseline)");
  summary.accepted = 3;
  summary.failed = false;
  EXPECT_EQ(VerdictLine(summary), "PASSED: 3 findings, all accepted by the baseline");
}

// What fails a check besides findings is named, and a run that could not do
// all it was asked never passes.
TEST(VerdictLineTest, NamesEveryCauseAndPutsFailuresFirst) {
  RunSummary summary;
  summary.missing_documents.emplace_back("Legacy.xml");
  summary.missing_frameworks.emplace_back("Sketch");
  summary.missing_frameworks.emplace_back("Old");
  summary.missing_frameworks.back().accepted = true;
  summary.nothing_checked = true;
  SettleVerdict(&summary);
  EXPECT_EQ(VerdictOf(summary), Verdict::kFailed);
  EXPECT_EQ(VerdictLine(summary),
            "FAILED: 1 reference document without counterpart, 1 reference framework without "
            "counterpart, nothing was checked");
  summary.failures.push_back({"ref", "No such file or directory"});
  EXPECT_EQ(VerdictOf(summary), Verdict::kError);
  EXPECT_EQ(VerdictLine(summary), "ERROR: the check is incomplete: an input or output failed");
  summary = RunSummary();
  SettleVerdict(&summary);
  EXPECT_EQ(VerdictName(VerdictOf(summary)), std::string("passed"));
}

}  // namespace
}  // namespace zor2
