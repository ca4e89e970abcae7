#include "driver/PairLoading.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <cstdio>
#include <fstream>
#include <string>
#include <vector>

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

class LoadPairTest : public ::testing::Test {
 protected:
  void SetUp() override {
    char pattern[] = "/tmp/pair_loading_XXXXXX";
    ASSERT_NE(mkdtemp(pattern), nullptr);
    directory_ = pattern;
  }
  void TearDown() override {
    for (const char* name : {"/ref.xml", "/chk.xml"}) std::remove((directory_ + name).c_str());
    rmdir(directory_.c_str());
  }
  TAFileName Write(const char* name, const char* text) {
    std::ofstream(directory_ + "/" + name) << text;
    return TAFileName(directory_ + "/" + name);
  }
  std::string directory_;
};

TEST_F(LoadPairTest, ReadsAndPreparesBothDocuments) {
  LoadedPair pair = LoadPair(Write("ref.xml", R"(<W><M Type="unsigned long &amp;"/></W>)"),
                             Write("chk.xml", R"(<W><M Type="long long"/></W>)"));
  ASSERT_NE(pair.reference.root, nullptr);
  ASSERT_NE(pair.checked.root, nullptr);
  QEXVBTXMLPosition position = pair.reference.root->getFirstNodePosition();
  EXPECT_STREQ(pair.reference.root->getNextNode(position)->getAttributeValue("Type"),
               "QEXULONG32 &");
  position = pair.checked.root->getFirstNodePosition();
  EXPECT_STREQ(pair.checked.root->getNextNode(position)->getAttributeValue("Type"), "QEXLONG64");
}

TEST_F(LoadPairTest, ReportsEachDocumentThatCannotBeRead) {
  TAFileName missing(directory_ + "/missing.xml");
  LoadedPair pair = LoadPair(missing, Write("chk.xml", "<W><Unclosed></W>"));
  EXPECT_EQ(pair.reference.root, nullptr);
  EXPECT_EQ(pair.reference.path.str(), missing.str());
  EXPECT_EQ(pair.reference.error.reason, "No such file or directory");
  EXPECT_EQ(pair.reference.error.line, 0);
  EXPECT_EQ(pair.checked.root, nullptr);
  EXPECT_EQ(pair.checked.error.line, 1);
}

TEST_F(LoadPairTest, LoadsInTheBackground) {
  std::future<LoadedPair> loading =
      StartLoadingPair(Write("ref.xml", "<W/>"), Write("chk.xml", "<X/>"));
  LoadedPair pair = loading.get();
  ASSERT_NE(pair.checked.root, nullptr);
  EXPECT_STREQ(pair.checked.root->getTag(), "X");
}

TEST_F(LoadPairTest, ReadsThePairsOfARunInOrder) {
  std::vector<PairReader::Paths> paths;
  for (int i = 0; i < 5; ++i) {
    const std::string name = std::to_string(i) + ".xml";
    std::ofstream(directory_ + "/r" + name) << "<R" << i << "/>";
    std::ofstream(directory_ + "/c" + name) << "<C" << i << "/>";
    paths.emplace_back(TAFileName(directory_ + "/r" + name), TAFileName(directory_ + "/c" + name));
  }
  // A pair whose reference document is missing keeps its place.
  paths.insert(paths.begin() + 2, {TAFileName(directory_ + "/none.xml"), paths[0].second});
  PairReader reader(paths);
  std::string order;
  while (reader.HasNext()) {
    LoadedPair pair = reader.Next();
    order += pair.reference.root ? pair.reference.root->getTag() : "-";
    order += pair.checked.root->getTag();
  }
  EXPECT_EQ(order, "R0C0R1C1-C0R2C2R3C3R4C4");
  for (const PairReader::Paths& pair : paths) {
    std::remove(pair.first.c_str());
    std::remove(pair.second.c_str());
  }
}

}  // namespace
