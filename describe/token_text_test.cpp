#include "describe/token_text.h"

#include <gtest/gtest.h>

namespace zor2::describe {
namespace {

TEST(JoinTokens, SameTokensGiveTheSameTextWhateverTheLayout) {
  EXPECT_EQ(JoinTokens({"f", "(", "1", ",", "a", "+", "b", ")"}), "f(1, a+b)");
  EXPECT_EQ(JoinTokens({"std", "::", "string", "(", "\"x  y\"", ")"}), "std::string(\"x  y\")");
  EXPECT_EQ(JoinTokens({"sizeof", "(", "Point", ")"}), "sizeof(Point)");
  EXPECT_EQ(JoinTokens({"{", "1", ",", "2", "}"}), "{1, 2}");
  EXPECT_EQ(JoinTokens({"nullptr"}), "nullptr");
  EXPECT_EQ(JoinTokens({}), "");
}

TEST(JoinTokens, KeepsApartTokensThatWouldRunTogether) {
  EXPECT_EQ(JoinTokens({"unsigned", "int", "(", "3", ")"}), "unsigned int(3)");
  EXPECT_EQ(JoinTokens({"a", "-", "-", "b"}), "a- -b");
  EXPECT_EQ(JoinTokens({"A", "<", "B", "<", "int", ">", ">", "(", ")"}), "A<B<int> >()");
  EXPECT_EQ(JoinTokens({"x", "<", "::", "y"}), "x< ::y");
  EXPECT_EQ(JoinTokens({"L", "\"w\""}), "L \"w\"");
  EXPECT_EQ(JoinTokens({"\"s\"", "sv"}), "\"s\" sv");
  EXPECT_EQ(JoinTokens({"1", "/", "*", "p"}), "1/ *p");
}

}  // namespace
}  // namespace zor2::describe
