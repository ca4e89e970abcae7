#include "platform/xml/QEXVBTXMLNode.h"

#include <dirent.h>
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cstdlib>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

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
  EXPECT_STREQ(node->getTag(), "File");
  EXPECT_EQ(node->getAttributeValue("Name"), nullptr);
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

TEST(QEXVBTXMLNodeTest, WritesIndentedLayout) {
  auto root = QEXVBTXMLNode::CreateNode("XmlDiff");
  EXPECT_EQ(Written(*root), "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<XmlDiff/>\n");
  QEXVBTXMLNode* framework = root->insertNodeAtEnd(QEXVBTXMLNode::CreateNode("Framework"));
  framework->setAttributeValue("Name", "F");
  QEXVBTXMLNode* file = framework->insertNodeAtEnd(QEXVBTXMLNode::CreateNode("File"));
  file->insertNodeAtEnd(QEXVBTXMLNode::CreateNode("Error"))->setAttributeValue("ID", "FHBD");
  root->insertNodeAtEnd(QEXVBTXMLNode::CreateNode("Framework"))->setAttributeValue("Name", "G");
  EXPECT_EQ(Written(*root),
            "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
            "<XmlDiff>\n"
            "  <Framework Name=\"F\">\n"
            "    <File>\n"
            "      <Error ID=\"FHBD\"/>\n"
            "    </File>\n"
            "  </Framework>\n"
            "  <Framework Name=\"G\"/>\n"
            "</XmlDiff>\n");
  // A subtree is written alone, without its siblings.
  EXPECT_EQ(
      Written(*file),
      "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<File>\n  <Error ID=\"FHBD\"/>\n</File>\n");
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

TEST(QEXVBTXMLNodeTest, ParsedElementsTakeInsertedChildrenAndNewAttributes) {
  int alive = 0;
  auto root = Parse("<r><a x='1' y='2'/></r>");
  ASSERT_NE(root, nullptr);
  QEXVBTXMLPosition position = root->getFirstNodePosition();
  QEXVBTXMLNode* a = root->getNextNode(position);
  const char* y = a->getAttributeValue("y");
  a->setAttributeValue("x", "changed");
  a->setAttributeValue("z", "3");
  a->insertNodeAtEnd(std::make_unique<CountedNode>(alive));
  EXPECT_STREQ(y, "2");
  EXPECT_EQ(Written(*root),
            "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<r>\n"
            "  <a x=\"changed\" y=\"2\" z=\"3\">\n    <Counted/>\n  </a>\n</r>\n");
  root.reset();
  EXPECT_EQ(alive, 0);
}

TEST(QEXVBTXMLNodeTest, ParsedAndBuiltChildrenMix) {
  int alive = 0;
  auto root = Parse("<r><p1/><p2/><p3/></r>");
  ASSERT_NE(root, nullptr);
  root->insertNodeAtEnd(std::make_unique<CountedNode>(alive));
  root->insertNodeAtEnd(QEXVBTXMLNode::CreateNode("b2"));
  // Removing while iterating: parsed children are found by a walk, built
  // ones through their links.
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
  QEXVBTXMLNode* b2 = root->getNextNode(position);
  root->removeNode(b2);
  p2->removeNode(p2);  // not a child of its own: ignored
  root->removeNode(p2);
  EXPECT_EQ(ChildTags(*root), std::vector<std::string>{"b3"});
  root->insertNodeAtEnd(QEXVBTXMLNode::CreateNode("b4"));
  EXPECT_EQ(ChildTags(*root), (std::vector<std::string>{"b3", "b4"}));
}

int Longer(std::string_view value, std::string& out) {
  if (value != "long") return 0;
  out = "QEXLONG32";
  return 1;
}

int Decode(std::string_view value, std::string& out) {
  if (value.find("&amp;") == std::string_view::npos) return 0;
  out = value;
  out.replace(out.find("&amp;"), 5, "&");
  return 1;
}

std::string visited;
int Record(std::string_view value, std::string&) {
  visited += value;
  return 0;
}

TEST(QEXVBTXMLNodeTest, ChangeAttributeValuesRewritesInDocumentOrder) {
  auto root = Parse(
      "<r v='1'><a v='2' t=\"long\" n='a &amp; b' w='long'><b v='3'/></a><c v='4' t='long'/></r>");
  ASSERT_NE(root, nullptr);
  visited.clear();
  changeAttributeValues(root.get(), Record);
  EXPECT_EQ(visited, "12longa &amp; blong34long");

  QEXVBTXMLPosition position = root->getFirstNodePosition();
  QEXVBTXMLNode* a = root->getNextNode(position);
  const char* before = a->getAttributeValue("v");
  changeAttributeValues(root.get(), Longer);  // grows: moved out of the block
  changeAttributeValues(root.get(), Decode);  // shrinks: rewritten in place
  EXPECT_STREQ(before, "2");
  EXPECT_EQ(Written(*root),
            "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<r v=\"1\">\n"
            "  <a v=\"2\" t=\"QEXLONG32\" n=\"a & b\" w=\"QEXLONG32\">\n    <b v=\"3\"/>\n  </a>\n"
            "  <c v=\"4\" t=\"QEXLONG32\"/>\n</r>\n");

  // A pass over part of a document, and over built elements.
  auto other = Parse("<r><a t='long'/></r>");
  position = other->getFirstNodePosition();
  QEXVBTXMLNode* part = other->getNextNode(position);
  changeAttributeValues(part, Longer);
  EXPECT_STREQ(part->getAttributeValue("t"), "QEXLONG32");
  auto built = QEXVBTXMLNode::CreateNode("b");
  built->setAttributeValue("t", "long");
  changeAttributeValues(built.get(), Longer);
  EXPECT_STREQ(built->getAttributeValue("t"), "QEXLONG32");
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
  QEXVBTXMLPosition position = root->getFirstNodePosition();
  while (QEXVBTXMLNode* e = root->getNextNode(position)) {
    for (size_t v = 0; v < values.size(); ++v) {
      std::string expected = values[v];
      for (int pass = 0; pass < 3; ++pass) {
        std::string before = expected;
        Grow(before, expected);
      }
      std::string name = "a";
      name += std::to_string(v);
      EXPECT_EQ(e->getAttributeValue(name.c_str()), expected);
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

class WriteTest : public ::testing::Test {
 protected:
  void SetUp() override {
    char pattern[] = "/tmp/xmlwrite_testXXXXXX";
    ASSERT_NE(mkdtemp(pattern), nullptr);
    dir_ = pattern;
  }
  void TearDown() override { std::system(("rm -rf " + dir_).c_str()); }
  std::vector<std::string> Entries() const {
    std::vector<std::string> names;
    DIR* dir = opendir(dir_.c_str());
    while (dirent* entry = readdir(dir)) {
      if (entry->d_name[0] != '.') names.push_back(entry->d_name);
    }
    closedir(dir);
    return names;
  }
  static std::string Contents(const std::string& path) {
    std::ifstream in(path);
    std::stringstream text;
    text << in.rdbuf();
    return text.str();
  }
  std::string dir_;
};

TEST_F(WriteTest, RoundTripsThroughAFile) {
  auto root = QEXVBTXMLNode::CreateNode("XmlDiff");
  QEXVBTXMLNode* file = root->insertNodeAtEnd(QEXVBTXMLNode::CreateNode("File"));
  file->setAttributeValue("Name", "a&amp;b.h");
  file->setAttributeValue("@ZOR2Level", "L1");
  file->setAttributeValue("@ZOR2Usage", "U2");
  file->insertNodeAtEnd(QEXVBTXMLNode::CreateNode("Error"))
      ->setAttributeValue("Help", "&lt;BR&gt;");
  std::string path = dir_ + "/out.xml";
  std::string error;
  ASSERT_EQ(root->writeInFile(path.c_str(), error), 0) << error;
  XMLReadError read_error;
  auto back = QEXVBTXMLNode::CreateFromFile(path.c_str(), read_error);
  ASSERT_NE(back, nullptr) << read_error.reason;
  EXPECT_EQ(Written(*back), Written(*root));
  EXPECT_EQ(Contents(path), Written(*root));
}

TEST_F(WriteTest, ReplacesRegularFilesKeepingTheirMode) {
  std::string path = dir_ + "/out.xml";
  std::ofstream(path) << "old";
  chmod(path.c_str(), 0600);
  std::string error;
  ASSERT_EQ(QEXVBTXMLNode::CreateNode("new")->writeInFile(path.c_str(), error), 0) << error;
  struct stat status;
  ASSERT_EQ(stat(path.c_str(), &status), 0);
  EXPECT_EQ(status.st_mode & 07777, 0600u);
  EXPECT_EQ(Contents(path), "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<new/>\n");
  EXPECT_EQ(Entries(), std::vector<std::string>{"out.xml"});  // no temporary left
}

TEST_F(WriteTest, WritesThroughLinksAndDevices) {
  std::string target = dir_ + "/target.xml";
  std::string link = dir_ + "/link.xml";
  std::ofstream(target) << "old";
  ASSERT_EQ(symlink(target.c_str(), link.c_str()), 0);
  std::string error;
  ASSERT_EQ(QEXVBTXMLNode::CreateNode("new")->writeInFile(link.c_str(), error), 0) << error;
  struct stat status;
  ASSERT_EQ(lstat(link.c_str(), &status), 0);
  EXPECT_TRUE(S_ISLNK(status.st_mode));
  EXPECT_EQ(Contents(target), "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<new/>\n");
  EXPECT_EQ(QEXVBTXMLNode::CreateNode("x")->writeInFile("/dev/null", error), 0);
}

TEST_F(WriteTest, ReportsWriteFailures) {
  std::string error;
  EXPECT_NE(QEXVBTXMLNode::CreateNode("x")->writeInFile("/dev/full", error), 0);
  EXPECT_EQ(error, "No space left on device");
  std::string missing = dir_ + "/missing/out.xml";
  EXPECT_NE(QEXVBTXMLNode::CreateNode("x")->writeInFile(missing.c_str(), error), 0);
  EXPECT_EQ(error, "No such file or directory");
  EXPECT_NE(QEXVBTXMLNode::CreateNode("x")->writeInFile(dir_.c_str(), error), 0);
  EXPECT_EQ(error, "Is a directory");
  EXPECT_TRUE(Entries().empty());
}

}  // namespace
