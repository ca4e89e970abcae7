#include "describe/type_spelling.h"

#include <gtest/gtest.h>

namespace zor2::describe {
namespace {

TemplateParameters OneClassTemplateAndOneMember() {
  return TemplateParameters({{{"T", "T1", false}, {"N", "T2", false}}, {{"Stream", "U1", true}}});
}

TEST(TemplateParameters, NamesEachParameterByItsPosition) {
  const TemplateParameters parameters = OneClassTemplateAndOneMember();
  EXPECT_EQ(parameters.Rename("const type-parameter-0-0 &"), "const T1 &");
  EXPECT_EQ(parameters.Rename("array<type-parameter-0-0, N>"), "array<T1, T2>");
  EXPECT_EQ(parameters.Rename("const Stream &..."), "const U1 &...");
  // A member of the same name, a longer word and a literal are left alone.
  EXPECT_EQ(parameters.Rename("typename type-parameter-1-0::T"), "typename U1::T");
  EXPECT_EQ(parameters.Rename("decltype(x.N + NN)"), "decltype(x.N + NN)");
  EXPECT_EQ(parameters.Rename("f(\"T\", 'N')"), "f(\"T\", 'N')");
  EXPECT_EQ(parameters.Rename("type-parameter-0-0x"), "type-parameter-0-0x");
}

TEST(TemplateParameters, WritesCompilerNamesAsDeclared) {
  const TemplateParameters parameters = OneClassTemplateAndOneMember();
  EXPECT_EQ(parameters.Written("Box<type-parameter-0-0 *, 3> &"), "Box<T *, 3> &");
  EXPECT_EQ(parameters.Written("type-parameter-5-0"), "Y1");
  EXPECT_EQ(TemplateParameters::PositionalName(8, 1), "T9_2");
}

TEST(WithStandardNames, UsesTheUsualNamesOfWholeNamesOnly) {
  EXPECT_EQ(WithStandardNames("const std::basic_string<char> &"), "const std::string &");
  EXPECT_EQ(WithStandardNames("std::map<std::basic_string<char>, std::basic_string<wchar_t>>"),
            "std::map<std::string, std::wstring>");
  EXPECT_EQ(WithStandardNames("std::__cxx11::list<int>"), "std::list<int>");
  EXPECT_EQ(WithStandardNames("mystd::basic_string<char>"), "mystd::basic_string<char>");
  EXPECT_EQ(WithStandardNames("_IO_FILE *"), "FILE *");
}

TEST(WithoutTopLevelQualifiers, DropsOnlyTheQualifiersOfTheTypeItself) {
  EXPECT_EQ(WithoutTopLevelQualifiers("const int", false), "int");
  EXPECT_EQ(WithoutTopLevelQualifiers("const volatile std::string", false), "std::string");
  EXPECT_EQ(WithoutTopLevelQualifiers("const char *const", true), "const char *");
  EXPECT_EQ(WithoutTopLevelQualifiers("int *const volatile", true), "int *");
  EXPECT_EQ(WithoutTopLevelQualifiers("constant_t", false), "constant_t");
  EXPECT_EQ(WithoutTopLevelQualifiers("my_const", true), "my_const");
}

}  // namespace
}  // namespace zor2::describe
