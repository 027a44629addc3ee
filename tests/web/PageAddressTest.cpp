#include "web/PageAddress.h"

#include <gtest/gtest.h>

namespace {

const LocalAddress Cable{.Address = "10.0.0.5", .Interface = "eth0"};
const LocalAddress Radio{.Address = "192.168.1.20", .Interface = "wlan0", .IsOfDefaultRoute = true};
const LocalAddress Own{.Address = "127.0.0.1", .Interface = "lo"};

TEST(AddressOfPages, IsThatOfTheDefaultRoute) {
  EXPECT_EQ(AddressToServe({Cable, Radio, Own}, ""), "192.168.1.20");
}

TEST(AddressOfPages, IsThatOfANetworkWithoutADefaultRoute) {
  EXPECT_EQ(AddressToServe({Own, Cable}, ""), "10.0.0.5");
}

TEST(AddressOfPages, IsTheComputersOwnOnlyIfThatIsSet) {
  EXPECT_EQ(AddressToServe({Own}, ""), "");
  EXPECT_EQ(AddressToServe({Cable, Radio, Own}, "127.0.0.1"), "127.0.0.1");
}

TEST(AddressOfPages, IsTheOneThatIsSetOrNone) {
  EXPECT_EQ(AddressToServe({Cable, Radio, Own}, "10.0.0.5"), "10.0.0.5");
  EXPECT_EQ(AddressToServe({Radio, Own}, "10.0.0.5"), "");
  EXPECT_EQ(AddressToServe({}, ""), "");
}

TEST(UrlOfPages, HoldsAddressAndPort) {
  EXPECT_EQ(UrlOfPages("192.168.1.20", 8080), "http://192.168.1.20:8080/");
}

}  // namespace
