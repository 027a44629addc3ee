#include "sim/line/Device.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <optional>
#include <sstream>

#include "tests/sim/line/EchoDevice.h"
#include "tests/support/RawHost.h"

namespace sim {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;

TEST(Device, ServesFromItsConstructionToItsDestruction) {
  std::optional<EchoDevice> device(std::in_place);
  RawHost host(device->DevicePath());
  host.Write({1, 2, 3});
  EXPECT_EQ(host.Read(3), (Bytes{1, 2, 3}));
  device.reset();
  host.ReadUntilHangUp();
  EXPECT_TRUE(host.HungUp());
}

TEST(Device, DoesNotAnswerAHostAtOtherSettingsAndNotesEachRunOfItsBytes) {
  EchoDevice device;
  RawHost host(device.DevicePath());
  host.Speak({.Baud = 9600});
  host.Write({1});
  ASSERT_TRUE(device.WaitUntilHostFaults(1, Limit));
  host.Speak({.Baud = 19200, .StopBits = 2});
  host.Write({3});
  ASSERT_TRUE(device.WaitUntilHostFaults(2, Limit));
  host.Speak({.Baud = 19200});
  host.Write({4});
  EXPECT_EQ(host.Read(1), Bytes{4});
  host.Speak({.Baud = 19200, .StopBits = 2});
  host.Write({5});
  ASSERT_TRUE(device.WaitUntilHostFaults(3, Limit));
  EXPECT_TRUE(host.IsSilent());
  EXPECT_THAT(device.HostFaults(), ElementsAre("the host speaks 9600,8N1 instead of 19200,8N1",
                                               "the host speaks 19200,8N2 instead of 19200,8N1",
                                               "the host speaks 19200,8N2 instead of 19200,8N1"));
}

TEST(Device, SaysWhichSettingsItWouldHaveUnderstood) {
  EchoDevice device({{.Baud = 19200}, {.Baud = 115200}});
  RawHost host(device.DevicePath());
  host.Speak({.Baud = 115200});
  host.Write({1});
  EXPECT_EQ(host.Read(1), Bytes{1});
  host.Speak({.Baud = 9600});
  host.Write({2});
  ASSERT_TRUE(device.WaitUntilHostFaults(1, Limit));
  EXPECT_THAT(device.HostFaults(),
              ElementsAre("the host speaks 9600,8N1 instead of 19200,8N1 or 115200,8N1"));
}

TEST(Device, LogsTheBytesThatItDidNotUnderstand) {
  std::ostringstream log;
  {
    EchoDevice device({{.Baud = 19200}}, &log);
    RawHost host(device.DevicePath());
    host.Speak({.Baud = 9600});
    host.Write({0xA5, 0x01});
    ASSERT_TRUE(device.WaitUntilHostFaults(1, Limit));
  }
  EXPECT_THAT(log.str(), HasSubstr("echo <- A5 01 fault: the host speaks 9600,8N1 instead of 19200,8N1\n"));
}

TEST(Device, WaitsNoLongerThanToldForAFault) {
  const EchoDevice device;
  EXPECT_FALSE(device.WaitUntilHostFaults(1, std::chrono::milliseconds(10)));
  EXPECT_TRUE(device.HostFaults().empty());
}

}  // namespace
}  // namespace sim
