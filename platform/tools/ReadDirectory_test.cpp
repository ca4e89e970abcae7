#include "platform/tools/ReadDirectory.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

#include "tests/TempDir.h"

namespace fs = std::filesystem;

namespace {

class ReadDirectoryTest : public TempDirTest {
 protected:
  // The paths listed for `pattern`, and ReadDirectory's answer checked.
  std::vector<std::string> List(const TAFileName& pattern, int expected_result = 0) {
    QEXListValTAFileName files;
    EXPECT_EQ(ReadDirectory(pattern, files), expected_result);
    std::vector<std::string> paths;
    for (int i = 1; i <= files.Size(); ++i) paths.push_back(files[i].str());
    return paths;
  }
};

}  // namespace

TEST_F(ReadDirectoryTest, ListsRegularFilesSortedByByteWiseName) {
  for (const char* name : {"b.xml", "B.xml", "a.xml", "_x", ".hidden", "a b.xml", "\xC3\xA9.xml"})
    Write(name, "x");
  const std::string d = dir_.string();
  EXPECT_EQ(List(TAFileName(d) + "*"),
            (std::vector<std::string>{d + "/.hidden", d + "/B.xml", d + "/_x", d + "/a b.xml",
                                      d + "/a.xml", d + "/b.xml", d + "/\xC3\xA9.xml"}));
  // A trailing slash on the directory does not double the separator.
  EXPECT_EQ(List(TAFileName(d + "/") + "*").front(), d + "/.hidden");
}

TEST_F(ReadDirectoryTest, SkipsDirectoriesAndFollowsLinks) {
  Write("real.xml", "x");
  fs::create_directory(dir_ / "sub");
  Write("sub/inner.xml", "x");
  fs::create_symlink(dir_ / "real.xml", dir_ / "link.xml");
  fs::create_symlink(dir_ / "sub", dir_ / "link_dir");
  fs::create_symlink(dir_ / "gone", dir_ / "dangling.xml");
  EXPECT_EQ(List(TAFileName(dir_.string()) + "*"),
            (std::vector<std::string>{Path("link.xml"), Path("real.xml")}));
}

TEST_F(ReadDirectoryTest, EmptyAndUnreadableDirectories) {
  EXPECT_TRUE(List(TAFileName(dir_.string()) + "*").empty());
  EXPECT_TRUE(List(TAFileName(Path("missing")) + "*", 1).empty());
  EXPECT_TRUE(List(TAFileName(Write("plain", "x")) + "*", 1).empty());
}
