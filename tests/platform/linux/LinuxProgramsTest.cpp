#include "platform/linux/LinuxPrograms.h"

#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <csignal>
#include <filesystem>
#include <functional>
#include <string>
#include <thread>

#include "tests/support/TemporaryFolder.h"
#include "tests/support/Thrown.h"

namespace {

/// True as soon as `condition` holds; false when it does not within ten seconds.
bool WaitUntil(const std::function<bool()>& condition) {
  const auto limit = std::chrono::steady_clock::now() + std::chrono::seconds(10);
  while (!condition()) {
    if (std::chrono::steady_clock::now() > limit) {
      return false;
    }
    std::this_thread::sleep_for(std::chrono::milliseconds(2));
  }
  return true;
}

/// What `script` writes to a file that is its first argument, once it is there in full.
std::string WrittenBy(LinuxPrograms& programs, const std::string& script, const std::string& path) {
  programs.Start({"sh", "-c", "{ " + script + "; } > \"$1.part\"; mv \"$1.part\" \"$1\"", "sh", path});
  EXPECT_TRUE(WaitUntil([&] { return std::filesystem::exists(path); }));
  return ReadFile(path);
}

TEST(LinuxPrograms, HandsEachArgumentOverAsItStands) {
  const TemporaryFolder folder;
  LinuxPrograms programs;
  programs.Start({"touch", "--", folder / "a 'b' \"c\" $d *", folder / "done"});
  EXPECT_TRUE(WaitUntil([&] { return std::filesystem::exists(folder / "done"); }));
  EXPECT_TRUE(std::filesystem::exists(folder / "a 'b' \"c\" $d *"));
}

TEST(LinuxPrograms, HaveASessionAndNoStreamsOfOurs) {
  const TemporaryFolder folder;
  LinuxPrograms programs;
  const std::string session = WrittenBy(programs, "ps -o sid= -p $$", folder / "session");
  EXPECT_NE(std::stoi(session), getsid(0));
  EXPECT_EQ(WrittenBy(programs, "readlink /proc/$$/fd/0 /proc/$$/fd/2", folder / "streams"),
            "/dev/null\n/dev/null\n");
}

TEST(LinuxPrograms, DieOfABrokenPipeAlsoWhereWeDoNot) {
  const auto before = std::signal(SIGPIPE, SIG_IGN);
  const TemporaryFolder folder;
  LinuxPrograms programs;
  const std::string ignored =
      WrittenBy(programs, "sed -n 's/^SigIgn:.*\\(....\\)$/\\1/p' /proc/$$/status", folder / "ignored");
  std::signal(SIGPIPE, before);
  EXPECT_EQ(std::stoi(ignored, nullptr, 16) & (1 << (SIGPIPE - 1)), 0);
}

TEST(LinuxPrograms, GoOnWithoutUs) {
  const TemporaryFolder folder;
  {
    LinuxPrograms programs;
    programs.Start({"sh", "-c", "while [ ! -e \"$1/go\" ]; do sleep 0.01; done; touch \"$1/done\"", "sh",
                    folder.Path()});
  }
  WriteFile(folder / "go", "");
  EXPECT_TRUE(WaitUntil([&] { return std::filesystem::exists(folder / "done"); }));
  EXPECT_GT(waitpid(-1, nullptr, 0), 0);
}

TEST(LinuxPrograms, LeaveNothingInTheSystemsTableForLong) {
  const TemporaryFolder folder;
  LinuxPrograms programs;
  const pid_t first = std::stoi(WrittenBy(programs, "echo $$", folder / "first"));
  EXPECT_TRUE(WaitUntil([&] {
    programs.Start({"true"});
    return kill(first, 0) != 0;
  }));
}

TEST(LinuxPrograms, ThatCannotBeStartedAreTold) {
  LinuxPrograms programs;
  EXPECT_EQ(NumberThrownBy([&] { programs.Start({"/nowhere/editor", "log"}); }), 53);
  EXPECT_EQ(NumberThrownBy([&] { programs.Start({"no-such-editor-anywhere"}); }), 53);
  EXPECT_EQ(NumberThrownBy([&] { programs.Start({}); }), 5);
}

}  // namespace
