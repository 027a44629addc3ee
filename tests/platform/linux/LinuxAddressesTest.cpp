#include "platform/linux/LinuxAddresses.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace {

const std::string Head =
    "Iface\tDestination\tGateway \tFlags\tRefCnt\tUse\tMetric\tMask\t\tMTU\tWindow\tIRTT\n";

TEST(DefaultInterface, IsTheOneOfTheDefaultRouteWithTheLowestMetric) {
  EXPECT_EQ(DefaultInterface(Head + "eth0\t0001A8C0\t00000000\t0001\t0\t0\t100\t00FFFFFF\t0\t0\t0\n"
                                    "wlan0\t00000000\t0101A8C0\t0003\t0\t0\t600\t00000000\t0\t0\t0\n"
                                    "eth0\t00000000\t0101A8C0\t0003\t0\t0\t100\t00000000\t0\t0\t0\n"),
            "eth0");
}

TEST(DefaultInterface, IsNoneWithoutARoute) {
  for (const std::string& text : {std::string(), Head, Head + "eth0\n", std::string("\x01\n\n\t\n")}) {
    EXPECT_EQ(DefaultInterface(text), "");
  }
}

TEST(PrivateAddress, IsOneOfALocalNetwork) {
  for (const std::uint32_t address :
       {0x0A000001U, 0x7F000001U, 0xA9FE0001U, 0xAC100001U, 0xAC1FFFFFU, 0xC0A80114U}) {
    EXPECT_TRUE(IsPrivateAddress(address)) << address;
  }
  for (const std::uint32_t address : {0x08080808U, 0x0B000001U, 0xAC200001U, 0xC0A90001U, 0x64400001U, 0U}) {
    EXPECT_FALSE(IsPrivateAddress(address)) << address;
  }
}

TEST(LinuxAddresses, EndWithTheComputersOwn) {
  const std::vector<LocalAddress> addresses = LinuxAddresses().Private();
  if (std::ranges::find(addresses, "127.0.0.1", &LocalAddress::Address) != addresses.end()) {
    EXPECT_EQ(addresses.back().Address.substr(0, 4), "127.");
  }
  EXPECT_FALSE(addresses.empty());
}

}  // namespace
