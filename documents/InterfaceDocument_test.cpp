#include "documents/InterfaceDocument.h"

#include <gtest/gtest.h>

#include <climits>
#include <string>

TEST(FirstWordTest, StopsAtTheFirstBlank) {
  EXPECT_EQ(FirstWord(nullptr), "");
  EXPECT_EQ(FirstWord(""), "");
  EXPECT_EQ(FirstWord("Y"), "Y");
  EXPECT_EQ(FirstWord("Y extra words"), "Y");
  EXPECT_EQ(FirstWord(" Y"), "");
  EXPECT_EQ(FirstWord("U2\tU3"), "U2\tU3");  // only " " ends the word
  const std::string big(100000, 'L');
  EXPECT_EQ(FirstWord((big + " x").c_str()), big);
  EXPECT_TRUE(FirstWordIs("L1 comment", "L1"));
  EXPECT_FALSE(FirstWordIs("L12", "L1"));
  EXPECT_FALSE(FirstWordIs(nullptr, "L1"));
}

// ReleaseAfterR reads the level of the command line, where the end-to-end
// cases (cli_level_*) cover it value by value. ReleaseFromFourthCharacter,
// which reads the deprecation of methods, answers zero unless every character
// from the fourth on is a digit.
TEST(ReleaseFromFourthCharacterTest, ReadsTheDigitsFromTheFourthCharacterOnly) {
  const std::string nines(1000, '9');
  EXPECT_EQ(ReleaseFromFourthCharacter("M4R18"), 18);
  EXPECT_EQ(ReleaseFromFourthCharacter("M4R7"), 7);
  EXPECT_EQ(ReleaseFromFourthCharacter("XYZ12"), 12);
  EXPECT_EQ(ReleaseFromFourthCharacter("M4R2147483648"), INT_MAX);
  EXPECT_EQ(ReleaseFromFourthCharacter(("M4R" + nines).c_str()), INT_MAX);
  const std::string zeros[] = {"M4R00",  "M4R18a",           "M4R", "R18", "M4R 18",
                               "M4R-18", "M4R" + nines + "a"};
  for (const std::string& zero : zeros) {
    EXPECT_EQ(ReleaseFromFourthCharacter(zero.c_str()), 0) << zero;
  }
  EXPECT_EQ(ReleaseFromFourthCharacter(nullptr), 0);
}
