#include "describe/include_order.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

namespace zor2::describe {
namespace {

TEST(IncludedNames, ReadsDirectivesOnlyOutsideComments) {
  EXPECT_EQ(IncludedNames("#include \"a.h\"\n  #  include <lib/b.h>\n// #include \"c.h\"\n"
                          "/* #include \"d.h\" */ int x; #include \"e.h\"\n#include_next <f.h>\n"
                          "#include MACRO\n#include \"unclosed\n"),
            (std::vector<std::string>{"a.h", "lib/b.h"}));
}

TEST(IncludeOrder, PutsHeadersThatOthersIncludeLast) {
  const std::string dir = ::testing::TempDir() + "/include_order";
  std::filesystem::create_directories(dir + "/lib");
  std::ofstream(dir + "/lib/logger-inl.h") << "#pragma once\n#include <lib/logger.h>\n";
  std::ofstream(dir + "/lib/logger.h") << "#pragma once\n#include \"logger-inl.h\"\n";
  std::ofstream(dir + "/lib/sink.h") << "#include <lib/logger.h>\n";
  std::ofstream(dir + "/lib/zone.h") << "#include <vector>\n";
  const std::vector<std::string> headers = {"lib/logger-inl.h", "lib/logger.h", "lib/sink.h",
                                            "lib/zone.h"};
  EXPECT_EQ(IncludeOrder(dir, headers, {dir}), (std::vector<size_t>{2, 3, 1, 0}));
  std::filesystem::remove_all(dir);
}

}  // namespace
}  // namespace zor2::describe
