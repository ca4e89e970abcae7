#include "platform/tools/paths.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

#include "tests/test_util.h"

namespace zor2 {
namespace {

namespace fs = std::filesystem;

class PathsTest : public testing::TempDirTest {
 protected:
  // The paths listed in `directory`, and ListRegularFiles's answer checked.
  std::vector<std::string> List(const std::string& directory, bool listed = true) {
    std::vector<std::string> paths;
    std::string err;
    EXPECT_EQ(ListRegularFiles(directory, &paths, &err), listed) << err;
    EXPECT_EQ(err.empty(), listed);
    return paths;
  }
};

TEST_F(PathsTest, ListsRegularFilesSortedByByteWiseName) {
  for (const char* name : {"b.xml", "B.xml", "a.xml", "_x", ".hidden", "a b.xml", "\xC3\xA9.xml"})
    Write(name, "x");
  const std::string d = dir_.string();
  EXPECT_EQ(List(d),
            (std::vector<std::string>{d + "/.hidden", d + "/B.xml", d + "/_x", d + "/a b.xml",
                                      d + "/a.xml", d + "/b.xml", d + "/\xC3\xA9.xml"}));
  // A trailing slash on the directory does not double the separator.
  EXPECT_EQ(List(d + "/").front(), d + "/.hidden");
}

TEST_F(PathsTest, ListsNoDirectoriesAndFollowsLinks) {
  Write("real.xml", "x");
  fs::create_directory(dir_ / "sub");
  Write("sub/inner.xml", "x");
  fs::create_symlink(dir_ / "real.xml", dir_ / "link.xml");
  fs::create_symlink(dir_ / "sub", dir_ / "link_dir");
  fs::create_symlink(dir_ / "gone", dir_ / "dangling.xml");
  EXPECT_EQ(List(dir_.string()), (std::vector<std::string>{Path("link.xml"), Path("real.xml")}));
  EXPECT_TRUE(IsRegularFile(Path("link.xml")));
  EXPECT_FALSE(IsRegularFile(Path("link_dir")));
  EXPECT_TRUE(IsDirectory(Path("link_dir")));
  EXPECT_FALSE(IsRegularFile(Path("dangling.xml")));
  EXPECT_FALSE(IsDirectory(Path("dangling.xml")));
  EXPECT_FALSE(IsDirectory(""));
}

TEST_F(PathsTest, EmptyAndUnreadableDirectories) {
  EXPECT_TRUE(List(dir_.string()).empty());
  EXPECT_TRUE(List(Path("missing"), false).empty());
  EXPECT_TRUE(List(Write("plain", "x"), false).empty());
}

TEST(PathsNamesTest, JoinAndBaseName) {
  EXPECT_EQ(JoinPath("", "F.xml"), "F.xml");
  EXPECT_EQ(JoinPath("a", "F.xml"), "a/F.xml");
  EXPECT_EQ(JoinPath("a/", "F.xml"), "a/F.xml");
  EXPECT_EQ(BaseName("a/b/F.xml"), "F.xml");
  EXPECT_EQ(BaseName("F.xml"), "F.xml");
  EXPECT_EQ(BaseName("a.d/"), "");
}

}  // namespace
}  // namespace zor2
