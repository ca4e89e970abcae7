#include "platform/tools/TAIndex.h"

#include <gtest/gtest.h>

TEST(TAIndexTest, KeepsAppendOrderAndFirstEntryOfARepeatedKey) {
  int a = 1, b = 2, c = 3;
  TAIndex index;
  EXPECT_EQ(index.IsIn("FHBD"), -1);
  index.Append("FHBD", &a);
  index.Append("LHC", &b);
  index.Append("FHBD", &c);
  ASSERT_EQ(index.Count(), 3);
  EXPECT_EQ(index.IsIn("FHBD"), 0);
  EXPECT_EQ(index.IsIn("LHC"), 1);
  EXPECT_EQ(index.IsIn("lhc"), -1);
  EXPECT_EQ(index.IsIn(""), -1);
  EXPECT_EQ(index.ValueAt(1), &b);
  EXPECT_EQ(index.ValueAt(2), &c);
  EXPECT_EQ(index.KeyAt(2), "FHBD");
}
