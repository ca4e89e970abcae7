#include "documents/type_name_normalization.h"

#include <gtest/gtest.h>

#include "tests/test_util.h"

namespace zor2 {

namespace {

std::string Normalized(std::string_view value) {
  return testing::Rewritten(NormalizeTypeNames, value);
}

}  // namespace

TEST(NormalizeTypeNamesTest, RewritesEachLongSpelling) {
  EXPECT_EQ(Normalized("unsigned long long"), "QEXULONG64");
  EXPECT_EQ(Normalized("signed long long"), "QEXLONG64");
  EXPECT_EQ(Normalized("long long"), "QEXLONG64");
  EXPECT_EQ(Normalized("unsigned long int"), "QEXULONG32");
  EXPECT_EQ(Normalized("unsigned long"), "QEXULONG32");
  EXPECT_EQ(Normalized("signed long int"), "QEXLONG32");
  EXPECT_EQ(Normalized("long int"), "QEXLONG32");
  EXPECT_EQ(Normalized("signed long"), "QEXLONG32");
  EXPECT_EQ(Normalized("long"), "QEXLONG32");
  EXPECT_EQ(Normalized("unsigned  long\tlong"), "QEXULONG64");
  EXPECT_EQ(Normalized("long long int"), "QEXLONG64 int");
}

TEST(NormalizeTypeNamesTest, KeepsLongDouble) {
  // Parked and restored: reported as a change although the text is the same.
  EXPECT_EQ(Normalized("long double"), "long double");
  EXPECT_EQ(Normalized("long  double"), "long double");
  EXPECT_EQ(Normalized("QEXDOUBLE128"), "long double");
  EXPECT_EQ(Normalized("QEXDOUBLE128*"), "long double*");
  EXPECT_EQ(Normalized("long double, long"), "long double, QEXLONG32");
}

TEST(NormalizeTypeNamesTest, RewritesInsideLargerValues) {
  EXPECT_EQ(Normalized("const long & x"), "const QEXLONG32 & x");
  EXPECT_EQ(Normalized("f(unsigned long a, long long* b)"), "f(QEXULONG32 a, QEXLONG64* b)");
  EXPECT_EQ(Normalized("as long as"), "as QEXLONG32 as");
}

TEST(NormalizeTypeNamesTest, LeavesOtherValuesAlone) {
  for (const char* value :
       {"", "int", "double", "unsigned int", "short", "char", "longer", "my_long", "Long", "LONG",
        "long_t", "QEXLONG32", "QEXDOUBLE1280", "aQEXDOUBLE128"}) {
    EXPECT_EQ(Normalized(value), "<unchanged>") << value;
  }
}

}  // namespace zor2
