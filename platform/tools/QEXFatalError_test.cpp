#include "platform/tools/QEXFatalError.h"

#include <gtest/gtest.h>

TEST(QEXFatalErrorTest, ReportsTheTextAndPositionThenAborts) {
  EXPECT_DEATH(QEXFatalError("two lists disagree", "rules/Methods.cpp", 123),
               "FATAL: two lists disagree \\(rules/Methods\\.cpp:123\\)");
}
