#include "platform/xml/QEXVBTXMLSearch.h"

#include <gtest/gtest.h>

#include <string>

namespace {

const char kDocument[] =
    "<Root>"
    "<Framework Name='F1'>"
    "<Interfaces Name='Public'><File Name='a.h' Aut='Y'/><Class Name='no'/><File "
    "Name='b.h'/></Interfaces>"
    "<Interfaces Name='Protected'><File Name='p.h' Aut='N'/></Interfaces>"
    "<Interfaces Name='Public'><File Name='c.h' Aut='Y'/></Interfaces>"
    "<Other><Interfaces Name='Public'><File Name='deep.h'/></Interfaces></Other>"
    "</Framework>"
    "<Framework Name='F2'/>"
    "</Root>";

// The "Name" values of all matches, joined with spaces.
std::string Names(QEXVBTXMLSearch& search, const QEXVBTXMLNode* start) {
  std::string names;
  QEXVBTXMLPosition position = search.searchStart(start);
  while (QEXVBTXMLNode* match = search.searchNext(position)) {
    names += names.empty() ? "" : " ";
    names += match->getAttributeValue("Name");
  }
  return names;
}

class QEXVBTXMLSearchTest : public ::testing::Test {
 protected:
  void SetUp() override {
    XMLReadError error;
    root_ = QEXVBTXMLNode::CreateFromText(kDocument, error);
    ASSERT_NE(root_, nullptr) << error.reason;
    QEXVBTXMLPosition position = root_->getFirstNodePosition();
    framework_ = root_->getNextNode(position);
  }
  std::unique_ptr<QEXVBTXMLNode> root_;
  QEXVBTXMLNode* framework_ = nullptr;
};

TEST_F(QEXVBTXMLSearchTest, FindsDirectChildrenByTagFromARestartablePosition) {
  QEXVBTXMLSearch search;
  search.setSearch({QEXVBTXMLSearch::SearchChildren, QEXVBTXMLSearch::TagIs, "Framework"});
  EXPECT_EQ(Names(search, root_.get()), "F1 F2");
  EXPECT_EQ(search.matches().size(), 2u);
  QEXVBTXMLPosition start = search.searchStart(root_.get());
  for (int round = 0; round < 2; ++round) {
    QEXVBTXMLPosition position = start;
    EXPECT_STREQ(search.searchNext(position)->getAttributeValue("Name"), "F1");
    EXPECT_STREQ(search.searchNext(position)->getAttributeValue("Name"), "F2");
    EXPECT_EQ(search.searchNext(position), nullptr);
  }
  search.setSearch({QEXVBTXMLSearch::SearchChildren, QEXVBTXMLSearch::TagIs, "File"});
  EXPECT_EQ(search.searchStart(root_.get()), nullptr);
  EXPECT_EQ(search.searchStart(nullptr), nullptr);
}

TEST_F(QEXVBTXMLSearchTest, FindsFilesOfNamedInterfaces) {
  QEXVBTXMLSearch search;
  search.setSearch({QEXVBTXMLSearch::SearchChildren, QEXVBTXMLSearch::TagIs, "Interfaces",
                    QEXVBTXMLSearch::AttrIs, "Name", "Public", QEXVBTXMLSearch::SearchChildren,
                    QEXVBTXMLSearch::TagIs, "File"});
  EXPECT_EQ(Names(search, framework_), "a.h b.h c.h");
  search.setSearch({QEXVBTXMLSearch::SearchChildren, QEXVBTXMLSearch::TagIs, "Interfaces",
                    QEXVBTXMLSearch::AttrIs, "Name", "Public", QEXVBTXMLSearch::SearchChildren,
                    QEXVBTXMLSearch::TagIs, "File", QEXVBTXMLSearch::HasAttr, "Aut"});
  EXPECT_EQ(Names(search, framework_), "a.h c.h");
}

}  // namespace
