#include "platform/tools/TAFileName.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>

TEST(TAFileNameTest, IsNullUntilAPathIsSet) {
  TAFileName name;
  EXPECT_TRUE(name.IsNull());
  EXPECT_STREQ(name.c_str(), "");
  name = std::string();
  EXPECT_FALSE(name.IsNull());
  EXPECT_FALSE(TAFileName("x").IsNull());
}

TEST(TAFileNameTest, JoinsComponentsWithOneSlash) {
  EXPECT_EQ((TAFileName("dir") + "x").str(), "dir/x");
  EXPECT_EQ((TAFileName("dir/") + "x").str(), "dir/x");
  EXPECT_EQ((TAFileName("/") + "*").str(), "/*");
  EXPECT_EQ((TAFileName("") + "x").str(), "x");
  EXPECT_FALSE((TAFileName() + "x").IsNull());
}

TEST(TAFileNameTest, BasenameIsTheLastComponent) {
  EXPECT_EQ(TAFileName("a/b/F.xml").basename(1), "F.xml");
  EXPECT_EQ(TAFileName("F.xml").basename(1), "F.xml");
  EXPECT_EQ(TAFileName("/F").basename(1), "F");
  EXPECT_EQ(TAFileName("a.d/").basename(1), "");
  EXPECT_EQ(TAFileName("").basename(1), "");
}

TEST(TAFileNameTest, TellsFilesFromDirectoriesThroughLinks) {
  namespace fs = std::filesystem;
  std::string tmpl = (fs::temp_directory_path() / "tafilename_XXXXXX").string();
  ASSERT_NE(mkdtemp(tmpl.data()), nullptr);
  const fs::path dir = tmpl;
  std::ofstream(dir / "file") << "x";
  fs::create_directory(dir / "sub");
  fs::create_symlink(dir / "file", dir / "to_file");
  fs::create_symlink(dir / "sub", dir / "to_sub");
  fs::create_symlink(dir / "missing", dir / "dangling");

  TAFileName base(dir.string());
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
  fs::remove_all(dir);
}
