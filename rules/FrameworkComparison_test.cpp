#include "rules/FrameworkComparison.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "platform/tools/ZOROFStream.h"

namespace {

std::unique_ptr<QEXVBTXMLNode> Parse(const char* text) {
  XMLReadError error;
  auto document = QEXVBTXMLNode::CreateFromText(text, error);
  EXPECT_NE(document, nullptr) << error.reason;
  return document;
}

// Framework pairs may be compared on several threads: the report and the log
// lines must still come in reference order.
TEST(FrameworkComparisonTest, KeepsReferenceOrderAcrossManyFrameworks) {
  std::string reference = "<W>";
  std::string checked = "<W>";
  std::string expectedLog;
  std::string expectedNames;
  for (int i = 0; i < 40; ++i) {
    const std::string name = std::to_string(i);
    // Every framework but each fifth has a counterpart and a deleted file.
    reference.append("<Framework Name=\"F").append(name).append("\">");
    reference.append("<Interfaces Name=\"Public\"><File Name=\"F").append(name);
    reference.append(".h\" Aut=\"Y\"/></Interfaces></Framework>");
    if (i % 5 == 4) continue;
    checked.append("<Framework Name=\"F").append(name).append("\"/>");
    expectedLog.append("Checking : F").append(name).append("\n");
    expectedNames.append("F").append(name);
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
  EXPECT_EQ(names, expectedNames);
}

}  // namespace
