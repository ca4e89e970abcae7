#include "platform/tools/ReadFile.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/TempDir.h"

namespace {

class ReadFileTest : public TempDirTest {
 protected:
  // The items of a file holding `content`.
  std::vector<std::string> Items(const std::string& content) {
    QEXListValQEXString items;
    items.Append("kept");
    EXPECT_EQ(ReadFile(Write("args", content).c_str(), items), 0);
    EXPECT_EQ(items[1], "kept");  // appends, never clears
    std::vector<std::string> result;
    for (int i = 2; i <= items.Size(); ++i) result.push_back(items[i]);
    return result;
  }
};

using Strings = std::vector<std::string>;

}  // namespace

// Files that cannot be read are in the end-to-end cases (cli_argument_file_*).
TEST_F(ReadFileTest, SplitsOnWhiteSpace) {
  EXPECT_EQ(Items("-r a.xml\t-c\r\nb.xml\n\n  -o  out.xml"),
            (Strings{"-r", "a.xml", "-c", "b.xml", "-o", "out.xml"}));
  EXPECT_EQ(Items("-L\n"), Strings{"-L"});
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
