#include "sim/bootcode/BootCommands.h"

#include <gtest/gtest.h>

#include <stdexcept>

#include "tests/support/BootHost.h"

namespace sim {
namespace {

class BootCommands : public testing::Test {
 protected:
  std::string Obey(const std::string& line) { return ObeyBootCommand(device_, line); }

  BootCode device_{{.LinePace = Pace::Fast}};
  BootHost host_{device_.DevicePath()};
};

TEST_F(BootCommands, SwitchTheDeviceOn) {
  EXPECT_EQ(Obey("power"), "switched on");
  EXPECT_EQ(host_.Hear(4), "BOOT");
}

TEST_F(BootCommands, SwitchTheDeviceOnWithAFailureForThisTime) {
  EXPECT_EQ(Obey(" power  boot-twice \r"), "switched on");
  EXPECT_EQ(host_.Hear(8), "BOOTBOOT");
  EXPECT_EQ(Obey("power other-reply 2"), "switched on");
  EXPECT_EQ(host_.Hear(4), "BOOT");
  EXPECT_EQ(host_.Say("XP"), "?d");
  EXPECT_EQ(Obey("power"), "switched on");
  EXPECT_EQ(host_.Hear(4), "BOOT");
  EXPECT_EQ(host_.Say("X"), "x");
}

TEST_F(BootCommands, DoNothingOnAnEmptyLine) {
  EXPECT_EQ(Obey(""), "");
  EXPECT_EQ(Obey(" \t"), "");
}

TEST_F(BootCommands, RefuseWhatTheyDoNotUnderstand) {
  for (const char* line : {"Power", "off", "power fire", "power silence 0", "power silence -1",
                           "power silence x", "power silence 1 2"}) {
    EXPECT_THROW(Obey(line), std::invalid_argument) << line;
  }
  EXPECT_TRUE(host_.IsSilent());
  EXPECT_EQ(device_.Traffic().PowerOns, 0U);
}

}  // namespace
}  // namespace sim
