#include "driver/pair_loading.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/test_util.h"

namespace zor2 {
namespace {

using LoadPairTest = testing::TempDirTest;

// Documents that cannot be read or parsed are in the end-to-end cases.
TEST_F(LoadPairTest, ReadsAndPreparesBothDocuments) {
  Executor executor(2);
  std::vector<PairReader::Paths> paths;
  paths.push_back(DocumentPair(Write("ref.xml", R"(<W><M Type="unsigned long &amp;"/></W>)"),
                               Write("chk.xml", R"(<W><M Type="long long"/></W>)")));
  PairReader reader(paths, true, executor);
  LoadedPair pair = reader.Next();
  EXPECT_FALSE(reader.HasNext());
  ASSERT_NE(pair.reference.document, nullptr);
  ASSERT_NE(pair.checked.document, nullptr);
  EXPECT_STREQ(pair.reference.document->root().first_child()->FindAttribute("Type"),
               "QEXULONG32 &");
  const char* checked_type = pair.checked.document->root().first_child()->FindAttribute("Type");
  EXPECT_STREQ(checked_type, "QEXLONG64");
  // The text as written is kept for what preparation changed.
  EXPECT_EQ(pair.checked.originals.Find(checked_type), "long long");
}

// Pairs are read ahead on other threads but handed out in their order.
TEST_F(LoadPairTest, ReadsThePairsOfARunInOrder) {
  std::vector<PairReader::Paths> paths;
  for (int i = 0; i < 5; ++i) {
    const std::string name = std::to_string(i) + ".xml";
    paths.push_back({Write("r" + name, "<R" + std::to_string(i) + "/>"),
                     Write("c" + name, "<C" + std::to_string(i) + "/>")});
  }
  // A pair whose reference document is missing keeps its place.
  paths.insert(paths.begin() + 2, {Path("none.xml"), paths[0].checked});
  // Without workers, the loads run on the thread that waits for them.
  for (size_t threads : {0, 1, 3}) {
    Executor executor(threads);
    PairReader reader(paths, false, executor);
    std::string order;
    while (reader.HasNext()) {
      LoadedPair pair = reader.Next();
      order += pair.reference.document ? pair.reference.document->root().tag() : "-";
      order += pair.checked.document->root().tag();
    }
    EXPECT_EQ(order, "R0C0R1C1-C0R2C2R3C3R4C4");
  }
}

}  // namespace
}  // namespace zor2
