#include "describe/describe_options.h"

#include <gtest/gtest.h>

#include <sstream>

#include "platform/tools/version.h"
#include "tests/test_util.h"

namespace zor2::describe {
namespace {

struct Outcome {
  std::optional<DescribeStatus> status;
  DescribeOptions options;
  std::string out;
  std::string err;
};

Outcome Read(std::vector<const char*> arguments) {
  arguments.insert(arguments.begin(), "zor2describe");
  Outcome outcome;
  std::ostringstream out;
  std::ostringstream err;
  outcome.status = ReadDescribeCommandLine(static_cast<int>(arguments.size()), arguments.data(),
                                           &outcome.options, out, err);
  outcome.out = out.str();
  outcome.err = err.str();
  return outcome;
}

TEST(ReadDescribeCommandLine, FillsEveryOptionInAnyOrder) {
  const Outcome outcome = Read({"-o",
                                "out.xml",
                                "-I",
                                "inc1",
                                "-D",
                                "A=1",
                                "-public",
                                "old",
                                "-framework",
                                "Geo",
                                "-protected",
                                "prot",
                                "-I",
                                "inc2",
                                "-D",
                                "B",
                                "-std",
                                "c++20",
                                "-default-level",
                                "L1",
                                "-default-usage",
                                "U3",
                                "-public",
                                "pub"});
  ASSERT_FALSE(outcome.status.has_value()) << outcome.err;
  const DescribeOptions& options = outcome.options;
  EXPECT_EQ(options.framework, "Geo");
  EXPECT_EQ(options.public_dir, "pub");  // a later occurrence wins
  EXPECT_EQ(options.protected_dir, "prot");
  EXPECT_EQ(options.include_dirs, (std::vector<std::string>{"inc1", "inc2"}));
  EXPECT_EQ(options.defines, (std::vector<std::string>{"A=1", "B"}));
  EXPECT_EQ(options.standard, "c++20");
  EXPECT_EQ(options.default_level, "L1");
  EXPECT_EQ(options.default_usage, "U3");
  EXPECT_EQ(options.output, "out.xml");
  EXPECT_EQ(outcome.err, "");
}

TEST(ReadDescribeCommandLine, DefaultsWhenOnlyTheRequiredOptionsAreGiven) {
  const Outcome outcome = Read({"-framework", "F", "-public", "p", "-o", "o.xml"});
  ASSERT_FALSE(outcome.status.has_value());
  EXPECT_FALSE(outcome.options.standard || outcome.options.protected_dir ||
               outcome.options.default_level || outcome.options.default_usage ||
               outcome.options.build_dir);
}

TEST(ReadDescribeCommandLine, HelpWinsUnlessTakenAsAValue) {
  const Outcome help = Read({"-x", "-h", "-public"});
  EXPECT_EQ(help.status, DescribeStatus::kDone);
  EXPECT_EQ(help.out, kDescribeUsage);
  EXPECT_EQ(help.err, "zor2describe: Unknown option or missing arguments -x\n");

  const Outcome value = Read({"-framework", "-h", "-public", "p", "-o", "o.xml"});
  EXPECT_FALSE(value.status.has_value());
  EXPECT_EQ(value.options.framework, "-h");
}

TEST(ReadDescribeCommandLine, LongFormsForHelpAndVersion) {
  const Outcome help = Read({"--help"});
  EXPECT_EQ(help.status, DescribeStatus::kDone);
  EXPECT_EQ(help.out, kDescribeUsage);

  const Outcome version = Read({"-o", "o.xml", "--version", "-public"});
  EXPECT_EQ(version.status, DescribeStatus::kDone);
  EXPECT_EQ(version.out, std::string("zor2describe ") + kVersion + "\n");
  EXPECT_EQ(version.err, "");

  // Only the long forms: a near miss is an unknown option.
  const Outcome near_miss = Read({"-version"});
  EXPECT_EQ(near_miss.status, DescribeStatus::kUsageError);
}

class ArgumentFileTest : public testing::TempDirTest {};

TEST_F(ArgumentFileTest, ItemsComeFromTheFile) {
  const std::string path =
      Write("args", "-framework \"My Framework\"\n-public pub -o out.xml -I \"dir with blanks\"\n");
  const Outcome outcome = Read({"=", path.c_str()});
  ASSERT_FALSE(outcome.status.has_value()) << outcome.err;
  EXPECT_EQ(outcome.options.framework, "My Framework");
  EXPECT_EQ(outcome.options.include_dirs, (std::vector<std::string>{"dir with blanks"}));
}

TEST_F(ArgumentFileTest, UnreadableFileIsAUsageErrorWithoutTheUsageText) {
  const std::string path = Path("missing");
  const Outcome outcome = Read({"=", path.c_str()});
  EXPECT_EQ(outcome.status, DescribeStatus::kUsageError);
  EXPECT_EQ(outcome.err,
            "zor2describe: unable to read file " + path + ": No such file or directory\n");
}

}  // namespace
}  // namespace zor2::describe
