#include "rules/ReportMirror.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "platform/tools/ZOROFStream.h"

namespace {

// The tree in document order: tags with their attributes, nesting shown by
// brackets.
std::string Shape(const QEXVBTXMLNode& element) {
  std::string text;
  element.writeTo(text);
  std::string shape;
  for (size_t start = text.find('\n') + 1; start < text.size();) {
    size_t end = text.find('\n', start);
    size_t indent = text.find_first_not_of(' ', start);
    shape += text.substr(indent, end - indent);
    start = end + 1;
  }
  return shape;
}

// The chain to a finding is created when the finding is recorded, ancestors
// first, in the order in which the walk mirrored the elements; branches
// without a finding never appear.
TEST(ReportMirrorTest, CreatesTheChainToEachFindingInWalkOrder) {
  auto root = QEXVBTXMLNode::CreateNode("XmlDiff");
  ReportMirror reportRoot(root.get());
  ReportMirror framework(reportRoot, "Framework");
  framework.CopyAttribute("Name", "F");
  framework.CopyAttribute("Missing", nullptr);
  {
    ReportMirror quiet(framework, "Class");
    quiet.CopyAttribute("Name", "Quiet");
  }
  ReportMirror cls(framework, "Class");
  cls.CopyAttribute("Name", "K");
  ReportMirror method(cls, "Method");
  MethodInfo info;
  info.name = "Foo";
  info.signature = "void Foo()";
  MirrorMethod(method, info);
  EXPECT_NE(AddError(method, "MHBDM"), nullptr);
  EXPECT_NE(AddError(cls, "CINMA"), nullptr);
  // An attribute given after the element exists goes to it at once.
  cls.CopyAttribute("Late", "yes");
  EXPECT_EQ(Shape(*root),
            "<XmlDiff>"
            "<Framework Name=\"F\">"
            "<Class Name=\"K\" Late=\"yes\">"
            "<Method Name=\"Foo\" Signature=\"void Foo()\">"
            "<Error ID=\"MHBDM\" FullName=\"Method Has Been Deleted or Modified\" Help=\"" +
                std::string(MessageTypeRegistry::Get().Find("MHBDM")->help) +
                "\"/>"
                "</Method>"
                "<Error ID=\"CINMA\" FullName=\"Class Is No More Automation\" Help=\"" +
                MessageTypeRegistry::Get().Find("CINMA")->help +
                "\"/>"
                "</Class>"
                "</Framework>"
                "</XmlDiff>");
}

TEST(ReportMirrorTest, RecordsNothingWithoutAReport) {
  ReportMirror reportRoot(nullptr);
  ReportMirror framework(reportRoot, "Framework");
  ReportMirror file(framework, "File");
  ZORout.flush();
  testing::internal::CaptureStdout();
  EXPECT_EQ(AddError(file, "NOSUCHCODE"), nullptr);
  EXPECT_EQ(file.Element(), nullptr);
  ZORout.flush();
  EXPECT_EQ(testing::internal::GetCapturedStdout(), "");
}

}  // namespace
