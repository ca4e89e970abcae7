#include "documents/value_preparation.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "documents/type_name_normalization.h"
#include "platform/tools/xml_escaping.h"
#include "tests/test_util.h"

namespace zor2 {
namespace {

std::string Prepared(std::string_view value) {
  return testing::Rewritten(PrepareValue, value);
}

// The two steps one after the other, row by row: what the one scan must give.
std::string InTwoSteps(std::string_view value) {
  std::string normalized;
  const bool was_normalized = NormalizeTypeNames(value, &normalized);
  std::string decoded;
  if (DecodeXmlReferences(was_normalized ? normalized : std::string(value), &decoded)) {
    return decoded;
  }
  return was_normalized ? normalized : "<unchanged>";
}

TEST(PrepareValueTest, NormalisesTypeNamesThenDecodesReferences) {
  EXPECT_EQ(Prepared("int"), "<unchanged>");
  EXPECT_EQ(Prepared("unsigned long"), "QEXULONG32");
  EXPECT_EQ(Prepared("a &amp; b"), "a & b");
  EXPECT_EQ(Prepared("const unsigned long long &amp;"), "const QEXULONG64 &");
  EXPECT_EQ(Prepared("f(long a, long  long b)"), "f(QEXLONG32 a, QEXLONG64 b)");
  EXPECT_EQ(Prepared("long double"), "long double");  // a change, as the rows make it
  EXPECT_EQ(Prepared("&bad; long"), "&bad; QEXLONG32");
  // Decoding comes second: a name spelled with a reference is not normalised.
  EXPECT_EQ(Prepared("&#108;ong"), "long");
  EXPECT_EQ(Prepared("long&#32;long"), "QEXLONG32 QEXLONG32");
}

// Every sequence of up to three words and separators drawn from those the rows
// and references care about gives what the two steps give.
TEST(PrepareValueTest, GivesWhatTheTwoStepsGive) {
  const std::vector<std::string> words = {"long", "unsigned", "signed", "int",
                                          "double", "QEXDOUBLE128", "x", "&amp;"};
  const std::vector<std::string> separators = {" ", "\t ", "", "&#32;", ",", "&", "_"};
  std::vector<std::string> values = {""};
  for (int length = 0; length < 3; ++length) {
    std::vector<std::string> longer;
    for (const std::string& value : values) {
      for (const std::string& word : words) {
        for (const std::string& separator : separators) longer.push_back(value + word + separator);
      }
    }
    for (const std::string& value : longer) {
      ASSERT_EQ(Prepared(value), InTwoSteps(value)) << '"' << value << '"';
    }
    values = std::move(longer);
  }
}

}  // namespace
}  // namespace zor2
