#include "platform/linux/ProgramOutput.h"

#include <gtest/gtest.h>

#include "platform/RuntimeError.h"
#include "tests/support/Thrown.h"

namespace {

constexpr std::chrono::seconds Patience(60);

ProgramOutput RunScript(const std::string& script) {
  return RunToEnd({"/bin/sh", "-c", script}, Patience, [] { return true; });
}

TEST(OutputOfAProgram, ComesFromBothItsStreams) {
  const ProgramOutput output = RunScript("echo one; echo two >&2; echo three");
  EXPECT_EQ(output.Text, "one\nthree\n");
  EXPECT_EQ(output.Errors, "two\n");
  EXPECT_TRUE(output.Succeeded);
}

TEST(OutputOfAProgram, MayBeMoreThanAPipeHolds) {
  EXPECT_EQ(RunScript("head -c 300000 /dev/zero; head -c 200000 /dev/zero >&2").Text.size(), 300000U);
}

TEST(OutputOfAProgram, TellsThatTheProgramFailed) {
  EXPECT_FALSE(RunScript("echo one; exit 3").Succeeded);
  EXPECT_EQ(RunScript("echo one; exit 3").Text, "one\n");
}

TEST(OutputOfAProgram, IsNotWaitedForWithoutEnd) {
  const auto wait = [](const std::string& script) {
    RunToEnd({"/bin/sh", "-c", script}, std::chrono::milliseconds(30), [] { return true; });
  };
  EXPECT_EQ(NumberThrownBy([&] { wait("exec sleep 1000"); }), Fault::DeviceUnavailable);
  EXPECT_EQ(NumberThrownBy([&] { wait("exec >&- 2>&-; exec sleep 1000"); }), Fault::DeviceUnavailable);
  EXPECT_EQ(NumberThrownBy([&] { wait("exec cat /dev/zero"); }), Fault::DeviceUnavailable);
}

TEST(OutputOfAProgram, IsLeftWhenThatIsWanted) {
  int asked = 0;
  const ProgramOutput output =
      RunToEnd({"/bin/sh", "-c", "echo one; exec sleep 1000"}, Patience, [&asked] { return ++asked < 3; });
  EXPECT_EQ(output.Text, "");
  EXPECT_FALSE(output.Succeeded);
  EXPECT_EQ(asked, 3);
}

TEST(OutputOfAProgram, IsNoneOfAProgramThatIsMissing) {
  EXPECT_EQ(NumberThrownBy([] { RunToEnd({"/missing"}, Patience, [] { return true; }); }),
            Fault::FileNotFound);
}

}  // namespace
