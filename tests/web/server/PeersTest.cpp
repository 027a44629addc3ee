#include "web/server/Peers.h"

#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;

bool IsPrivateText(const std::string& address) {
  const auto socketAddress = SocketAddressOf({.Address = address, .Port = 80});
  EXPECT_TRUE(socketAddress) << address;
  return socketAddress && IsPrivate(reinterpret_cast<const sockaddr&>(socketAddress->Storage));
}

TEST(Addresses, OfPrivateNetworksArePrivate) {
  for (const char* address :
       {"10.0.0.1", "10.255.255.255", "127.0.0.1", "169.254.3.4", "172.16.0.1", "172.31.255.255",
        "192.168.0.1", "192.168.255.255", "::1", "fc00::1", "fdff::1", "fe80::1", "::ffff:192.168.1.1"}) {
    EXPECT_TRUE(IsPrivateText(address)) << address;
  }
}

TEST(Addresses, OfTheInternetAreNotPrivate) {
  for (const char* address :
       {"8.8.8.8", "9.255.255.255", "11.0.0.0", "0.0.0.0", "126.255.255.255", "128.0.0.1", "169.253.1.1",
        "172.15.255.255", "172.32.0.1", "192.167.1.1", "192.169.1.1", "255.255.255.255", "::", "2001:db8::1",
        "fec0::1", "fe00::1", "::ffff:8.8.8.8"}) {
    EXPECT_FALSE(IsPrivateText(address)) << address;
  }
}

TEST(Addresses, OfOtherFamiliesAreNotPrivate) {
  sockaddr_storage storage{};
  storage.ss_family = AF_UNIX;
  EXPECT_FALSE(IsPrivate(reinterpret_cast<const sockaddr&>(storage)));
}

TEST(Addresses, AreDigits) {
  for (const char* text : {"", "localhost", "192.168.1", "192.168.1.5:80", "[::1]", "300.1.1.1"}) {
    EXPECT_FALSE(SocketAddressOf({.Address = text, .Port = 80})) << text;
  }
}

TEST(Addresses, OfOneDeviceAreAlikeWhateverItsPort) {
  const auto key = [](const std::string& address, std::uint16_t port) {
    const auto socketAddress = SocketAddressOf({.Address = address, .Port = port});
    return AddressKey(reinterpret_cast<const sockaddr&>(socketAddress->Storage));
  };
  EXPECT_EQ(key("10.0.0.1", 1), key("10.0.0.1", 2));
  EXPECT_NE(key("10.0.0.1", 1), key("10.0.0.2", 1));
  EXPECT_EQ(key("fd00::1", 1), key("fd00::1", 2));
  EXPECT_NE(key("fd00::1", 1), key("fd00::2", 1));
}

TEST(Hosts, AreTheAddressWithItsPort) {
  EXPECT_THAT(HostsOf({.Address = "192.168.1.5", .Port = 8080}), ElementsAre("192.168.1.5:8080"));
  EXPECT_THAT(HostsOf({.Address = "192.168.1.5", .Port = 80}), ElementsAre("192.168.1.5:80", "192.168.1.5"));
  EXPECT_THAT(HostsOf({.Address = "fd00::1", .Port = 8080}), ElementsAre("[fd00::1]:8080"));
  EXPECT_THAT(HostsOf({.Address = "127.0.0.1", .Port = 81}), ElementsAre("127.0.0.1:81", "localhost:81"));
}

}  // namespace
