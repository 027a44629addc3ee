#include "core/BaseUnitDownload.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <memory>

#include "tests/core/Frames.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/fakes/FakeSerialPort.h"
#include "tests/fakes/FakeTransferProgress.h"

namespace {

using std::chrono::milliseconds;
using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;

const FakeMessageBoxes::Box TimedOutBox{"Timed out waiting for Data. Please try again.", "Tessarine", BoxIcon::Exclamation,
                                        BoxButtons::Ok};
const FakeMessageBoxes::Box ReceiveErrorBox{"Error occured receiving data. Please try again.", "Tessarine",
                                            BoxIcon::Exclamation, BoxButtons::Ok};
const FakeMessageBoxes::Box SendErrorBox{"Error occured sending data. Please try again.", "Tessarine",
                                         BoxIcon::Exclamation, BoxButtons::Ok};

class Download : public testing::Test {
 protected:
  Download() {
    devices.Ports = {"/dev/ttyS0"};
    port.OnOutput = [this](std::uint8_t byte) { Answer(byte); };
  }

  /// Plays the unit: the request brings the count and the first frame, each reply the next frame.
  void Answer(std::uint8_t byte) {
    const bool isRequest = port.Sent.size() == 1 && byte == 1;
    if (isRequest) {
      return;
    }
    if (port.Sent.size() == 2) {
      Send({Count.value_or(static_cast<std::uint8_t>(Frames.size()))});
    }
    if (next_ < Frames.size()) {
      Send(Frames[next_++]);
    }
  }

  /// Bytes arrive, up to the limit after which the unit falls silent.
  void Send(const Bytes& bytes) {
    for (const std::uint8_t byte : bytes) {
      if (sent_++ < SilentFrom) {
        port.Receive({byte});
      }
    }
  }

  void GetScores() {
    BaseUnitDownload(port, commPort, events, boxes, clock, progress, game).GetScores();
  }

  std::vector<Bytes> Frames;
  std::optional<std::uint8_t> Count;  ///< when it is to differ from the number of frames
  std::size_t SilentFrom = 1'000'000;

  FakeFiles files;
  IniReader ini{files, "/tessarine.ini"};
  FakeSerialDevices devices;
  FakeSerialPort port;
  FakeMessageBoxes boxes;
  FakeEventPump events;
  FakeClock clock;
  FakeTransferProgress progress;
  StringTable strings{Language::English};
  Game game{strings};
  int settingsShown = 0;
  CommPort commPort{port, ini, devices, boxes, strings, [this] { ++settingsShown; }};

 private:
  std::size_t next_ = 0;
  std::size_t sent_ = 0;
};

TEST_F(Download, OfTwoGunsSpeaksByteByByteAsTheUnitExpects) {
  Frames = {FrameOfRed1(), FrameOfBlue0()};
  GetScores();
  EXPECT_THAT(port.Log, ElementsAre("Open /dev/ttyS0 19200,N,8,1", "Output 1", "Output 0", "Output 170", "Output 170",
                                    "Close"));
  EXPECT_THAT(events.Sleeps, ElementsAre(milliseconds(20), milliseconds(50), milliseconds(50)));
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_TRUE(game.Players(2).Active);
  EXPECT_TRUE(game.Players(33).Active);
}

TEST_F(Download, ShowsItsProgress) {
  Frames = {FrameOfRed1(), FrameOfBlue0()};
  GetScores();
  EXPECT_THAT(progress.Log,
              ElementsAre("Open", "Status Requesting Data...", "Maximum 2", "Status Accepting Score Data...", "Animate",
                          "Progress 1", "Status Accepting Score Data...", "Animate", "Progress 2", "Close"));
}

TEST_F(Download, WithoutScoresSaysSoOnceTheProgressIsHidden) {
  Count = 0;
  boxes.WhileOpen = [this](const auto&) { EXPECT_EQ(progress.Log.back(), "Close"); };
  GetScores();
  EXPECT_THAT(boxes.Boxes, ElementsAre(FakeMessageBoxes::Box{"Kesh has no score data.", "Tessarine",
                                                             BoxIcon::Information, BoxButtons::Ok}));
  EXPECT_FALSE(port.PortOpen());
  EXPECT_FALSE(game.DataPresent);
}

TEST_F(Download, TakesUpTo255Frames) {
  Frames.assign(255, FrameOfBlue0());
  GetScores();
  EXPECT_EQ(game.Players(33).ShotCount, 255);
  EXPECT_THAT(progress.Log, Contains("Progress 255"));
}

TEST_F(Download, AddsUpAGunThatReportsTwice) {
  Frames = {FrameOfRed1(), FrameOfRed1()};
  GetScores();
  EXPECT_EQ(game.Players(2).ShotCount, 516);
  EXPECT_EQ(game.Players(2).RemainingHealth, 100);
}

TEST_F(Download, LeavesOutAFrameWithAWrongChecksumAndGoesOn) {
  Frames = {FrameOfRed1(), FrameOfBlue0(), FrameOfRed1()};
  Frames[1].back() ^= 1;
  boxes.WhileOpen = [this](const auto&) {
    EXPECT_EQ(port.Log.back(), "Output 0");
    EXPECT_EQ(progress.Log.back(), "Progress 2");
  };
  GetScores();
  EXPECT_THAT(boxes.Boxes,
              ElementsAre(FakeMessageBoxes::Box{"Checksum failed", "Tessarine", BoxIcon::Critical, BoxButtons::Ok}));
  EXPECT_THAT(port.Sent, ElementsAre(1, 0, 170, 0, 170));
  EXPECT_THAT(events.Sleeps, ElementsAre(milliseconds(20), milliseconds(50), milliseconds(50), milliseconds(2000),
                                         milliseconds(50)));
  EXPECT_THAT(progress.Log, Contains("Status Checksum failed!"));
  EXPECT_EQ(game.Players(2).ShotCount, 516);
  EXPECT_FALSE(game.Players(33).Active);
}

TEST_F(Download, EndsWithOneBoxWhereverTheUnitFallsSilent) {
  const std::size_t whole = 1 + FrameOfRed1().size() + FrameOfBlue0().size();
  for (std::size_t silentFrom = 0; silentFrom < whole; ++silentFrom) {
    boxes.Boxes.clear();
    FakeSerialPort line;
    FakeEventPump pump;
    Game scores(strings);
    std::size_t sent = 0;
    const auto send = [&](const Bytes& bytes) {
      for (const std::uint8_t byte : bytes) {
        if (sent++ < silentFrom) {
          line.Receive({byte});
        }
      }
    };
    line.OnOutput = [&](std::uint8_t byte) {
      if (byte == 0) {
        send({2});
        send(FrameOfRed1());
      } else if (byte == 170 && sent < whole) {
        send(FrameOfBlue0());
      }
    };
    CommPort lineOwner(line, ini, devices, boxes, strings, [] {});
    BaseUnitDownload(line, lineOwner, pump, boxes, clock, progress, scores).GetScores();
    EXPECT_THAT(boxes.Boxes, ElementsAre(TimedOutBox)) << silentFrom;
    EXPECT_FALSE(line.PortOpen());
    EXPECT_EQ(scores.Players(2).Active, silentFrom > FrameOfRed1().size()) << silentFrom;
    EXPECT_FALSE(scores.Players(33).Active);
    EXPECT_GE(pump.Now(), milliseconds(5000));
  }
}

TEST_F(Download, WaitsFiveSecondsForEachByteByItself) {
  Frames = {FrameOfBlue0()};
  port.OnOutput = [this](std::uint8_t byte) {
    if (byte != 0) {
      return;
    }
    Bytes bytes = {1};
    bytes.insert(bytes.end(), Frames[0].begin(), Frames[0].end());
    milliseconds arrival{0};
    for (const std::uint8_t next : bytes) {
      arrival += milliseconds(4999);
      events.At(arrival, [this, next] { port.Receive({next}); });
    }
  };
  GetScores();
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_TRUE(game.Players(33).Active);
}

TEST_F(Download, FailsTheChecksumOfAFrameThatIsTooLong) {
  for (const int length : {1002, 32767}) {
    port.Log.clear();
    port.Sent.clear();
    boxes.Boxes.clear();
    Bytes frame(static_cast<std::size_t>(length) + 1, 0);
    frame[0] = static_cast<std::uint8_t>(length & 255);
    frame[1] = static_cast<std::uint8_t>(length >> 8);
    port.OnOutput = [this, &frame](std::uint8_t byte) {
      if (byte == 0 && port.Sent.size() == 2) {
        port.Receive({1});
        port.Receive(frame);
      }
    };
    GetScores();
    ASSERT_EQ(boxes.Boxes.size(), 1u) << length;
    EXPECT_EQ(boxes.Boxes[0].Text, "Checksum failed");
    EXPECT_FALSE(game.DataPresent);
  }
}

TEST_F(Download, TakesALengthWithTheHighBitForNothing) {
  Frames = {{0, 0x80, 0}};  // no bytes of a frame, and the check byte of no bytes
  GetScores();
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_THAT(port.Sent, ElementsAre(1, 0, 170));
  EXPECT_TRUE(game.DataPresent);
}

TEST_F(Download, ChecksFramesOfLength0And1LikeAnyOther) {
  Frames = {{0, 0, 0}, {1, 0, 94}, {1, 0, 93}};
  GetScores();
  EXPECT_THAT(port.Sent, ElementsAre(1, 0, 170, 170, 0));
  EXPECT_EQ(boxes.Boxes.size(), 1u);
}

TEST_F(Download, EndsWithOneBoxWhenTheLineIsLostInMidFrame) {
  Frames = {FrameOfRed1()};
  SilentFrom = 20;
  events.At(milliseconds(100), [this] { port.Lose(); });
  GetScores();
  EXPECT_THAT(boxes.Boxes, ElementsAre(ReceiveErrorBox));
  EXPECT_FALSE(port.PortOpen());
}

TEST_F(Download, EndsWithOneBoxWhenNothingCanBeSent) {
  port.FailOutput(8012);
  GetScores();
  EXPECT_THAT(boxes.Boxes, ElementsAre(SendErrorBox));
  EXPECT_FALSE(port.PortOpen());
}

TEST_F(Download, KeepsTheFrameWhoseReplyCouldNotBeSent) {
  Frames = {FrameOfRed1(), FrameOfBlue0()};
  events.OnSleep = [this](milliseconds time) {
    if (time == milliseconds(50)) {
      port.FailOutput(8012);
    }
  };
  GetScores();
  EXPECT_THAT(boxes.Boxes, ElementsAre(SendErrorBox));
  EXPECT_TRUE(game.Players(2).Active);
}

TEST_F(Download, EndsWithoutAFurtherBoxAfterCancelAtThePortQuestion) {
  port.FailNextOpen(8002);
  boxes.Answers = {BoxAnswer::Cancel};
  GetScores();
  EXPECT_EQ(boxes.Boxes.size(), 1u);
  EXPECT_TRUE(commPort.CommDisabled());
  EXPECT_THAT(progress.Log, ElementsAre("Open", "Status Requesting Data...", "Close"));
  EXPECT_THAT(port.Sent, IsEmpty());
}

TEST_F(Download, EndsWithoutABoxWhenTheProgramCloses) {
  SilentFrom = 0;
  events.At(milliseconds(500), [this] { events.EndWaits(); });
  GetScores();
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_FALSE(port.PortOpen());
  EXPECT_LT(events.Now(), milliseconds(5000));
}

TEST_F(Download, EndsWithoutABoxWhenItsWindowIsClosed) {
  Frames = {FrameOfRed1()};
  SilentFrom = 20;
  events.At(milliseconds(500), [this] { progress.Closed = true; });
  GetScores();
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_FALSE(port.PortOpen());
}

TEST_F(Download, OfASecondPressInMidWaitTakesTheLineFromTheFirst) {
  Frames = {FrameOfRed1()};
  FakeTransferProgress second;
  SilentFrom = 20;
  events.At(milliseconds(500), [&] {
    BaseUnitDownload(port, commPort, events, boxes, clock, second, game).GetScores();
  });
  GetScores();
  EXPECT_FALSE(port.PortOpen());
  EXPECT_THAT(boxes.Boxes, ElementsAre(TimedOutBox, ReceiveErrorBox));
}

TEST_F(Download, TakesNoiseForTheCount) {
  port.OnOutput = [this](std::uint8_t byte) {
    if (byte == 0 && port.Sent.size() == 2) {
      port.Receive({0, 1});
      port.Receive(FrameOfRed1());
    }
  };
  GetScores();
  ASSERT_EQ(boxes.Boxes.size(), 1u);
  EXPECT_EQ(boxes.Boxes[0].Text, "Kesh has no score data.");
}

}  // namespace
