#include "documents/export_markdown.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace zor2 {
namespace {

TEST(MarkdownTextTest, EscapesMarkupAndKeepsLineBreaksInsideACell) {
  EXPECT_EQ(MarkdownText("a|b *c* _d_ [e](f) <g> `h` #1 @me $x$ ~i~ &amp; \\"),
            "a\\|b \\*c\\* \\_d\\_ \\[e\\](f) \\<g\\> \\`h\\` \\#1 \\@me \\$x\\$ \\~i\\~ "
            "\\&amp; \\\\");
  EXPECT_EQ(MarkdownText("one\r\ntwo\rthree"), "one<br>two<br>three");
}

// Hosting services turn URLs, "www." names and e-mail addresses into links,
// the last whatever their escapes: each is broken up where it would start.
TEST(MarkdownTextTest, BreaksUpWhatWouldBecomeALink) {
  EXPECT_EQ(MarkdownText("https://a.example www.b.com WWW.c.com wwwx.d FAILED: 1"),
            "https\\://a.example www\\.b.com WWW\\.c.com wwwx.d FAILED: 1");
  EXPECT_EQ(MarkdownText("me@x.com @team"), "me<!-- -->\\@x.com \\@team");
}

TEST(MarkdownCodeTest, FencesLongerThanAnyBacktickRunAndEscapesPipes) {
  EXPECT_EQ(MarkdownCode("const String& s"), "`const String& s`");
  EXPECT_EQ(MarkdownCode("a | b"), "`a \\| b`");
  EXPECT_EQ(MarkdownCode("x ``y`` z"), "```x ``y`` z```");
  // A backtick at either end would join the fence without the blanks.
  EXPECT_EQ(MarkdownCode("`q`"), "`` `q` ``");
  EXPECT_EQ(MarkdownCode("void Run(long a)\nvoid Run(short a)"),
            "`void Run(long a)`<br>`void Run(short a)`");
  EXPECT_EQ(MarkdownCode(""), "");
  // A lone carriage return ends a line as a line feed does.
  EXPECT_EQ(MarkdownCode("a\r[x](y)\r\nb"), "`a`<br>`[x](y)`<br>`b`");
  // A span would show blanks as nothing.
  EXPECT_EQ(MarkdownCode("  \t\r\n"), "*blank: 2 spaces, 1 tab, 1 line break*");
}

Finding At(std::string framework, std::string file, MessageCode code, std::string reference,
           std::string checked) {
  return {code, std::move(framework), "Public",           std::move(file), "K", "",      "",
          "",   std::move(reference), std::move(checked), false,           "",  nullptr, ""};
}

TEST(ExportMarkdownTest, GroupsFindingsByFrameworkAndFileWithValuesSideBySide) {
  std::vector<Finding> findings = {
      At("Geo", "Point.h", MessageCode::kMRTHC, "double", "float"),
      At("Doc", "Doc.h", MessageCode::kADVHC, "", "1"),
      At("Geo", "Point.h", MessageCode::kPMHC, "P", "R"),
  };
  findings[1].accepted = true;
  findings[1].reason = std::string("agreed | see #4");
  RunSummary summary;
  const std::string markdown = ExportMarkdown({}, summary, findings);

  const size_t geo = markdown.find("#### Framework Geo\n");
  const size_t point = markdown.find("##### Public: Point.h\n");
  const size_t mrthc = markdown.find("| `MRTHC` | `K` |  | `double` | `float` | new |\n");
  const size_t pmhc = markdown.find("| `PMHC` | `K` |  | `P` | `R` | new |\n");
  const size_t doc = markdown.find("#### Framework Doc\n");
  const size_t advhc =
      markdown.find("| `ADVHC` | `K` |  | *none* | `1` | accepted: agreed \\| see \\#4 |\n");
  ASSERT_NE(geo, std::string::npos);
  ASSERT_NE(point, std::string::npos);
  ASSERT_NE(mrthc, std::string::npos);
  ASSERT_NE(pmhc, std::string::npos);
  ASSERT_NE(doc, std::string::npos);
  ASSERT_NE(advhc, std::string::npos);
  EXPECT_LT(geo, point);
  EXPECT_LT(point, mrthc);
  EXPECT_LT(mrthc, pmhc);
  EXPECT_LT(pmhc, doc);
  EXPECT_LT(doc, advhc);
  EXPECT_EQ(markdown.find("#### Framework Geo", geo + 1), std::string::npos);
}

}  // namespace
}  // namespace zor2
