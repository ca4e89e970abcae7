#include "describe/source_scan.h"

#include <gtest/gtest.h>

#include <vector>

namespace zor2::describe {
namespace {

TEST(ScanDirectives, TellsCodeFromCommentsAndDirectives) {
  EXPECT_FALSE(ScanDirectives("// only\n/* comments */\n#pragma once\n#define A \\\n  1\n"));
  EXPECT_TRUE(ScanDirectives("#pragma once\nstruct A;\n"));
  // A '#' that does not start its line is code.
  EXPECT_TRUE(ScanDirectives("int a; # define B\n"));
  std::vector<std::string> directives;
  ScanDirectives("#include <a.h>\n  #  if X\n/* #include \"no.h\" */\n",
                 [&](std::string_view directive) { directives.emplace_back(directive); });
  EXPECT_EQ(directives, (std::vector<std::string>{"include <a.h>", "  if X"}));
}

TEST(IncludeTarget, KeepsTheDelimitersOfIncludesOnly) {
  EXPECT_EQ(IncludeTarget("include <lib/b.h>"), "<lib/b.h>");
  EXPECT_EQ(IncludeTarget(" include\t\"c.h\" // note"), "\"c.h\"");
  EXPECT_EQ(IncludeTarget("include_next <stdlib.h>"), "");
  EXPECT_EQ(IncludeTarget("include HEADER"), "");
  EXPECT_EQ(IncludeTarget("include \"open"), "");
  EXPECT_EQ(IncludeTarget("define include"), "");
}

TEST(DirectiveAt, FindsTheDirectiveOfTheLineOfAnOffset) {
  const std::string_view source = "int a;\n  #include <x.h>\nint b;\n";
  EXPECT_EQ(DirectiveAt(source, 12), "include <x.h>");
  EXPECT_EQ(DirectiveAt(source, 0), "");
  EXPECT_EQ(DirectiveAt(source, 27), "");
  EXPECT_EQ(DirectiveAt(source, 1000), "");
}

}  // namespace
}  // namespace zor2::describe
