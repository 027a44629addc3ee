#include "core/line/CommPortSetting.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/support/FailureOf.h"

namespace {

class PortOfTheSettings : public testing::Test {
 protected:
  PortOfTheSettings() { devices.Ports = {"/dev/ttyS0", "/dev/ttyUSB0"}; }

  void PutNumber(const std::string& text) { files.Put("/tessarine.ini", "[comm]\ncommport=" + text + "\n"); }

  FakeFiles files;
  IniReader ini{files, "/tessarine.ini"};
  FakeSerialDevices devices;
  CommPortSetting setting{ini, devices};
};

TEST_F(PortOfTheSettings, IsTheFirstByDefault) {
  EXPECT_EQ(setting.Number(), 1);
  EXPECT_EQ(setting.Device(), "/dev/ttyS0");
}

TEST_F(PortOfTheSettings, IsReadAtTheMomentOfUse) {
  ASSERT_EQ(setting.Number(), 1);
  PutNumber("2");
  EXPECT_EQ(setting.Number(), 2);
  EXPECT_EQ(setting.Device(), "/dev/ttyUSB0");
}

TEST_F(PortOfTheSettings, ThatIsNoNumberIsATypeMismatch) {
  for (const char* text : {"", "abc", "2abc"}) {
    PutNumber(text);
    EXPECT_EQ(FailureOf([&] { setting.Number(); }), 13) << text;
    EXPECT_EQ(FailureOf([&] { setting.Device(); }), 13) << text;
  }
}

TEST_F(PortOfTheSettings, BeyondSixteenBitsIsAnOverflow) {
  for (const char* text : {"32768", "-32769", "1e99"}) {
    PutNumber(text);
    EXPECT_EQ(FailureOf([&] { setting.Number(); }), 6) << text;
  }
}

TEST_F(PortOfTheSettings, WithoutADeviceIsNoSuchPort) {
  for (const char* text : {"0", "-3", "3", "32767"}) {
    PutNumber(text);
    EXPECT_EQ(FailureOf([&] { setting.Device(); }), 8002) << text;
  }
}

/// For a window that remembers the number and opens the line later.
TEST_F(PortOfTheSettings, GivesTheDeviceOfAnyOtherNumberToo) {
  EXPECT_EQ(setting.DeviceOf(2), "/dev/ttyUSB0");
  EXPECT_EQ(FailureOf([&] { setting.DeviceOf(9); }), 8002);
  files.Put("/tessarine.ini", "[ports]\ncom9=/dev/pts/7\n");
  EXPECT_EQ(setting.DeviceOf(9), "/dev/pts/7");
}

}  // namespace
