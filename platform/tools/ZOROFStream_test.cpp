#include "platform/tools/ZOROFStream.h"

#include <gtest/gtest.h>

#include <climits>
#include <cstdio>

#include "tests/TempDir.h"

// Failures to open and to write are in the end-to-end cases of the help page.
using ZOROFStreamTest = TempDirTest;

TEST_F(ZOROFStreamTest, WritesTextIntsAndLineEnds) {
  const std::string path = Write("help.htm", "old content that is longer");
  ZOROFStream out;
  out << "ignored while closed" << 1 << endl;
  EXPECT_EQ(out.close(), 0);
  ASSERT_EQ(out.open(path.c_str(), 8), 0);
  const char* null_text = nullptr;
  out << "n=" << 42 << " " << -7 << " " << INT_MIN << null_text << endl
      << std::string("s") << std::string_view("v", 1) << endl;
  EXPECT_EQ(out.close(), 0);
  EXPECT_FALSE(out.isOpen());
  EXPECT_EQ(Contents(path), "n=42 -7 -2147483648\nsv\n");  // replaced, not appended
}

TEST_F(ZOROFStreamTest, BorrowedStreamIsFlushedButNotClosed) {
  const std::string path = Path("borrowed");
  std::FILE* file = std::fopen(path.c_str(), "wb");
  ASSERT_NE(file, nullptr);
  {
    ZOROFStream log(file);
    log << "line" << endl;
    EXPECT_EQ(log.close(), 0);
    EXPECT_TRUE(log.isOpen());
    EXPECT_EQ(Contents(path), "line\n");
    log << "more";
  }
  EXPECT_EQ(Contents(path), "line\nmore");
  EXPECT_EQ(std::fclose(file), 0);
}

// Two borrowed streams appending to one file stand for the log streams going
// to the same place: a line shows up there when it is ended.
TEST_F(ZOROFStreamTest, CapturedLinesAreReplayedInTheirOrder) {
  const std::string path = Path("log");
  std::FILE* outFile = std::fopen(path.c_str(), "ab");
  std::FILE* errFile = std::fopen(path.c_str(), "ab");
  ASSERT_NE(outFile, nullptr);
  ASSERT_NE(errFile, nullptr);
  const std::string help = Path("help.htm");
  {
    ZOROFStream out(outFile);
    ZOROFStream err(errFile);
    ZOROFStream owned;
    ASSERT_EQ(owned.open(help.c_str(), 8), 0);
    ZORLog first;
    ZORLog second;
    {
      ZORLogCapture capture(second);
      err << "b1" << endl;
      out << "b2 ";
      {
        ZORLogCapture inner(first);
        out << "a" << 1 << endl;
      }
      err << "b3" << endl;
      out << "b4" << endl;
      owned << "not held" << endl;  // a stream that owns its file writes at once
    }
    EXPECT_EQ(Contents(path), "");
    first.Replay();
    EXPECT_EQ(Contents(path), "a1\n");
    second.Replay();
    second.Replay();  // nothing is left to write twice
    EXPECT_EQ(owned.close(), 0);
  }
  // "b2 " waits in its stream until its line is ended, as it would have.
  EXPECT_EQ(Contents(path), "a1\nb1\nb3\nb2 b4\n");
  EXPECT_EQ(Contents(help), "not held\n");
  EXPECT_EQ(std::fclose(outFile), 0);
  EXPECT_EQ(std::fclose(errFile), 0);
}
