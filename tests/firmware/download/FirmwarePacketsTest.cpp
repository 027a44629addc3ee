#include "firmware/download/FirmwarePackets.h"

#include <gmock/gmock.h>

#include <numeric>
#include <vector>

namespace {

using testing::ElementsAre;

TEST(ErasePacket, HasThePagesAddressAndAChecksum) {
  EXPECT_THAT(ErasePacket(0), ElementsAre(0x45, 0x00, 0x00, 0x00, 0x01, 0xBA));
  EXPECT_THAT(ErasePacket(1), ElementsAre(0x45, 0x00, 0x04, 0x00, 0x01, 0xB6));
  EXPECT_THAT(ErasePacket(63), ElementsAre(0x45, 0x00, 0xFC, 0x00, 0x01, 0xBE));
  EXPECT_THAT(ErasePacket(64), ElementsAre(0x45, 0x01, 0x00, 0x00, 0x01, 0xB9));
  EXPECT_THAT(ErasePacket(511), ElementsAre(0x45, 0x07, 0xFC, 0x00, 0x01, 0xB7));
}

class RowPacket : public testing::Test {
 protected:
  std::vector<int> Of(int row) const {
    const auto packet = WritePacket(row, bytes);
    return {packet.begin(), packet.end()};
  }

  std::array<std::uint8_t, 192> bytes{};
};

TEST_F(RowPacket, HasTheRowsAddressItsBytesAndAChecksum) {
  std::iota(bytes.begin(), bytes.end(), std::uint8_t{0});
  const std::vector<int> packet = Of(1);
  ASSERT_EQ(packet.size(), 198U);
  EXPECT_THAT(std::vector<int>(packet.begin(), packet.begin() + 8),
              ElementsAre(0x5A, 0x00, 0x00, 0x80, 0xC1, 0, 1, 2));
  EXPECT_EQ(packet[196], 191);
  // 0x5A + 0x80 + 0xC1 + 0 + 1 + ... + 191 = 18747 = 0x493B
  EXPECT_EQ(packet[197], 0xC5);
}

TEST_F(RowPacket, CountsAddressesByTheSizeOfARow) {
  const auto addressOf = [this](int row) {
    const std::vector<int> packet = Of(row);
    return packet[1] * 65536 + packet[2] * 256 + packet[3];
  };
  EXPECT_EQ(addressOf(0), 0);
  EXPECT_EQ(addressOf(2), 256);
  EXPECT_EQ(addressOf(511), 65408);
  EXPECT_EQ(addressOf(512), 65536);
  EXPECT_EQ(addressOf(4095), 0x07FF80);
}

TEST_F(RowPacket, AddsUpToZero) {
  for (const int fill : {0x00, 0x01, 0x7F, 0x80, 0xFF}) {
    bytes.fill(static_cast<std::uint8_t>(fill));
    for (const int row : {0, 1, 255, 4095}) {
      const std::vector<int> packet = Of(row);
      EXPECT_EQ(std::accumulate(packet.begin(), packet.end(), 0) % 256, 0) << row;
    }
  }
}

}  // namespace
