#include "platform/linux/ChildProcess.h"

#include <fcntl.h>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <csignal>
#include <string>

#include "tests/support/Thrown.h"

namespace {

using testing::HasSubstr;

/// Everything that comes out of a pipe until its other end is closed.
std::string AllOf(Pipe& pipe) {
  pipe.WriteEnd.Close();
  std::string text;
  char byte = 0;
  while (read(pipe.ReadEnd.Number(), &byte, 1) == 1) {
    text += byte;
  }
  return text;
}

TEST(ChildProcess, GetsItsArgumentsAndStreams) {
  Pipe input;
  Pipe output;
  Pipe errors;
  ChildProcess child({"/bin/sh", "-c", "cat; printf '%s|' \"$@\" >&2", "sh", "a b", "", "*'\""},
                     {input.ReadEnd.Number(), output.WriteEnd.Number(), errors.WriteEnd.Number()});
  ASSERT_EQ(write(input.WriteEnd.Number(), "in", 2), 2);
  input.WriteEnd.Close();
  EXPECT_EQ(AllOf(output), "in");
  EXPECT_EQ(AllOf(errors), "a b||*'\"|");
  EXPECT_TRUE(child.Wait());
}

TEST(ChildProcess, GetsNoOtherDescriptorOfOurs) {
  const Descriptor inherited(open("/dev/zero", O_RDONLY));
  ASSERT_GT(inherited.Number(), STDERR_FILENO);
  Pipe output;
  ChildProcess child({"/bin/ls", "-l", "/proc/self/fd"}, {.Output = output.WriteEnd.Number()});
  const std::string list = AllOf(output);
  EXPECT_THAT(list, HasSubstr("pipe:"));
  EXPECT_THAT(list, testing::Not(HasSubstr("/dev/zero")));
}

TEST(ChildProcess, IsAskedForItsEnd) {
  Pipe leash;
  ChildProcess child({"/bin/cat"}, {.Input = leash.ReadEnd.Number()});
  EXPECT_TRUE(child.Running());
  leash.WriteEnd.Close();
  EXPECT_TRUE(child.Wait());
  EXPECT_FALSE(child.Running());
  EXPECT_TRUE(child.Wait()) << "asked again";
}

TEST(ChildProcess, TellsAFailureAndADeathFromAnEnd) {
  EXPECT_FALSE(ChildProcess({"/bin/sh", "-c", "exit 3"}, {}).Wait());
  ChildProcess killed({"/bin/sleep", "60"}, {});
  killed.Kill();
  EXPECT_FALSE(killed.Wait());
}

TEST(ChildProcess, RemembersHowItEndedWhenThatWasNoticedEarlier) {
  ChildProcess child({"/bin/sh", "-c", "exit 3"}, {});
  while (child.Running()) {
  }
  EXPECT_FALSE(child.Wait());
}

TEST(ChildProcess, DoesNotOutliveItsOwner) {
  Pipe leash;
  {
    Pipe answer;
    const ChildProcess child({"/bin/sh", "-c", "echo; exec cat"},
                             {leash.ReadEnd.Number(), answer.WriteEnd.Number()});
    char byte = 0;
    ASSERT_EQ(read(answer.ReadEnd.Number(), &byte, 1), 1);
  }
  leash.ReadEnd.Close();
  EXPECT_EQ(waitpid(-1, nullptr, WNOHANG), -1) << "no child is left";
  EXPECT_EQ(errno, ECHILD);
}

TEST(ChildProcess, ThatIsMissingIs53AndNamesIt) {
  const Thrown thrown = ThrownBy([] { ChildProcess({"/nowhere/program"}, {}); });
  EXPECT_EQ(thrown.Number, 53);
  EXPECT_EQ(thrown.Text, "File not found: /nowhere/program");
  EXPECT_EQ(NumberThrownBy([] { ChildProcess({"/etc"}, {}); }), 53) << "no program";
}

}  // namespace
