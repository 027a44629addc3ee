#include "sim/onewire/OneWireDevice.h"

#include <gtest/gtest.h>

#include <cstdint>

namespace sim {
namespace {

constexpr RomId Rom{0x01, 0x23, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0xEF};

// A slot with only this device and the master on the line.
bool Slot(OneWireDevice& device, bool level) {
  const bool heard = level && device.Releases();
  device.Slot(heard);
  return heard;
}

void Send(OneWireDevice& device, std::uint8_t byte) {
  for (unsigned bit = 0; bit < 8; ++bit) {
    Slot(device, (byte >> bit & 1U) != 0);
  }
}

std::uint8_t Read(OneWireDevice& device) {
  unsigned byte = 0;
  for (unsigned bit = 0; bit < 8; ++bit) {
    byte |= (Slot(device, true) ? 1U : 0U) << bit;
  }
  return static_cast<std::uint8_t>(byte);
}

class OneWireDeviceTest : public testing::Test {
 protected:
  void Command(std::uint8_t command) {
    device_.Reset();
    Send(device_, command);
  }

  OneWireDevice device_{Rom};
};

TEST_F(OneWireDeviceTest, HearsNothingBeforeTheFirstResetPulse) {
  Send(device_, 0x33);
  EXPECT_EQ(Read(device_), 0xFF);
  Send(device_, 0xCC);
  EXPECT_FALSE(device_.IsSelected());
}

TEST_F(OneWireDeviceTest, GivesItsRomLeastSignificantBitFirst) {
  Command(0x33);
  for (const std::uint8_t byte : Rom) {
    EXPECT_EQ(Read(device_), byte);
  }
  EXPECT_EQ(device_.RomBitsGiven(), 64U);
  EXPECT_EQ(Read(device_), 0xFF);
}

TEST_F(OneWireDeviceTest, BeginsAnewAtEachResetPulse) {
  Command(0x33);
  EXPECT_EQ(Read(device_), 0x01);
  device_.Reset();
  Slot(device_, true);
  Command(0x33);
  EXPECT_EQ(device_.RomBitsGiven(), 0U);
  EXPECT_EQ(Read(device_), 0x01);
}

TEST_F(OneWireDeviceTest, GivesBitAndComplementAndDropsOutOfASearchThatGoesAnotherWay) {
  Command(0xF0);
  EXPECT_TRUE(Slot(device_, true));
  EXPECT_FALSE(Slot(device_, true));
  Slot(device_, true);
  EXPECT_FALSE(Slot(device_, true));
  EXPECT_TRUE(Slot(device_, true));
  Slot(device_, true);
  EXPECT_EQ(device_.RomBitsGiven(), 2U);
  EXPECT_TRUE(Slot(device_, true));
  EXPECT_TRUE(Slot(device_, true));
}

TEST_F(OneWireDeviceTest, IsSelectedByASearchThatFollowsItToTheEnd) {
  Command(0xF0);
  for (int bit = 0; bit < 64; ++bit) {
    EXPECT_FALSE(device_.IsSelected());
    const bool value = Slot(device_, true);
    EXPECT_NE(Slot(device_, true), value);
    Slot(device_, value);
  }
  EXPECT_TRUE(device_.IsSelected());
}

TEST_F(OneWireDeviceTest, IsSelectedByItsOwnRomOnly) {
  Command(0x55);
  for (const std::uint8_t byte : Rom) {
    Send(device_, byte);
  }
  EXPECT_TRUE(device_.IsSelected());
  for (std::size_t bit = 0; bit < 64; ++bit) {
    RomId other = Rom;
    other[bit / 8] ^= static_cast<std::uint8_t>(1U << bit % 8);
    Command(0x55);
    for (const std::uint8_t byte : other) {
      Send(device_, byte);
    }
    EXPECT_FALSE(device_.IsSelected()) << "bit " << bit;
  }
}

TEST_F(OneWireDeviceTest, IsSelectedBySkippingTheRom) {
  Command(0xCC);
  EXPECT_TRUE(device_.IsSelected());
  EXPECT_EQ(Read(device_), 0xFF);
  device_.Reset();
  EXPECT_FALSE(device_.IsSelected());
}

TEST_F(OneWireDeviceTest, LeavesOtherCommandsUnanswered) {
  for (const int command : {0x00, 0x0F, 0x3C, 0x69, 0xEC, 0xFF}) {
    Command(static_cast<std::uint8_t>(command));
    EXPECT_EQ(Read(device_), 0xFF) << command;
    EXPECT_FALSE(device_.IsSelected()) << command;
  }
}

TEST_F(OneWireDeviceTest, IsBackAtTheNextResetPulseWhenItsContactIsLost) {
  Command(0x33);
  EXPECT_FALSE(Slot(device_, true) && Slot(device_, true));
  device_.LoseContact();
  EXPECT_EQ(Read(device_), 0xFF);
  Command(0x33);
  EXPECT_EQ(Read(device_), 0x01);
}

}  // namespace
}  // namespace sim
