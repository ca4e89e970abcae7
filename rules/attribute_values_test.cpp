#include "rules/attribute_values.h"

#include <gtest/gtest.h>

#include <climits>
#include <string>

namespace zor2 {
namespace {

TEST(FirstWordTest, StopsAtTheFirstBlank) {
  EXPECT_EQ(FirstWord(nullptr), "");
  EXPECT_EQ(FirstWord(""), "");
  EXPECT_EQ(FirstWord("Y"), "Y");
  EXPECT_EQ(FirstWord("Y extra words"), "Y");
  EXPECT_EQ(FirstWord(" Y"), "");
  EXPECT_EQ(FirstWord("U2\tU3"), "U2\tU3");  // only " " ends the word
  EXPECT_TRUE(FirstWordIs("L1 comment", "L1"));
  EXPECT_FALSE(FirstWordIs("L12", "L1"));
  EXPECT_FALSE(FirstWordIs(nullptr, "L1"));
}

// The level of the command line ("-level"); cli_level_release shows the wiring.
TEST(ReleaseAfterRTest, ReadsTheNumberAfterTheFirstR) {
  const struct {
    const char* text;
    int release;
  } cases[] = {
      {"M4R11", 11},
      {"M4R07", 7},
      {"M4R2a", 2},       // atoi stops at the first non-digit
      {"M4R \t+12", 12},  // and skips blanks and a sign
      {"M4R-5", -5},
      {"M4RxR20", 0},               // the first "R" counts
      {"XM4R", 0},                  // nothing after the "R"
      {"VX12", 0},                  // no "R"
      {"R55", 0},                   // shorter than 4 characters
      {"M4R99999999999", INT_MAX},  // clamped
      {"M4R-99999999999", INT_MIN},
      {"M4R2147483648", INT_MAX},
      {"M4R-2147483648", INT_MIN},
  };
  for (const auto& c : cases) EXPECT_EQ(ReleaseAfterR(c.text), c.release) << c.text;
  for (const char* number : {"M4R11", "M4R00", "M4R -5", "M4R2a"}) {
    EXPECT_TRUE(HoldsReleaseAfterR(number)) << number;
  }
  const char* const nones[] = {"banana", "R", "R55", "XM4R", "M4RxR20", "M4R -", nullptr};
  for (const char* none : nones) {
    EXPECT_FALSE(HoldsReleaseAfterR(none)) << (none ? none : "(null)");
  }
  EXPECT_EQ(ReleaseAfterR(nullptr), 0);
  EXPECT_EQ(ReleaseAfterR(("M4R" + std::string(10000, '9')).c_str()), INT_MAX);
}

// The deprecation of methods: zero unless every character from the fourth on
// is a digit.
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

}  // namespace
}  // namespace zor2
