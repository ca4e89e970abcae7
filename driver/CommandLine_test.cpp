#include "driver/CommandLine.h"

#include <gtest/gtest.h>

#include <initializer_list>
#include <optional>
#include <vector>

#include "platform/tools/ZOROFStream.h"
#include "rules/CheckSettings.h"

namespace {

// Reads a command line made of "zor2check" and `arguments`, with the log and
// usage output kept out of the test's own output.
std::optional<ExitStatus> Read(std::initializer_list<const char*> arguments,
                               RunConfiguration& config) {
  std::vector<const char*> argv = {"zor2check"};
  argv.insert(argv.end(), arguments);
  testing::internal::CaptureStdout();
  testing::internal::CaptureStderr();
  std::optional<ExitStatus> status =
      ReadCommandLine(static_cast<int>(argv.size()), argv.data(), config);
  ZORout.flush();
  ZORerr.flush();
  testing::internal::GetCapturedStdout();
  testing::internal::GetCapturedStderr();
  return status;
}

TEST(ReadCommandLineTest, FillsTheConfigurationAndTheSettings) {
  RunConfiguration config;
  EXPECT_EQ(Read({"-o", "first.xml", "-r", "ref", "-L", "-c", "chk", "-level", "M4R-3", "-o",
                  "out.xml", "-htm", "help.htm"},
                 config),
            std::nullopt);
  EXPECT_EQ(config.referencePath.str(), "ref");
  EXPECT_EQ(config.checkedPath.str(), "chk");
  EXPECT_EQ(config.outputPath.str(), "out.xml");  // the later "-o" wins
  EXPECT_FALSE(config.helpPagePath.IsNull());
  EXPECT_EQ(config.helpPagePath.str(), "help.htm");
  EXPECT_EQ(OnlyFlaggedFiles, 1);
  EXPECT_EQ(CurrentLevel, -3);
}

TEST(ReadCommandLineTest, DefaultsWithoutOptionalOptions) {
  RunConfiguration config;
  CurrentLevel = 5;
  OnlyFlaggedFiles = 1;
  EXPECT_EQ(Read({"-r", "ref", "-c", "chk", "-o", "out.xml"}, config), std::nullopt);
  EXPECT_TRUE(config.helpPagePath.IsNull());
  EXPECT_EQ(OnlyFlaggedFiles, 0);
  EXPECT_EQ(CurrentLevel, 99);
}

}  // namespace
