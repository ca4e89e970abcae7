#include "platform/tools/TAFileName.h"

#include <gtest/gtest.h>

#include <filesystem>

#include "tests/TempDir.h"

TEST(TAFileNameTest, IsNullUntilAPathIsSet) {
  TAFileName name;
  EXPECT_TRUE(name.IsNull());
  EXPECT_STREQ(name.c_str(), "");
  name = std::string();
  EXPECT_FALSE(name.IsNull());
  EXPECT_FALSE(TAFileName("x").IsNull());
}

// Joining paths is covered by ReadDirectory's test and the end-to-end cases.
TEST(TAFileNameTest, BasenameIsTheLastComponent) {
  EXPECT_EQ(TAFileName("a/b/F.xml").basename(1), "F.xml");
  EXPECT_EQ(TAFileName("F.xml").basename(1), "F.xml");
  EXPECT_EQ(TAFileName("/F").basename(1), "F");
  EXPECT_EQ(TAFileName("a.d/").basename(1), "");
  EXPECT_EQ(TAFileName("").basename(1), "");
}

using TAFileNameFileTest = TempDirTest;

TEST_F(TAFileNameFileTest, TellsFilesFromDirectoriesThroughLinks) {
  namespace fs = std::filesystem;
  Write("file", "x");
  fs::create_directory(dir_ / "sub");
  fs::create_symlink(dir_ / "file", dir_ / "to_file");
  fs::create_symlink(dir_ / "sub", dir_ / "to_sub");
  fs::create_symlink(dir_ / "missing", dir_ / "dangling");
  TAFileName base(dir_.string());
  EXPECT_TRUE(base.IsDirectory());
  EXPECT_FALSE(base.IsFile());
  EXPECT_TRUE((base + "file").IsFile());
  EXPECT_TRUE((base + "to_file").IsFile());
  EXPECT_TRUE((base + "to_sub").IsDirectory());
  EXPECT_FALSE((base + "to_sub").IsFile());
  EXPECT_FALSE((base + "dangling").IsFile());
  EXPECT_FALSE((base + "dangling").IsDirectory());
  EXPECT_FALSE((base + "nothing").IsFile());
  EXPECT_FALSE(TAFileName("").IsDirectory());
}
