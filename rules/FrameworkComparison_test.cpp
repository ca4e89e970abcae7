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
  EXPECT_EQ(CompareMethods(nullptr, reference.get(), report.get()), 1);
  EXPECT_EQ(CompareMethods(reference.get(), nullptr, report.get()), 1);
  EXPECT_EQ(CheckNewPureVirtualMethods(nullptr, reference.get(), report.get()), 0);
  EXPECT_EQ(report->getFirstNodePosition(), nullptr);
}

}  // namespace
