#include "platform/xml/output_element.h"

#include <gtest/gtest.h>

#include <string>

namespace zor2::xml {
namespace {

std::string Written(const OutputElement& root) {
  std::string text;
  AppendDocument(root, &text);
  return text;
}

TEST(OutputElementTest, WritesAttributesInOrderEscapedAndIndented) {
  OutputElement root("XmlDiff");
  OutputElement* file = root.AddChild("File");
  file->SetAttribute("Name", "a<b>&\"c'\t\n\r");
  file->SetAttribute("@ZOR2Level", "L1");
  file->SetAttribute("Name", "A.h");  // replaced where it stands
  file->AddChild("Error")->SetAttribute("Help", "<BR>");
  root.AddChild("Framework");
  EXPECT_EQ(*file->FindAttribute("Name"), "A.h");
  EXPECT_EQ(file->FindAttribute("Aut"), nullptr);
  EXPECT_EQ(Written(root),
            "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
            "<XmlDiff>\n"
            "  <File Name=\"A.h\" @ZOR2Level=\"L1\">\n"
            "    <Error Help=\"&lt;BR&gt;\"/>\n"
            "  </File>\n"
            "  <Framework/>\n"
            "</XmlDiff>\n");
  OutputElement escaped("E");
  escaped.SetAttribute("v", "a<b>&\"c'\t\n\r");
  EXPECT_EQ(Written(escaped),
            "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
            "<E v=\"a&lt;b&gt;&amp;&quot;c&apos;&#9;&#10;&#13;\"/>\n");
}

}  // namespace
}  // namespace zor2::xml
