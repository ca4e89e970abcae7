#include "platform/tools/file_output.h"

#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <filesystem>
#include <iterator>

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

}  // namespace
}  // namespace zor2
