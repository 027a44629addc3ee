#include "sim/line/Crc.h"

#include <gtest/gtest.h>

#include <vector>

namespace sim {
namespace {

std::uint8_t CrcOf(const std::vector<std::uint8_t>& bytes) {
  return Crc8(bytes);
}

TEST(Crc, GivesTheCheckValueOfThePublishedCatalogue) {
  EXPECT_EQ(CrcOf({'1', '2', '3', '4', '5', '6', '7', '8', '9'}), 0xA1);
}

TEST(Crc, GivesTheLastByteOfTheRomIdInTheChipMakersApplicationNote) {
  EXPECT_EQ(CrcOf({0x02, 0x1C, 0xB8, 0x01, 0x00, 0x00, 0x00}), 0xA2);
}

TEST(Crc, OfASingleByteIsItsEntryInThePublishedTable) {
  EXPECT_EQ(CrcOf({0}), 0);
  EXPECT_EQ(CrcOf({1}), 94);
  EXPECT_EQ(CrcOf({2}), 188);
  EXPECT_EQ(CrcOf({255}), 53);
}

TEST(Crc, OfNothingIsZero) {
  EXPECT_EQ(CrcOf({}), 0);
}

TEST(Crc, OverBytesAndTheirOwnCrcIsZero) {
  EXPECT_EQ(CrcOf({'1', '2', '3', '4', '5', '6', '7', '8', '9', 0xA1}), 0);
}

}  // namespace
}  // namespace sim
