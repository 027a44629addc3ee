#include "devices/baseunit/BaseUnitDownload.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <string>

#include "tests/support/DownloadStage.h"

namespace {

using std::chrono::milliseconds;
using testing::Each;
using testing::ElementsAre;
using testing::IsEmpty;

class Download : public testing::Test, protected DownloadStage {
 protected:
  const Player& Red1() const { return Scores.Players(2); }
  const Player& Blue0() const { return Scores.Players(33); }
};

TEST_F(Download, SpeaksByteByByteAsTheUnitExpects) {
  Frames = {FrameOfRed1(), FrameOfBlue0()};
  GetScores();
  EXPECT_THAT(Port.Log, ElementsAre("Open /dev/ttyS0 19200,N,8,1", "Output 1", "Output 0", "Output 170",
                                    "Output 170", "Close"));
  EXPECT_THAT(Events.Sleeps, ElementsAre(milliseconds(20), milliseconds(50), milliseconds(50)));
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  EXPECT_TRUE(Red1().Active);
  EXPECT_TRUE(Blue0().Active);
}

TEST_F(Download, KeepsItsOrderOfBytesPausesAndTexts) {
  Frames = {FrameOfRed1(), WithWrongCheckByte(FrameOfBlue0()), FrameOfRed1()};
  LogAll();
  GetScores();
  EXPECT_THAT(Progress.Log,
              ElementsAre("Open", "Status Requesting Data...", "Output 1", "Sleep 20", "Output 0",
                          "Maximum 3", "Status Accepting Score Data...", "Animate", "Progress 1", "Sleep 50",
                          "Output 170", "Status Accepting Score Data...", "Animate", "Progress 2", "Sleep 50",
                          "Output 0", "Box Checksum failed", "Status Checksum failed!", "Sleep 2000",
                          "Status Accepting Score Data...", "Animate", "Progress 3", "Sleep 50", "Output 170",
                          "Close"));
}

TEST_F(Download, WithoutScoresSaysSoOnceTheProgressIsHidden) {
  Count = 0;
  Scores.GameDate = "before";
  LogAll();
  GetScores();
  ASSERT_GE(Progress.Log.size(), 7U);
  Progress.Log.resize(7);
  EXPECT_THAT(Progress.Log, ElementsAre("Open", "Status Requesting Data...", "Output 1", "Sleep 20",
                                        "Output 0", "Close", "Box Kesh has no score data."));
  EXPECT_THAT(Boxes.Boxes, ElementsAre(NoScoresBox));
  EXPECT_FALSE(Port.PortOpen());
  EXPECT_FALSE(Scores.DataPresent);
  EXPECT_EQ(Scores.GameDate, "before");
}

TEST_F(Download, OfOneFrameFillsTheBarWithIt) {
  Frames = {FrameOfBlue0()};
  GetScores();
  EXPECT_THAT(Progress.Log, ElementsAre("Open", "Status Requesting Data...", "Maximum 1",
                                        "Status Accepting Score Data...", "Animate", "Progress 1", "Close"));
  EXPECT_THAT(Port.Sent, ElementsAre(1, 0, 170));
}

TEST_F(Download, TakesUpTo255Frames) {
  Frames.assign(255, FrameOfBlue0());
  GetScores();
  EXPECT_EQ(Blue0().ShotCount, 255);
  EXPECT_EQ(Port.Sent.size(), 257U);
  EXPECT_EQ(std::count(Port.Sent.begin(), Port.Sent.end(), 170), 255);
  EXPECT_THAT(Progress.Log, testing::Contains("Maximum 255"));
  for (int frame = 1; frame <= 255; ++frame) {
    EXPECT_THAT(Progress.Log, testing::Contains("Progress " + std::to_string(frame)).Times(1));
  }
}

TEST_F(Download, DecodesAFrameBeforeItAcceptsIt) {
  Frames = {FrameOfRed1()};
  bool decoded = false;
  Events.OnSleep = [this, &decoded](milliseconds time) {
    decoded = time == milliseconds(50) && Red1().Active && Port.Sent.size() == 2;
  };
  GetScores();
  EXPECT_TRUE(decoded);
}

TEST_F(Download, AddsUpAGunThatReportsTwiceAndReplacesTheRest) {
  Frames = {FrameOfRed1(), SecondFrameOfRed1()};
  GetScores();
  EXPECT_EQ(Red1().ShotCount, 516);
  EXPECT_EQ(Red1().HitByPlayer(33), 520);
  EXPECT_EQ(Red1().RemainingHealth, 7);
  EXPECT_EQ(Red1().DallasID, "08070605040302AB");
  EXPECT_EQ(Red1().PowerCheatFlag, 3);
}

TEST_F(Download, AddsToWhatIsOnTheBoard) {
  Frames = {FrameOfRed1()};
  GetScores();
  GetScores();
  EXPECT_EQ(Red1().ShotCount, 516);
  EXPECT_EQ(Red1().HitByPlayer(2), 10);
}

TEST_F(Download, DatesTheGameByItsLastFrame) {
  Frames = {FrameOfRed1(), FrameOfBlue0()};
  Events.OnSleep = [this](milliseconds) { Time.Time = "14:3" + std::to_string(Port.Sent.size()); };
  GetScores();
  EXPECT_EQ(Scores.GameDate, "21/05/2013 14:32");
}

TEST_F(Download, LeavesOutAFrameWithAWrongChecksumAndGoesOn) {
  Frames = {FrameOfRed1(), WithWrongCheckByte(FrameOfBlue0()), FrameOfRed1()};
  GetScores();
  EXPECT_THAT(Boxes.Boxes, ElementsAre(ChecksumBox));
  EXPECT_THAT(Port.Sent, ElementsAre(1, 0, 170, 0, 170));
  EXPECT_EQ(Red1().ShotCount, 516);
  EXPECT_FALSE(Blue0().Active);
}

TEST_F(Download, TakesTheFirstByteForTheCount) {
  Count = 0;
  Frames = {{1}, FrameOfRed1()};  // a stray 0 came before the true count
  GetScores();
  EXPECT_THAT(Boxes.Boxes, ElementsAre(NoScoresBox));
}

TEST_F(Download, ClosesALineThatIsOpenAndDropsWhatItReceived) {
  Frames = {FrameOfRed1()};
  Port.Open("/dev/ttyUSB0", "57600,N,8,1");
  Port.Receive({7, 7, 7});
  GetScores();
  EXPECT_THAT(Port.Log, ElementsAre("Open /dev/ttyUSB0 57600,N,8,1", "Close", "Open /dev/ttyS0 19200,N,8,1",
                                    "Output 1", "Output 0", "Output 170", "Close"));
  EXPECT_TRUE(Red1().Active);
}

TEST_F(Download, TakesTheLongestFrameThatFits) {
  Frames = {LongestFrameOfRed1()};
  ASSERT_EQ(Frames[0].size(), 1002U);
  GetScores();
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  EXPECT_EQ(Red1().HitByPlayer(33), 260);
  EXPECT_EQ(Red1().HitByPlayer(2), 517);
}

TEST_F(Download, FailsAFrameThatIsTooLongWhateverItsCheckByte) {
  Frames.assign(255, Bytes(1003, 0));
  for (std::size_t i = 0; i < Frames.size(); ++i) {
    Frames[i][0] = 0xEA;
    Frames[i][1] = 0x03;
    Frames[i].back() = static_cast<std::uint8_t>(i);
  }
  GetScores();
  EXPECT_EQ(Boxes.Boxes.size(), 255U);
  EXPECT_THAT(Boxes.Boxes, Each(ChecksumBox));
  EXPECT_FALSE(Scores.DataPresent);
}

TEST_F(Download, ReadsAFrameThatIsTooLongToItsEnd) {
  Bytes tooLong(32768, 0);
  tooLong[0] = 0xFF;
  tooLong[1] = 0x7F;
  tooLong.back() = 74;  // the right one
  Frames = {tooLong, FrameOfRed1()};
  GetScores();
  EXPECT_THAT(Boxes.Boxes, ElementsAre(ChecksumBox));
  EXPECT_THAT(Port.Sent, ElementsAre(1, 0, 0, 170));
  EXPECT_EQ(Red1().ShotCount, 258);
}

TEST_F(Download, TakesALengthWithTheHighBitForNothing) {
  // The check byte follows at once, and that of no bytes is 0.
  Frames = {FrameOfRed1(), {0, 0x80, 0}, {0xFF, 0xFF, 1}, FrameOfBlue0()};
  GetScores();
  EXPECT_THAT(Boxes.Boxes, ElementsAre(ChecksumBox));
  EXPECT_THAT(Port.Sent, ElementsAre(1, 0, 170, 170, 0, 170));
  EXPECT_EQ(Red1().ShotCount, 258);
  EXPECT_TRUE(Blue0().Active);
}

TEST_F(Download, ChecksFramesOfLength0And1LikeAnyOther) {
  Frames = {{0, 0, 0}, {1, 0, 94}, {0, 0, 1}, {1, 0, 93}};
  GetScores();
  EXPECT_THAT(Port.Sent, ElementsAre(1, 0, 170, 170, 0, 0));
  EXPECT_TRUE(Scores.DataPresent);
  EXPECT_TRUE(
      std::none_of(Scores.Players.begin(), Scores.Players.end(), [](const Player& p) { return p.Active; }));
}

TEST_F(Download, OfAnEmptyFrameDecodesWhatARejectedOneLeft) {
  Frames = {WithWrongCheckByte(FrameOfRed1()), {0, 0x80, 0}};
  GetScores();
  EXPECT_THAT(Port.Sent, ElementsAre(1, 0, 0, 170));
  EXPECT_EQ(Red1().ShotCount, 258);
}

TEST_F(Download, EndsWithOneBoxWhereverTheUnitFallsSilent) {
  constexpr std::size_t behindRed1 = 1 + 53;
  constexpr std::size_t whole = behindRed1 + 47;
  for (std::size_t silentFrom = 0; silentFrom < whole; ++silentFrom) {
    SCOPED_TRACE(silentFrom);
    DownloadStage stage;
    stage.Frames = {FrameOfRed1(), FrameOfBlue0()};
    stage.SilentFrom = silentFrom;
    stage.GetScores();
    const bool redCameThrough = silentFrom >= behindRed1;
    EXPECT_THAT(stage.Boxes.Boxes, ElementsAre(TimedOutBox));
    EXPECT_EQ(stage.Events.Now(), milliseconds(redCameThrough ? 5070 : 5020));
    EXPECT_EQ(stage.Port.Sent.size(), redCameThrough ? 3U : 2U);
    EXPECT_EQ(stage.Scores.Players(2).ShotCount, redCameThrough ? 258 : 0);
    EXPECT_EQ(stage.Scores.DataPresent, redCameThrough);
    EXPECT_FALSE(stage.Scores.Players(33).Active);
    EXPECT_EQ(stage.Progress.Log.back(), "Close");
    EXPECT_FALSE(stage.Port.PortOpen());
  }
}

TEST_F(Download, WaitsFiveSecondsForEachByteByItself) {
  const Bytes answer = {1, 46, 0, 41, 0, 64, 18, 0, 1, 0, 0,  0, 0, 0, 0, 0, 2, 0, 0,  0, 0, 0, 0, 0,
                        0, 0,  0, 0,  0, 0,  0,  0, 0, 0, 50, 0, 0, 0, 0, 0, 0, 0, 20, 0, 1, 0, 0, 215};
  for (const int wait : {4999, 5001}) {
    DownloadStage stage;
    stage.Port.OnOutput = [&stage, &answer, wait](std::uint8_t byte) {
      milliseconds arrival{0};
      for (const std::uint8_t next : byte == 0 ? answer : Bytes()) {
        arrival += milliseconds(wait);
        stage.Events.At(arrival, [&stage, next] { stage.Port.Receive({next}); });
      }
    };
    stage.GetScores();
    EXPECT_EQ(stage.Boxes.Boxes.size(), wait < 5000 ? 0U : 1U);
    EXPECT_EQ(stage.Scores.Players(33).Active, wait < 5000);
  }
}

TEST_F(Download, EndsWithOneBoxWhenTheRequestCannotBeSent) {
  Frames = {FrameOfRed1()};
  Port.FailOutput(8012);
  GetScores();
  EXPECT_THAT(Boxes.Boxes, ElementsAre(SendErrorBox));
  EXPECT_EQ(Progress.Log.back(), "Close");
  EXPECT_FALSE(Port.PortOpen());
}

TEST_F(Download, EndsWithOneBoxWhenTheLineIsLostWithinTheRequest) {
  Frames = {FrameOfRed1()};
  Events.OnSleep = [this](milliseconds) { Port.Lose(); };
  GetScores();
  EXPECT_THAT(Boxes.Boxes, ElementsAre(SendErrorBox));
  EXPECT_THAT(Port.Sent, ElementsAre(1));
  EXPECT_FALSE(Port.PortOpen());
}

TEST_F(Download, EndsWithOneBoxWhereverTheLineIsLost) {
  for (const std::size_t bytes : {0, 1, 2, 3, 30, 53, 54, 60}) {
    SCOPED_TRACE(bytes);
    DownloadStage stage;
    stage.Frames = {FrameOfRed1(), FrameOfBlue0()};
    stage.SilentFrom = bytes;
    stage.Events.At(milliseconds(1000), [&stage] { stage.Port.Lose(); });
    stage.GetScores();
    EXPECT_THAT(stage.Boxes.Boxes, ElementsAre(ReceiveErrorBox));
    EXPECT_EQ(stage.Scores.Players(2).Active, bytes >= 54);
    EXPECT_EQ(stage.Events.Now(), milliseconds(1000));
    EXPECT_EQ(stage.Progress.Log.back(), "Close");
    EXPECT_FALSE(stage.Port.PortOpen());
  }
}

TEST_F(Download, EndsWithOneBoxWhenTheReplyCannotBeSent) {
  for (const bool accepted : {true, false}) {
    DownloadStage stage;
    stage.Frames = {accepted ? FrameOfRed1() : WithWrongCheckByte(FrameOfRed1()), FrameOfBlue0()};
    stage.Events.OnSleep = [&stage](milliseconds time) {
      stage.Port.FailOutput(time == milliseconds(50) ? 8012 : 0);
    };
    stage.GetScores();
    EXPECT_THAT(stage.Boxes.Boxes, ElementsAre(SendErrorBox));
    EXPECT_THAT(stage.Events.Sleeps, ElementsAre(milliseconds(20), milliseconds(50)));
    EXPECT_EQ(stage.Scores.Players(2).Active, accepted);
    EXPECT_FALSE(stage.Port.PortOpen());
  }
}

TEST_F(Download, GoesOnWithTheNumberThatWasSavedAtThePortQuestion) {
  Frames = {FrameOfRed1()};
  Port.FailNextOpen(8005);
  ShowSettings = [this] { Store.Put("/tessarine.ini", "[comm]\ncommport=2\n"); };
  GetScores();
  EXPECT_EQ(Boxes.Boxes.size(), 1U);
  EXPECT_EQ(Port.Device, "/dev/ttyUSB0");
  EXPECT_TRUE(Red1().Active);
  EXPECT_FALSE(Line.CommDisabled());
}

TEST_F(Download, EndsWithoutAFurtherBoxAfterCancelAtThePortQuestion) {
  Port.FailNextOpen(8002);
  Boxes.Answers = {BoxAnswer::Cancel};
  GetScores();
  EXPECT_EQ(Boxes.Boxes.size(), 1U);
  EXPECT_TRUE(Line.CommDisabled());
  EXPECT_THAT(Progress.Log, ElementsAre("Open", "Status Requesting Data...", "Close"));
  EXPECT_THAT(Port.Sent, IsEmpty());
}

}  // namespace
