#include "web/PageServer.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakePipedProgram.h"
#include "tests/web/Games.h"
#include "web/ServerEnd.h"

namespace {

using namespace std::chrono_literals;
using namespace std::string_literals;
using Phase = PageServing::Phase;
using testing::ElementsAre;
using testing::IsEmpty;

const std::string Port8080 = "P\x90\x1F\x00\x00"s;

class ServingPages : public testing::Test {
 protected:
  void SetUp() override {
    server.OnChange = [this] { ++changes; };
  }

  /// Paths of the pages that the program was sent.
  std::vector<std::string> Sent() const {
    PageFrameReader reader;
    reader.Add(program.Input);
    std::vector<std::string> paths;
    while (const auto frame = reader.Next()) {
      paths.push_back(frame->Path);
    }
    EXPECT_FALSE(reader.Broken());
    return paths;
  }

  FakePipedProgram program;
  FakeEventPump clock;
  ResultsPages pages{Language::English};
  PageServer server{program, clock, pages, "/bin/results"};
  int changes = 0;
};

TEST_F(ServingPages, StartsNothingUntilItIsSwitchedOn) {
  pages.Put(SmallGame(), 0h);
  server.Update();
  EXPECT_THAT(program.Runs, IsEmpty());
  EXPECT_EQ(server.State(), PageServing{});
}

TEST_F(ServingPages, StartsTheProgramWithAddressAndPort) {
  server.SwitchOn("192.168.1.5", 8080);
  ASSERT_EQ(program.Runs.size(), 1U);
  EXPECT_THAT(program.Runs[0].Words, ElementsAre("/bin/results", "192.168.1.5", "8080"));
  EXPECT_EQ(program.Runs[0].Pause, 0ms);
  EXPECT_EQ(server.State().Now, Phase::Starting);
  EXPECT_THAT(program.Input, IsEmpty());
}

TEST_F(ServingPages, SendsAllPagesOnceTheProgramAnswers) {
  server.SwitchOn("127.0.0.1", 8080);
  program.OnOutput(Port8080);
  EXPECT_EQ(server.State().Now, Phase::Serving);
  EXPECT_EQ(server.State().Port, 8080);
  EXPECT_EQ(Sent().size(), pages.Pages().size() + 1);
}

TEST_F(ServingPages, SendsWhatChangesFromThenOn) {
  server.SwitchOn("127.0.0.1", 8080);
  program.OnOutput(Port8080);
  program.Input.clear();
  pages.Put(SmallGame(), 0h);
  server.Update();
  EXPECT_THAT(Sent(), testing::Contains("/en/g/1/40"));
  EXPECT_THAT(Sent(), testing::Not(testing::Contains("/style.css")));
}

TEST_F(ServingPages, TellsTheVisitorsThatTheProgramCounts) {
  server.SwitchOn("127.0.0.1", 8080);
  program.OnOutput(Port8080);
  changes = 0;
  program.OnOutput("V\x07\x00\x00\x00"s);
  program.OnOutput("V\x07\x00\x00\x00"s);
  EXPECT_EQ(server.State().Visitors, 7U);
  EXPECT_EQ(changes, 1);
}

TEST_F(ServingPages, StartsAProgramThatEndedAgainAfterGrowingPauses) {
  server.SwitchOn("127.0.0.1", 8080);
  std::vector<std::chrono::milliseconds> pauses;
  for (int i = 0; i < 8; ++i) {
    program.End();
    EXPECT_EQ(server.State().Now, Phase::Pausing);
    pauses.push_back(program.Runs.back().Pause);
  }
  EXPECT_THAT(pauses, ElementsAre(1s, 2s, 4s, 8s, 16s, 32s, 60s, 60s));
  EXPECT_EQ(server.State().Starts, 9);
}

TEST_F(ServingPages, TellsHowTheProgramEndedUntilTheNextOneServes) {
  server.SwitchOn("127.0.0.1", 8080);
  program.End(static_cast<int>(ServerEnd::NoAddress));
  EXPECT_EQ(server.State().LastEnd, 3);
  program.End();
  EXPECT_EQ(server.State().LastEnd, PipedProgram::Killed);
  program.OnOutput(Port8080);
  EXPECT_EQ(server.State().LastEnd, 0);
}

TEST_F(ServingPages, PausesBrieflyAgainAfterAProgramThatServedForAMinute) {
  server.SwitchOn("127.0.0.1", 8080);
  program.End();
  program.End();
  program.OnOutput(Port8080);
  clock.Pass(60s);
  program.End();
  EXPECT_EQ(program.Runs.back().Pause, 1s);
}

TEST_F(ServingPages, SendsAllPagesToTheNextProgramToo) {
  server.SwitchOn("127.0.0.1", 8080);
  program.OnOutput(Port8080);
  program.End();
  pages.Put(SmallGame(), 0h);
  server.Update();
  EXPECT_THAT(program.Input, IsEmpty());
  program.OnOutput(Port8080);
  EXPECT_EQ(server.State().Now, Phase::Serving);
  EXPECT_EQ(Sent().size(), pages.Pages().size() + 1);
}

TEST_F(ServingPages, EndsAProgramThatReportsAnythingButNumbers) {
  server.SwitchOn("127.0.0.1", 8080);
  program.OnOutput("GET / HTTP/1.1");
  EXPECT_EQ(server.State().Now, Phase::Pausing);
  EXPECT_EQ(program.Runs.size(), 2U);
}

TEST_F(ServingPages, EndsAProgramThatNoLongerReads) {
  server.SwitchOn("127.0.0.1", 8080);
  program.OnOutput(Port8080);
  program.Backlog = 2 * MostPageBytes + 1;
  server.Update();
  EXPECT_EQ(server.State().Now, Phase::Pausing);
}

TEST_F(ServingPages, TellsVisitorsOnceASecondAndTheLastOnesAtTheNextUpdate) {
  server.SwitchOn("127.0.0.1", 8080);
  program.OnOutput(Port8080);
  clock.Pass(10s);
  changes = 0;
  program.OnOutput("V\x07\x00\x00\x00V\x08\x00\x00\x00V\x09\x00\x00\x00"s);
  EXPECT_EQ(server.State().Visitors, 7U);
  EXPECT_EQ(changes, 1);
  server.Update();
  EXPECT_EQ(server.State().Visitors, 9U);
  EXPECT_EQ(changes, 2);
}

TEST_F(ServingPages, EndsAProgramThatNeverStopsReporting) {
  server.SwitchOn("127.0.0.1", 8080);
  program.OnOutput(Port8080);
  std::string flood;
  for (int i = 0; i < 1000; ++i) {
    flood.append("V\x07\x00\x00\x00"s);
  }
  program.OnOutput(flood);
  EXPECT_EQ(server.State().Now, Phase::Pausing);
  EXPECT_EQ(program.Runs.size(), 2U);
}

TEST_F(ServingPages, EndsAProgramThatChangesItsPort) {
  server.SwitchOn("127.0.0.1", 8080);
  program.OnOutput(Port8080);
  program.OnOutput(Port8080);
  EXPECT_EQ(server.State().Now, Phase::Pausing);
}

TEST_F(ServingPages, ReplacesAProgramThatGivesNoAnswers) {
  server.SwitchOn("127.0.0.1", 8080);
  server.Replace();
  EXPECT_EQ(program.Runs.size(), 1U);  // it has not even begun
  program.OnOutput(Port8080);
  server.Replace();
  EXPECT_EQ(server.State().Now, Phase::Pausing);
  EXPECT_EQ(program.Runs.size(), 2U);
}

TEST_F(ServingPages, StopsWhenSwitchedOff) {
  server.SwitchOn("127.0.0.1", 8080);
  program.OnOutput(Port8080);
  server.SwitchOff();
  EXPECT_FALSE(program.Running);
  EXPECT_EQ(server.State(), PageServing{});
}

}  // namespace
