#include "core/line/ReaderPoll.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakeOneWire.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;

class ReaderPolling : public testing::Test {
 protected:
  static constexpr FakeOneWire::Rom First = {0x0C, 1, 0, 0, 0, 0, 0, 0x11};
  static constexpr FakeOneWire::Rom Second = {0x0C, 2, 0, 0, 0, 0, 0, 0x22};

  ReaderPolling() { wire.Devices = {First, Second}; }

  FakeOneWire wire;
  ReaderPoll poll{wire};
};

TEST_F(ReaderPolling, WalksOnFromSessionToSession) {
  std::vector<BusStep> steps;
  for (int i = 0; i < 4; ++i) {
    ASSERT_TRUE(poll.Begin());
    steps.push_back(poll.Next());
    poll.End();
  }
  EXPECT_THAT(steps, ElementsAre(BusStep::Device, BusStep::Device, BusStep::End, BusStep::Device));
}

TEST_F(ReaderPolling, SelectsAndExchangesWithTheDeviceThatItFound) {
  wire.OnByte = [](std::uint8_t byte) { return static_cast<std::uint8_t>(byte + 1); };
  poll.Begin();
  poll.Next();
  EXPECT_EQ(poll.Rom(), First);
  EXPECT_TRUE(poll.Access());
  std::array<std::uint8_t, 2> bytes = {1, 2};
  EXPECT_TRUE(poll.Exchange(bytes));
  EXPECT_THAT(bytes, ElementsAre(2, 3));
}

TEST_F(ReaderPolling, TellsWhenTheDeviceHasGone) {
  poll.Begin();
  poll.Next();
  wire.Devices = {Second};
  EXPECT_FALSE(poll.Access());
  EXPECT_FALSE(poll.IsOnBus(First));
}

TEST_F(ReaderPolling, LooksForADeviceWithoutLosingItsPlace) {
  poll.Begin();
  poll.Next();
  EXPECT_TRUE(poll.IsOnBus(First));
  EXPECT_TRUE(poll.IsOnBus(Second));
  EXPECT_EQ(poll.Next(), BusStep::Device);
  EXPECT_EQ(poll.Rom(), Second);
}

TEST_F(ReaderPolling, FindsNoDeviceAfterABadRead) {
  poll.Begin();
  wire.NextResults = {OneWire::BadRead};
  EXPECT_FALSE(poll.IsOnBus(First));
}

TEST_F(ReaderPolling, GivesUpOnADriverThatFindsDevicesWithoutEnd) {
  poll.Begin();
  wire.NextResults.assign(1000, OneWire::DeviceFound);
  EXPECT_FALSE(poll.IsOnBus(First));
  EXPECT_GT(wire.NextResults.size(), 900U);
}

TEST_F(ReaderPolling, DropsWhatTheDriverThrowsAtAnEndAfterAFailure) {
  poll.Begin();
  wire.Broken = "TMEndSession";
  EXPECT_EQ(NumberThrownBy([this] { poll.EndFailed(); }), 0);
  EXPECT_EQ(NumberThrownBy([this] { poll.End(); }), Fault::FileNotFound);
}

}  // namespace
