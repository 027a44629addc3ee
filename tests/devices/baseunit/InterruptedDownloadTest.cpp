#include <gmock/gmock.h>

#include "tests/support/Described.h"
#include "tests/support/DownloadStage.h"

namespace {

using std::chrono::milliseconds;
using testing::ElementsAre;
using testing::IsEmpty;

class InterruptedDownload : public testing::Test, protected DownloadStage {
 protected:
  const Player& Red1() const { return Scores.Players(2); }
  const Player& Blue0() const { return Scores.Players(33); }
};

/// Both end a download without a word.
constexpr void (*SilentEnds[])(DownloadStage&) = {
    [](DownloadStage& stage) { stage.Events.EndWaits(); },
    [](DownloadStage& stage) { stage.Progress.Closed = true; },
};

TEST_F(InterruptedDownload, EndsWithoutABoxWhenTheProgramOrItsWindowIsClosedInAWait) {
  for (const auto end : SilentEnds) {
    for (const std::size_t bytes : {0, 1, 2, 20, 53, 60}) {
      SCOPED_TRACE(bytes);
      DownloadStage stage;
      stage.Frames = {FrameOfRed1(), FrameOfBlue0()};
      stage.SilentFrom = bytes;
      stage.Events.At(milliseconds(500), [&stage, end] { end(stage); });
      stage.GetScores();
      EXPECT_THAT(stage.Boxes.Boxes, IsEmpty());
      EXPECT_EQ(stage.Scores.Players(2).Active, bytes == 60);
      EXPECT_EQ(stage.Progress.Log.back(), "Close");
      EXPECT_FALSE(stage.Port.PortOpen());
      EXPECT_EQ(stage.Events.Now(), milliseconds(500));
    }
  }
}

TEST_F(InterruptedDownload, EndsWithoutAFurtherBoxWhenTheProgramOrItsWindowIsClosedBehindABadFrame) {
  for (const auto end : SilentEnds) {
    DownloadStage stage;
    stage.Frames = {WithWrongCheckByte(FrameOfRed1()), FrameOfBlue0()};
    stage.SilentFrom = 60;
    stage.Events.At(milliseconds(500), [&stage, end] { end(stage); });
    stage.GetScores();
    EXPECT_THAT(stage.Boxes.Boxes, ElementsAre(ChecksumBox));
    EXPECT_FALSE(stage.Scores.DataPresent);
    EXPECT_FALSE(stage.Port.PortOpen());
    EXPECT_LE(stage.Events.Now(), milliseconds(2100));
  }
}

TEST_F(InterruptedDownload, ReadsNoFurtherFrameOnceItsWindowIsClosed) {
  Frames = {WithWrongCheckByte(FrameOfRed1()), FrameOfBlue0()};
  Events.At(milliseconds(500), [this] { Progress.Closed = true; });
  GetScores();
  EXPECT_THAT(Port.Sent, ElementsAre(1, 0, 0));
  EXPECT_FALSE(Blue0().Active);
}

TEST_F(InterruptedDownload, LosesItsLineToASecondOneStartedInAWait) {
  for (const std::size_t bytes : {0, 1, 20, 53, 60}) {
    SCOPED_TRACE(bytes);
    DownloadStage stage;
    FakeDownloadProgress second;
    stage.Frames = {FrameOfRed1(), FrameOfBlue0()};
    stage.SilentFrom = bytes;
    stage.Events.At(milliseconds(500), [&] {
      stage.SilentFrom = DownloadStage::Never;
      stage.GetScores(second);
      EXPECT_FALSE(stage.Port.PortOpen());
    });
    stage.GetScores();
    EXPECT_THAT(stage.Boxes.Boxes, IsEmpty());
    EXPECT_EQ(stage.Scores.Players(2).ShotCount, 258);  // counted once, though it came twice
    EXPECT_EQ(stage.Scores.Players(33).ShotCount, 1);
    EXPECT_THAT(second.Log, testing::Contains("Progress 2"));
    EXPECT_EQ(second.Log.back(), "Close");
    EXPECT_EQ(stage.Progress.Log.back(), "Close");
    EXPECT_FALSE(stage.Port.PortOpen());
  }
}

TEST_F(InterruptedDownload, LosesItsLineToASecondOneStartedInThePauseBehindABadFrame) {
  FakeDownloadProgress second;
  Frames = {WithWrongCheckByte(FrameOfRed1()), FrameOfBlue0()};
  Events.At(milliseconds(500), [&] {
    Frames = {FrameOfRed1()};
    GetScores(second);
  });
  GetScores();
  EXPECT_THAT(Boxes.Boxes, ElementsAre(ChecksumBox));
  EXPECT_EQ(Red1().ShotCount, 258);
  EXPECT_FALSE(Port.PortOpen());
}

TEST_F(InterruptedDownload, EndsTogetherWithASecondOneWhenTheProgramCloses) {
  FakeDownloadProgress second;
  SilentFrom = 0;
  Events.At(milliseconds(500), [&] { GetScores(second); });
  Events.At(milliseconds(1000), [this] { Events.EndWaits(); });
  GetScores();
  EXPECT_EQ(Events.Now(), milliseconds(1000));
  EXPECT_EQ(second.Log.back(), "Close");
  EXPECT_EQ(Progress.Log.back(), "Close");
  EXPECT_FALSE(Port.PortOpen());
}

TEST_F(InterruptedDownload, TellsHowItEndedAndHowManyFramesCame) {
  const auto ends = [](DownloadStage& stage, DownloadEnd end, int received, int expected) {
    const DownloadResult result = stage.GetScores();
    EXPECT_EQ(result.End, end);
    EXPECT_EQ(result.Received, received);
    EXPECT_EQ(result.Expected, expected);
  };
  const auto run = [&](std::size_t silentFrom, const std::function<void(DownloadStage&)>& prepare,
                       DownloadEnd end, int received, int expected) {
    DownloadStage stage;
    stage.Frames = {FrameOfRed1(), FrameOfBlue0()};
    stage.SilentFrom = silentFrom;
    prepare(stage);
    ends(stage, end, received, expected);
  };
  const auto nothing = [](DownloadStage&) {};
  const auto stopLater = [](DownloadStage& stage) {
    stage.Events.At(milliseconds(500), [&stage] { stage.Progress.Closed = true; });
  };
  const auto closeLater = [](DownloadStage& stage) {
    stage.Events.At(milliseconds(500), [&stage] { stage.Line.CloseIfOpen(); });
  };
  const auto loseLater = [](DownloadStage& stage) {
    stage.Events.At(milliseconds(500), [&stage] { stage.Port.Lose(); });
  };
  run(DownloadStage::Never, nothing, DownloadEnd::Complete, 2, 2);
  run(
      DownloadStage::Never, [](DownloadStage& stage) { stage.Frames.clear(); }, DownloadEnd::Complete, 0, 0);
  run(0, nothing, DownloadEnd::Failed, 0, 0);
  run(60, nothing, DownloadEnd::Failed, 1, 2);
  run(60, stopLater, DownloadEnd::Stopped, 1, 2);
  run(60, closeLater, DownloadEnd::Stopped, 1, 2);
  run(60, loseLater, DownloadEnd::Failed, 1, 2);
  run(
      DownloadStage::Never, [](DownloadStage& stage) { stage.Frames[0] = WithWrongCheckByte(FrameOfRed1()); },
      DownloadEnd::Failed, 1, 2);
  run(
      DownloadStage::Never,
      [](DownloadStage& stage) {
        stage.Port.FailNextOpen(8002);
        stage.Boxes.Answers = {BoxAnswer::Cancel};
      },
      DownloadEnd::Failed, 0, 0);
}

TEST_F(InterruptedDownload, EndsWithoutABoxWhenACommandClosesItsLine) {
  for (const std::size_t bytes : {0, 1, 20, 53, 60}) {
    DownloadStage stage;
    stage.Frames = {FrameOfRed1(), FrameOfBlue0()};
    stage.SilentFrom = bytes;
    stage.Events.At(milliseconds(500), [&stage] { stage.Line.CloseIfOpen(); });
    stage.GetScores();
    EXPECT_THAT(stage.Boxes.Boxes, IsEmpty()) << bytes;
    EXPECT_EQ(stage.Events.Now(), milliseconds(500)) << bytes;
  }
}

TEST_F(InterruptedDownload, CountsNoGunAgainWithTheNextOne) {
  Frames = {FrameOfRed1(), FrameOfBlue0()};
  GetScores();
  const std::string once = Described(Red1()) + Described(Blue0());
  Scores.Clear();
  Guns.Settle();
  SilentFrom = 60;
  GetScores();
  GetScores();
  ASSERT_EQ(Red1().ShotCount, 258);
  ASSERT_FALSE(Blue0().Active);
  SilentFrom = Never;
  GetScores();
  EXPECT_EQ(Described(Red1()) + Described(Blue0()), once);
  GetScores();  // behind a complete one they add up again
  EXPECT_EQ(Red1().ShotCount, 516);
}

TEST_F(InterruptedDownload, KeepsTheGunsThatDoNotComeAgain) {
  Frames = {FrameOfRed1(), FrameOfBlue0()};
  SilentFrom = 60;
  GetScores();
  Frames = {FrameOfBlue0()};
  SilentFrom = Never;
  GetScores();
  EXPECT_EQ(Red1().ShotCount, 258);
  EXPECT_EQ(Blue0().ShotCount, 1);
}

TEST_F(InterruptedDownload, AddsUpAGunThatReportsTwiceInTheNextOne) {
  Frames = {FrameOfRed1(), SecondFrameOfRed1(), FrameOfBlue0()};
  GetScores();
  const std::string both = Described(Red1());
  Scores.Clear();
  Guns.Settle();
  SilentFrom = 60;
  GetScores();
  SilentFrom = Never;
  GetScores();
  EXPECT_EQ(Described(Red1()), both);
}

TEST_F(InterruptedDownload, TakesBackOnlyWhatItAdded) {
  Scores.Players(2).ShotCount = 1000;
  Scores.Players(2).HitByPlayer(33) = 7;
  Frames = {FrameOfRed1(), FrameOfBlue0()};
  SilentFrom = 60;
  GetScores();
  const std::int32_t hits = Red1().HitByPlayer(33);
  Scores.Players(2).ShotCount += 10;  // by radio, say
  SilentFrom = Never;
  GetScores();
  EXPECT_EQ(Red1().ShotCount, 1268);
  EXPECT_EQ(Red1().HitByPlayer(33), hits);
}

TEST_F(InterruptedDownload, TellsWhichGunsWereCountedTwice) {
  const int red1 = 2;
  const int blue0 = 33;
  Frames = {FrameOfRed1(), FrameOfBlue0()};
  SilentFrom = 60;
  GetScores();
  GetScores();
  SilentFrom = Never;
  GetScores();
  EXPECT_THAT(Guns.CountedTwice(), IsEmpty()) << "what the first ones gave was taken back";
  Frames = {FrameOfBlue0()};
  GetScores();
  EXPECT_THAT(Guns.CountedTwice(), testing::ElementsAre(blue0));
  Frames = {FrameOfRed1(), FrameOfBlue0()};
  SilentFrom = 60;
  GetScores();
  SilentFrom = Never;
  GetScores();
  EXPECT_THAT(Guns.CountedTwice(), testing::ElementsAre(red1, blue0));
  Scores.Clear();
  Guns.Forget();
  GetScores();
  EXPECT_THAT(Guns.CountedTwice(), IsEmpty());
}

TEST_F(InterruptedDownload, CountsAGunOnceThatReportedTwiceOnlyInTheOneTakenBack) {
  Frames = {FrameOfRed1(), SecondFrameOfRed1(), FrameOfBlue0()};
  SilentFrom = 120;
  GetScores();
  EXPECT_THAT(Guns.CountedTwice(), testing::ElementsAre(2));
  Frames = {FrameOfRed1(), FrameOfBlue0()};
  SilentFrom = Never;
  GetScores();
  EXPECT_THAT(Guns.CountedTwice(), IsEmpty());
}

TEST_F(InterruptedDownload, TellsWhichGunsCameByAnotherRoadToo) {
  const int red1 = 2;
  const int blue0 = 33;
  const int red2 = 3;
  Guns.ComesOtherwise(0);  // ids below 32 have no record
  Guns.ComesOtherwise(red2);
  EXPECT_THAT(Guns.CountedTwice(), IsEmpty());
  Scores.Players(red2).Active = true;
  Frames = {FrameOfRed1(), FrameOfBlue0()};
  SilentFrom = 60;
  GetScores();
  Guns.ComesOtherwise(red1);
  EXPECT_THAT(Guns.CountedTwice(), testing::ElementsAre(red1));
  SilentFrom = Never;
  GetScores();
  EXPECT_THAT(Guns.CountedTwice(), testing::ElementsAre(red1)) << "the other road's scores are still there";
  Guns.ComesOtherwise(blue0);
  EXPECT_THAT(Guns.CountedTwice(), testing::ElementsAre(red1, blue0));
}

}  // namespace
