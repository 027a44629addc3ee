#include "core/line/Checksum.h"

#include <gtest/gtest.h>

#include <array>
#include <cstdint>
#include <set>
#include <vector>

namespace {

TEST(CrcTable, HasThePublishedEntries) {
  const std::array<std::uint8_t, 8> published = {0, 94, 188, 226, 97, 63, 221, 131};
  for (std::size_t entry = 0; entry < published.size(); ++entry) {
    EXPECT_EQ(CrcTable[entry], published[entry]) << entry;
  }
  EXPECT_EQ(CrcTable[128], 0x8C);
  EXPECT_EQ(CrcTable[255], 53);
}

TEST(CrcTable, HoldsEachByteOnce) {
  EXPECT_EQ(std::set<std::uint8_t>(CrcTable.begin(), CrcTable.end()).size(), 256U);
}

TEST(Crc8, GivesThePublishedCheckValue) {
  const std::vector<std::uint8_t> digits = {'1', '2', '3', '4', '5', '6', '7', '8', '9'};
  EXPECT_EQ(Crc8(digits), 0xA1);
}

TEST(Crc8, GivesTheCheckByteOfARegistrationNumber) {
  // The worked example in the 1-Wire documentation: family 02, serial number 00000001B81C, check byte A2.
  const std::vector<std::uint8_t> number = {0x02, 0x1C, 0xB8, 0x01, 0x00, 0x00, 0x00};
  EXPECT_EQ(Crc8(number), 0xA2);
}

TEST(Crc8, LeavesTheStartingValueOverNoData) {
  EXPECT_EQ(Crc8({}), 0);
  EXPECT_EQ(Crc8({}, 77), 77);
}

TEST(Crc8, ContinuesFromAnEarlierPart) {
  const std::vector<std::uint8_t> whole = {9, 8, 7, 6, 5};
  const std::span<const std::uint8_t> data(whole);
  EXPECT_EQ(Crc8(data.subspan(2), Crc8(data.first(2))), Crc8(data));
}

TEST(Crc8, IsZeroOverDataWithItsOwnCheckByte) {
  std::vector<std::uint8_t> data = {0x02, 0x1C, 0xB8, 0x01, 0x00, 0x00, 0x00, 0xA2};
  EXPECT_EQ(Crc8(data), 0);
  data[3] ^= 0x10;
  EXPECT_NE(Crc8(data), 0);
}

TEST(Crc32, IsTheCheckValueOfArchives) {
  EXPECT_EQ(Crc32("123456789"), 0xCBF43926U);
  EXPECT_EQ(Crc32(""), 0U);
  EXPECT_EQ(Crc32(std::string_view("\0\xFF", 2)), 0x6CDBFD72U);
}

}  // namespace
