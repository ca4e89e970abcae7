#include "rules/report_mirror.h"

#include <gtest/gtest.h>

#include <string>

#include "platform/tools/xml_escaping.h"
#include "tests/test_util.h"

namespace zor2 {
namespace {

// The chain to a finding is created when the finding is recorded, ancestors
// first, in the order in which the walk mirrored the elements; branches
// without a finding never appear, so the report never holds an empty branch.
TEST(ReportMirrorTest, CreatesOnlyTheChainsToFindingsInWalkOrder) {
  xml::OutputElement root("XmlDiff");
  ReportMirror report_root(&root);
  ReportMirror framework(report_root, "Framework");
  framework.CopyAttribute("Name", "F");
  framework.CopyAttribute("Missing", nullptr);
  {
    ReportMirror quiet(framework, "Class");
    quiet.CopyAttribute("Name", "Quiet");
    ReportMirror quiet_method(quiet, "Method");
  }
  ReportMirror cls(framework, "Class");
  cls.CopyAttribute("Name", "K");
  ReportMirror method(cls, "Method");
  MethodRecord record;
  record.name = "Foo";
  record.signature = "void Foo()";
  MirrorMethod(method, record);
  AddError(method, MessageCode::kMHBDM);
  AddError(cls, MessageCode::kCINMA);
  // An attribute given after the element exists goes to it at once.
  cls.CopyAttribute("Late", "yes");
  const MessageType& deleted = MessageTypeOf(MessageCode::kMHBDM);
  const MessageType& automation = MessageTypeOf(MessageCode::kCINMA);
  std::string help_deleted, help_automation;
  AppendEscaped(deleted.help, &help_deleted);
  AppendEscaped(automation.help, &help_automation);
  EXPECT_EQ(testing::Shape(root),
            "<XmlDiff>"
            "<Framework Name=\"F\">"
            "<Class Name=\"K\" Late=\"yes\">"
            "<Method Name=\"Foo\" Signature=\"void Foo()\">"
            "<Error ID=\"MHBDM\" FullName=\"Method Has Been Deleted or Modified\" Help=\"" +
                help_deleted +
                "\"/>"
                "</Method>"
                "<Error ID=\"CINMA\" FullName=\"Class Is No More Automation\" Help=\"" +
                help_automation +
                "\"/>"
                "</Class>"
                "</Framework>"
                "</XmlDiff>");
}

}  // namespace
}  // namespace zor2
