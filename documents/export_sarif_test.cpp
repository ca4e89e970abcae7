#include "documents/export_sarif.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace zor2 {
namespace {

Finding MethodFinding(MessageCode code, std::string signature) {
  return {code, "Geo", "Public", "Point.h", "Point", "Move",  std::move(signature),
          "",   "",    "",       false,     "",      nullptr, ""};
}

TEST(FindingFingerprintTest, FollowsTheFindingsPlaceNotItsValues) {
  const Finding finding = MethodFinding(MessageCode::kMRTHC, "void Move(int)");
  Finding changed_values = finding;
  changed_values.reference_value = std::string("void");
  changed_values.checked_value = std::string("int");
  changed_values.accepted = true;
  EXPECT_EQ(FindingFingerprint(finding, 1), FindingFingerprint(changed_values, 1));

  // Overloads, codes, classes and groups tell findings apart.
  EXPECT_NE(FindingFingerprint(finding, 1),
            FindingFingerprint(MethodFinding(MessageCode::kMRTHC, "void Move(long)"), 1));
  EXPECT_NE(FindingFingerprint(finding, 1),
            FindingFingerprint(MethodFinding(MessageCode::kINDM, "void Move(int)"), 1));
  Finding other_group = finding;
  other_group.group = std::string("Protected");
  EXPECT_NE(FindingFingerprint(finding, 1), FindingFingerprint(other_group, 1));
  // Names are not run together: "ab" + "c" is not "a" + "bc".
  Finding split_a = finding;
  split_a.class_name = std::string("ab");
  split_a.method = std::string("c");
  split_a.signature = std::string("");
  Finding split_b = split_a;
  split_b.class_name = std::string("a");
  split_b.method = std::string("bc");
  EXPECT_NE(FindingFingerprint(split_a, 1), FindingFingerprint(split_b, 1));
}

TEST(ExportSarifTest, FingerprintsDoNotDependOnTheOrderOfOtherFindings) {
  const Finding a = MethodFinding(MessageCode::kMRTHC, "void Move(int)");
  const Finding b = MethodFinding(MessageCode::kMHBDM, "void Stop()");
  const std::string fingerprint_a = FindingFingerprint(a, 1);
  const std::string fingerprint_b = FindingFingerprint(b, 1);
  const std::string forward = ExportSarif({}, {}, {a, b});
  const std::string backward = ExportSarif({}, {}, {b, a});
  for (const std::string& sarif : {forward, backward}) {
    EXPECT_NE(sarif.find("\"zor2checkFinding/v1\":\"" + fingerprint_a + "\""), std::string::npos);
    EXPECT_NE(sarif.find("\"zor2checkFinding/v1\":\"" + fingerprint_b + "\""), std::string::npos);
  }
  // Two findings with the same place (two classes of one name) differ by rank.
  const std::string twice = ExportSarif({}, {}, {a, a});
  EXPECT_NE(twice.find("\"" + fingerprint_a + "\""), std::string::npos);
  EXPECT_NE(twice.find("\"" + fingerprint_a + ":2\""), std::string::npos);
}

TEST(ExportSarifTest, AcceptedFindingsAreSuppressedWithTheirReason) {
  Finding accepted = MethodFinding(MessageCode::kMHBDM, "void Stop()");
  accepted.accepted = true;
  accepted.reason = std::string("Replaced by \"Halt\"");
  const std::string sarif =
      ExportSarif({}, {}, {accepted, MethodFinding(MessageCode::kMRTHC, "int Run()")});
  const size_t suppressions = sarif.find("\"suppressions\"");
  ASSERT_NE(suppressions, std::string::npos);
  EXPECT_EQ(sarif.find("\"suppressions\"", suppressions + 1), std::string::npos);
  // The suppression belongs to the accepted finding, which comes first.
  const size_t second_result = sarif.find("\"ruleId\":\"MRTHC\"");
  EXPECT_LT(suppressions, second_result);
  for (const char* member : {"\"kind\":\"external\"", "\"status\":\"accepted\"",
                             "\"justification\":\"Replaced by \\\"Halt\\\"\""}) {
    const size_t at = sarif.find(member, suppressions);
    EXPECT_LT(at, second_result) << member;
  }
}

// Code-scanning services place an annotation by a URI relative to the root of
// the repository: never absolute, never climbing out of it, "/" kept.
TEST(ExportSarifTest, ArtifactsAreRelativeToTheFolderOfTheRepository) {
  Finding finding = MethodFinding(MessageCode::kMRTHC, "int Run()");
  RunDescription run;
  run.sarif_base = "/include/./sub/";
  const auto uri_of = [&](const std::string& file) {
    finding.file = file;
    const std::string sarif = ExportSarif(run, {}, {finding});
    const size_t at = sarif.find("\"uri\":\"");
    return sarif.substr(at + 7, sarif.find('"', at + 7) - at - 7);
  };
  EXPECT_EQ(uri_of("geo/Point.h"), "include/sub/geo/Point.h");
  EXPECT_EQ(uri_of("/abs/../x/./geo//Point.h"), "include/sub/x/geo/Point.h");
  EXPECT_EQ(uri_of("../../../../etc/a b:c.h"), "etc/a%20b%3Ac.h");
  run.sarif_base.clear();
  EXPECT_EQ(uri_of("/usr/include/Point.h"), "usr/include/Point.h");

  // A declaration's line gives the region; without one there is none.
  finding.line = 12;
  EXPECT_NE(ExportSarif(run, {}, {finding}).find("\"region\":{\"startLine\":12}"),
            std::string::npos);
  finding.line = 0;
  EXPECT_EQ(ExportSarif(run, {}, {finding}).find("\"region\""), std::string::npos);
}

}  // namespace
}  // namespace zor2
