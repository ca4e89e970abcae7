#include "platform/xml/xml_characters.h"

#include <gtest/gtest.h>

#include <string>

namespace zor2::xml {
namespace {

// The boundaries of well-formed UTF-8: each row is a byte sequence (followed
// by the zero that ends every text) and the length and code point expected,
// length 0 for a sequence that must be refused.
TEST(DecodeUtf8Test, AcceptsWellFormedSequencesOnly) {
  struct Row {
    std::string bytes;
    size_t length;
    char32_t code_point;
  };
  const Row rows[] = {
      {"A", 1, U'A'},
      {"\xC2\x80", 2, 0x80},
      {"\xDF\xBF", 2, 0x7FF},
      {"\xE0\xA0\x80", 3, 0x800},
      {"\xED\x9F\xBF", 3, 0xD7FF},
      {"\xEE\x80\x80", 3, 0xE000},
      {"\xEF\xBF\xBF", 3, 0xFFFF},
      {"\xF0\x90\x80\x80", 4, 0x10000},
      {"\xF4\x8F\xBF\xBF", 4, 0x10FFFF},
      {"\x80", 0, 0},              // a continuation byte alone
      {"\xC0\xAF", 0, 0},          // overlong two-byte form
      {"\xC1\xBF", 0, 0},          // overlong two-byte form
      {"\xE0\x9F\xBF", 0, 0},      // overlong three-byte form
      {"\xF0\x8F\xBF\xBF", 0, 0},  // overlong four-byte form
      {"\xED\xA0\x80", 0, 0},      // a surrogate
      {"\xF4\x90\x80\x80", 0, 0},  // beyond U+10FFFF
      {"\xF5\x80\x80\x80", 0, 0},
      {"\xFF", 0, 0},
      {"\xE2\x82", 0, 0},      // cut short by the end of the text
      {"\xE2\x82\x41", 0, 0},  // cut short by "A"
  };
  for (const Row& row : rows) {
    char32_t code_point = 0;
    EXPECT_EQ(DecodeUtf8(row.bytes, &code_point), row.length) << row.bytes;
    if (row.length != 0) {
      EXPECT_EQ(code_point, row.code_point) << row.bytes;
    }
  }
}

TEST(IsXmlCharacterTest, FollowsTheCharProduction) {
  for (char32_t allowed : {0x9, 0xA, 0xD, 0x20, 0xD7FF, 0xE000, 0xFFFD, 0x10000, 0x10FFFF}) {
    EXPECT_TRUE(IsXmlCharacter(allowed)) << CodePointName(allowed);
  }
  for (char32_t refused : {0x0, 0x1, 0x8, 0xB, 0x1F, 0xD800, 0xDFFF, 0xFFFE, 0xFFFF, 0x110000}) {
    EXPECT_FALSE(IsXmlCharacter(refused)) << CodePointName(refused);
  }
}

}  // namespace
}  // namespace zor2::xml
