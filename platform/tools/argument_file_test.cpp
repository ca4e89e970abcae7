#include "platform/tools/argument_file.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/test_util.h"

namespace zor2 {
namespace {

using Strings = std::vector<std::string>;

class ArgumentFileTest : public testing::TempDirTest {
 protected:
  // The items of a file holding `content`.
  Strings Items(const std::string& content) {
    Strings items = {"kept"};
    std::string err;
    EXPECT_TRUE(ReadArgumentFile(Write("args", content), &items, &err)) << err;
    EXPECT_EQ(items[0], "kept");  // appends, never clears
    return Strings(items.begin() + 1, items.end());
  }
};

// Files that cannot be read are in the end-to-end cases (cli_argument_file_*).
TEST_F(ArgumentFileTest, SplitsOnWhiteSpace) {
  EXPECT_EQ(Items("-r a.xml\t-c\r\nb.xml\n\n  -o  out.xml"),
            (Strings{"-r", "a.xml", "-c", "b.xml", "-o", "out.xml"}));
  EXPECT_EQ(Items("-L\n"), Strings{"-L"});
  EXPECT_EQ(Items(" \t\r\n \n"), Strings{});
}

TEST_F(ArgumentFileTest, QuotesKeepBlanksInsideOneItem) {
  EXPECT_EQ(Items("-r \"my dir/a b.xml\" -c x"), (Strings{"-r", "my dir/a b.xml", "-c", "x"}));
  EXPECT_EQ(Items("\"\" x"), (Strings{"", "x"}));
  EXPECT_EQ(Items("a\"b c\"d"), Strings{"ab cd"});
  EXPECT_EQ(Items("\"tab\there\nline\""), Strings{"tab\there\nline"});
  // An unterminated quote runs to the end of the file.
  EXPECT_EQ(Items("x \"open to the end \n"), (Strings{"x", "open to the end \n"}));
  const std::string big(200000, 'v');
  EXPECT_EQ(Items("-level " + big + "\n"), (Strings{"-level", big}));
}

}  // namespace
}  // namespace zor2
