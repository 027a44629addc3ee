#include "devices/radio/RadioLink.h"

#include <gmock/gmock.h>

#include <chrono>

#include "tests/devices/radio/RadioSite.h"

namespace {

using std::chrono::milliseconds;
using testing::ElementsAre;
using testing::IsEmpty;

const XBeeAddress Address = {0x33, 0x22, 0x11, 0x40, 0x00, 0xA2, 0x13, 0x00};

class Link : public testing::Test, protected RadioSite {
 protected:
  void SendSearch() { link.SendGunPacket(32, BroadcastAddress, 0, 0, 6); }

  int Now() const { return static_cast<int>(Events.Now().count()); }

  bool stopped = false;
  RadioLink link{Port, Line, Events, [this] { return stopped; }};
};

TEST_F(Link, OpensTheLineOfTheSettingsAt57600Baud) {
  link.OpenXBeePort();
  EXPECT_THAT(Port.Log, ElementsAre("Open /dev/ttyS0 57600,N,8,1"));
  Store.Put("/tessarine.ini", "[comm]\ncommport=2\n");
  link.OpenXBeePort();
  EXPECT_EQ(Port.Device, "/dev/ttyUSB0");
}

TEST_F(Link, ClosesALineThatIsOpenFirst) {
  Port.Open("/dev/ttyUSB0", "19200,N,8,1");
  link.OpenXBeePort();
  EXPECT_THAT(Port.Log, ElementsAre("Open /dev/ttyUSB0 19200,N,8,1", "Close", "Open /dev/ttyS0 57600,N,8,1"));
}

TEST_F(Link, SaysNothingOfALineThatDoesNotOpen) {
  Port.FailNextOpen(8002);
  EXPECT_NO_THROW(link.OpenXBeePort());
  EXPECT_FALSE(Port.PortOpen());
  for (const char* number : {"9", "no number", "70000"}) {
    Store.Put("/tessarine.ini", std::string("[comm]\ncommport=") + number + "\n");
    EXPECT_NO_THROW(link.OpenXBeePort());
    EXPECT_FALSE(Port.PortOpen()) << number;
  }
  EXPECT_NO_THROW(link.ThrowIfLineLost());
}

TEST_F(Link, FindsOutByTheFirstByteThatTheLineIsClosed) {
  Port.FailNextOpen(8005);
  link.OpenXBeePort();
  SendSearch();
  EXPECT_TRUE(link.Stopped());
  EXPECT_THAT(Port.Sent, IsEmpty());
  EXPECT_THROW(link.ThrowIfLineLost(), RuntimeError);
}

TEST_F(Link, ForgetsFramesAndPiecesOfThemWhenItIsOpenedAgain) {
  link.OpenXBeePort();
  const Bytes answer = Received(1, SearchAnswer(33));
  Port.Receive(answer);
  Port.Receive({0x7E, 0, 20, 0x80});
  ASSERT_TRUE(link.TakeFrame());
  ASSERT_FALSE(link.TakeFrame());
  link.OpenXBeePort();
  EXPECT_EQ(link.ReceivedFrameType(), 0);
  EXPECT_EQ(link.Frame().Data[4], 0);
  Port.Receive(answer);
  EXPECT_TRUE(link.TakeFrame());
}

TEST_F(Link, SendsAGunPacketByteByByte) {
  link.OpenXBeePort();
  link.SendGunPacket(33, Address, 0, 0, 4, Bytes{2, 90, 45});
  EXPECT_THAT(Port.Sent, ElementsAre(0x7E, 0x00, 0x13, 0x00, 0x00,                          //
                                     0x00, 0x13, 0xA2, 0x00, 0x40, 0x11, 0x22, 0x33, 0x00,  //
                                     0x03, 0x21, 0x00, 0x00, 0x04, 0x02, 0x5A, 0x2D, 0xF3));
  EXPECT_EQ(link.BytesSent(), 23U);
}

TEST_F(Link, ServesEventsAfterEachByte) {
  link.OpenXBeePort();
  std::vector<std::size_t> sentAtEvents;
  std::function<void()> note = [&] {
    sentAtEvents.push_back(Port.Sent.size());
    Events.At(milliseconds(0), note);
  };
  Events.At(milliseconds(0), note);
  link.SendAtCommand(1, {'A', 'P'}, {});
  EXPECT_THAT(sentAtEvents, ElementsAre(1, 2, 3, 4, 5, 6, 7, 8));
}

TEST_F(Link, SendsAtCommandsAndTakesTheirAnswers) {
  link.OpenXBeePort();
  Arrive(5, {0x7E, 0x00, 0x06, 0x88, 0x01, 0x41, 0x50, 0x00, 0x01, 0xE4});
  link.SendAtCommand(1, {'A', 'P'}, {});
  EXPECT_THAT(Port.Sent, ElementsAre(0x7E, 0x00, 0x04, 0x08, 0x01, 0x41, 0x50, 0x65));
  EXPECT_TRUE(link.WaitForFrame(true));
  EXPECT_EQ(link.ReceivedFrameType(), 0x88);
  EXPECT_EQ(link.Frame().AtData[0], 1);
}

TEST_F(Link, WaitsTwoSecondsOrTwelveMilliseconds) {
  link.OpenXBeePort();
  SendSearch();
  EXPECT_FALSE(link.WaitForFrame(false));
  EXPECT_EQ(Now(), 12);
  EXPECT_FALSE(link.WaitForFrame(true));
  EXPECT_EQ(Now(), 2012);
  EXPECT_FALSE(link.Stopped());
}

TEST_F(Link, EndsItsWaitWithAnyGoodFrame) {
  for (const Bytes& frame : {Received(1, SearchAnswer(33)), ModemStatusFrame(), TransmitStatusFrame(),
                             Framed({0x81, 1, 2, 40, 0, 9}), Framed({0x88, 1, 'A', 'P', 0})}) {
    link.OpenXBeePort();
    SendSearch();
    const int start = Now();
    Arrive(3, frame);
    EXPECT_TRUE(link.WaitForFrame(true));
    EXPECT_EQ(link.ReceivedFrameType(), frame[3]);
    EXPECT_EQ(Now() - start, 3);
  }
}

TEST_F(Link, DoesNotEndItsWaitWithABadFrame) {
  link.OpenXBeePort();
  Bytes bad = Received(1, SearchAnswer(33));
  bad.back() ^= 1;
  Arrive(3, bad);
  Arrive(6, {1, 2, 3});
  EXPECT_FALSE(link.WaitForFrame(false));
  EXPECT_EQ(Now(), 12);
}

TEST_F(Link, PutsAFrameTogetherFromSingleBytes) {
  link.OpenXBeePort();
  const Bytes frame = ModemStatusFrame();
  for (std::size_t i = 0; i < frame.size(); ++i) {
    Arrive(static_cast<int>(i) * 10, {frame[i]});
  }
  EXPECT_TRUE(link.WaitForFrame(true));
  EXPECT_EQ(Now(), 50);
}

TEST_F(Link, TakesOneFrameForOneWait) {
  link.OpenXBeePort();
  Arrive(3, Joined({ModemStatusFrame(), Received(1, SearchAnswer(33))}));
  EXPECT_TRUE(link.WaitForFrame(true));
  EXPECT_EQ(link.ReceivedFrameType(), 0x8A);
  EXPECT_TRUE(link.WaitForFrame(true));
  EXPECT_EQ(link.ReceivedFrameType(), 0x80);
}

TEST_F(Link, DoesNotTakeAFrameFromBeforeThePacketForItsAnswer) {
  link.OpenXBeePort();
  Port.Receive(Received(1, SearchAnswer(33)));
  ASSERT_TRUE(link.TakeFrame());
  SendSearch();
  EXPECT_EQ(link.ReceivedFrameType(), 0);
  EXPECT_FALSE(link.WaitForFrame(false));
}

TEST_F(Link, TakesAnAnswerThatComesWhileThePacketIsStillGoingOut) {
  link.OpenXBeePort();
  Arrive(0, Received(1, SearchAnswer(33)));
  SendSearch();
  EXPECT_TRUE(link.WaitForFrame(false));
  EXPECT_EQ(Now(), 0);
}

TEST_F(Link, OnceStoppedSendsNothingMore) {
  link.OpenXBeePort();
  Port.OnOutput = [this](std::uint8_t) { stopped = Port.Sent.size() == 4; };
  SendSearch();
  EXPECT_EQ(Port.Sent.size(), 4U);
  EXPECT_TRUE(link.Stopped());
  EXPECT_FALSE(link.WaitForFrame(true));
  EXPECT_EQ(Now(), 0);
  EXPECT_NO_THROW(link.ThrowIfLineLost());
}

TEST_F(Link, StoppedInAWaitEndsItAsWithoutAnswer) {
  link.OpenXBeePort();
  Events.At(milliseconds(700), [this] { stopped = true; });
  EXPECT_FALSE(link.WaitForFrame(true));
  EXPECT_EQ(Now(), 700);
}

TEST_F(Link, IsStoppedWhenTheProgramCloses) {
  link.OpenXBeePort();
  Events.At(milliseconds(700), [this] { Events.EndWaits(); });
  EXPECT_FALSE(link.WaitForFrame(true));
  EXPECT_TRUE(link.Stopped());
  SendSearch();
  EXPECT_THAT(Port.Sent, IsEmpty());
  EXPECT_NO_THROW(link.ThrowIfLineLost());
}

TEST_F(Link, EndsAWaitInWhichTheLineIsLost) {
  link.OpenXBeePort();
  SendSearch();
  Events.At(milliseconds(300), [this] { Port.Lose(); });
  EXPECT_FALSE(link.WaitForFrame(true));
  EXPECT_EQ(Now(), 300);
  EXPECT_TRUE(link.Stopped());
  try {
    link.ThrowIfLineLost();
    FAIL() << "nothing thrown";
  } catch (const RuntimeError& error) {
    EXPECT_EQ(error.Number(), 8012);
  }
}

TEST_F(Link, LostWhileSendingSendsNoFurtherByte) {
  link.OpenXBeePort();
  Port.OnOutput = [this](std::uint8_t) {
    if (Port.Sent.size() == 2) {
      Port.Lose();
    }
  };
  SendSearch();
  EXPECT_EQ(Port.Log.back(), "Output 16 failed 8012");
  SendSearch();
  EXPECT_EQ(Port.Log.back(), "Output 16 failed 8012");
  EXPECT_THROW(link.ThrowIfLineLost(), RuntimeError);
  stopped = true;
  EXPECT_NO_THROW(link.ThrowIfLineLost());
}

TEST_F(Link, LeavesTheLineClosed) {
  {
    RadioLink other(Port, Line, Events, [] { return false; });
    other.OpenXBeePort();
    EXPECT_TRUE(Port.PortOpen());
  }
  EXPECT_FALSE(Port.PortOpen());
}

TEST_F(Link, ClosesAnOpenLineOnce) {
  link.XBee_CloseCommPort();
  EXPECT_THAT(Port.Log, IsEmpty());
  link.OpenXBeePort();
  link.XBee_CloseCommPort();
  link.XBee_CloseCommPort();
  EXPECT_THAT(Port.Log, ElementsAre("Open /dev/ttyS0 57600,N,8,1", "Close"));
}

TEST_F(Link, PassesAFaultOfTheFrameParserOn) {
  link.OpenXBeePort();
  Bytes data(102, 0);
  Arrive(3, Received(1, data));
  try {
    link.WaitForFrame(true);
    FAIL() << "nothing thrown";
  } catch (const RuntimeError& error) {
    EXPECT_EQ(error.Number(), 9);
  }
}

}  // namespace
