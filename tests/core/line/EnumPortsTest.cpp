#include "core/line/EnumPorts.h"

#include <gtest/gtest.h>

#include <string>

#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeSerialDevices.h"

namespace {

class EnumPortsTest : public testing::Test {
 protected:
  EnumPorts Ports(const std::string& ini = "") {
    Store.Put("/data/tessarine.ini", ini);
    return {IniReader(Store, "/data/tessarine.ini"), Devices};
  }

  FakeFiles Store;
  FakeSerialDevices Devices;
};

TEST_F(EnumPortsTest, CountsTheMachinesPorts) {
  Devices.Ports = {"/dev/ttyS2", "/dev/ttyS10"};
  const EnumPorts ports = Ports();
  EXPECT_EQ(ports.DeviceOf(1), "/dev/ttyS2");
  EXPECT_EQ(ports.DeviceOf(2), "/dev/ttyS10");
  EXPECT_TRUE(ports.PortExists(1));
  EXPECT_TRUE(ports.PortExists(2));
}

TEST_F(EnumPortsTest, KnowsNoOtherNumber) {
  Devices.Ports = {"/dev/ttyS2"};
  const EnumPorts ports = Ports();
  for (const int number : {-32768, -1, 0, 2, 100, 32767}) {
    EXPECT_EQ(ports.DeviceOf(static_cast<std::int16_t>(number)), "") << number;
    EXPECT_FALSE(ports.PortExists(static_cast<std::int16_t>(number))) << number;
  }
}

TEST_F(EnumPortsTest, PrefersTheDeviceThatTheFileNames) {
  Devices.Ports = {"/dev/ttyS0", "/dev/ttyS1"};
  Devices.Others = {"/dev/serial/by-id/base"};
  const EnumPorts ports = Ports("[Ports]\nCOM1 = /dev/serial/by-id/base\nCom7=/dev/ttyS1\n");
  EXPECT_EQ(ports.DeviceOf(1), "/dev/serial/by-id/base");
  EXPECT_EQ(ports.DeviceOf(2), "/dev/ttyS1");
  EXPECT_EQ(ports.DeviceOf(7), "/dev/ttyS1");
  EXPECT_TRUE(ports.PortExists(1));
  EXPECT_TRUE(ports.PortExists(7));
}

TEST_F(EnumPortsTest, DoesNotFallBackWhenTheNamedDeviceIsGone) {
  Devices.Ports = {"/dev/ttyS0"};
  const EnumPorts ports = Ports("[ports]\ncom1=/dev/serial/by-id/base\n");
  EXPECT_EQ(ports.DeviceOf(1), "/dev/serial/by-id/base");
  EXPECT_FALSE(ports.PortExists(1));
}

TEST_F(EnumPortsTest, TakesAnEmptyKeyForNoPort) {
  Devices.Ports = {"/dev/ttyS0"};
  Devices.Others = {""};
  const EnumPorts ports = Ports("[ports]\ncom1=\n");
  EXPECT_EQ(ports.DeviceOf(1), "");
  EXPECT_FALSE(ports.PortExists(1));
}

TEST_F(EnumPortsTest, TakesTheFirstOfTwoKeys) {
  EXPECT_EQ(Ports("[ports]\ncom3=/dev/a\ncom3=/dev/b\n").DeviceOf(3), "/dev/a");
}

TEST_F(EnumPortsTest, PassesOverOtherKeys) {
  Devices.Ports = {"/dev/ttyS0"};
  const EnumPorts ports = Ports(
      "[ports]\ncom=/dev/a\ncom0=/dev/b\ncom01=/dev/c\ncom1x=/dev/d\ncom-1=/dev/e\ncomm1=/dev/f\nxcom1=/dev/"
      "g\n"
      "co=/dev/h\ncom99999999999999=/dev/i\ncom 1=/dev/j\n[comm]\ncom1=/dev/k\n");
  EXPECT_EQ(ports.DeviceOf(1), "/dev/ttyS0");
  EXPECT_EQ(ports.DeviceOf(0), "");
  EXPECT_EQ(ports.DeviceOf(-1), "");
}

TEST_F(EnumPortsTest, KeepsTheNumbersThatItReadAtFirst) {
  Devices.Ports = {"/dev/ttyS0"};
  const EnumPorts ports = Ports("[ports]\ncom2=/dev/ttyS0\n");
  Devices.Ports = {"/dev/ttyS5"};
  Store.Put("/data/tessarine.ini", "");
  EXPECT_EQ(ports.DeviceOf(1), "/dev/ttyS0");
  EXPECT_EQ(ports.DeviceOf(2), "/dev/ttyS0");
}

TEST_F(EnumPortsTest, WorksOnAMachineWithoutPortsOrFile) {
  Store.Remove("/data/tessarine.ini");
  const EnumPorts ports(IniReader(Store, "/data/tessarine.ini"), Devices);
  EXPECT_FALSE(ports.PortExists(1));
}

}  // namespace
