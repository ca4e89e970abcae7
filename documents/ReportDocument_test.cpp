#include "documents/ReportDocument.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>

namespace {

QEXVBTXMLNode* Add(QEXVBTXMLNode* parent, const char* tag) {
  return parent->insertNodeAtEnd(QEXVBTXMLNode::CreateNode(tag));
}

// The tags of the tree in document order, nesting shown by brackets.
std::string Shape(const QEXVBTXMLNode& element) {
  std::string shape = element.getTag();
  QEXVBTXMLPosition position = element.getFirstNodePosition();
  if (position == nullptr) return shape;
  shape += "[";
  bool first = true;
  while (position != nullptr) {
    if (!first) shape += " ";
    first = false;
    shape += Shape(*element.getNextNode(position));
  }
  return shape + "]";
}

TEST(PruneReportTest, KeepsOnlyTheBranchesLeadingToAnError) {
  // A childless element stays exactly when it is an error; an error with
  // children stays only through them.
  EXPECT_TRUE(PruneReport(QEXVBTXMLNode::CreateNode("Error").get()));
  EXPECT_FALSE(PruneReport(QEXVBTXMLNode::CreateNode("File").get()));
  auto file = QEXVBTXMLNode::CreateNode("File");
  Add(Add(file.get(), "Error"), "Note");
  EXPECT_FALSE(PruneReport(file.get()));
  EXPECT_EQ(Shape(*file), "File");

  auto framework = QEXVBTXMLNode::CreateNode("Framework");
  QEXVBTXMLNode* publicGroup = Add(framework.get(), "Interfaces");
  Add(Add(publicGroup, "File"), "Class");
  QEXVBTXMLNode* kept = Add(publicGroup, "File");
  Add(kept, "Class");
  QEXVBTXMLNode* klass = Add(kept, "Class");
  Add(klass, "Method");
  Add(Add(Add(klass, "Method"), "Arg"), "Error");
  Add(klass, "Method");
  Add(kept, "Class");
  Add(framework.get(), "Interfaces");
  EXPECT_TRUE(PruneReport(framework.get()));
  EXPECT_EQ(Shape(*framework), "Framework[Interfaces[File[Class[Method[Arg[Error]]]]]]");
}

TEST(PruneReportTest, HandlesVeryDeepReports) {
  const int depth = 200000;
  auto kept = QEXVBTXMLNode::CreateNode("Framework");
  auto dropped = QEXVBTXMLNode::CreateNode("Framework");
  QEXVBTXMLNode* keptTip = kept.get();
  QEXVBTXMLNode* droppedTip = dropped.get();
  for (int i = 0; i < depth; ++i) {
    keptTip = Add(keptTip, "Class");
    droppedTip = Add(droppedTip, "Class");
  }
  Add(keptTip, "Error");
  EXPECT_TRUE(PruneReport(kept.get()));
  EXPECT_FALSE(PruneReport(dropped.get()));
  EXPECT_EQ(dropped->getFirstNodePosition(), nullptr);
}

}  // namespace
