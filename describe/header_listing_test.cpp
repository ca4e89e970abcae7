#include "describe/header_listing.h"

#include <gtest/gtest.h>

#include <filesystem>

#include "tests/test_util.h"

namespace zor2::describe {
namespace {

TEST(IsHeaderName, KnowsTheHeaderExtensions) {
  for (const char* name : {"a.h", "a.hh", "a.hpp", "a.hxx", "a.h++", "dir.x/b.h"}) {
    EXPECT_TRUE(IsHeaderName(name)) << name;
  }
  for (const char* name : {"a.cpp", "a.inl", "a.H", "h", ".h", "a.h.orig", "a.hp"}) {
    EXPECT_FALSE(IsHeaderName(name)) << name;
  }
}

class ListHeadersTest : public testing::TempDirTest {};

TEST_F(ListHeadersTest, ListsHeadersOfEveryLevelSortedBytewise) {
  std::filesystem::create_directories(dir_ / "pub/geo/detail");
  std::filesystem::create_directories(dir_ / "pub/Zeta");
  std::filesystem::create_directories(dir_ / "pub/empty");
  for (const char* name : {"pub/geo.h", "pub/geo/point.hpp", "pub/geo/detail/cache.hh",
                           "pub/Zeta/z.h", "pub/b.hxx", "pub/geo/point.cpp", "pub/README"}) {
    Write(name, "");
  }
  // A link to a file counts; a link to a directory is not followed.
  std::filesystem::create_symlink(dir_ / "pub/b.hxx", dir_ / "pub/link.h");
  std::filesystem::create_directory_symlink(dir_ / "pub/geo", dir_ / "pub/loop");

  std::vector<std::string> names;
  std::string err;
  ASSERT_TRUE(ListHeaders(Path("pub"), &names, &err)) << err;
  EXPECT_EQ(names, (std::vector<std::string>{"Zeta/z.h", "b.hxx", "geo.h", "geo/detail/cache.hh",
                                             "geo/point.hpp", "link.h"}));
}

TEST_F(ListHeadersTest, MissingDirectoryOrFileIsAnError) {
  std::vector<std::string> names = {"stale"};
  std::string err;
  EXPECT_FALSE(ListHeaders(Path("missing"), &names, &err));
  EXPECT_TRUE(names.empty());
  EXPECT_EQ(err, Path("missing") + ": No such file or directory");

  Write("file.h", "");
  EXPECT_FALSE(ListHeaders(Path("file.h"), &names, &err));
  EXPECT_EQ(err, Path("file.h") + ": Not a directory");
}

}  // namespace
}  // namespace zor2::describe
