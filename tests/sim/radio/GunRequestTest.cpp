#include "sim/radio/GunRequest.h"

#include <gtest/gtest.h>

#include "tests/support/RadioLiterals.h"

namespace sim {
namespace {

constexpr std::uint64_t Red2 = 0x0013A200407E0E22;
constexpr std::uint64_t Blue0 = 0x0013A200407EC040;

// A request as its description, a fault as its text.
std::string Read(std::uint64_t destination, const Bytes& data) {
  const std::vector<RadioGun> guns = TwoGuns();
  const auto read = ReadGunRequest({destination, data}, guns);
  if (const auto* fault = std::get_if<HostFault>(&read)) {
    return std::string(fault->What);
  }
  return Describe(std::get<GunRequest>(read));
}

TEST(GunRequest, IsASearchForAnyPlayerId) {
  EXPECT_EQ(Read(0xFFFF, {0, 32, 0, 0, 6}), "search 32");
  EXPECT_EQ(Read(0xFFFF, {0, 255, 0, 0, 6}), "search 255");
}

TEST(GunRequest, IsACommandToAGun) {
  EXPECT_EQ(Read(Red2, {1, 0x22, 0, 0, 4, 1}), "size 34");
  EXPECT_EQ(Read(Blue0, {3, 0x40, 0, 0, 4, 2, 90, 10}), "block 64 90+10");
  EXPECT_EQ(Read(Blue0, {1, 0x40, 0, 0, 4, 3}), "close 64");
}

TEST(GunRequest, HasALengthThatAgreesWithItsPacket) {
  for (const Bytes& data : {Bytes{}, Bytes{0, 0x22, 0, 0}, Bytes{1, 0x22, 0, 0, 6},
                            Bytes{0, 0x22, 0, 0, 6, 0}, Bytes{5, 0x22, 0, 0, 6}}) {
    EXPECT_EQ(Read(0xFFFF, data), "a packet of another length than it says");
  }
}

TEST(GunRequest, HasTwoZerosBehindThePlayerId) {
  EXPECT_EQ(Read(0xFFFF, {0, 0x22, 1, 0, 6}), "a packet without its zeros");
  EXPECT_EQ(Read(0xFFFF, {0, 0x22, 0, 1, 6}), "a packet without its zeros");
}

TEST(GunRequest, HasAKnownTypeAndCommand) {
  for (const std::uint8_t type : Bytes{0, 5, 7, 255}) {
    EXPECT_EQ(Read(0xFFFF, {0, 0x22, 0, 0, type}), "an unknown packet type");
  }
  for (const std::uint8_t command : Bytes{0, 4, 255}) {
    EXPECT_EQ(Read(Red2, {1, 0x22, 0, 0, 4, command}), "an unknown command");
  }
  EXPECT_EQ(Read(Red2, {0, 0x22, 0, 0, 4}), "an unknown command");
}

TEST(GunRequest, GoesToAllAsASearchAndToOneGunAsACommand) {
  EXPECT_EQ(Read(Red2, {0, 0x22, 0, 0, 6}), "a search to a single address");
  EXPECT_EQ(Read(0xFFFF, {1, 0x22, 0, 0, 4, 1}), "an address that no gun has");
  EXPECT_EQ(Read(Red2 + 1, {1, 0x22, 0, 0, 4, 1}), "an address that no gun has");
}

TEST(GunRequest, HasTheAddressHighByteFirst) {
  EXPECT_EQ(Read(0xFFFF000000000000, {0, 0x22, 0, 0, 6}), "an address in the wrong byte order");
  EXPECT_EQ(Read(0x220E7E4000A21300, {1, 0x22, 0, 0, 4, 1}), "an address in the wrong byte order");
}

TEST(GunRequest, NamesTheGunToWhichItGoes) {
  EXPECT_EQ(Read(Red2, {1, 0x40, 0, 0, 4, 1}), "another gun's player id");
}

TEST(GunRequest, SearchesNoPlayerIdBelow32AndWithoutPayload) {
  EXPECT_EQ(Read(0xFFFF, {0, 31, 0, 0, 6}), "a search for a player id below 32");
  EXPECT_EQ(Read(0xFFFF, {1, 32, 0, 0, 6, 1}), "a search with a payload");
}

TEST(GunRequest, HasTheArgumentsOfItsCommand) {
  EXPECT_EQ(Read(Red2, {2, 0x22, 0, 0, 4, 1, 0}), "a wrong number of arguments");
  EXPECT_EQ(Read(Red2, {2, 0x22, 0, 0, 4, 2, 0}), "a wrong number of arguments");
  EXPECT_EQ(Read(Red2, {4, 0x22, 0, 0, 4, 2, 0, 1, 0}), "a wrong number of arguments");
  EXPECT_EQ(Read(Red2, {3, 0x22, 0, 0, 4, 3, 0, 0}), "a wrong number of arguments");
}

TEST(GunRequest, AsksForABlockWithinTheScoresAndAFrame) {
  EXPECT_EQ(Read(Blue0, {3, 0x40, 0, 0, 4, 2, 8, 92}), "block 64 8+92");
  EXPECT_EQ(Read(Blue0, {3, 0x40, 0, 0, 4, 2, 0, 93}), "a block that fits no frame");
  EXPECT_EQ(Read(Blue0, {3, 0x40, 0, 0, 4, 2, 0, 0}), "a block that fits no frame");
  EXPECT_EQ(Read(Blue0, {3, 0x40, 0, 0, 4, 2, 90, 11}), "a block beyond the scores");
  EXPECT_EQ(Read(Blue0, {3, 0x40, 0, 0, 4, 2, 255, 1}), "a block beyond the scores");
}

}  // namespace
}  // namespace sim
