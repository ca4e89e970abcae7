#include "platform/tools/Numbers.h"

#include <gtest/gtest.h>

#include <climits>
#include <string>

// Through the level of the command line, the end-to-end cases (cli_level_*)
// cover signs, blanks, trailing letters and overflow; ZOROFStream's test covers
// toString.
TEST(SaturatingAtoiTest, ReadsLikeAtoiButClampsAtThe32BitLimits) {
  EXPECT_EQ(SaturatingAtoi(" \t\n\v\f\r-42x"), -42);
  EXPECT_EQ(SaturatingAtoi("+-5"), 0);
  EXPECT_EQ(SaturatingAtoi("2147483647"), INT_MAX);
  EXPECT_EQ(SaturatingAtoi("2147483648"), INT_MAX);
  EXPECT_EQ(SaturatingAtoi("-2147483648"), INT_MIN);
  EXPECT_EQ(SaturatingAtoi("-2147483649"), INT_MIN);
  EXPECT_EQ(SaturatingAtoi(std::string(10000, '9').c_str()), INT_MAX);
  EXPECT_EQ(SaturatingAtoi(("-" + std::string(10000, '9')).c_str()), INT_MIN);
  EXPECT_EQ(SaturatingAtoi("000000000000012"), 12);
}
