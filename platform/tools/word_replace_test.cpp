#include "platform/tools/word_replace.h"

#include <gtest/gtest.h>

#include <vector>

namespace zor2 {

namespace {

std::string Replaced(std::string text, const char* a, const char* b, const char* c,
                     const char* with, int expected_result) {
  std::vector<std::string_view> words;
  for (const char* word : {a, b, c}) {
    if (word != nullptr) words.push_back(word);
  }
  EXPECT_EQ(ReplaceWordSequence(&text, words, with), expected_result != 0) << text;
  return text;
}

}  // namespace

TEST(WordReplaceTest, MatchesWholeWordsOnly) {
  EXPECT_EQ(Replaced("long", "long", nullptr, nullptr, "L", 1), "L");
  EXPECT_EQ(Replaced("longer my_long long2 Long", "long", nullptr, nullptr, "L", 0),
            "longer my_long long2 Long");
  EXPECT_EQ(Replaced("const long& x,long*(long)", "long", nullptr, nullptr, "L", 1),
            "const L& x,L*(L)");
  // Occurrences inside words are passed over, not the whole words after them.
  EXPECT_EQ(Replaced("alonglong long", "long", nullptr, nullptr, "L", 1), "alonglong L");
  EXPECT_EQ(Replaced("longlong_long,long", "long", nullptr, nullptr, "L", 1), "longlong_long,L");
  // A non-ASCII byte ends a word.
  EXPECT_EQ(Replaced("\xC3\xA9long", "long", nullptr, nullptr, "L", 1), "\xC3\xA9L");
}

TEST(WordReplaceTest, SequencesNeedOnlyWhiteSpaceBetweenWords) {
  EXPECT_EQ(Replaced("unsigned  long\tlong", "unsigned", "long", "long", "U64", 1), "U64");
  EXPECT_EQ(Replaced("a long\r\nint b", "long", "int", nullptr, "L", 1), "a L b");
  EXPECT_EQ(Replaced("longint", "long", "int", nullptr, "L", 0), "longint");
  EXPECT_EQ(Replaced("long,int", "long", "int", nullptr, "L", 0), "long,int");
  EXPECT_EQ(Replaced("long intx", "long", "int", nullptr, "L", 0), "long intx");
  EXPECT_EQ(Replaced("long", "long", "int", nullptr, "L", 0), "long");
  EXPECT_EQ(Replaced("long ", "long", "int", nullptr, "L", 0), "long ");
}

TEST(WordReplaceTest, ScansLeftToRightWithoutOverlap) {
  EXPECT_EQ(Replaced("long long long", "long", "long", nullptr, "LL", 1), "LL long");
  EXPECT_EQ(Replaced("long long long long", "long", "long", nullptr, "LL", 1), "LL LL");
  // A failed longer match does not hide the match starting at the next word.
  EXPECT_EQ(Replaced("long long int", "long", "int", nullptr, "LI", 1), "long LI");
  // The replacement is not scanned again.
  EXPECT_EQ(Replaced("a b", "a", nullptr, nullptr, "a a", 1), "a a b");
  EXPECT_EQ(Replaced("", "a", nullptr, nullptr, "b", 0), "");
  EXPECT_EQ(Replaced("x a", "a", nullptr, nullptr, "", 1), "x ");
}

TEST(WordReplaceTest, HandlesLongTexts) {
  std::string text;
  for (int i = 0; i < 100000; ++i) text += "long  ";
  ASSERT_TRUE(ReplaceWordSequence(&text, std::vector<std::string_view>{"long", "long"}, "X"));
  std::string expected;
  for (int i = 0; i < 50000; ++i) expected += "X  ";
  EXPECT_EQ(text, expected);
}

}  // namespace zor2
