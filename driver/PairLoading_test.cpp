#include "driver/PairLoading.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/TempDir.h"

namespace {

// The prepared value, or "<unchanged>" when PrepareValue answers 0.
std::string Prepared(std::string_view value) {
  std::string out = "<unchanged>";
  int result = PrepareValue(value, out);
  EXPECT_EQ(result != 0, out != "<unchanged>") << value;
  return out;
}

TEST(PrepareValueTest, NormalisesTypeNamesThenDecodesReferences) {
  EXPECT_EQ(Prepared("int"), "<unchanged>");
  EXPECT_EQ(Prepared("unsigned long"), "QEXULONG32");
  EXPECT_EQ(Prepared("a &amp; b"), "a & b");
  EXPECT_EQ(Prepared("const unsigned long long &amp;"), "const QEXULONG64 &");
  EXPECT_EQ(Prepared("f(long a, long  long b)"), "f(QEXLONG32 a, QEXLONG64 b)");
  // Decoding comes second: a name spelled with a reference is not normalised.
  EXPECT_EQ(Prepared("&#108;ong"), "long");
  EXPECT_EQ(Prepared("long&#32;long"), "QEXLONG32 QEXLONG32");
}

using LoadPairTest = TempDirTest;

// Documents that cannot be read or parsed are in the end-to-end cases.
TEST_F(LoadPairTest, ReadsAndPreparesBothDocuments) {
  LoadedPair pair =
      LoadPair(TAFileName(Write("ref.xml", R"(<W><M Type="unsigned long &amp;"/></W>)")),
               TAFileName(Write("chk.xml", R"(<W><M Type="long long"/></W>)")));
  ASSERT_NE(pair.reference.root, nullptr);
  ASSERT_NE(pair.checked.root, nullptr);
  QEXVBTXMLPosition position = pair.reference.root->getFirstNodePosition();
  EXPECT_STREQ(pair.reference.root->getNextNode(position)->getAttributeValue("Type"),
               "QEXULONG32 &");
  position = pair.checked.root->getFirstNodePosition();
  EXPECT_STREQ(pair.checked.root->getNextNode(position)->getAttributeValue("Type"), "QEXLONG64");
}

// Pairs are read ahead on other threads but handed out in their order.
TEST_F(LoadPairTest, ReadsThePairsOfARunInOrder) {
  std::vector<PairReader::Paths> paths;
  for (int i = 0; i < 5; ++i) {
    const std::string name = std::to_string(i) + ".xml";
    paths.emplace_back(TAFileName(Write("r" + name, "<R" + std::to_string(i) + "/>")),
                       TAFileName(Write("c" + name, "<C" + std::to_string(i) + "/>")));
  }
  // A pair whose reference document is missing keeps its place.
  paths.insert(paths.begin() + 2, {TAFileName(Path("none.xml")), paths[0].second});
  PairReader reader(paths);
  std::string order;
  while (reader.HasNext()) {
    LoadedPair pair = reader.Next();
    order += pair.reference.root ? pair.reference.root->getTag() : "-";
    order += pair.checked.root->getTag();
  }
  EXPECT_EQ(order, "R0C0R1C1-C0R2C2R3C3R4C4");
}

}  // namespace
