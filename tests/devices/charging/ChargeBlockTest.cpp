#include "devices/charging/ChargeBlock.h"

#include <gmock/gmock.h>

namespace {

using testing::Each;

/// Bytes 1, 0, 3, 4, ... 30 and their check byte, which another program computed.
ChargeBlock GoodMag() {
  ChargeBlock block{};
  for (std::size_t i = 2; i < 31; ++i) {
    block[i] = static_cast<std::uint8_t>(i);
  }
  block[31] = 0xDE;
  return block;
}

TEST(ChargeBlock, HasTheCheckByteOfItsFirst31Bytes) {
  EXPECT_EQ(CheckByteOf(GoodMag()), 0xDE);
  EXPECT_TRUE(CheckHolds(GoodMag()));
  for (std::size_t i = 0; i < 32; ++i) {
    ChargeBlock block = GoodMag();
    block[i] ^= 0x10;
    EXPECT_FALSE(CheckHolds(block)) << i;
  }
}

TEST(ChargeBlock, OfZerosHoldsItsCheckByte) {
  EXPECT_TRUE(CheckHolds({}));
}

TEST(ChargeBlock, OfAFullMagHasOneCharge) {
  ChargeBlock block = GoodMag();
  ASSERT_TRUE(Charge(block));
  EXPECT_EQ(block[0], 0);
  EXPECT_EQ(block[1], 1);
  for (std::size_t i = 2; i < 31; ++i) {
    EXPECT_EQ(block[i], i);
  }
  EXPECT_NE(block[31], 0xDE);
  EXPECT_TRUE(CheckHolds(block));
}

TEST(ChargeBlock, OfAFullBandageHasFiveCharges) {
  ChargeBlock block = GoodMag();
  block[0] = 1;
  ASSERT_TRUE(Charge(block));
  EXPECT_EQ(block[0], 1);
  EXPECT_EQ(block[1], 5);
  EXPECT_EQ(block[2], 2);
  EXPECT_TRUE(CheckHolds(block));
}

TEST(ChargeBlock, OfAnotherKindStaysAsItIs) {
  for (const int kind : {2, 7, 0x80, 0xFF}) {
    ChargeBlock block = GoodMag();
    block[0] = static_cast<std::uint8_t>(kind);
    const ChargeBlock before = block;
    EXPECT_FALSE(Charge(block)) << kind;
    EXPECT_EQ(block, before) << kind;
  }
}

TEST(ChargeBlock, RecoversAsAMagWithItsThirdByteCleared) {
  ChargeBlock block;
  block.fill(0x5A);
  Recover(block, true);
  EXPECT_EQ(block[0], 0);
  EXPECT_EQ(block[1], 0x5A);
  EXPECT_EQ(block[2], 0);
  EXPECT_THAT(std::vector<std::uint8_t>(block.begin() + 3, block.end()), Each(0x5A));
}

TEST(ChargeBlock, RecoversAsABandageWithItsThirdByteKept) {
  ChargeBlock block;
  block.fill(0x5A);
  Recover(block, false);
  EXPECT_EQ(block[0], 1);
  EXPECT_THAT(std::vector<std::uint8_t>(block.begin() + 1, block.end()), Each(0x5A));
}

}  // namespace
