#include "rules/PairingIndex.h"

#include <gtest/gtest.h>

#include <memory>
#include <vector>

#include "platform/xml/QEXVBTXMLSearch.h"

namespace {

std::unique_ptr<QEXVBTXMLNode> Parse(const char* text) {
  XMLReadError error;
  auto document = QEXVBTXMLNode::CreateFromText(text, error);
  EXPECT_NE(document, nullptr) << error.reason;
  return document;
}

TEST(NameIndexTest, FindsTheFirstElementOfANameAndNeverANamelessOne) {
  auto document =
      Parse(R"xml(<F><C Name="a" n="1"/><C/><C Name="b"/><C Name="a" n="2"/><C Name=""/></F>)xml");
  QEXVBTXMLSearch query;
  query.setSearch({QEXVBTXMLSearch::SearchChildren, QEXVBTXMLSearch::TagIs, "C"});
  query.searchStart(document.get());
  const NameIndex index(query.matches());
  ASSERT_NE(index.Find("a"), nullptr);
  EXPECT_STREQ(index.Find("a")->getAttributeValue("n"), "1");
  EXPECT_EQ(index.Find("b"), query.matches()[2]);
  EXPECT_EQ(index.Find(""), query.matches()[4]);
  EXPECT_EQ(index.Find("A"), nullptr);
  EXPECT_EQ(index.Find(nullptr), nullptr);
}

// The index must answer exactly what a scan for the first SameMethod match
// answers, duplicates, overloads and incomplete records included.
TEST(MethodIndexTest, AgreesWithAFirstMatchScan) {
  auto document = Parse(R"xml(<C>
    <M Name="f" Access="Public"><Arg Type="int"/></M>
    <M Name="f" Access="Public"><Arg Type="long"/></M>
    <M Name="f" Access="Public" ReturnedType="x"><Arg Type="int"/></M>
    <M Name="f" Access="Protected"><Arg Type="int"/></M>
    <M Name="f" Access="Public"><Arg/></M>
    <M Name="f" Access="Public"><Arg Type=""/></M>
    <M Name="f" Access="Public"/>
    <M Name="f"><Arg Type="int"/></M>
    <M Access="Public"><Arg Type="int"/></M>
    <M Name="g" Access="Public"/>
    <M Name="f" Access="Public"><Arg/></M>
  </C>)xml");
  RecordList<MethodInfo> methods;
  QEXVBTXMLPosition position = document->getFirstNodePosition();
  while (position != nullptr) methods.push_back(BuildMethodInfo(*document->getNextNode(position)));

  const MethodIndex index(methods);
  for (const MethodInfo& m : methods) {
    size_t expected = MethodIndex::npos;
    for (size_t j = 0; j < methods.size() && expected == MethodIndex::npos; ++j) {
      if (SameMethod(m, methods[j])) expected = j;
    }
    EXPECT_EQ(index.Find(m), expected) << (m.name ? m.name : "(null)");
  }
  EXPECT_EQ(index.Find(methods[2]), 0u);
  EXPECT_EQ(index.Find(methods[10]), 4u);
  EXPECT_EQ(index.Find(methods[7]), MethodIndex::npos);
}

}  // namespace
