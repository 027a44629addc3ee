#include "sim/onewire/OneWireAdapter.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sstream>
#include <stdexcept>

#include "sim/line/Crc.h"
#include "tests/support/AdapterHost.h"

namespace sim {
namespace {

constexpr RomId Button{0x02, 0x1C, 0xB8, 0x01, 0x00, 0x00, 0x00, 0xA2};
const Bytes ReadRom{0xC1, 0xE1, 0x33, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xE3};

Bytes RomAnswer(const Bytes& rom) {
  Bytes answer{0xCD, 0x33};
  answer.insert(answer.end(), rom.begin(), rom.end());
  return answer;
}

TEST(OneWireAdapter, AnswersDetectionAndHasAnIdentityOfItsOwn) {
  OneWireAdapter adapter({.LinePace = Pace::Fast});
  AdapterHost host(adapter.DevicePath());
  EXPECT_EQ(host.Ask({0x17, 0x45, 0x5B, 0x0F, 0x91}, 5), (Bytes{0x16, 0x44, 0x5A, 0x00, 0x93}));
  const Bytes identity{0x81, 0x37, 0x5A, 0x1E, 0x00, 0x00, 0x00, 0xC7};
  EXPECT_EQ(Crc8(identity), 0);
  EXPECT_EQ(host.Ask(ReadRom, 10), RomAnswer(identity));
}

TEST(OneWireAdapter, HasAButtonOnItsBusWhileItIsTouched) {
  OneWireAdapter adapter({.Failure = OneWireFailure::NoOwnDevice, .LinePace = Pace::Fast});
  AdapterHost host(adapter.DevicePath());
  const Bytes absent(1, 0xCF);
  EXPECT_EQ(host.Ask({0xC1}, 1), absent);
  adapter.Touch(Button);
  EXPECT_EQ(host.Ask(ReadRom, 10), RomAnswer({Button.begin(), Button.end()}));
  EXPECT_TRUE(adapter.Leave(Button));
  EXPECT_EQ(host.Ask({0xC1}, 1), absent);
  EXPECT_FALSE(adapter.Leave(Button));
  adapter.Touch(Button);
  adapter.LeaveAll();
  EXPECT_EQ(host.Ask({0xC1}, 1), absent);
}

TEST(OneWireAdapter, IsAsItWasLeftWhenAHostComesBack) {
  OneWireAdapter adapter({.LinePace = Pace::Fast});
  {
    AdapterHost host(adapter.DevicePath());
    EXPECT_EQ(host.Ask({0x45, 0x75, 0xE1, 0x33}, 3), (Bytes{0x44, 0x74, 0x33}));
  }
  RawHost host(adapter.DevicePath());
  host.Speak({.Baud = 57600});
  host.Write({0xE3, 0x09, 0x0F});
  EXPECT_EQ(host.Read(2), (Bytes{0x04, 0x04}));
}

TEST(OneWireAdapter, HearsTheHostAtTheSpeedThatItWasTold) {
  OneWireAdapter adapter({.LinePace = Pace::Fast});
  AdapterHost host(adapter.DevicePath());
  EXPECT_EQ(host.Ask({0x75}, 1), Bytes{0x74});
  host.Write({0x17});
  ASSERT_TRUE(adapter.WaitUntilHostFaults(1, Limit));
  EXPECT_EQ(adapter.HostFaults(), std::vector<std::string>{"the host speaks 9600,8N1 instead of 57600,8N1"});
  host.Speak({.Baud = 57600});
  EXPECT_EQ(host.Ask({0x0F, 0x71}, 2), (Bytes{0x04, 0x70}));
  host.Speak({.Baud = 9600});
  EXPECT_EQ(host.Ask({0x0F}, 1), Bytes{0x00});
}

TEST(OneWireAdapter, KeepsToTheSpeedOfTheLineUnlessTold) {
  OneWireAdapter adapter({});
  AdapterHost host(adapter.DevicePath());
  const auto start = std::chrono::steady_clock::now();
  const Bytes asked(20, 0x91);
  EXPECT_EQ(host.Ask(asked, 20), Bytes(20, 0x93));
  EXPECT_GE(std::chrono::steady_clock::now() - start, std::chrono::duration<double>(21 * 10.0 / 9600.0));
}

TEST(OneWireAdapter, LogsBothDirections) {
  std::ostringstream log;
  {
    OneWireAdapter adapter({.LinePace = Pace::Fast, .Log = &log});
    AdapterHost host(adapter.DevicePath());
    EXPECT_EQ(host.Ask({0x17}, 1), Bytes{0x16});
  }
  EXPECT_THAT(log.str(), testing::ContainsRegex("1-wire <- C1\n.*1-wire <- 17\n.*1-wire -> 16\n"));
}

TEST(OneWireAdapter, EndsInTheMiddleOfAnExchange) {
  OneWireAdapter adapter({});
  AdapterHost host(adapter.DevicePath());
  EXPECT_EQ(host.Ask(Bytes(200, 0x91), 1), Bytes{0x93});
}

TEST(OneWireAdapter, RefusesPlacesThatDoNotExist) {
  for (const OneWireFailureInfo& info : OneWireFailures) {
    const bool hasPlace = info.Place != FailurePlace::None;
    for (const auto& [place, refused] : {std::pair<std::size_t, bool>{0, hasPlace},
                                         {1, false},
                                         {64, false},
                                         {65, info.Place == FailurePlace::Bit}}) {
      const OneWireAdapterSettings settings{.Failure = info.Failure, .FailurePlace = place};
      if (refused) {
        EXPECT_THROW(OneWireAdapter{settings}, std::invalid_argument) << info.Name << ' ' << place;
      } else {
        EXPECT_NO_THROW(OneWireAdapter{settings}) << info.Name << ' ' << place;
      }
    }
  }
}

}  // namespace
}  // namespace sim
