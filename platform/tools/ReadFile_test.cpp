#include "platform/tools/ReadFile.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <vector>

namespace fs = std::filesystem;

namespace {

class ReadFileTest : public testing::Test {
 protected:
  void SetUp() override {
    std::string tmpl = (fs::temp_directory_path() / "readfile_XXXXXX").string();
    ASSERT_NE(mkdtemp(tmpl.data()), nullptr);
    dir_ = tmpl;
  }
  void TearDown() override { fs::remove_all(dir_); }

  // The items of a file holding `content`.
  std::vector<std::string> Items(const std::string& content) {
    const std::string path = (dir_ / "args").string();
    std::ofstream(path, std::ios::binary) << content;
    QEXListValQEXString items;
    items.Append("kept");
    EXPECT_EQ(ReadFile(path.c_str(), items), 0);
    EXPECT_EQ(items[1], "kept");  // appends, never clears
    std::vector<std::string> result;
    for (int i = 2; i <= items.Size(); ++i) result.push_back(items[i]);
    return result;
  }

  fs::path dir_;
};

using Strings = std::vector<std::string>;

}  // namespace

TEST_F(ReadFileTest, SplitsOnWhiteSpace) {
  EXPECT_EQ(Items("-r a.xml\t-c\r\nb.xml\n\n  -o  out.xml"),
            (Strings{"-r", "a.xml", "-c", "b.xml", "-o", "out.xml"}));
  EXPECT_EQ(Items("-L\n"), Strings{"-L"});
  EXPECT_EQ(Items(""), Strings{});
  EXPECT_EQ(Items(" \t\r\n \n"), Strings{});
}

TEST_F(ReadFileTest, QuotesKeepBlanksInsideOneItem) {
  EXPECT_EQ(Items("-r \"my dir/a b.xml\" -c x"), (Strings{"-r", "my dir/a b.xml", "-c", "x"}));
  EXPECT_EQ(Items("\"\" x"), (Strings{"", "x"}));
  EXPECT_EQ(Items("a\"b c\"d"), Strings{"ab cd"});
  EXPECT_EQ(Items("\"tab\there\nline\""), Strings{"tab\there\nline"});
  // An unterminated quote runs to the end of the file.
  EXPECT_EQ(Items("x \"open to the end \n"), (Strings{"x", "open to the end \n"}));
}

TEST_F(ReadFileTest, KeepsLongItemsWhole) {
  const std::string big(200000, 'v');
  EXPECT_EQ(Items("-level " + big + "\n"), (Strings{"-level", big}));
}

TEST_F(ReadFileTest, ReportsUnreadableFiles) {
  QEXListValQEXString items;
  EXPECT_NE(ReadFile((dir_ / "missing").c_str(), items), 0);
  EXPECT_NE(ReadFile(dir_.c_str(), items), 0);
  EXPECT_NE(ReadFile(nullptr, items), 0);
  EXPECT_EQ(items.Size(), 0);
}
