#include "devices/box/BoxProgrammer.h"

#include <gmock/gmock.h>

#include "tests/devices/box/BoxSite.h"
#include "tests/support/Thrown.h"

namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::Pair;
using testing::SizeIs;

class BoxProgramming : public testing::Test, protected BoxSite {
 protected:
  using Bytes = std::vector<std::uint8_t>;
  static constexpr std::uint8_t Accept = 0xAA;

  BoxProgrammer programmer{{.MSComm1 = Port,
                            .Port = Line,
                            .Events = Events,
                            .Boxes = Boxes,
                            .Stopped = [this] { return stopped; },
                            .OnResult =
                                [this](const BoxEntries& entries, BoxResult result) {
                                  results.emplace_back(entries.PointsPerAct, result);
                                  boxesAtResult.push_back(Boxes.Boxes.size());
                                }}};
  const BoxEntries medic = {.TeamList = 1, .PointsPerAct = "5", .RechargePoints = "6"};
  bool stopped = false;
  std::vector<std::pair<std::string, BoxResult>> results;
  std::vector<std::size_t> boxesAtResult;
};

TEST_F(BoxProgramming, SendsTheFrameByteByByteOnTheBoxsLine) {
  AnswerWith({Accept});
  programmer.Program(medic);
  EXPECT_THAT(Port.Log,
              ElementsAre("Open /dev/ttyS0 19200,N,8,1", "Output 66", "Output 67", "Output 16", "Output 5",
                          "Output 6", "Output 0", "Output 0", "Output 0", "Output 0", "Output 0", "Close"));
  EXPECT_EQ(Port.Instrument, "utility-box");
}

TEST_F(BoxProgramming, PausesAMillisecondAfterEachByteButTheLast) {
  AnswerWith({Accept});
  std::vector<std::size_t> sentAtPause;
  Events.OnSleep = [&](FakeEventPump::Time) { sentAtPause.push_back(Port.Sent.size()); };
  programmer.Program(medic);
  EXPECT_THAT(Events.Sleeps, ElementsAre(1ms, 1ms, 1ms, 1ms, 1ms, 1ms, 1ms, 1ms, 1ms));
  EXPECT_THAT(sentAtPause, ElementsAre(1, 2, 3, 4, 5, 6, 7, 8, 9));
}

TEST_F(BoxProgramming, TellsOfSuccessAndClosesThePort) {
  AnswerWith({Accept});
  bool openAtBox = false;
  Boxes.WhileOpen = [&](const FakeMessageBoxes::Box&) { openAtBox = Port.PortOpen(); };
  programmer.Program(medic);
  EXPECT_THAT(Boxes.Boxes, ElementsAre(Successful()));
  EXPECT_THAT(results, ElementsAre(Pair("5", BoxResult::Accepted)));
  EXPECT_THAT(boxesAtResult, ElementsAre(0U));
  EXPECT_TRUE(openAtBox);
  EXPECT_FALSE(Port.PortOpen());
}

TEST_F(BoxProgramming, TakesAnyOtherByteForARejection) {
  for (const std::uint8_t answer : Bytes{0x55, 0x00, 0xAB, 0xFF}) {
    AnswerWith({answer});
    Boxes.Boxes.clear();
    results.clear();
    programmer.Program(medic);
    EXPECT_THAT(Boxes.Boxes, ElementsAre(RejectedByBox())) << int{answer};
    EXPECT_THAT(results, ElementsAre(Pair("5", BoxResult::Rejected)));
    EXPECT_EQ(boxesAtResult.back(), 0U);
    EXPECT_FALSE(Port.PortOpen());
  }
}

TEST_F(BoxProgramming, CountsOnlyTheFirstByteOfTheAnswer) {
  AnswerWith({0x00, Accept});
  programmer.Program(medic);
  EXPECT_THAT(Boxes.Boxes, ElementsAre(RejectedByBox()));
  AnswerWith({Accept, 0x00});
  programmer.Program(medic);
  EXPECT_THAT(Boxes.Boxes, ElementsAre(RejectedByBox(), Successful()));
}

TEST_F(BoxProgramming, TakesAnAnswerThatCameBeforeTheLastByteWasSent) {
  Port.OnOutput = [this](std::uint8_t) {
    if (Port.Sent.size() == 4) {
      Port.Receive({Accept});
    }
  };
  programmer.Program(medic);
  EXPECT_THAT(Boxes.Boxes, ElementsAre(Successful()));
  EXPECT_THAT(Port.Sent, SizeIs(10));
}

TEST_F(BoxProgramming, TellsOfASilentBoxAfterTwoSeconds) {
  programmer.Program(medic);
  EXPECT_EQ(Events.Now(), 2009ms);
  EXPECT_THAT(Boxes.Boxes, ElementsAre(NoResponse()));
  EXPECT_THAT(results, ElementsAre(Pair("5", BoxResult::NoResponse)));
  EXPECT_THAT(boxesAtResult, ElementsAre(0U));
  EXPECT_FALSE(Port.PortOpen());
}

TEST_F(BoxProgramming, TakesAnAnswerInTheLastMoment) {
  AnswerWith({Accept}, 1999);
  programmer.Program(medic);
  EXPECT_THAT(Boxes.Boxes, ElementsAre(Successful()));
}

TEST_F(BoxProgramming, DropsAnAnswerThatComesWhenItHasTold) {
  Boxes.WhileOpen = [this](const FakeMessageBoxes::Box&) { Port.Receive({Accept}); };
  programmer.Program(medic);
  EXPECT_THAT(Boxes.Boxes, ElementsAre(NoResponse()));
  Boxes.WhileOpen = {};
  programmer.Program(medic);
  EXPECT_THAT(Boxes.Boxes, ElementsAre(NoResponse(), NoResponse()));
}

TEST_F(BoxProgramming, SendsAgainOnTheOpenPortWithoutANewLimit) {
  Meanwhile(1500, [this] { programmer.Program(medic); });
  programmer.Program(medic);
  EXPECT_THAT(Port.Sent, SizeIs(20));
  EXPECT_EQ(std::count(Port.Log.begin(), Port.Log.end(), "Open /dev/ttyS0 19200,N,8,1"), 1);
  EXPECT_EQ(Events.Now(), 2009ms);
  EXPECT_THAT(Boxes.Boxes, ElementsAre(NoResponse()));
  EXPECT_THAT(results, SizeIs(1));
}

TEST_F(BoxProgramming, TellsOneAnswerForTwoPressesWithTheEntriesOfTheLater) {
  BoxEntries later = medic;
  later.PointsPerAct = "99";
  Meanwhile(500, [this, later] { programmer.Program(later); });
  Meanwhile(600, [this] { Port.Receive({Accept, Accept}); });
  programmer.Program(medic);
  EXPECT_THAT(Boxes.Boxes, ElementsAre(Successful()));
  EXPECT_THAT(results, ElementsAre(Pair("99", BoxResult::Accepted)));
}

TEST_F(BoxProgramming, UsesTheFirstPortForTheSecondPressEvenIfTheSettingsChanged) {
  Meanwhile(500, [this] {
    Store.Put("/tessarine.ini", "[comm]\ncommport=2\n");
    programmer.Program(medic);
  });
  programmer.Program(medic);
  EXPECT_EQ(Port.Device, "/dev/ttyS0");
  EXPECT_THAT(Port.Sent, SizeIs(20));
}

TEST_F(BoxProgramming, ReadsThePortNumberAtEachPress) {
  AnswerWith({Accept});
  programmer.Program(medic);
  EXPECT_EQ(Port.Device, "/dev/ttyS0");
  Store.Put("/tessarine.ini", "[comm]\ncommport=2\n");
  programmer.Program(medic);
  EXPECT_EQ(Port.Device, "/dev/ttyUSB0");
}

TEST_F(BoxProgramming, TellsOfAPortThatIsTaken) {
  Port.FailNextOpen(Fault::PortAlreadyOpen);
  programmer.Program(medic);
  EXPECT_THAT(Boxes.Boxes, ElementsAre(PortTaken()));
  EXPECT_THAT(results, ElementsAre(Pair("5", BoxResult::NotSent)));
  EXPECT_EQ(Events.Now(), 0ms);
}

TEST_F(BoxProgramming, TellsEveryOtherFaultAlike) {
  for (const int fault : {Fault::InvalidPortNumber, Fault::InvalidPropertyValue, Fault::PortLost}) {
    Port.FailNextOpen(fault);
    Boxes.Boxes.clear();
    programmer.Program(medic);
    EXPECT_THAT(Boxes.Boxes, ElementsAre(PortError())) << fault;
  }
  EXPECT_THAT(Port.Sent, IsEmpty());
}

TEST_F(BoxProgramming, TellsOfAPortNumberWithoutADevice) {
  for (const char* number : {"9", "0", "", "x", "99999"}) {
    Store.Put("/tessarine.ini", std::string("[comm]\ncommport=") + number + "\n");
    Boxes.Boxes.clear();
    programmer.Program(medic);
    EXPECT_THAT(Boxes.Boxes, ElementsAre(PortError())) << number;
  }
}

TEST_F(BoxProgramming, SendsNothingOfABadEntry) {
  BoxEntries bad = medic;
  bad.AutoModeTime = "abc";
  programmer.Program(bad);
  EXPECT_THAT(Port.Sent, IsEmpty());
  EXPECT_THAT(Boxes.Boxes, ElementsAre(PortError()));
  EXPECT_FALSE(Port.PortOpen());
}

TEST_F(BoxProgramming, EndsTheWaitWhenASecondPressFails) {
  BoxEntries bad = medic;
  bad.RechargePoints = "";
  bool openAtBox = true;
  Boxes.WhileOpen = [&](const FakeMessageBoxes::Box&) { openAtBox = Port.PortOpen(); };
  Meanwhile(700, [this, bad] { programmer.Program(bad); });
  programmer.Program(medic);
  EXPECT_THAT(Boxes.Boxes, ElementsAre(PortError()));
  EXPECT_EQ(Events.Now(), 700ms);
  EXPECT_FALSE(openAtBox);
  EXPECT_THAT(results, ElementsAre(Pair("5", BoxResult::Unconfirmed)));
  AnswerWith({Accept});
  programmer.Program(medic);
  EXPECT_EQ(Boxes.Boxes.back(), Successful());
}

TEST_F(BoxProgramming, TellsOnceOfALinePulledOutBetweenAnyTwoBytes) {
  for (std::size_t after = 0; after < 10; ++after) {
    Port.Sent.clear();
    Boxes.Boxes.clear();
    results.clear();
    Port.OnOutput = [this, after](std::uint8_t) {
      if (Port.Sent.size() == after) {
        Port.Lose();
      }
    };
    if (after == 0) {
      Port.FailOutput(Fault::PortLost);
    }
    programmer.Program(medic);
    Port.FailOutput(0);
    EXPECT_THAT(Boxes.Boxes, ElementsAre(PortError())) << after;
    EXPECT_THAT(results, ElementsAre(Pair("5", BoxResult::NotSent)));
    EXPECT_THAT(Port.Sent, SizeIs(after));
    EXPECT_FALSE(Port.PortOpen());
  }
}

TEST_F(BoxProgramming, ReportsALineThatIsLostInTheWait) {
  Meanwhile(300, [this] { Port.Lose(); });
  EXPECT_EQ(NumberThrownBy([this] { programmer.Program(medic); }), Fault::PortLost);
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  EXPECT_THAT(results, ElementsAre(Pair("5", BoxResult::Unconfirmed)));
  EXPECT_EQ(Events.Now(), 300ms);
  EXPECT_FALSE(Port.PortOpen());
}

TEST_F(BoxProgramming, TellsOfALostLineAtTheSecondPressAlone) {
  Meanwhile(300, [this] {
    Port.FailOutput(Fault::PortLost);
    programmer.Program(medic);
  });
  programmer.Program(medic);
  EXPECT_THAT(Boxes.Boxes, ElementsAre(PortError()));
  EXPECT_THAT(results, ElementsAre(Pair("5", BoxResult::Unconfirmed)));
  EXPECT_EQ(Events.Now(), 300ms);
}

TEST_F(BoxProgramming, EndsSilentlyWhenItsWindowCloses) {
  Meanwhile(300, [this] { stopped = true; });
  programmer.Program(medic);
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  EXPECT_THAT(results, ElementsAre(Pair("5", BoxResult::Unconfirmed)));
  EXPECT_EQ(Events.Now(), 300ms);
  EXPECT_FALSE(Port.PortOpen());
}

TEST_F(BoxProgramming, EndsSilentlyWhenTheProgramCloses) {
  Meanwhile(300, [this] { Events.EndWaits(); });
  programmer.Program(medic);
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  EXPECT_FALSE(Port.PortOpen());
}

}  // namespace
