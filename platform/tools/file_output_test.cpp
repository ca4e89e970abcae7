#include "platform/tools/file_output.h"

#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <atomic>
#include <filesystem>
#include <iterator>
#include <string>
#include <thread>
#include <vector>

#include "tests/test_util.h"

namespace zor2 {
namespace {

using FileOutputTest = testing::TempDirTest;

// A regular file is replaced through a temporary beside it, which takes the
// file's mode and is gone afterwards; a link is written through, not replaced.
// Devices, full file systems and missing directories are in the end-to-end
// cases (report_*).
TEST_F(FileOutputTest, ReplacesFilesKeepingTheirModeAndWritesThroughLinks) {
  const std::string path = Write("out.xml", "old");
  const std::string link = Path("link.xml");
  ASSERT_EQ(chmod(path.c_str(), 0600), 0);
  ASSERT_EQ(symlink(path.c_str(), link.c_str()), 0);
  std::string err;
  ASSERT_TRUE(WriteFileAtomically(path, "new", nullptr, &err)) << err;
  struct stat status;
  ASSERT_EQ(stat(path.c_str(), &status), 0);
  EXPECT_EQ(status.st_mode & 07777, 0600u);
  EXPECT_EQ(Contents(path), "new");
  ASSERT_TRUE(WriteFileAtomically(link, "through", nullptr, &err)) << err;
  ASSERT_EQ(lstat(link.c_str(), &status), 0);
  EXPECT_TRUE(S_ISLNK(status.st_mode));
  EXPECT_EQ(Contents(path), "through");
  EXPECT_EQ(std::distance(std::filesystem::directory_iterator(dir_), {}), 2);
}

// Any number of outputs may be written at once (a run with many exports):
// none waits for another, and each ends whole.
TEST_F(FileOutputTest, WritesManyOutputsAtOnce) {
  std::vector<std::thread> writers;
  std::atomic<int> written{0};
  for (int i = 0; i < 16; ++i) {
    writers.emplace_back([this, i, &written] {
      std::string err;
      const std::string text(100000, static_cast<char>('a' + i));
      if (WriteFileAtomically(Path(std::to_string(i)), text, nullptr, &err)) ++written;
    });
  }
  for (std::thread& writer : writers) writer.join();
  EXPECT_EQ(written, 16);
  for (int i = 0; i < 16; ++i) {
    EXPECT_EQ(Contents(Path(std::to_string(i))), std::string(100000, static_cast<char>('a' + i)));
  }
  EXPECT_EQ(std::distance(std::filesystem::directory_iterator(dir_), {}), 16);
}

}  // namespace
}  // namespace zor2
