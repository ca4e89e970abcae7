#include "describe/compile_database.h"

#include <gtest/gtest.h>

namespace zor2::describe {
namespace {

TEST(FlagsOfCommand, KeepsWhatReadingHeadersNeedWithAbsolutePaths) {
  const BuildFlags flags =
      FlagsOfCommand({"g++",   "-O2",       "-Iinclude", "-I",       "/opt/x", "-isystem",
                      "third", "-DA=1",     "-D",        "B",        "-UC",    "-std=gnu++17",
                      "-Wall", "-fno-rtti", "-fPIC",     "-include", "pre.h",  "-include-pch",
                      "p.pch", "-c",        "a.cpp",     "-o",       "a.o"},
                     "/build");
  EXPECT_EQ(flags.arguments, (std::vector<std::string>{
                                 "-I", "/build/include", "-I", "/opt/x", "-isystem", "/build/third",
                                 "-DA=1", "-DB", "-UC", "-fno-rtti", "-include", "/build/pre.h"}));
  EXPECT_EQ(flags.standard, "gnu++17");
}

TEST(FlagsOfCommand, NamesNewerStandardsAsThisClangKnowsThem) {
  EXPECT_EQ(FlagsOfCommand({"c++", "-std=c++23"}, "/").standard, "c++2b");
  EXPECT_FALSE(FlagsOfCommand({"c++", "-I"}, "/").standard);
  EXPECT_TRUE(FlagsOfCommand({"c++", "-I"}, "/").arguments.empty());
}

}  // namespace
}  // namespace zor2::describe
