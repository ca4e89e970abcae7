#include "rules/pairing_index.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "tests/test_util.h"

// NameIndex, which pairs files and classes, is covered by the end-to-end
// cases rules_files_pairing and rules_classes_pairing.

namespace zor2 {
namespace {

// The index must answer exactly what a scan of the list answers: the first
// SameMethod match with the same signature, else the first SameMethod match;
// duplicates, const twins, overloads and incomplete records included.
TEST(MethodIndexTest, AgreesWithAScanOfTheList) {
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
    <M Name="t" Access="Public" Signature="T* t()" ReturnedType="T*"/>
    <M Name="t" Access="Public" Signature="const T* t() const" ReturnedType="const T*"/>
    <M Name="t" Access="Public" Signature="const T* t() const" ReturnedType="const T*"/>
  </C>)xml";
  auto document = testing::Parse(text);
  std::vector<MethodRecord> methods;
  for (const xml::Element* e = document->root().first_child(); e; e = e->next_sibling()) {
    methods.push_back(ReadMethod(*e));
  }

  std::vector<const MethodRecord*> list;
  for (const MethodRecord& m : methods) list.push_back(&m);
  const MethodIndex index(list);
  for (const MethodRecord& m : methods) {
    size_t expected = MethodIndex::npos;
    for (size_t j = 0; j < methods.size() && expected == MethodIndex::npos; ++j) {
      if (SameMethod(m, methods[j]) && m.signature && methods[j].signature &&
          std::string(m.signature) == methods[j].signature) {
        expected = j;
      }
    }
    for (size_t j = 0; j < methods.size() && expected == MethodIndex::npos; ++j) {
      if (SameMethod(m, methods[j])) expected = j;
    }
    EXPECT_EQ(index.Find(m), expected) << (m.name ? m.name : "(null)");
  }
  EXPECT_EQ(index.Find(methods[2]), 0u);
  EXPECT_EQ(index.Find(methods[10]), 4u);
  EXPECT_EQ(index.Find(methods[7]), MethodIndex::npos);
  EXPECT_EQ(index.Find(methods[12]), 12u);  // each const twin pairs with its own
  EXPECT_EQ(index.Find(methods[13]), 12u);
  EXPECT_EQ(index.Find(methods[11]), 11u);
}

}  // namespace
}  // namespace zor2
