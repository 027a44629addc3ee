#include "sim/box/UtilityBox.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sstream>
#include <stdexcept>

#include "tests/support/BoxHost.h"

namespace sim {
namespace {

using testing::ContainsRegex;

const Bytes Zeros{0x42, 0x43, 0, 0, 0, 0, 0, 0, 0, 0};
const Bytes Domination{0x42, 0x43, 0x38, 0x14, 0x05, 0x64, 0x02, 0x01, 0x00, 0x00};
const Bytes WrongType{0x42, 0x43, 0x39, 0, 0, 0, 0, 0, 0, 0};
const Bytes Accepted{0xAA};
const Bytes Rejected{0x55};

BoxFrame AsFrame(const Bytes& bytes) {
  BoxFrame frame{};
  std::copy(bytes.begin(), bytes.end(), frame.begin());
  return frame;
}

TEST(UtilityBox, AcceptsGoodFramesOneAfterTheOther) {
  for (const Pace pace : {Pace::Fast, Pace::AsWired}) {
    UtilityBox box({.LinePace = pace});
    BoxHost host(box.DevicePath());
    host.Send(Domination);
    EXPECT_EQ(host.Read(1), Accepted);
    host.Send(Zeros);
    EXPECT_EQ(host.Read(1), Accepted);
    EXPECT_TRUE(host.IsSilent());
    EXPECT_EQ(box.Traffic().Frames, (std::vector<BoxFrame>{AsFrame(Domination), AsFrame(Zeros)}));
    EXPECT_EQ(box.Traffic().Accepted, AsFrame(Zeros));
    EXPECT_EQ(box.HostFaults(), std::vector<std::string>{});
  }
}

TEST(UtilityBox, RejectsWrongValuesAndKeepsItsOwn) {
  UtilityBox box({.LinePace = Pace::Fast});
  BoxHost host(box.DevicePath());
  host.Send(Domination);
  EXPECT_EQ(host.Read(1), Accepted);
  host.Send(WrongType);
  EXPECT_EQ(host.Read(1), Rejected);
  EXPECT_EQ(box.Traffic().Accepted, AsFrame(Domination));
  EXPECT_EQ(box.HostFaults(), std::vector<std::string>{"the host sent a frame with a type of 9"});
}

TEST(UtilityBox, AnswersEachOfTwoFramesThatFollowEachOtherAtOnce) {
  UtilityBox box({.LinePace = Pace::Fast});
  BoxHost host(box.DevicePath());
  host.Send(Domination);
  host.Send(WrongType);
  EXPECT_EQ(host.Read(2), (Bytes{0xAA, 0x55}));
}

TEST(UtilityBox, DropsNoiseBeforeAFrame) {
  UtilityBox box({.LinePace = Pace::Fast});
  BoxHost host(box.DevicePath());
  host.Send({0xFF, 0x42});
  host.Send(Domination);
  EXPECT_EQ(host.Read(1), Accepted);
  EXPECT_EQ(box.HostFaults(), std::vector<std::string>{});
}

TEST(UtilityBox, StartsOverWhenAFrameBreaksOff) {
  UtilityBox box({.LinePace = Pace::Fast});
  BoxHost host(box.DevicePath());
  host.Send({0x42, 0x43, 0x38, 0x14});
  ASSERT_TRUE(box.WaitUntilHostFaults(1, Limit));
  EXPECT_EQ(box.HostFaults(), std::vector<std::string>{"the host sent only 4 bytes of a frame"});
  host.Send(Domination);
  EXPECT_EQ(host.Read(1), Accepted);
}

TEST(UtilityBox, NotesAHostThatLeavesOutThePauses) {
  for (const Pace pace : {Pace::Fast, Pace::AsWired}) {
    UtilityBox box({.LinePace = pace});
    BoxHost host(box.DevicePath());
    const auto end = std::chrono::steady_clock::now() + Limit;
    int frames = 0;
    for (; box.HostFaults().empty() && std::chrono::steady_clock::now() < end; ++frames) {
      host.Write(Domination);
      EXPECT_EQ(host.Read(1), Accepted);
    }
    EXPECT_GE(frames, 3);
    EXPECT_EQ(box.HostFaults(),
              std::vector<std::string>{"the host sent frames without pauses of 1 ms between their bytes"});
  }
}

TEST(UtilityBox, FindsNoFaultInPausesHoweverManyFramesCome) {
  UtilityBox box({.LinePace = Pace::AsWired});
  BoxHost host(box.DevicePath());
  for (int round = 0; round < 20; ++round) {
    host.Send(Domination);
    EXPECT_EQ(host.Read(1), Accepted);
  }
  EXPECT_EQ(box.HostFaults(), std::vector<std::string>{});
}

TEST(UtilityBox, TellsInItsLogWhatItWasTold) {
  std::ostringstream log;
  {
    UtilityBox box({.LinePace = Pace::Fast, .Log = &log});
    BoxHost host(box.DevicePath());
    host.Send({0xFF});
    host.Send(Domination);
    EXPECT_EQ(host.Read(1), Accepted);
    host.Send(WrongType);
    EXPECT_EQ(host.Read(1), Rejected);
  }
  EXPECT_THAT(log.str(), ContainsRegex("box <- FF ignored\n.*box <- 42\n.*box <- 43\n.*box <- 38\n"));
  EXPECT_THAT(log.str(),
              ContainsRegex("box <- 00 told: Dom. \\(iBtn\\), yellow, 20 points per activation, 5 "
                            "to recharge, 100 to give, automatic after 20 s, destroyable\n.*box -> "
                            "AA\n"));
  EXPECT_THAT(log.str(), ContainsRegex("box <- 00 fault: a type of 9\n.*box -> 55\n"));
}

TEST(UtilityBox, EndsInTheMiddleOfAFrame) {
  UtilityBox box({});
  BoxHost host(box.DevicePath());
  host.Send({0x42, 0x43, 0x38});
}

TEST(UtilityBox, RefusesPlacesThatDoNotExist) {
  for (const BoxFailureInfo& info : BoxFailures) {
    const bool hasPlace = info.Place != FailurePlace::None;
    for (const auto& [place, refused] :
         {std::pair<std::size_t, bool>{0, hasPlace}, {1, false}, {10, false}, {11, hasPlace}}) {
      const UtilityBoxSettings settings{.Failure = info.Failure, .FailurePlace = place};
      if (refused) {
        EXPECT_THROW(UtilityBox{settings}, std::invalid_argument) << info.Name << ' ' << place;
      } else {
        EXPECT_NO_THROW(UtilityBox{settings}) << info.Name << ' ' << place;
      }
    }
  }
}

}  // namespace
}  // namespace sim
