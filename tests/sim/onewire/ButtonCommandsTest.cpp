#include "sim/onewire/ButtonCommands.h"

#include <gtest/gtest.h>

#include <stdexcept>

#include "tests/support/AdapterHost.h"

namespace sim {
namespace {

constexpr std::uint8_t Present = 0xCD;
constexpr std::uint8_t Absent = 0xCF;

class ButtonCommands : public testing::Test {
 protected:
  std::string Obey(const std::string& line) { return ObeyButtonCommand(adapter_, line); }
  std::uint8_t ResetAnswer() { return host_.Ask({0xC1}, 1).at(0); }

  OneWireAdapter adapter_{{.Failure = OneWireFailure::NoOwnDevice, .LinePace = Pace::Fast}};
  AdapterHost host_{adapter_.DevicePath()};
};

TEST_F(ButtonCommands, TouchAButtonWithTheRomThatTheyName) {
  EXPECT_EQ(Obey("touch efcdab8967452301"), "touched EFCDAB8967452301");
  EXPECT_EQ(host_.Ask({0xC1, 0xE1, 0x33, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xE3}, 10),
            (Bytes{Present, 0x33, 0x01, 0x23, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0xEF}));
}

TEST_F(ButtonCommands, TakeAButtonAway) {
  Obey("touch EFCDAB8967452301");
  EXPECT_EQ(Obey("  leave   EFCDAB8967452301 \r"), "left EFCDAB8967452301");
  EXPECT_EQ(ResetAnswer(), Absent);
}

TEST_F(ButtonCommands, TakeAllButtonsAway) {
  Obey("touch EFCDAB8967452301");
  Obey("touch A200000001B81C02");
  EXPECT_EQ(ResetAnswer(), Present);
  EXPECT_EQ(Obey("leave"), "left");
  EXPECT_EQ(ResetAnswer(), Absent);
  EXPECT_EQ(Obey("leave"), "left");
}

TEST_F(ButtonCommands, FillAButtonAndShowItsBlock) {
  EXPECT_EQ(
      Obey("show 5600000001b81c06"),
      "5600000001B81C06 FF FF FF FF FF FF FF FF FF FF FF FF FF FF FF FF FF FF FF FF FF FF FF FF FF FF FF FF "
      "FF FF FF FF");
  EXPECT_EQ(Obey("fill 5600000001B81C06 bandage"), "filled 5600000001B81C06");
  EXPECT_EQ(
      Obey("show 5600000001B81C06"),
      "5600000001B81C06 01 00 3E 4F 60 71 82 93 A4 B5 C6 D7 E8 F9 0A 1B 2C 3D 4E 5F 70 81 92 A3 B4 C5 D6 E7 "
      "F8 09 1A F0");
}

TEST_F(ButtonCommands, FillAButtonWhileItIsAtTheReader) {
  Obey("touch 5600000001B81C06");
  Obey("fill 5600000001B81C06 unknown-kind");
  EXPECT_EQ(host_.Ask({0xC1, 0xE1, 0xCC, 0xF0, 0x20, 0x00, 0xFF, 0xFF, 0xFF, 0xE3}, 8),
            (Bytes{Present, 0xCC, 0xF0, 0x20, 0x00, 0x02, 0x00, 0x3E}));
}

TEST_F(ButtonCommands, DoNothingOnAnEmptyLine) {
  EXPECT_EQ(Obey(""), "");
  EXPECT_EQ(Obey(" \t"), "");
}

TEST_F(ButtonCommands, RefuseWhatTheyDoNotUnderstandAndButtonsThatAreNotThere) {
  Obey("touch EFCDAB8967452301");
  for (const char* line :
       {"touch", "touch 1", "touch EFCDAB8967452301 now", "leave A200000001B81C02", "leave all",
        "leave EFCDAB8967452301 now", "Touch EFCDAB8967452301", "EFCDAB8967452301", "fill",
        "fill 5600000001B81C06", "fill 5600000001B81C06 grenade", "fill 5600000001B81C06 bandage now",
        "fill EFCDAB8967452301 bandage", "fill bandage", "show", "show EFCDAB8967452301",
        "show 5600000001B81C06 now"}) {
    EXPECT_THROW(Obey(line), std::invalid_argument) << line;
  }
  EXPECT_EQ(ResetAnswer(), Present);
}

}  // namespace
}  // namespace sim
