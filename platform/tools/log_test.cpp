#include "platform/tools/log.h"

#include <gtest/gtest.h>

#include <string>

namespace zor2 {
namespace {

// Lines held back on other threads reach the standard streams in the order
// in which they are replayed, whichever stream each goes to.
TEST(LogTest, HeldLinesAreReplayedInTheirOrder) {
  Log first;
  Log second;
  second.Warning() << "b" << 1;
  first.Progress() << "a" << -7 << static_cast<const char*>(nullptr);
  second.Progress() << "b" << 2;
  second.Progress();
  ::testing::internal::CaptureStdout();
  ::testing::internal::CaptureStderr();
  first.ReplayInto(Log::Standard());
  second.ReplayInto(Log::Standard());
  second.ReplayInto(Log::Standard());  // nothing is left to write twice
  EXPECT_EQ(::testing::internal::GetCapturedStderr(), "b1\n");
  EXPECT_EQ(::testing::internal::GetCapturedStdout(), "a-7\nb2\n\n");
}

// Whatever did not come from the program's own literals is escaped, so that a
// name read from a document cannot end its line and forge the next one.
TEST(LogTest, OnlyLiteralsAreWrittenAsTheyAre) {
  Log log;
  const std::string name = "Geo\nERROR: forged\t\x7F";
  log.Progress() << "Checking : " << name << "\t" << std::string_view("\r") << 3;
  ::testing::internal::CaptureStdout();
  log.ReplayInto(Log::Standard());
  EXPECT_EQ(::testing::internal::GetCapturedStdout(),
            "Checking : Geo\\nERROR: forged\\t\\x7F\t\\r3\n");
}

}  // namespace
}  // namespace zor2
