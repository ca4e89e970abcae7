#include "platform/tools/ReadDirectory.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <vector>

namespace fs = std::filesystem;

namespace {

class ReadDirectoryTest : public testing::Test {
 protected:
  void SetUp() override {
    std::string tmpl = (fs::temp_directory_path() / "readdirectory_XXXXXX").string();
    ASSERT_NE(mkdtemp(tmpl.data()), nullptr);
    dir_ = tmpl;
  }
  void TearDown() override { fs::remove_all(dir_); }
  void Touch(const std::string& name) { std::ofstream(dir_ / name) << "x"; }

  std::vector<std::string> List(const TAFileName& pattern, int expected_result = 0) {
    QEXListValTAFileName files;
    EXPECT_EQ(ReadDirectory(pattern, files), expected_result);
    std::vector<std::string> paths;
    for (int i = 1; i <= files.Size(); ++i) paths.push_back(files[i].str());
    return paths;
  }

  fs::path dir_;
};

}  // namespace

TEST_F(ReadDirectoryTest, ListsRegularFilesSortedByByteWiseName) {
  for (const char* name : {"b.xml", "B.xml", "a.xml", "_x", ".hidden", "a b.xml", "\xC3\xA9.xml"})
    Touch(name);
  const std::string d = dir_.string();
  EXPECT_EQ(List(TAFileName(d) + "*"),
            (std::vector<std::string>{d + "/.hidden", d + "/B.xml", d + "/_x", d + "/a b.xml",
                                      d + "/a.xml", d + "/b.xml", d + "/\xC3\xA9.xml"}));
  // A trailing slash on the directory does not double the separator.
  EXPECT_EQ(List(TAFileName(d + "/") + "*").front(), d + "/.hidden");
}

TEST_F(ReadDirectoryTest, SkipsDirectoriesAndFollowsLinks) {
  Touch("real.xml");
  fs::create_directory(dir_ / "sub");
  std::ofstream(dir_ / "sub" / "inner.xml") << "x";
  fs::create_symlink(dir_ / "real.xml", dir_ / "link.xml");
  fs::create_symlink(dir_ / "sub", dir_ / "link_dir");
  fs::create_symlink(dir_ / "gone", dir_ / "dangling.xml");
  const std::string d = dir_.string();
  EXPECT_EQ(List(TAFileName(d) + "*"),
            (std::vector<std::string>{d + "/link.xml", d + "/real.xml"}));
}

TEST_F(ReadDirectoryTest, EmptyAndUnreadableDirectories) {
  EXPECT_TRUE(List(TAFileName(dir_.string()) + "*").empty());
  EXPECT_TRUE(List(TAFileName((dir_ / "missing").string()) + "*", 1).empty());
  Touch("plain");
  EXPECT_TRUE(List(TAFileName((dir_ / "plain").string()) + "*", 1).empty());
}

TEST_F(ReadDirectoryTest, StarAloneListsTheCurrentDirectory) {
  Touch("f");
  const fs::path previous = fs::current_path();
  fs::current_path(dir_);
  std::vector<std::string> listed = List(TAFileName("") + "*");
  fs::current_path(previous);
  EXPECT_EQ(listed, std::vector<std::string>{"f"});
}
