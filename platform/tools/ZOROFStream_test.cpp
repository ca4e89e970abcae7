#include "platform/tools/ZOROFStream.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <cerrno>
#include <climits>
#include <filesystem>
#include <fstream>
#include <sstream>

namespace fs = std::filesystem;

namespace {

std::string Contents(const fs::path& path) {
  std::ifstream in(path, std::ios::binary);
  std::stringstream text;
  text << in.rdbuf();
  return text.str();
}

class ZOROFStreamTest : public testing::Test {
 protected:
  void SetUp() override {
    std::string tmpl = (fs::temp_directory_path() / "zorofstream_XXXXXX").string();
    ASSERT_NE(mkdtemp(tmpl.data()), nullptr);
    dir_ = tmpl;
  }
  void TearDown() override { fs::remove_all(dir_); }
  fs::path dir_;
};

}  // namespace

TEST_F(ZOROFStreamTest, WritesTextIntsAndLineEnds) {
  const fs::path path = dir_ / "help.htm";
  std::ofstream(path) << "old content that is longer";
  ZOROFStream out;
  EXPECT_FALSE(out.isOpen());
  ASSERT_EQ(out.open(path.c_str(), 8), 0);
  EXPECT_TRUE(out.isOpen());
  const char* null_text = nullptr;
  out << "n=" << 42 << " " << -7 << " " << INT_MIN << null_text << endl
      << std::string("s") << std::string_view("v", 1) << endl;
  EXPECT_EQ(out.close(), 0);
  EXPECT_FALSE(out.isOpen());
  EXPECT_EQ(out.error(), 0);
  EXPECT_EQ(Contents(path), "n=42 -7 -2147483648\nsv\n");  // replaced, not appended
}

TEST_F(ZOROFStreamTest, ClosedStreamsIgnoreWrites) {
  ZOROFStream out;
  out << "nothing" << 1 << endl;
  EXPECT_EQ(out.flush(), 0);
  EXPECT_EQ(out.close(), 0);
  EXPECT_NE(out.open((dir_ / "no" / "such.htm").c_str(), 8), 0);
  EXPECT_EQ(errno, ENOENT);
  EXPECT_FALSE(out.isOpen());
  EXPECT_NE(out.open(dir_.c_str(), 8), 0);
}

TEST_F(ZOROFStreamTest, ReportsAFailedWriteOnClose) {
  ZOROFStream out;
  ASSERT_EQ(out.open("/dev/full", 8), 0);
  out << "lost" << endl;
  EXPECT_NE(out.close(), 0);
  EXPECT_EQ(out.error(), ENOSPC);
  // Reopening starts afresh.
  ASSERT_EQ(out.open((dir_ / "ok").c_str(), 8), 0);
  EXPECT_EQ(out.error(), 0);
  out << "ok";
  EXPECT_EQ(out.close(), 0);
}

TEST_F(ZOROFStreamTest, BorrowedStreamIsFlushedButNotClosed) {
  const fs::path path = dir_ / "borrowed";
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
  const fs::path path = dir_ / "log";
  std::FILE* outFile = std::fopen(path.c_str(), "ab");
  std::FILE* errFile = std::fopen(path.c_str(), "ab");
  ASSERT_NE(outFile, nullptr);
  ASSERT_NE(errFile, nullptr);
  const fs::path help = dir_ / "help.htm";
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
