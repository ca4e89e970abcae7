#include "documents/ReportDocument.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <cstdio>
#include <fstream>
#include <iterator>
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

TEST(PruneReportTest, ChildlessElementStaysOnlyWhenItIsAnError) {
  auto error = QEXVBTXMLNode::CreateNode("Error");
  EXPECT_TRUE(PruneReport(error.get()));
  auto file = QEXVBTXMLNode::CreateNode("File");
  EXPECT_FALSE(PruneReport(file.get()));
}

TEST(PruneReportTest, KeepsOnlyTheBranchesLeadingToAnError) {
  auto framework = QEXVBTXMLNode::CreateNode("Framework");
  QEXVBTXMLNode* publicGroup = Add(framework.get(), "Interfaces");
  Add(Add(publicGroup, "File"), "Class");
  QEXVBTXMLNode* file = Add(publicGroup, "File");
  Add(file, "Class");
  QEXVBTXMLNode* klass = Add(file, "Class");
  Add(klass, "Method");
  Add(Add(Add(klass, "Method"), "Arg"), "Error");
  Add(klass, "Method");
  Add(file, "Class");
  Add(framework.get(), "Interfaces");

  EXPECT_TRUE(PruneReport(framework.get()));
  EXPECT_EQ(Shape(*framework), "Framework[Interfaces[File[Class[Method[Arg[Error]]]]]]");
}

TEST(PruneReportTest, ElementWithoutSurvivingChildrenLosesThemAll) {
  auto framework = QEXVBTXMLNode::CreateNode("Framework");
  Add(Add(framework.get(), "Interfaces"), "File");
  Add(framework.get(), "Interfaces");
  EXPECT_FALSE(PruneReport(framework.get()));
  EXPECT_EQ(Shape(*framework), "Framework");
}

TEST(PruneReportTest, ErrorWithChildrenCountsOnlyThroughThem) {
  auto file = QEXVBTXMLNode::CreateNode("File");
  Add(Add(file.get(), "Error"), "Note");
  EXPECT_FALSE(PruneReport(file.get()));
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

class FinishReportTest : public ::testing::Test {
 protected:
  void SetUp() override {
    char pattern[] = "/tmp/zor2report_XXXXXX";
    ASSERT_NE(mkdtemp(pattern), nullptr);
    directory_ = pattern;
  }
  void TearDown() override {
    std::remove(path().c_str());
    rmdir(directory_.c_str());
  }
  std::string path() const { return directory_ + "/out.xml"; }
  std::string Written() const {
    std::ifstream in(path(), std::ios::binary);
    return std::string(std::istreambuf_iterator<char>(in), {});
  }

  std::string directory_;
};

TEST_F(FinishReportTest, ReportWithoutFindingsIsTheBareRoot) {
  auto root = QEXVBTXMLNode::CreateNode("XmlDiff");
  Add(Add(root.get(), "Framework"), "Interfaces");
  Add(root.get(), "Framework");
  std::string error;
  ASSERT_EQ(FinishReport(*root, path().c_str(), error), 0) << error;
  EXPECT_EQ(Written(), "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<XmlDiff/>\n");
}

TEST_F(FinishReportTest, EscapesEveryValueOfTheKeptBranches) {
  auto root = QEXVBTXMLNode::CreateNode("XmlDiff");
  QEXVBTXMLNode* framework = Add(root.get(), "Framework");
  framework->setAttributeValue("Name", "A&B <\"x\">");
  Add(framework, "Error")->setAttributeValue("Help", "one<BR>two");
  std::string error;
  ASSERT_EQ(FinishReport(*root, path().c_str(), error), 0) << error;
  EXPECT_EQ(Written(),
            "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
            "<XmlDiff>\n"
            "  <Framework Name=\"A&amp;B &lt;&quot;x&quot;&gt;\">\n"
            "    <Error Help=\"one&lt;BR&gt;two\"/>\n"
            "  </Framework>\n"
            "</XmlDiff>\n");
}

TEST_F(FinishReportTest, UnwritablePathGivesTheReason) {
  auto root = QEXVBTXMLNode::CreateNode("XmlDiff");
  std::string error;
  std::string missing = directory_ + "/missing/out.xml";
  EXPECT_NE(FinishReport(*root, missing.c_str(), error), 0);
  EXPECT_FALSE(error.empty());
}

}  // namespace
