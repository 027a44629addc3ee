#include "sim/bootcode/BootCode.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sstream>
#include <stdexcept>

#include "tests/support/BootHost.h"
#include "tests/support/TemporaryFolder.h"

namespace sim {
namespace {

using namespace wire;
using std::chrono::milliseconds;

const Bytes SetUpBytes{0x53, 0x00, 0x70, 0x8F};

bool Downloaded(const BootCode& device, std::size_t count) {
  return device.WaitUntil(Limit, [&](const BootCodeTraffic& traffic) { return traffic.Downloads >= count; });
}

TEST(BootCode, SaysBootWheneverItIsSwitchedOnAndNothingBefore) {
  for (const Pace pace : {Pace::Fast, Pace::AsWired}) {
    BootCode device({.LinePace = pace});
    BootHost host(device.DevicePath());
    EXPECT_TRUE(host.IsSilent());
    device.PowerOn();
    EXPECT_EQ(host.Hear(4), "BOOT");
    EXPECT_TRUE(host.IsSilent());
    device.PowerOn();
    EXPECT_EQ(host.Hear(4), "BOOT");
  }
}

TEST(BootCode, TakesAnImageAndKeepsItInAFile) {
  for (const Pace pace : {Pace::Fast, Pace::AsWired}) {
    const TemporaryFolder folder;
    BootCode device({.FlashFile = folder / "flash", .LinePace = pace});
    BootHost host(device.DevicePath());
    device.PowerOn();
    EXPECT_EQ(host.Hear(4), "BOOT");
    EXPECT_EQ(host.Begin(), "xds");
    EXPECT_EQ(host.Ask(ErasePage0), "b");
    EXPECT_EQ(host.Ask(WriteBlankRow0), "f");
    EXPECT_EQ(host.Ask(WriteCountingRow1), "f");
    EXPECT_EQ(host.Say("F"), "f");
    EXPECT_TRUE(Downloaded(device, 1));
    EXPECT_EQ(device.HostFaults(), std::vector<std::string>{});
    const Bytes row = CountingRow();
    const std::string flash = ReadFile(folder / "flash");
    EXPECT_EQ(flash.size(), 786432U);
    EXPECT_EQ(flash.substr(0, 384), std::string(192, '\xFF') + std::string(row.begin(), row.end()));
    EXPECT_EQ(flash.find_first_not_of('\xFF', 384), std::string::npos);
  }
}

TEST(BootCode, TakesBuffersAndKeepsThemInAFile) {
  for (const Pace pace : {Pace::Fast, Pace::AsWired}) {
    const TemporaryFolder folder;
    BootCode device({.Product = BootProduct::Qvm, .FlashFile = folder / "lines", .LinePace = pace});
    BootHost host(device.DevicePath());
    device.PowerOn();
    EXPECT_EQ(host.Hear(4), "BOOT");
    EXPECT_EQ(host.Begin(), "xpb");
    EXPECT_EQ(host.Ask(SetUpBytes), "f");
    EXPECT_EQ(host.Ask({0x5A, 0x10, 0x20, 0xFF}), "f");
    EXPECT_EQ(host.Ask(Bytes{0x5A} + Bytes(51, 0x33)), "f");
    EXPECT_EQ(host.Say("F"), "f");
    EXPECT_TRUE(Downloaded(device, 1));
    std::string longest = ":";
    for (int i = 0; i < 51; ++i) {
      longest += "33";
    }
    EXPECT_EQ(ReadFile(folder / "lines"), ":1020FF\r\n" + longest + "\r\n");
    EXPECT_EQ(device.HostFaults(), std::vector<std::string>{});
  }
}

TEST(BootCode, EndsABufferWhenTheLineFallsQuietAndNotBefore) {
  constexpr milliseconds gap{300};
  BootCode device({.Product = BootProduct::Qvm, .Gap = gap, .LinePace = Pace::Fast});
  BootHost host(device.DevicePath());
  device.PowerOn();
  EXPECT_EQ(host.Hear(4), "BOOT");
  EXPECT_EQ(host.Begin(), "xpb");
  EXPECT_EQ(host.Ask(SetUpBytes), "f");
  const auto start = std::chrono::steady_clock::now();
  EXPECT_EQ(host.Ask({0x5A, 0x10}), "f");
  EXPECT_GE(std::chrono::steady_clock::now() - start, gap);
}

TEST(BootCode, IsGoneAfterADownloadUntilItIsSwitchedOnAgain) {
  BootCode device({.LinePace = Pace::Fast});
  BootHost host(device.DevicePath());
  device.PowerOn();
  EXPECT_EQ(host.Hear(4), "BOOT");
  EXPECT_EQ(host.Begin(), "xds");
  EXPECT_EQ(host.Say("F"), "f");
  host.Write({'X'});
  ASSERT_TRUE(device.WaitUntilHostFaults(1, Limit));
  EXPECT_EQ(device.HostFaults(),
            std::vector<std::string>{"the host spoke to a device that is not in its boot code"});
  EXPECT_TRUE(host.IsSilent());
  device.PowerOn();
  EXPECT_EQ(host.Hear(4), "BOOT");
  EXPECT_EQ(host.Say("X"), "x");
}

TEST(BootCode, BeginsAnewWhenItIsSwitchedOnInTheMiddleOfAPacket) {
  BootCode device({.LinePace = Pace::Fast});
  BootHost host(device.DevicePath());
  device.PowerOn();
  EXPECT_EQ(host.Hear(4), "BOOT");
  EXPECT_EQ(host.Begin(), "xds");
  host.Write(Bytes(WriteCountingRow1.begin(), WriteCountingRow1.begin() + 100));
  device.PowerOn();
  EXPECT_EQ(host.Hear(4), "BOOT");
  EXPECT_EQ(host.Begin(), "xds");
  EXPECT_EQ(host.Ask(ErasePage0), "b");
}

TEST(BootCode, TellsWhatTheHostDidWrong) {
  BootCode device({.LinePace = Pace::Fast});
  BootHost host(device.DevicePath());
  device.PowerOn();
  EXPECT_EQ(host.Hear(4), "BOOT");
  EXPECT_EQ(host.Begin(), "xds");
  EXPECT_EQ(host.Ask({0x45, 0x00, 0x00, 0x00, 0x01, 0x00}), "c");
  EXPECT_EQ(host.Ask({0x45, 0x08, 0x00, 0x00, 0x01, 0xB2}), "e");
  EXPECT_EQ(device.HostFaults(), (std::vector<std::string>{"the host sent a wrong checksum",
                                                           "the host sent the address 080000 of no page"}));
}

TEST(BootCode, IsSwitchedOnByItselfAfterEachOpeningWhenTold) {
  BootCode device({.PowerOnAfterOpening = milliseconds(1), .LinePace = Pace::Fast});
  for (int opening = 0; opening < 3; ++opening) {
    BootHost host(device.DevicePath());
    EXPECT_EQ(host.Hear(4), "BOOT");
    EXPECT_EQ(host.Begin(), "xds");
  }
  EXPECT_EQ(device.Traffic().PowerOns, 3U);
}

TEST(BootCode, LogsBothDirections) {
  std::ostringstream log;
  {
    BootCode device({.LinePace = Pace::Fast, .Log = &log});
    BootHost host(device.DevicePath());
    device.PowerOn();
    EXPECT_EQ(host.Hear(4), "BOOT");
    EXPECT_EQ(host.Begin(), "xds");
    EXPECT_EQ(host.Ask(ErasePage1), "b");
    EXPECT_EQ(host.Say("F"), "f");
    EXPECT_TRUE(Downloaded(device, 1));
  }
  EXPECT_THAT(log.str(), testing::ContainsRegex(
                             "boot-code -- switched on\n.*boot-code -> 42 4F 4F 54\n.*boot-code <- 58\n"));
  EXPECT_THAT(log.str(),
              testing::ContainsRegex("boot-code <- 45 00 04 00 01 B6 page 1 erased\n.*boot-code -> "
                                     "62\n.*boot-code <- 46 complete\n"));
}

TEST(BootCode, EndsInTheMiddleOfAPacket) {
  BootCode device({});
  BootHost host(device.DevicePath());
  device.PowerOn();
  EXPECT_EQ(host.Hear(4), "BOOT");
  EXPECT_EQ(host.Begin(), "xds");
  host.Write({0x5A, 0x00});
}

TEST(BootCode, RefusesPlacesThatDoNotExist) {
  BootCode good({});
  for (const BootFailureInfo& info : BootFailures) {
    const BootCodeSettings settings{.Trouble = {.Failure = info.Failure, .Place = 0}};
    if (info.Place == FailurePlace::None) {
      EXPECT_NO_THROW(BootCode{settings}) << info.Name;
      EXPECT_NO_THROW(good.PowerOn(settings.Trouble)) << info.Name;
    } else {
      EXPECT_THROW(BootCode{settings}, std::invalid_argument) << info.Name;
      EXPECT_THROW(good.PowerOn(settings.Trouble), std::invalid_argument) << info.Name;
    }
  }
}

TEST(BootCode, RefusesAFlashFileThatCannotBeUsed) {
  EXPECT_THROW(BootCode({.FlashFile = "/missing/flash"}), std::runtime_error);
  EXPECT_THROW(BootCode({.Product = BootProduct::Qvm, .FlashFile = "/missing/lines"}), std::runtime_error);
}

}  // namespace
}  // namespace sim
