#include "web/PageProbe.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakePipedProgram.h"

namespace {

using namespace std::string_literals;
using testing::ElementsAre;

const std::string Yes = "A\x01\x00\x00\x00"s;
const std::string No = "A\x00\x00\x00\x00"s;

class TrialOfThePages : public testing::Test {
 protected:
  void SetUp() override {
    probe.OnChange = [this] { ++changes; };
  }

  void Ask() { probe.Ask("192.168.1.5", 8080); }
  void Answer(const std::string& bytes) {
    program.OnOutput(bytes);
    program.End();
  }

  FakePipedProgram program;
  PageProbe probe{program, "/bin/results"};
  int changes = 0;
};

TEST_F(TrialOfThePages, AsksThroughTheOtherProgram) {
  EXPECT_FALSE(probe.Answered());
  Ask();
  ASSERT_EQ(program.Runs.size(), 1U);
  EXPECT_THAT(program.Runs[0].Words, ElementsAre("/bin/results", "--ask", "192.168.1.5", "8080"));
  EXPECT_FALSE(probe.Answered());
  Answer(Yes);
  EXPECT_TRUE(probe.Answered());
  EXPECT_EQ(changes, 1);
}

TEST_F(TrialOfThePages, HoldsUntilARequestIsNotAnswered) {
  Ask();
  Answer(Yes);
  Ask();
  EXPECT_TRUE(probe.Answered());
  Answer(No);
  EXPECT_FALSE(probe.Answered());
  EXPECT_EQ(changes, 2);
}

TEST_F(TrialOfThePages, EndsWithAProgramThatSaysNothing) {
  Ask();
  Answer(Yes);
  Ask();
  program.End();
  EXPECT_FALSE(probe.Answered());
}

TEST_F(TrialOfThePages, EndsWithAnAnswerThatDoesNotCome) {
  Ask();
  Answer(Yes);
  Ask();
  Ask();
  EXPECT_FALSE(probe.Answered());
}

TEST_F(TrialOfThePages, TakesNothingElseForAnAnswer) {
  for (const std::string& bytes :
       {"P\x01\x00\x00\x00"s, "V\x01\x00\x00\x00"s, "A\x02\x00\x00\x00"s, "A\x01"s}) {
    Ask();
    Answer(bytes);
    EXPECT_FALSE(probe.Answered());
  }
}

TEST_F(TrialOfThePages, IsForgottenWithThePages) {
  Ask();
  Answer(Yes);
  probe.Forget();
  EXPECT_FALSE(probe.Answered());
  Ask();
  probe.Forget();
  EXPECT_FALSE(program.Running);
}

}  // namespace
