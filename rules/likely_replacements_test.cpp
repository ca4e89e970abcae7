#include "rules/likely_replacements.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

#include "rules/method_lists.h"
#include "tests/test_util.h"

namespace zor2 {
namespace {

std::string Method(const std::string& signature) {
  return "<Method Name=\"Move\" Signature=\"" + signature + "\"/>";
}

// A deleted method is shown the overloads that look most like it, in the
// class's order, and the count of the others; a short list is shown whole.
TEST(LikelyReplacementsTest, ShowsTheMostAlikeOfManyInTheirOrder) {
  std::string cls = "<Class Name=\"K\">" + Method("void Move(short dy)");
  for (int i = 0; i < 30; ++i) cls += Method("void Move(Unrelated" + std::to_string(i) + " q)");
  cls += Method("void Move(double dx, double dy, bool animate)");
  cls += "<Method Name=\"Other\" Signature=\"void Move(double dx, double dy)\"/></Class>";
  const auto document = testing::Parse(cls);
  const FindingCollector shown(nullptr, nullptr, false);
  const std::vector<MethodRecord> methods = ReadClassMethods(document->root());
  LikelyReplacements replacements(methods);

  int more = -1;
  const std::string shown_list =
      replacements.Signatures("Move", "void Move(double dx, double dy)", shown, &more);
  EXPECT_EQ(more, 22);
  EXPECT_EQ(std::count(shown_list.begin(), shown_list.end(), '\n'), 9);
  // Sharing the beginning, and sharing the end, both count.
  const size_t animate = shown_list.find("void Move(double dx, double dy, bool animate)");
  const size_t dy = shown_list.find("void Move(short dy)");
  ASSERT_NE(animate, std::string::npos) << shown_list;
  ASSERT_NE(dy, std::string::npos) << shown_list;
  EXPECT_LT(dy, animate);  // the class's order
  EXPECT_EQ(shown_list.find("void Move(double dx, double dy)\n"), std::string::npos);

  EXPECT_EQ(replacements.Signatures("Other", "void Other()", shown, &more),
            "void Move(double dx, double dy)");
  EXPECT_EQ(more, 0);
  EXPECT_EQ(replacements.Signatures("Gone", "void Gone()", shown, &more), "");
  EXPECT_EQ(replacements.Signatures(nullptr, "void Gone()", shown, &more), "");
}

}  // namespace
}  // namespace zor2
