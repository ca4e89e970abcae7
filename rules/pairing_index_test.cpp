#include "rules/pairing_index.h"

#include <gtest/gtest.h>

#include <memory>
#include <vector>

#include "tests/test_util.h"

// NameIndex, which pairs files and classes, is covered by the end-to-end
// cases rules_files_pairing and rules_classes_pairing.

namespace zor2 {
namespace {

// The index must answer exactly what a scan for the first SameMethod match
// answers, duplicates, overloads and incomplete records included.
TEST(MethodIndexTest, AgreesWithAFirstMatchScan) {
  const char* text = R"xml(<C>
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
  </C>)xml";
  auto document = testing::Parse(text);
  std::vector<MethodRecord> methods;
  for (const xml::Element* e = document->root().first_child(); e; e = e->next_sibling()) {
    methods.push_back(ReadMethod(*e));
  }

  const MethodIndex index(methods);
  for (const MethodRecord& m : methods) {
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
}  // namespace zor2
