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

TEST(ReleaseAfterRTest, ReadsTheNumberAfterTheFirstR) {
  EXPECT_EQ(ReleaseAfterR("M4R18"), 18);
  EXPECT_EQ(ReleaseAfterR("M4R07"), 7);
  EXPECT_EQ(ReleaseAfterR("M4R18a"), 18);
  EXPECT_EQ(ReleaseAfterR("M4R2a"), 2);
  EXPECT_EQ(ReleaseAfterR("M4R00"), 0);
  EXPECT_EQ(ReleaseAfterR("M4R -3"), -3);
  EXPECT_EQ(ReleaseAfterR("M4R99999999999"), INT_MAX);
  EXPECT_EQ(ReleaseAfterR("M4R-99999999999"), INT_MIN);
  EXPECT_EQ(ReleaseAfterR("R1R2"), 1);
}

TEST(ReleaseAfterRTest, ZeroWithoutANumberAfterR) {
  EXPECT_EQ(ReleaseAfterR(nullptr), 0);
  EXPECT_EQ(ReleaseAfterR("R55"), 0);  // shorter than 4 characters
  EXPECT_EQ(ReleaseAfterR("M4R"), 0);
  EXPECT_EQ(ReleaseAfterR("R18"), 0);
  EXPECT_EQ(ReleaseAfterR("XM4R"), 0);  // nothing after the R
  EXPECT_EQ(ReleaseAfterR("VX12"), 0);  // no R
  EXPECT_EQ(ReleaseAfterR("M4Rx1"), 0);
}

TEST(ReleaseFromFourthCharacterTest, ReadsAllDigitsFromTheFourthCharacter) {
  EXPECT_EQ(ReleaseFromFourthCharacter("M4R18"), 18);
  EXPECT_EQ(ReleaseFromFourthCharacter("M4R7"), 7);
  EXPECT_EQ(ReleaseFromFourthCharacter("XYZ12"), 12);
  EXPECT_EQ(ReleaseFromFourthCharacter("M4R00"), 0);
  EXPECT_EQ(ReleaseFromFourthCharacter("M4R2147483648"), INT_MAX);
  EXPECT_EQ(ReleaseFromFourthCharacter("M4R99999999999"), INT_MAX);
  EXPECT_EQ(ReleaseFromFourthCharacter(("M4R" + std::string(1000, '9')).c_str()), INT_MAX);
}

TEST(ReleaseFromFourthCharacterTest, ZeroUnlessEveryCharacterIsADigit) {
  EXPECT_EQ(ReleaseFromFourthCharacter(nullptr), 0);
  EXPECT_EQ(ReleaseFromFourthCharacter("M4R18a"), 0);
  EXPECT_EQ(ReleaseFromFourthCharacter("M4R"), 0);
  EXPECT_EQ(ReleaseFromFourthCharacter("R18"), 0);
  EXPECT_EQ(ReleaseFromFourthCharacter("M4R 18"), 0);
  EXPECT_EQ(ReleaseFromFourthCharacter("M4R-18"), 0);
  EXPECT_EQ(ReleaseFromFourthCharacter(("M4R" + std::string(1000, '9') + "a").c_str()), 0);
}
