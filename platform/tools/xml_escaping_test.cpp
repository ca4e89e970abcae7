#include "platform/tools/xml_escaping.h"

#include <gtest/gtest.h>

#include "tests/test_util.h"

namespace zor2 {

namespace {

std::string Decoded(std::string_view value) {
  return testing::Rewritten(DecodeXmlReferences, value);
}

}  // namespace

// The report's values, help texts included, go through both in every
// end-to-end case (report_values_escaped_again shows the named references).
TEST(AppendEscapedTest, EscapesMarkupQuotesAndLineBlanks) {
  std::string out = "kept:";
  AppendEscaped("plain text (0)", &out);
  EXPECT_EQ(out, "kept:plain text (0)");
  out.clear();
  AppendEscaped("a&b<c>d\"e'f\tg\nh\ri", &out);
  EXPECT_EQ(out, "a&amp;b&lt;c&gt;d&quot;e&apos;f&#9;g&#10;h&#13;i");
}

TEST(DecodeXmlReferencesTest, DecodesNamedAndCharacterReferences) {
  EXPECT_EQ(Decoded("no reference"), "<unchanged>");
  EXPECT_EQ(Decoded("&#65;&#x41;&#x4a;&#x4A;&#0065;"), "AAJJA");
  EXPECT_EQ(Decoded("&#9;&#10;&#13;"), "\t\n\r");
  EXPECT_EQ(Decoded("&#xE9;"), "\xC3\xA9");
  EXPECT_EQ(Decoded("&#x20AC;"), "\xE2\x82\xAC");
  EXPECT_EQ(Decoded("&#x10FFFF;"), "\xF4\x8F\xBF\xBF");
  EXPECT_EQ(Decoded("&#1114111;"), "\xF4\x8F\xBF\xBF");
  // One pass: decoded text is not decoded again.
  EXPECT_EQ(Decoded("&amp;lt;"), "&lt;");
  EXPECT_EQ(Decoded("&&amp;"), "&&");
}

TEST(DecodeXmlReferencesTest, LeavesMalformedReferencesAsTheyStand) {
  for (const char* bad :
       {"&", "&amp", "& amp;", "&AMP;", "&nbsp;", "&#;", "&#x;", "&#X41;", "&#65", "&#6 5;",
        "&#x4G;", "&#0;", "&#xD800;", "&#xDFFF;", "&#x110000;", "&#1114112;",
        "&#99999999999999999999999;", "&#x00000000000000000000000FFFFFFFF41;"}) {
    EXPECT_EQ(Decoded(bad), "<unchanged>") << bad;
  }
  EXPECT_EQ(Decoded("&bad; &lt; &#0;"), "&bad; < &#0;");
  // Leading zeros are digits like any other, however many.
  EXPECT_EQ(Decoded("&#x" + std::string(1000, '0') + "41;"), "A");
}

TEST(XmlEscapingTest, EncodeThenDecodeGivesTheValueBack) {
  const std::string value = "if (a < b && c > 'd') \"e\"\t\r\n&#65; &amp; \xC3\xA9";
  std::string encoded;
  AppendEscaped(value, &encoded);
  std::string decoded;
  ASSERT_TRUE(DecodeXmlReferences(encoded, &decoded));
  EXPECT_EQ(decoded, value);
}

}  // namespace zor2
