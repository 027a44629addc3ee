#include "platform/jet/ChildProgram.h"

#include <gtest/gtest.h>

#include "platform/RuntimeError.h"
#include "tests/support/Thrown.h"

namespace {

using namespace std::chrono_literals;

struct Ran {
  ChildEnd End;
  std::string Output;
};

Ran RunShell(const std::string& script, std::chrono::milliseconds silence = 10s) {
  Ran ran;
  ran.End =
      RunChild("/bin/sh", {"-c", script}, silence, {[&ran](std::string_view bytes) { ran.Output += bytes; }});
  return ran;
}

TEST(ChildProgram, PassesItsOutputOn) {
  const Ran ran = RunShell("printf 'one\\ntwo'");
  EXPECT_TRUE(ran.End.Succeeded);
  EXPECT_EQ(ran.Output, "one\ntwo");
  EXPECT_EQ(ran.End.Error, "");
}

TEST(ChildProgram, PassesOnMoreThanAPipeHolds) {
  const Ran ran = RunShell("head -c 3000000 /dev/zero; head -c 200000 /dev/zero >&2");
  EXPECT_TRUE(ran.End.Succeeded);
  EXPECT_EQ(ran.Output.size(), 3000000U);
}

TEST(ChildProgram, TellsAFailureWithTheFirstLineOfItsError) {
  const Ran ran = RunShell("echo first >&2; echo second >&2; exit 3");
  EXPECT_FALSE(ran.End.Succeeded);
  EXPECT_FALSE(ran.End.TimedOut);
  EXPECT_EQ(ran.End.Error, "first");
}

TEST(ChildProgram, TellsACrash) {
  EXPECT_FALSE(RunShell("kill -SEGV $$").End.Succeeded);
}

TEST(ChildProgram, IsEndedWhenItIsSilentForTooLong) {
  const Ran ran = RunShell("echo start; exec sleep 60", 100ms);
  EXPECT_TRUE(ran.End.TimedOut);
  EXPECT_FALSE(ran.End.Succeeded);
  EXPECT_EQ(ran.Output, "start\n");
}

TEST(ChildProgram, IsEndedWhenItWritesErrorsWithoutEnd) {
  const Ran ran = RunShell("exec yes >&2", 100ms);
  EXPECT_TRUE(ran.End.TimedOut);
  EXPECT_EQ(ran.End.Error, "y");
}

TEST(ChildProgram, IsEndedWhenItsOutputIsRefused) {
  const auto refuse = [](std::string_view) { throw RuntimeError(3343); };
  EXPECT_EQ(NumberThrownBy([&] {
              RunChild("/bin/sh", {"-c", "echo x; exec sleep 60"}, 10s, {refuse});
            }),
            3343);
}

TEST(ChildProgram, IsEndedByItsErrorsLongBeforeItIsSilentForTooLong) {
  const auto start = std::chrono::steady_clock::now();
  EXPECT_TRUE(RunShell("exec yes >&2", 60s).End.TimedOut);
  EXPECT_LT(std::chrono::steady_clock::now() - start, 30s);
}

TEST(ChildProgram, LeavesItsListenerTimeWhileItIsSilent) {
  int waits = 0;
  RunChild("/bin/sh", {"-c", "sleep 1"}, 10s, {[](std::string_view) {}, [&waits] { ++waits; }});
  EXPECT_GE(waits, 5);
}

TEST(ChildProgram, ThatIsMissingIsReported) {
  EXPECT_EQ(NumberThrownBy([] { RunChild("/nowhere/program", {}, 1s, {[](std::string_view) {}}); }), 53);
}

}  // namespace
