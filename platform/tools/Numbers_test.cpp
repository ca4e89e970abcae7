#include "platform/tools/Numbers.h"

#include <gtest/gtest.h>

#include <climits>

TEST(SaturatingAtoiTest, ReadsLikeAtoi) {
  EXPECT_EQ(SaturatingAtoi("18"), 18);
  EXPECT_EQ(SaturatingAtoi(" \t\n\v\f\r-42x"), -42);
  EXPECT_EQ(SaturatingAtoi("+5"), 5);
  EXPECT_EQ(SaturatingAtoi("2a"), 2);
  EXPECT_EQ(SaturatingAtoi(""), 0);
  EXPECT_EQ(SaturatingAtoi("- 5"), 0);
  EXPECT_EQ(SaturatingAtoi("+-5"), 0);
}

TEST(SaturatingAtoiTest, ClampsAtThe32BitLimits) {
  EXPECT_EQ(SaturatingAtoi("2147483647"), INT_MAX);
  EXPECT_EQ(SaturatingAtoi("2147483648"), INT_MAX);
  EXPECT_EQ(SaturatingAtoi("-2147483648"), INT_MIN);
  EXPECT_EQ(SaturatingAtoi("-2147483649"), INT_MIN);
  EXPECT_EQ(SaturatingAtoi("99999999999"), INT_MAX);
  EXPECT_EQ(SaturatingAtoi(std::string(10000, '9').c_str()), INT_MAX);
  EXPECT_EQ(SaturatingAtoi(("-" + std::string(10000, '9')).c_str()), INT_MIN);
  EXPECT_EQ(SaturatingAtoi("000000000000012"), 12);
}

TEST(ToStringTest, WritesDecimal) {
  EXPECT_EQ(toString(0), "0");
  EXPECT_EQ(toString(-7), "-7");
  EXPECT_EQ(toString(INT_MIN), "-2147483648");
}
