#include "core/line/Transcript.h"

#include <gmock/gmock.h>

#include <optional>

#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFiles.h"

using namespace std::chrono_literals;

namespace {

class LineTranscript : public testing::Test {
 protected:
  LineTranscript() { files.AddFolder("/logs"); }

  std::string Written() const {
    return files.FileExists("/logs/box.log") ? files.Read("/logs/box.log") : std::string();
  }

  Transcript Make(Transcript::Repeats repeats) const {
    return {LogRing(files, "/logs", "box", Transcript::FileBytes), "box", time, repeats};
  }

  mutable FakeFiles files;
  FakeEventPump time;
  Transcript log = Make(Transcript::Repeats::Written);
};

TEST_F(LineTranscript, HasARowForTheBytesOfOneDirection) {
  time.Pass(1500000us);
  log.FromHost(1);
  log.FromHost(0);
  log.ToHost(0xAB);
  log.FromHost(0x0F);
  log.End();
  EXPECT_EQ(Written(),
            "    1.500000 box <- 01 00\n"
            "    1.500000 box -> AB\n"
            "    1.500000 box <- 0F\n");
}

TEST_F(LineTranscript, ARowHasTheTimeOfItsLastByteAndEndsWithAGapOfMoreThanFiveMilliseconds) {
  log.ToHost(1);
  time.Pass(5ms);
  log.ToHost(2);
  time.Pass(5ms);
  log.ToHost(3);
  time.Pass(5001us);
  log.ToHost(4);
  log.End();
  EXPECT_EQ(Written(),
            "    0.010000 box -> 01 02 03\n"
            "    0.015001 box -> 04\n");
}

TEST_F(LineTranscript, ARowHas64BytesAtMost) {
  for (int byte = 0; byte < 65; ++byte) {
    log.ToHost(7);
  }
  log.End();
  std::string row = "    0.000000 box ->";
  for (int byte = 0; byte < 64; ++byte) {
    row += " 07";
  }
  EXPECT_EQ(Written(), row + "\n    0.000000 box -> 07\n");
}

TEST_F(LineTranscript, NotesStandInRowsOfTheirOwnAndBehindBytes) {
  log.ToHost(1);
  log.Note("settings 9600,N,8,1");
  log.ToHost(2);
  log.EndRow("dropped");
  log.EndRow("nothing to stand behind");
  log.Note("opened", "2013-05-21 14:30:05");
  log.End();
  EXPECT_EQ(Written(),
            "    0.000000 box -> 01\n"
            "    0.000000 box -- settings 9600,N,8,1\n"
            "    0.000000 box -> 02 dropped\n"
            "    0.000000 box -- opened 2013-05-21 14:30:05\n");
}

TEST_F(LineTranscript, WaitsInMemoryUntilTheConversationEnds) {
  for (int byte = 0; byte < 1000; ++byte) {
    log.ToHost(1);
    log.FromHost(2);
    if (files.Appends != 0) {
      break;
    }
  }
  EXPECT_GT(Written().size(), 16000U);
  EXPECT_EQ(files.Appends, 1);
  log.End();
  EXPECT_EQ(files.Appends, 2);
}

TEST_F(LineTranscript, WritesWhatIsLeftAtItsEnd) {
  {
    Transcript other = Make(Transcript::Repeats::Counted);
    other.ToHost(1);
  }
  EXPECT_EQ(Written(), "    0.000000 box -> 01\n");
}

TEST_F(LineTranscript, WritesARepeatedConversationAgain) {
  for (int i = 0; i < 2; ++i) {
    log.ToHost(1);
    log.End();
  }
  EXPECT_EQ(Written(), "    0.000000 box -> 01\n    0.000000 box -> 01\n");
}

/// A reader that is polled.
class PollTranscript : public LineTranscript {
 protected:
  PollTranscript() {
    poll.emplace(LogRing(files, "/logs", "box", Transcript::FileBytes), "box", time,
                 Transcript::Repeats::Counted);
  }

  /// One poll of the bus, which answers `answer`; the second byte comes `gap` later.
  void Tick(std::uint8_t answer, std::chrono::milliseconds gap = 0ms) {
    time.Pass(100ms);
    poll->Note("opened", std::to_string(time.Now().count()));
    poll->FromHost(0xC1);
    poll->ToHost(answer);
    time.Pass(gap);
    poll->ToHost(answer);
    poll->Note("closed");
    poll->End();
  }

  std::optional<Transcript> poll;
};

TEST_F(PollTranscript, CountsTicksThatRepeatTheLastOne) {
  for (int tick = 0; tick < 38; ++tick) {
    Tick(0xCD);
  }
  EXPECT_EQ(files.Appends, 1);
  Tick(0xCF);
  EXPECT_EQ(Written(),
            "    0.100000 box -- opened 100\n"
            "    0.100000 box <- C1\n"
            "    0.100000 box -> CD CD\n"
            "    0.100000 box -- closed\n"
            "    3.800000 box -- the last ones again, 37 times\n"
            "    3.900000 box -- opened 3900\n"
            "    3.900000 box <- C1\n"
            "    3.900000 box -> CF CF\n"
            "    3.900000 box -- closed\n");
}

/// As when a walk along the bus has several steps.
TEST_F(PollTranscript, CountsTicksThatRepeatInTurn) {
  for (int round = 0; round < 10; ++round) {
    for (std::uint8_t step = 1; step <= 4; ++step) {
      Tick(step);
    }
  }
  EXPECT_EQ(files.Appends, 4);
  Tick(9);
  EXPECT_THAT(Written(), testing::HasSubstr(" box -- the last ones again, 36 times\n"));
}

TEST_F(PollTranscript, WritesATickAgainThatWasNotAmongTheLastFour) {
  for (std::uint8_t step = 1; step <= 5; ++step) {
    Tick(step);
  }
  Tick(1);
  EXPECT_EQ(files.Appends, 6);
}

TEST_F(PollTranscript, TellsRepeatsAtItsEndToo) {
  Tick(1);
  Tick(1);
  poll.reset();
  EXPECT_THAT(Written(), testing::EndsWith("    0.200000 box -- the last ones again, 1 time\n"));
}

TEST_F(PollTranscript, TakesBytesThatOnlyComeInAnotherPaceForTheSame) {
  Tick(1);
  Tick(1, 6ms);
  EXPECT_EQ(files.Appends, 1);
}

TEST_F(PollTranscript, TellsADirectionFromTheOther) {
  poll->FromHost(1);
  poll->ToHost(1);
  poll->End();
  poll->ToHost(1);
  poll->FromHost(1);
  poll->End();
  EXPECT_EQ(files.Appends, 2);
}

TEST_F(PollTranscript, WritesALongConversationWhetherOrNotItRepeats) {
  constexpr int bytes = 20000;
  for (int round = 0; round < 2; ++round) {
    for (int byte = 0; byte < bytes; ++byte) {
      poll->ToHost(1);
    }
    poll->End();
  }
  const std::string text = Written();
  EXPECT_EQ(std::count(text.begin(), text.end(), '>'), 2 * ((bytes + 63) / 64));
}

}  // namespace
