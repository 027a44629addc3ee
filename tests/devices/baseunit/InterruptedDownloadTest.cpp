#include <gmock/gmock.h>

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
    EXPECT_THAT(stage.Boxes.Boxes, ElementsAre(ReceiveErrorBox));
    EXPECT_EQ(stage.Scores.Players(2).ShotCount, bytes == 60 ? 516 : 258);
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
  EXPECT_THAT(Boxes.Boxes, ElementsAre(ChecksumBox, ReceiveErrorBox));
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

}  // namespace
