#include "platform/xml/QEXVBTXMLNode.h"

#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <filesystem>
#include <iterator>
#include <string>
#include <vector>

#include "platform/tools/XMLString.h"
#include "tests/TempDir.h"

namespace {

std::unique_ptr<QEXVBTXMLNode> Parse(std::string_view text) {
  XMLReadError error;
  std::unique_ptr<QEXVBTXMLNode> root = QEXVBTXMLNode::CreateFromText(text, error);
  EXPECT_NE(root, nullptr) << error.reason;
  return root;
}

std::string Written(const QEXVBTXMLNode& node) {
  std::string text;
  node.writeTo(text);
  return text;
}

std::vector<std::string> ChildTags(const QEXVBTXMLNode& node) {
  std::vector<std::string> tags;
  QEXVBTXMLPosition position = node.getFirstNodePosition();
  while (QEXVBTXMLNode* child = node.getNextNode(position)) tags.push_back(child->getTag());
  return tags;
}

// An element type of its own, as the report's error elements are.
class CountedNode : public QEXVBTXMLNode {
 public:
  explicit CountedNode(int& alive) : QEXVBTXMLNode("Counted"), alive_(alive) { ++alive_; }
  ~CountedNode() override { --alive_; }

 private:
  int& alive_;
};

TEST(QEXVBTXMLNodeTest, BuiltElementsKeepAttributeOrderAndReplaceInPlace) {
  auto node = QEXVBTXMLNode::CreateNode("File");
  node->setAttributeValue("Name", "a.h");
  node->setAttributeValue("@ZOR2Level", "L1");
  node->setAttributeValue("Aut", "Y");
  const char* aut = node->getAttributeValue("Aut");
  node->setAttributeValue("Name", "b.h");
  EXPECT_STREQ(node->getAttributeValue("Name"), "b.h");
  EXPECT_STREQ(aut, "Y");  // setting another attribute leaves this one's pointer valid
  EXPECT_EQ(Written(*node),
            "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
            "<File Name=\"b.h\" @ZOR2Level=\"L1\" Aut=\"Y\"/>\n");
}

TEST(QEXVBTXMLNodeTest, IterationSurvivesRemovalOfTheReturnedChild) {
  int alive = 0;
  auto root = QEXVBTXMLNode::CreateNode("r");
  for (int i = 0; i < 6; ++i) {
    auto child = std::make_unique<CountedNode>(alive);
    child->setAttributeValue("i", std::to_string(i).c_str());
    child->insertNodeAtEnd(std::make_unique<CountedNode>(alive));
    root->insertNodeAtEnd(std::move(child));
  }
  EXPECT_EQ(alive, 12);
  QEXVBTXMLPosition position = root->getFirstNodePosition();
  std::string kept;
  while (QEXVBTXMLNode* child = root->getNextNode(position)) {
    std::string i = child->getAttributeValue("i");
    if (i == "0" || i == "3" || i == "5") {
      root->removeNode(child);  // first, middle and last
    } else {
      kept += i;
    }
  }
  EXPECT_EQ(kept, "124");
  EXPECT_EQ(alive, 6);
  // The links stay consistent: appending after removing the last child.
  root->insertNodeAtEnd(QEXVBTXMLNode::CreateNode("end"));
  EXPECT_EQ(ChildTags(*root), (std::vector<std::string>{"Counted", "Counted", "Counted", "end"}));
  root.reset();
  EXPECT_EQ(alive, 0);
}

TEST(QEXVBTXMLNodeTest, DropsDeepAndWideTreesWithoutRecursion) {
  auto root = QEXVBTXMLNode::CreateNode("r");
  QEXVBTXMLNode* node = root.get();
  for (int i = 0; i < 100000; ++i) node = node->insertNodeAtEnd(QEXVBTXMLNode::CreateNode("e"));
  for (int i = 0; i < 100000; ++i) root->insertNodeAtEnd(QEXVBTXMLNode::CreateNode("s"));
  root.reset();
}

// Among a parsed element's children, parsed ones are found by a walk and
// built ones through their links; removal while iterating works for both.
TEST(QEXVBTXMLNodeTest, ParsedAndBuiltChildrenMix) {
  int alive = 0;
  auto root = Parse("<r><p1/><p2/><p3/></r>");
  ASSERT_NE(root, nullptr);
  root->insertNodeAtEnd(std::make_unique<CountedNode>(alive));
  root->insertNodeAtEnd(QEXVBTXMLNode::CreateNode("b2"));
  QEXVBTXMLPosition position = root->getFirstNodePosition();
  while (QEXVBTXMLNode* child = root->getNextNode(position)) {
    std::string tag = child->getTag();
    if (tag == "p1" || tag == "p3" || tag == "Counted") root->removeNode(child);
  }
  EXPECT_EQ(alive, 0);
  EXPECT_EQ(ChildTags(*root), (std::vector<std::string>{"p2", "b2"}));
  root->insertNodeAtEnd(QEXVBTXMLNode::CreateNode("b3"));
  position = root->getFirstNodePosition();
  QEXVBTXMLNode* p2 = root->getNextNode(position);
  root->removeNode(root->getNextNode(position));
  p2->removeNode(p2);  // not a child of its own: ignored
  root->removeNode(p2);
  root->insertNodeAtEnd(QEXVBTXMLNode::CreateNode("b4"));
  EXPECT_EQ(ChildTags(*root), (std::vector<std::string>{"b3", "b4"}));
}

int Longer(std::string_view value, std::string& out) {
  if (value != "long") return 0;
  out = "QEXLONG32";
  return 1;
}

TEST(QEXVBTXMLNodeTest, ChangeAttributeValuesRewritesEveryValue) {
  auto root = Parse(
      "<r v='1'><a v='2' t=\"long\" n='a &amp; b' w='long'><b v='3'/></a><c v='4' t='long'/></r>");
  ASSERT_NE(root, nullptr);
  QEXVBTXMLPosition position = root->getFirstNodePosition();
  QEXVBTXMLNode* a = root->getNextNode(position);
  const char* before = a->getAttributeValue("v");
  changeAttributeValues(root.get(), Longer);           // grows: moved out of the block
  changeAttributeValues(root.get(), decodeXMLString);  // shrinks: rewritten in place
  EXPECT_STREQ(before, "2");
  EXPECT_EQ(Written(*root),
            "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<r v=\"1\">\n"
            "  <a v=\"2\" t=\"QEXLONG32\" n=\"a & b\" w=\"QEXLONG32\">\n    <b v=\"3\"/>\n  </a>\n"
            "  <c v=\"4\" t=\"QEXLONG32\"/>\n</r>\n");

  // A pass over part of a document keeps grown values in its elements.
  auto other = Parse("<r><a t='long'/></r>");
  position = other->getFirstNodePosition();
  QEXVBTXMLNode* part = other->getNextNode(position);
  changeAttributeValues(part, Longer);
  EXPECT_STREQ(part->getAttributeValue("t"), "QEXLONG32");
}

// Every value grows: "+" and a digit per character are appended.
int Grow(std::string_view value, std::string& out) {
  out.assign(value);
  out += '+';
  out.append(value.size(), static_cast<char>('0' + value.size() % 10));
  return 1;
}

TEST(QEXVBTXMLNodeTest, GrownValuesFindRoomWhateverTheirSize) {
  // Values under three characters cannot point to a new home and have their
  // block rebuilt; longer ones move until the document's spare capacity is
  // used up, then have their block rebuilt too.
  const std::vector<std::string> values = {"", "x", "abc", "abcdefgh", std::string(40, 'v')};
  std::string text = "<r>";
  for (int i = 0; i < 20; ++i) {
    text += "<e";
    for (size_t v = 0; v < values.size(); ++v) {
      text.append(" a").append(std::to_string(v)).append("=\"").append(values[v]).append("\"");
    }
    text += "/>";
  }
  auto root = Parse(text + "</r>");
  ASSERT_NE(root, nullptr);
  for (int pass = 0; pass < 3; ++pass) changeAttributeValues(root.get(), Grow);
  std::vector<std::string> grown = values;
  for (std::string& value : grown) {
    for (int pass = 0; pass < 3; ++pass) Grow(std::string(value), value);
  }
  QEXVBTXMLPosition position = root->getFirstNodePosition();
  while (QEXVBTXMLNode* e = root->getNextNode(position)) {
    for (size_t v = 0; v < values.size(); ++v) {
      const std::string name = std::string("a").append(std::to_string(v));
      EXPECT_EQ(e->getAttributeValue(name.c_str()), grown[v]);
    }
  }
}

TEST(QEXVBTXMLNodeTest, RewrittenValuesEndAtAZeroByte) {
  auto root = Parse("<r a='abcdef' b='x'/>");
  changeAttributeValues(root.get(), [](std::string_view value, std::string& out) {
    if (value != "abcdef") return 0;
    out = std::string("ab\0cd", 5);
    return 1;
  });
  EXPECT_STREQ(root->getAttributeValue("a"), "ab");
  EXPECT_STREQ(root->getAttributeValue("b"), "x");
}

using WriteTest = TempDirTest;

// A regular file is replaced through a temporary beside it, which takes the
// file's mode and is gone afterwards; a link is written through, not replaced.
TEST_F(WriteTest, ReplacesFilesKeepingTheirModeAndWritesThroughLinks) {
  const std::string path = Write("out.xml", "old");
  const std::string link = Path("link.xml");
  ASSERT_EQ(chmod(path.c_str(), 0600), 0);
  ASSERT_EQ(symlink(path.c_str(), link.c_str()), 0);
  std::string error;
  ASSERT_EQ(QEXVBTXMLNode::CreateNode("new")->writeInFile(path.c_str(), error), 0) << error;
  struct stat status;
  ASSERT_EQ(stat(path.c_str(), &status), 0);
  EXPECT_EQ(status.st_mode & 07777, 0600u);
  EXPECT_EQ(Contents(path), "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<new/>\n");
  ASSERT_EQ(QEXVBTXMLNode::CreateNode("x")->writeInFile(link.c_str(), error), 0) << error;
  ASSERT_EQ(lstat(link.c_str(), &status), 0);
  EXPECT_TRUE(S_ISLNK(status.st_mode));
  EXPECT_EQ(Contents(path), "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<x/>\n");
  EXPECT_EQ(std::distance(std::filesystem::directory_iterator(dir_), {}), 2);
}

}  // namespace
