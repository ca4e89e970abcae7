#include "rules/method_records.h"

#include <gtest/gtest.h>

#include <memory>
#include <string_view>
#include <vector>

#include "tests/test_util.h"

namespace zor2 {
namespace {

// The records of the "Method" children of a "Class" document.
class MethodRecordsTest : public ::testing::Test {
 protected:
  std::vector<MethodRecord> Read(std::string_view text) {
    document_ = testing::Parse(text);
    std::vector<MethodRecord> methods;
    for (const xml::Element* e = document_->root().first_child(); e; e = e->next_sibling()) {
      methods.push_back(ReadMethod(*e));
    }
    return methods;
  }
  std::unique_ptr<xml::Document> document_;
};

// What each attribute means to the rules is in the end-to-end cases
// (rules_methods_*); here, which children are the arguments.
TEST_F(MethodRecordsTest, ArgumentsAreTheDirectArgChildrenInOrder) {
  auto m = Read(R"xml(<Class><Method Name="Get">
      <Arg Type="long" Name="a" Value="0" Retval=""/>
      <Other Type="skipped"/>
      <Arg Type="int"><Arg Type="nested"/></Arg>
    </Method></Class>)xml");
  ASSERT_EQ(m.size(), 1u);
  ASSERT_EQ(m[0].args.size(), 2u);
  EXPECT_STREQ(m[0].args[0].type, "long");
  EXPECT_STREQ(m[0].args[0].name, "a");
  EXPECT_STREQ(m[0].args[0].value, "0");
  EXPECT_NE(m[0].args[0].retval, nullptr);
  EXPECT_STREQ(m[0].args[1].type, "int");
  EXPECT_EQ(m[0].args[1].name, nullptr);
  EXPECT_EQ(m[0].args[1].value, nullptr);
  EXPECT_EQ(m[0].args[1].retval, nullptr);
}

// How deprecation values are read is in attribute_values_test.
TEST_F(MethodRecordsTest, DefaultsPropertyAndDeprecation) {
  auto m = Read(
      R"xml(<Class><Method Name="A"/><Method Name="B" Property="" Deprecated="M4R7"/></Class>)xml");
  ASSERT_EQ(m.size(), 2u);
  EXPECT_EQ(m[0].property, 'N');
  EXPECT_EQ(m[0].deprecated, 0);
  EXPECT_EQ(m[1].property, '\0');
  EXPECT_EQ(m[1].deprecated, 7);
}

TEST_F(MethodRecordsTest, OptionalTextPredicatesAreThreeWay) {
  auto m = Read(R"xml(<Class>
    <Method Name="A" ReturnedType="int"><Arg Type="int" Value="1"/><Arg/></Method>
    <Method Name="B" ReturnedType="int"><Arg Type="int" Value="1"/><Arg/></Method>
    <Method Name="C" ReturnedType="long"><Arg Type="long" Value="2"/><Arg Type="" Value=""/></Method>
    <Method Name="D"><Arg/><Arg/></Method>
  </Class>)xml");
  ASSERT_EQ(m.size(), 4u);
  EXPECT_TRUE(SameReturnedType(m[0], m[1]));
  EXPECT_FALSE(SameReturnedType(m[0], m[2]));
  EXPECT_FALSE(SameReturnedType(m[0], m[3]));
  EXPECT_TRUE(SameReturnedType(m[3], m[3]));

  EXPECT_TRUE(SameArgType(m[0].args[0], m[1].args[0]));
  EXPECT_FALSE(SameArgType(m[0].args[0], m[2].args[0]));
  EXPECT_TRUE(SameArgType(m[0].args[1], m[3].args[1]));   // both absent
  EXPECT_FALSE(SameArgType(m[0].args[1], m[2].args[1]));  // absent against empty
  EXPECT_FALSE(SameArgType(m[2].args[1], m[0].args[1]));

  EXPECT_TRUE(SameDefaultValue(m[0].args[0], m[1].args[0]));
  EXPECT_FALSE(SameDefaultValue(m[0].args[0], m[2].args[0]));
  EXPECT_TRUE(SameDefaultValue(m[0].args[1], m[3].args[1]));
  EXPECT_FALSE(SameDefaultValue(m[0].args[1], m[2].args[1]));
  EXPECT_FALSE(SameDefaultValue(m[2].args[1], m[0].args[1]));
}

TEST_F(MethodRecordsTest, SameMethodIsNameAccessAndArgumentTypes) {
  auto m = Read(R"xml(<Class>
    <Method Name="F" Access="Public" ReturnedType="int" Property="P"><Arg Type="int" Name="x"/></Method>
    <Method Name="F" Access="Public" ReturnedType="long" @nodoc="" Type="PureVirtual">
      <Arg Type="int" Name="y" Value="3" Retval=""/></Method>
    <Method Name="F" Access="Public"><Arg Type="long"/></Method>
    <Method Name="F" Access="Protected"><Arg Type="int"/></Method>
    <Method Name="F" Access="Public"><Arg Type="int"/><Arg Type="int"/></Method>
    <Method Name="G" Access="Public"><Arg Type="int"/></Method>
    <Method Name="F"><Arg Type="int"/></Method>
    <Method Access="Public"><Arg Type="int"/></Method>
    <Method Name="F" Access="Public"><Arg/></Method>
  </Class>)xml");
  ASSERT_EQ(m.size(), 9u);
  EXPECT_TRUE(SameMethod(m[0], m[1]));   // only non-identity attributes differ
  EXPECT_FALSE(SameMethod(m[0], m[2]));  // overload on an argument type
  EXPECT_FALSE(SameMethod(m[0], m[3]));  // access
  EXPECT_FALSE(SameMethod(m[0], m[4]));  // argument count
  EXPECT_FALSE(SameMethod(m[0], m[5]));  // name
  EXPECT_FALSE(SameMethod(m[6], m[6]));  // no access: not even itself
  EXPECT_FALSE(SameMethod(m[7], m[7]));  // no name: not even itself
  EXPECT_FALSE(SameMethod(m[0], m[8]));  // a typed argument against an untyped one
  EXPECT_TRUE(SameMethod(m[8], m[8]));   // untyped arguments are alike
}

}  // namespace
}  // namespace zor2
