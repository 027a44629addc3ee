#include "tests/fakes/FakePrograms.h"

#include <gtest/gtest.h>

#include "tests/support/Thrown.h"

namespace {

TEST(FakePrograms, KeepTheWordsOfEachStart) {
  FakePrograms programs;
  programs.Start({"gedit", "/tmp/a log.txt"});
  programs.Start({"true"});
  ASSERT_EQ(programs.Started.size(), 2U);
  EXPECT_EQ(programs.Started[0], (std::vector<std::string>{"gedit", "/tmp/a log.txt"}));
  EXPECT_EQ(programs.Started[1], std::vector<std::string>{"true"});
}

TEST(FakePrograms, FailAsTheTestSays) {
  FakePrograms programs;
  programs.Failure = RuntimeError(Fault::FileNotFound);
  EXPECT_EQ(NumberThrownBy([&] { programs.Start({"absent"}); }), 53);
  EXPECT_TRUE(programs.Started.empty());
}

TEST(FakePrograms, RefuseAStartWithoutWords) {
  FakePrograms programs;
  EXPECT_EQ(NumberThrownBy([&] { programs.Start({}); }), 5);
  EXPECT_TRUE(programs.Started.empty());
}

}  // namespace
