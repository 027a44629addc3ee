#include "sim/onewire/OneWireBus.h"

#include <gtest/gtest.h>

#include <cstdint>

namespace sim {
namespace {

using Presence = OneWireBus::Presence;

constexpr RomId Reader{0x81, 0x11, 0x22, 0x33, 0x44, 0x55, 0x66, 0x77};
constexpr RomId Button{0x01, 0x23, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0xEF};
constexpr RomId Other{0x01, 0x23, 0x55, 0x67, 0x89, 0xAB, 0xCD, 0x12};

void Send(OneWireBus& bus, std::uint8_t byte) {
  for (unsigned bit = 0; bit < 8; ++bit) {
    bus.Slot((byte >> bit & 1U) != 0);
  }
}

RomId ReadRom(OneWireBus& bus) {
  bus.Reset();
  Send(bus, 0x33);
  RomId rom{};
  for (std::size_t bit = 0; bit < 64; ++bit) {
    rom[bit / 8] |= static_cast<std::uint8_t>((bus.Slot(true) ? 1U : 0U) << bit % 8);
  }
  return rom;
}

constexpr RomId Nobody{0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF};

TEST(OneWireBus, IsEmptyUntilAButtonIsTouched) {
  OneWireBus bus;
  EXPECT_EQ(bus.Reset(), Presence::Absent);
  EXPECT_EQ(ReadRom(bus), Nobody);
  bus.Touch(Button);
  EXPECT_EQ(bus.Reset(), Presence::Present);
  EXPECT_EQ(ReadRom(bus), Button);
}

TEST(OneWireBus, AlwaysHasTheDeviceThatIsSolderedToIt) {
  OneWireBus bus({.OwnDevice = Reader});
  EXPECT_EQ(ReadRom(bus), Reader);
  bus.LeaveAll();
  EXPECT_FALSE(bus.Leave(Reader));
  EXPECT_EQ(bus.Reset(), Presence::Present);
  EXPECT_EQ(ReadRom(bus), Reader);
}

TEST(OneWireBus, IsLowWhereAnyDevicePullsItLow) {
  OneWireBus bus;
  bus.Touch(Button);
  bus.Touch(Other);
  RomId both{};
  for (std::size_t i = 0; i < both.size(); ++i) {
    both[i] = Button[i] & Other[i];
  }
  EXPECT_EQ(ReadRom(bus), both);
}

TEST(OneWireBus, HasAButtonOnceHoweverOftenItIsTouched) {
  OneWireBus bus;
  bus.Touch(Button);
  bus.Touch(Button);
  EXPECT_TRUE(bus.Leave(Button));
  EXPECT_EQ(bus.Reset(), Presence::Absent);
  EXPECT_FALSE(bus.Leave(Button));
}

TEST(OneWireBus, LosesTheButtonThatLeavesAndNoOther) {
  OneWireBus bus;
  bus.Touch(Button);
  bus.Touch(Other);
  EXPECT_TRUE(bus.Leave(Button));
  EXPECT_EQ(ReadRom(bus), Other);
  bus.LeaveAll();
  EXPECT_EQ(ReadRom(bus), Nobody);
}

TEST(OneWireBus, HearsANewButtonFromTheNextResetPulseOn) {
  OneWireBus bus;
  bus.Reset();
  bus.Touch(Button);
  Send(bus, 0x33);
  EXPECT_TRUE(bus.Slot(true));
  EXPECT_TRUE(bus.Slot(true));
  EXPECT_EQ(ReadRom(bus), Button);
}

TEST(OneWireBus, StaysLowWhenItIsShorted) {
  OneWireBus bus({.OwnDevice = Reader, .Shorted = true});
  EXPECT_EQ(bus.Reset(), Presence::Shorted);
  EXPECT_EQ(ReadRom(bus), RomId{});
}

TEST(OneWireBus, LosesButtonsButNotItsOwnDeviceInMidRead) {
  OneWireBus alone({.ContactLostAfterBits = 12});
  alone.Touch(Button);
  for (int read = 0; read < 2; ++read) {
    EXPECT_EQ(ReadRom(alone), (RomId{0x01, 0xF3, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF}));
  }
  OneWireBus withReader({.OwnDevice = Reader, .ContactLostAfterBits = 1});
  withReader.Touch(Button);
  EXPECT_EQ(ReadRom(withReader), Reader);
}

}  // namespace
}  // namespace sim
