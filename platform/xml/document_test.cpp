#include "platform/xml/document.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "platform/tools/xml_escaping.h"
#include "tests/test_util.h"

namespace zor2::xml {
namespace {

using testing::Parse;

// Every attribute of every element, in document order, as "tag.name=value".
std::string Values(const Document& document) {
  std::string values;
  std::vector<const Element*> pending = {&document.root()};
  while (!pending.empty()) {
    const Element* element = pending.back();
    pending.pop_back();
    std::vector<const Element*> children;
    for (const Element* child = element->first_child(); child; child = child->next_sibling()) {
      children.push_back(child);
    }
    pending.insert(pending.end(), children.rbegin(), children.rend());
    for (const char* name : {"v", "t", "n", "w"}) {
      if (const char* value = element->FindAttribute(name)) {
        values += std::string(element->tag()) + "." + name + "=" + value + " ";
      }
    }
  }
  return values;
}

bool Longer(std::string_view value, std::string* out) {
  if (value != "long") return false;
  *out = "QEXLONG32";
  return true;
}

TEST(DocumentTest, RewriteValuesReachesEveryValue) {
  auto document = Parse(
      "<r v='1'><a v='2' t=\"long\" n='a &amp; b' w='long'><b v='3'/></a><c v='4' t='long'/></r>");
  const char* before = document->root().first_child()->FindAttribute("v");
  document->RewriteValues(Longer);               // grows: moved out of the block
  document->RewriteValues(DecodeXmlReferences);  // shrinks: rewritten in place
  EXPECT_STREQ(before, "2");
  EXPECT_EQ(Values(*document),
            "r.v=1 a.v=2 a.t=QEXLONG32 a.n=a & b a.w=QEXLONG32 b.v=3 c.v=4 c.t=QEXLONG32 ");
}

// Every value grows: "+" and a digit per character are appended.
bool Grow(std::string_view value, std::string* out) {
  out->assign(value);
  *out += '+';
  out->append(value.size(), static_cast<char>('0' + value.size() % 10));
  return true;
}

TEST(DocumentTest, GrownValuesFindRoomWhateverTheirSize) {
  // Values under three characters cannot point to a new home and have their
  // block rebuilt; longer ones move until the document's spare capacity is
  // used up, then have their block rebuilt too.
  const std::vector<std::string> values = {"", "x", "abc", "abcdefgh", std::string(40, 'v')};
  std::string text = "<r>";
  for (int i = 0; i < 20; ++i) {
    text += "<e";
    for (size_t v = 0; v < values.size(); ++v) {
      text.append(" a").append(std::to_string(v)).append("=\"").append(values[v]).append("\"");
    }
    text += "/>";
  }
  auto document = Parse(text + "</r>");
  for (int pass = 0; pass < 3; ++pass) document->RewriteValues(Grow);
  std::vector<std::string> grown = values;
  for (std::string& value : grown) {
    for (int pass = 0; pass < 3; ++pass) Grow(std::string(value), &value);
  }
  for (const Element* e = document->root().first_child(); e; e = e->next_sibling()) {
    for (size_t v = 0; v < values.size(); ++v) {
      std::string name = "a";
      name += std::to_string(v);
      EXPECT_EQ(e->FindAttribute(name.c_str()), grown[v]);
    }
  }
}

TEST(DocumentTest, RewrittenValuesEndAtAZeroByte) {
  auto document = Parse("<r a='abcdef' b='x'/>");
  document->RewriteValues([](std::string_view value, std::string* out) {
    if (value != "abcdef") return false;
    *out = std::string("ab\0cd", 5);
    return true;
  });
  EXPECT_STREQ(document->root().FindAttribute("a"), "ab");
  EXPECT_STREQ(document->root().FindAttribute("b"), "x");
}

TEST(DocumentTest, FindAttributesAnswersInAnyOrder) {
  auto document = Parse("<r a='1' b='2' c='3'/>");
  static constexpr std::string_view kNames[] = {"c", "x", "a", "b"};
  const char* values[4];
  document->root().FindAttributes(kNames, values);
  EXPECT_STREQ(values[0], "3");
  EXPECT_EQ(values[1], nullptr);
  EXPECT_STREQ(values[2], "1");
  EXPECT_STREQ(values[3], "2");
}

}  // namespace
}  // namespace zor2::xml
