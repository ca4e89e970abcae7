#include "describe/comment_tags.h"

#include <gtest/gtest.h>

namespace zor2::describe {
namespace {

TEST(CommentsIn, FindsLineAndBlockCommentsButNotCommentMarkersInLiterals) {
  const std::string source =
      "// one\n"
      "const char* a = \"// not a comment\";\n"
      "char b = '/'; /* two\n still two */ int c = 1'000; // three \\\n continued\n"
      "const char* d = R\"x(/* raw )\" */)x\"; /* four */\n"
      "const char* e = u8R\"(// raw)\"; // five";
  const std::vector<std::string_view> comments = CommentsIn(source);
  ASSERT_EQ(comments.size(), 5u);
  EXPECT_EQ(comments[0], "// one");
  EXPECT_EQ(comments[1], "/* two\n still two */");
  EXPECT_EQ(comments[2], "// three \\\n continued");
  EXPECT_EQ(comments[3], "/* four */");
  EXPECT_EQ(comments[4], "// five");
}

TEST(CommentsIn, UnclosedCommentAndLiteralEndWithTheText) {
  EXPECT_EQ(CommentsIn("x /* open").size(), 1u);
  // An unclosed string ends at its line, so the next line's comment counts.
  EXPECT_EQ(CommentsIn("\"open\n// after").size(), 1u);
  EXPECT_TRUE(CommentsIn("R\"x(never closed // )\"").empty());
}

TEST(FindTag, MatchesWholeWordsAndTakesTheNextWordOnTheLine) {
  std::string value;
  EXPECT_TRUE(FindTag("// @ZOR2Level L1 more", "@ZOR2Level", &value));
  EXPECT_EQ(value, "L1");
  EXPECT_TRUE(FindTag("/* @ZOR2Level L2*/", "@ZOR2Level", &value));
  EXPECT_EQ(value, "L2");
  EXPECT_TRUE(FindTag("// @ZOR2Level\n// L1", "@ZOR2Level", &value));
  EXPECT_EQ(value, "");
  EXPECT_TRUE(FindTag("// @ZOR2Level @ZOR2Usage U1", "@ZOR2Level", &value));
  EXPECT_EQ(value, "");
  EXPECT_FALSE(FindTag("// @nodocs", "@nodoc", &value));
  EXPECT_FALSE(FindTag("// x@nodoc", "@nodoc", &value));
  EXPECT_TRUE(FindTag("// @nodocs and @nodoc", "@nodoc", nullptr));
}

TEST(FindRelease, AcceptsOnlyWordsWrittenLikeALevel) {
  EXPECT_EQ(FindRelease("since M4R18, use Bar"), "M4R18");
  EXPECT_EQ(FindRelease("V12R7"), "V12R7");
  EXPECT_FALSE(FindRelease("R18 MR18 M4R M4R18a 4R18 use Bar").has_value());
}

TEST(ReadFileTags, FirstOccurrenceWinsAndDefaultsStayOpen) {
  const FileTags tags = ReadFileTags(
      "#pragma once\n"
      "/* @ZOR2Level L1\n"
      " * @ZOR2Usage U3 */\n"
      "// @ZOR2Level L2 @ZOR2NoAut\n"
      "const char* s = \"@ZOR2Usage U9\";\n");
  EXPECT_EQ(tags.level, "L1");
  EXPECT_EQ(tags.usage, "U3");
  EXPECT_TRUE(tags.not_automation);

  const FileTags none = ReadFileTags("class A {}; // @ZOR2Levels L1");
  EXPECT_FALSE(none.level.has_value());
  EXPECT_FALSE(none.usage.has_value());
  EXPECT_FALSE(none.not_automation);
}

TEST(ReadDeclarationTags, ReadsEveryDeclarationTag) {
  const DeclarationTags tags = ReadDeclarationTags(
      "/// Gets it. @nodoc\n"
      "/// @ZOR2Aut @ZOR2Property R\n"
      "/// @ZOR2Retval oFirst @ZOR2Retval\n"
      "/// @ZOR2Retval oSecond\n"
      "/// @deprecated M4R18 use Other");
  EXPECT_TRUE(tags.automation);
  EXPECT_TRUE(tags.nodoc);
  EXPECT_EQ(tags.property, "R");
  EXPECT_EQ(tags.retval_names, (std::vector<std::string>{"oFirst", "oSecond"}));
  EXPECT_TRUE(tags.deprecated);
  EXPECT_EQ(tags.deprecated_release, "M4R18");
}

TEST(ReadDeclarationTags, DeprecatedWithoutReleaseAndEmptyComment) {
  const DeclarationTags tags = ReadDeclarationTags("// @deprecated use Other");
  EXPECT_TRUE(tags.deprecated);
  EXPECT_FALSE(tags.deprecated_release.has_value());
  EXPECT_FALSE(tags.property.has_value());

  const DeclarationTags empty = ReadDeclarationTags("");
  EXPECT_FALSE(empty.automation || empty.nodoc || empty.deprecated);
}

}  // namespace
}  // namespace zor2::describe
