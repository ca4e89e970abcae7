#include "rules/FrameworkComparison.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "platform/tools/ZOROFStream.h"
#include "rules/CheckSettings.h"
#include "rules/MethodComparison.h"
#include "rules/NewPureVirtualMethods.h"

namespace {

std::unique_ptr<QEXVBTXMLNode> Parse(const char* text) {
  XMLReadError error;
  auto document = QEXVBTXMLNode::CreateFromText(text, error);
  EXPECT_NE(document, nullptr) << error.reason;
  return document;
}

// Findings at every level, and methods that the method rules name in log lines.
const char* const kReference = R"xml(<W><Framework Name="F"><Interfaces Name="Public">
  <File Name="Gone.h" Aut="Y" @ZOR2Level="L1" @ZOR2Usage="U1"><Class Name="G"/></File>
  <File Name="K.h" Aut="Y" @ZOR2Level="L1" @ZOR2Usage="U1">
    <Class Name="Lost"/>
    <Class Name="K" Aut="Y">
      <Method Name="NoSig" Access="Public"/>
      <Method Name="Foo" Access="Public" Signature="void Foo(int a = 0)"><Arg Type="int" Value="0"/></Method>
    </Class>
  </File></Interfaces></Framework></W>)xml";
const char* const kChecked = R"xml(<W><Framework Name="F"><Interfaces Name="Public">
  <File Name="K.h" Aut="Y" @ZOR2Level="L2" @ZOR2Usage="U2">
    <Class Name="K" Aut="N">
      <Method Name="Foo" Access="Public" Signature="void Foo(int a = 1)"><Arg Type="int" Value="1"/></Method>
      <Method Name="New" Access="Public" Type="PureVirtual" Signature="void New()"/>
    </Class>
  </File></Interfaces></Framework></W>)xml";

// Without a report element the walk still runs to the end and logs, but
// records nothing.
TEST(FrameworkComparisonTest, WalksAndLogsWithoutAReport) {
  auto reference = Parse(kReference);
  auto checked = Parse(kChecked);
  OnlyFlaggedFiles = 1;
  QEXVBTXMLNode* report = nullptr;
  testing::internal::CaptureStdout();
  testing::internal::CaptureStderr();
  EXPECT_EQ(CompareFrameworks(reference.get(), checked.get(), report), 0);
  ZORout.flush();
  ZORerr.flush();
  EXPECT_EQ(testing::internal::GetCapturedStdout(), "Checking : F\n");
  EXPECT_EQ(testing::internal::GetCapturedStderr(),
            "  No signature found for method (ref) : NoSig\n"
            "  No signature found for method (ref) : NoSig\n"
            "  No Type found for method (ref) : NoSig\n"
            "  No Type found for method (ref) : Foo\n"
            "  No Type found for method (check) : Foo\n");
  OnlyFlaggedFiles = 0;
}

TEST(FrameworkComparisonTest, ClassRulesAcceptNullElements) {
  auto reference = Parse(kReference);
  auto report = QEXVBTXMLNode::CreateNode("Class");
  ReportMirror reportClass(report.get());
  EXPECT_EQ(CompareMethods(nullptr, reference.get(), reportClass), 1);
  EXPECT_EQ(CompareMethods(reference.get(), nullptr, reportClass), 1);
  EXPECT_EQ(CheckNewPureVirtualMethods(nullptr, reference.get(), reportClass), 0);
  EXPECT_EQ(report->getFirstNodePosition(), nullptr);
}

// Framework pairs may be compared on several threads: the report and the log
// lines must still come in reference order.
TEST(FrameworkComparisonTest, KeepsReferenceOrderAcrossManyFrameworks) {
  std::string reference = "<W>";
  std::string checked = "<W>";
  std::string expectedLog;
  for (int i = 0; i < 40; ++i) {
    const std::string name = std::to_string(i);
    // Every framework but each fifth has a counterpart and a deleted file.
    reference.append("<Framework Name=\"F").append(name).append("\">");
    reference.append("<Interfaces Name=\"Public\"><File Name=\"F").append(name);
    reference.append(".h\" Aut=\"Y\"/></Interfaces></Framework>");
    if (i % 5 == 4) continue;
    checked.append("<Framework Name=\"F").append(name).append("\"/>");
    expectedLog.append("Checking : F").append(name).append("\n");
  }
  auto referenceDocument = Parse((reference + "</W>").c_str());
  auto checkedDocument = Parse((checked + "</W>").c_str());
  auto root = QEXVBTXMLNode::CreateNode("XmlDiff");
  QEXVBTXMLNode* report = root.get();
  testing::internal::CaptureStdout();
  CompareFrameworks(referenceDocument.get(), checkedDocument.get(), report);
  ZORout.flush();
  EXPECT_EQ(testing::internal::GetCapturedStdout(), expectedLog);
  std::string names;
  QEXVBTXMLPosition position = root->getFirstNodePosition();
  while (position != nullptr) names += root->getNextNode(position)->getAttributeValue("Name");
  EXPECT_EQ(names,
            "F0F1F2F3F5F6F7F8F10F11F12F13F15F16F17F18F20F21F22F23F25F26F27F28F30F31F32F33"
            "F35F36F37F38");
}

}  // namespace
