#include "sim/onewire/OneWireBus.h"

#include <gtest/gtest.h>

#include <cstdint>

namespace sim {
namespace {

using Presence = OneWireBus::Presence;

constexpr RomId reader{0x81, 0x11, 0x22, 0x33, 0x44, 0x55, 0x66, 0x77};
constexpr RomId button{0x01, 0x23, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0xEF};
constexpr RomId other{0x01, 0x23, 0x55, 0x67, 0x89, 0xAB, 0xCD, 0x12};

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

constexpr RomId nobody{0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF};

TEST(OneWireBus, IsEmptyUntilAButtonIsTouched) {
  OneWireBus bus;
  EXPECT_EQ(bus.Reset(), Presence::Absent);
  EXPECT_EQ(ReadRom(bus), nobody);
  bus.Touch(button);
  EXPECT_EQ(bus.Reset(), Presence::Present);
  EXPECT_EQ(ReadRom(bus), button);
}

TEST(OneWireBus, AlwaysHasTheDeviceThatIsSolderedToIt) {
  OneWireBus bus({.OwnDevice = reader});
  EXPECT_EQ(ReadRom(bus), reader);
  bus.LeaveAll();
  EXPECT_FALSE(bus.Leave(reader));
  EXPECT_EQ(bus.Reset(), Presence::Present);
  EXPECT_EQ(ReadRom(bus), reader);
}

TEST(OneWireBus, IsLowWhereAnyDevicePullsItLow) {
  OneWireBus bus;
  bus.Touch(button);
  bus.Touch(other);
  RomId both{};
  for (std::size_t i = 0; i < both.size(); ++i) {
    both[i] = button[i] & other[i];
  }
  EXPECT_EQ(ReadRom(bus), both);
}

TEST(OneWireBus, HasAButtonOnceHoweverOftenItIsTouched) {
  OneWireBus bus;
  bus.Touch(button);
  bus.Touch(button);
  EXPECT_TRUE(bus.Leave(button));
  EXPECT_EQ(bus.Reset(), Presence::Absent);
  EXPECT_FALSE(bus.Leave(button));
}

TEST(OneWireBus, LosesTheButtonThatLeavesAndNoOther) {
  OneWireBus bus;
  bus.Touch(button);
  bus.Touch(other);
  EXPECT_TRUE(bus.Leave(button));
  EXPECT_EQ(ReadRom(bus), other);
  bus.LeaveAll();
  EXPECT_EQ(ReadRom(bus), nobody);
}

TEST(OneWireBus, HearsANewButtonFromTheNextResetPulseOn) {
  OneWireBus bus;
  bus.Reset();
  bus.Touch(button);
  Send(bus, 0x33);
  EXPECT_TRUE(bus.Slot(true));
  EXPECT_TRUE(bus.Slot(true));
  EXPECT_EQ(ReadRom(bus), button);
}

TEST(OneWireBus, StaysLowWhenItIsShorted) {
  OneWireBus bus({.OwnDevice = reader, .Shorted = true});
  EXPECT_EQ(bus.Reset(), Presence::Shorted);
  EXPECT_EQ(ReadRom(bus), RomId{});
}

TEST(OneWireBus, LosesButtonsButNotItsOwnDeviceInMidRead) {
  OneWireBus alone({.ContactLostAfterBits = 12});
  alone.Touch(button);
  for (int read = 0; read < 2; ++read) {
    EXPECT_EQ(ReadRom(alone), (RomId{0x01, 0xF3, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF}));
  }
  OneWireBus withReader({.OwnDevice = reader, .ContactLostAfterBits = 1});
  withReader.Touch(button);
  EXPECT_EQ(ReadRom(withReader), reader);
}

}  // namespace
}  // namespace sim
