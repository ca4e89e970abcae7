#include "platform/xml/reader.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "platform/tools/xml_escaping.h"
#include "tests/test_util.h"

namespace zor2::xml {
namespace {

using testing::ChildTags;

// The root of the document parsed from `text`, kept alive with it.
struct Parsed {
  std::unique_ptr<Document> document;
  const Element* operator->() const { return &document->root(); }
  const Element& operator*() const { return document->root(); }
  bool ok() const { return document != nullptr; }
};

Parsed Parse(std::string_view text) {
  return {testing::Parse(text)};
}

// Whether `text` fails to read, with `err` telling why.
bool Fails(std::string_view text, ReadError* err) {
  std::unique_ptr<Document> document;
  return !ReadDocumentText(text, &document, err) && document == nullptr;
}

TEST(ReaderTest, HandsOverValuesRawAndAcceptsAtInNames) {
  auto root = Parse(
      "<@root a=\"x &amp; &#10; &undefined; y\" b='tab\there\nline\r\nend' c=\"it's\" "
      "d='say \"hi\"' e=\"\" @ZOR2Level = \"L1 x\"\n @nodoc=\"\" in@side=\"1\" _x.y-1:z=\"2\">"
      "<@child/></@root>");
  ASSERT_TRUE(root.ok());
  EXPECT_STREQ(root->tag(), "@root");
  EXPECT_STREQ(root->FindAttribute("a"), "x &amp; &#10; &undefined; y");
  EXPECT_STREQ(root->FindAttribute("b"), "tab\there\nline\r\nend");
  EXPECT_STREQ(root->FindAttribute("c"), "it's");
  EXPECT_STREQ(root->FindAttribute("d"), "say \"hi\"");
  EXPECT_STREQ(root->FindAttribute("e"), "");
  EXPECT_STREQ(root->FindAttribute("@ZOR2Level"), "L1 x");
  EXPECT_STREQ(root->FindAttribute("in@side"), "1");
  EXPECT_STREQ(root->FindAttribute("_x.y-1:z"), "2");
  EXPECT_EQ(root->FindAttribute("@ZOR2"), nullptr);
  EXPECT_EQ(root->FindAttribute("@ZOR2Levels"), nullptr);
  EXPECT_EQ(ChildTags(*root), std::vector<std::string>{"@child"});
}

TEST(ReaderTest, SkipsDeclarationCommentsInstructionsDoctypeCdataAndText) {
  auto root = Parse(
      "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
      "<!-- a comment - with > and <tags> -->\n<?pi before?>\n"
      "<!DOCTYPE r SYSTEM \"r.dtd\" [\n"
      "  <!ENTITY e \"EXPANDED]>\">\n  <!-- ] > ' -->\n  <?pi ]>?>\n  <!ATTLIST r a CDATA 'x'>\n"
      "]>\n"
      "<r a=\"&e;\">&e; text > with &amp; <![CDATA[<not-a-tag> ]] ]]>"
      "<one/><!-- <two/> --><?pi <three/>?><four></four></r>\n<!-- after -->\n<?pi after?>\n");
  ASSERT_TRUE(root.ok());
  EXPECT_STREQ(root->FindAttribute("a"), "&e;");
  EXPECT_EQ(ChildTags(*root), (std::vector<std::string>{"one", "four"}));
}

std::string Utf16(std::u16string_view text, bool little_endian) {
  std::string bytes = little_endian ? "\xFF\xFE" : "\xFE\xFF";
  for (char16_t c : text) {
    char high = static_cast<char>(c >> 8), low = static_cast<char>(c & 0xFF);
    bytes += little_endian ? low : high;
    bytes += little_endian ? high : low;
  }
  return bytes;
}

std::string Utf32(std::u32string_view text, bool little_endian) {
  std::u32string characters = U"\uFEFF";
  characters += text;
  std::string bytes;
  for (char32_t c : characters) {
    for (int i = 0; i < 4; ++i) {
      int shift = little_endian ? 8 * i : 8 * (3 - i);
      bytes += static_cast<char>((c >> shift) & 0xFF);
    }
  }
  return bytes;
}

struct FaultCase {
  std::string text;
  std::string reason;
  int line;
  int column;
};

// The faults that whole runs meet (empty, garbage, truncated, unclosed,
// mismatched, duplicated) are in the end-to-end cases; these are the others.
TEST(ReaderTest, ReportsFaultsWithLineAndColumn) {
  const FaultCase cases[] = {
      {"  \n  <!-- only -->\n ", "no root element", 3, 2},
      {"<a></a>\ntext", "text after the root element", 2, 1},
      {"<a></a><b/>", "more than one root element", 1, 8},
      {"<a><b/></a", "unexpected end of document, expected '>' to close end tag </a>", 1, 11},
      {"</a>", "end tag without a start tag", 1, 1},
      {"<a b=1/>", "expected a quoted attribute value", 1, 6},
      {"<a b=\"<\"/>", "'<' is not allowed in an attribute value", 1, 7},
      {std::string("<a b=\"x\0y\"/>", 12), "expected the closing quote", 1, 8},
      {"<a b=\"1\"c=\"2\"/>", "white space expected before an attribute name", 1, 9},
      // The line feed after "b" is overwritten by the reader; lines still count it.
      {"<a b\n=\"1\" c=\"2\" c=\"3\"/>", "duplicate attribute \"c\"", 2, 12},
      // Columns count characters, not bytes.
      {"<a \xC3\xA9=\"1\" \xC3\xA9=\"2\"/>", "duplicate attribute \"\xC3\xA9\"", 1, 10},
      {"<a><!-- open </a>", "comment is not closed", 1, 4},
      {"<![CDATA[x]]><a/>", "CDATA section outside the root element", 1, 1},
      {"<a/><!DOCTYPE a>", "DOCTYPE after the root element", 1, 5},
      {"<a>\n<?xml version='1.0'?></a>", "XML declaration not at the start of the document", 2, 1},
      {"<?xml version=\"1.0\" encoding=\"X-NOPE\"?><a/>", "unknown encoding \"X-NOPE\"", 1, 31},
      {"<?xml version=\"1.0\" encoding=\"UTF-8//IGNORE\"?><a/>", "invalid encoding name", 1, 31},
      {"<?xml version=\"1.0\" encoding=\"UTF-16\"?><a/>", "encoding \"UTF-16\" declared", 1, 31},
      // A lone surrogate: the fault is placed after what was converted.
      {Utf16(u"<a>\n <b x=\"\xD800\"/></a>", true), "byte sequence not valid", 2, 8},
      // Positions in converted documents count characters.
      {Utf16(u"<a>\n <\u00E9 x='1' x='2'/></a>", true), "duplicate attribute \"x\"", 2, 11},
  };
  for (const FaultCase& c : cases) {
    ReadError error;
    EXPECT_TRUE(Fails(c.text, &error)) << c.reason;
    EXPECT_EQ(error.reason.substr(0, c.reason.size()), c.reason);
    EXPECT_EQ(error.line, c.line) << c.reason;
    EXPECT_EQ(error.column, c.column) << c.reason;
  }
}

// UTF-16 with a byte order mark is in the end-to-end cases.
TEST(ReaderTest, ConvertsOtherEncodingsToUTF8) {
  const std::string documents[] = {
      "\xEF\xBB\xBF<a x=\"\xE2\x82\xAC\xC3\xA9\"/>",
      Utf16(u"<?xml version=\"1.0\" encoding=\"UTF-16\"?><a x=\"\u20AC\u00E9\"/>", true),
      Utf32(U"<a x=\"\u20AC\u00E9\"/>", true),
      Utf32(U"<a x=\"\u20AC\u00E9\"/>", false),
      "<?xml version=\"1.0\" encoding=\"windows-1252\"?>\n<a x=\"\x80\xE9\"/>",
  };
  for (const std::string& document : documents) {
    auto root = Parse(document);
    ASSERT_TRUE(root.ok());
    EXPECT_EQ(std::string(root->FindAttribute("x")), "\xE2\x82\xAC\xC3\xA9");
  }
  auto latin1 = Parse("<?xml version='1.0' encoding='ISO-8859-1' ?><a x='\xE9'/>");
  ASSERT_TRUE(latin1.ok());
  EXPECT_STREQ(latin1->FindAttribute("x"), "\xC3\xA9");
}

TEST(ReaderTest, ReadsDeepDocumentsWithoutRecursion) {
  const int depth = 100000;
  std::string text;
  for (int i = 0; i < depth; ++i) text += "<e v=\"long\">";
  for (int i = 0; i < depth; ++i) text += "</e>";
  auto root = Parse(text);
  ASSERT_TRUE(root.ok());
  root.document->RewriteValues([](std::string_view, std::string* out) {
    *out = "QEXLONG32";
    return true;
  });
  int levels = 1;
  for (const Element* element = &*root; (element = element->first_child()) != nullptr;) {
    EXPECT_STREQ(element->FindAttribute("v"), "QEXLONG32");
    ++levels;
  }
  EXPECT_EQ(levels, depth);
}

// Duplicates among many attributes are in the end-to-end cases. After a large
// element, whose names go through a hash set, small ones are compared pairwise
// again, and only among themselves.
TEST(ReaderTest, SmallElementsAfterALargeOne) {
  std::string text = "<r><a";
  for (int i = 0; i < 100; ++i) text += " a" + std::to_string(i) + "=\"v\"";
  EXPECT_TRUE(Parse(text + "/><b a1='1' a2='2'/></r>").ok());
  ReadError error;
  EXPECT_TRUE(Fails(text + "/><b x='1' x='2'/></r>", &error));
  EXPECT_EQ(error.reason, "duplicate attribute \"x\"");
}

// The whole tree of `element`, with the values of the attributes it may have.
std::string Dump(const Element& element) {
  std::string text = std::string("<") + element.tag();
  for (const char* name : {"Name", "v", "Type", "a"}) {
    if (const char* value = element.FindAttribute(name)) text.append(" ").append(value);
  }
  text += ">";
  for (const Element* child = element.first_child(); child; child = child->next_sibling()) {
    text += Dump(*child);
  }
  return text + "</>";
}

using WindowedReaderTest = testing::TempDirTest;

// A document of several megabytes is read window by window; it must read as
// the same text read whole: elements, values, their preparation and the
// originals kept, and where a fault is, with "<" in comments across windows
// and line ends of every kind.
TEST_F(WindowedReaderTest, ReadsLargeDocumentsAsTheSameTextReadWhole) {
  std::string text = "\xEF\xBB\xBF<?xml version=\"1.0\" encoding=\"UTF-8\"?>\r\n<W>";
  for (int i = 0; text.size() < (size_t{5} << 20); ++i) {
    const std::string n = std::to_string(i);
    text += "<F Name=\"F" + n + "\"\r\n  v='a &amp; b &lt; " + n + "'><!-- <not> <a> <tag> -->";
    text += "\r<M Name=\"m\" Type=\"x &#65;\"/><M\n Name='m" + n + "'/>text</F>\n";
  }
  const std::string good = text + "</W>";
  const std::string bad = text + "<Last a=\"1\" a=\"2\"/></W>";
  for (const std::string* document : {&good, &bad}) {
    std::unique_ptr<Document> whole;
    ReadError whole_err;
    const bool whole_read = ReadDocumentText(*document, &whole, &whole_err);
    OriginalValues whole_originals;
    if (whole_read) whole->RewriteValues(DecodeXmlReferences, &whole_originals);

    std::unique_ptr<Document> windowed;
    ReadError windowed_err;
    OriginalValues windowed_originals;
    const bool windowed_read =
        ReadDocumentFile(Write("doc.xml", *document), MemoryLimit(),
                         {DecodeXmlReferences, &windowed_originals}, &windowed, &windowed_err);
    ASSERT_EQ(windowed_read, whole_read);
    EXPECT_EQ(windowed_read, document == &good);
    EXPECT_EQ(windowed_err.reason, whole_err.reason);
    EXPECT_EQ(windowed_err.line, whole_err.line);
    EXPECT_EQ(windowed_err.column, whole_err.column);
    if (!whole_read) continue;
    EXPECT_EQ(Dump(windowed->root()), Dump(whole->root()));
    const Element* last = windowed->root().first_child();
    while (last->next_sibling() != nullptr) last = last->next_sibling();
    const std::string written = std::string("a &amp; b &lt; ") + (last->FindAttribute("Name") + 1);
    EXPECT_EQ(windowed_originals.Find(last->FindAttribute("v")), written);
  }
}

}  // namespace
}  // namespace zor2::xml
