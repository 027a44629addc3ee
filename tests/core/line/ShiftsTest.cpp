#include "core/line/Shifts.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <initializer_list>
#include <limits>

#include "platform/RuntimeError.h"

namespace {

constexpr std::int32_t Lowest = std::numeric_limits<std::int32_t>::min();

TEST(BitMasks, HaveTheirLowBitsSet) {
  EXPECT_EQ(BitMasks[0], 1);
  EXPECT_EQ(BitMasks[1], 3);
  EXPECT_EQ(BitMasks[15], 0xFFFF);
  EXPECT_EQ(BitMasks[30], 0x7FFFFFFF);
  EXPECT_EQ(BitMasks[31], -1);
}

TEST(ShiftLeft32, MultipliesByAPowerOfTwo) {
  EXPECT_EQ(ShiftLeft32(1, 0), 1);
  EXPECT_EQ(ShiftLeft32(1, 8), 256);
  EXPECT_EQ(ShiftLeft32(0x12, 16), 0x120000);
  EXPECT_EQ(ShiftLeft32(1, 30), 0x40000000);
}

TEST(ShiftLeft32, LandsABitInTheSign) {
  EXPECT_EQ(ShiftLeft32(0x80, 24), Lowest);
  EXPECT_EQ(ShiftLeft32(0xFF, 24), -0x01000000);
  EXPECT_EQ(ShiftLeft32(2, 30), Lowest);
  EXPECT_EQ(ShiftLeft32(3, 30), -0x40000000);
  EXPECT_EQ(ShiftLeft32(-1, 0), -1);
}

TEST(ShiftLeft32, DropsBitsBeyondTheSign) {
  EXPECT_EQ(ShiftLeft32(0x1FF, 24), -0x01000000);
  EXPECT_EQ(ShiftLeft32(4, 30), 0);
  EXPECT_EQ(ShiftLeft32(Lowest, 1), 0);
  EXPECT_EQ(ShiftLeft32(-1, 4), -16);
}

TEST(ShiftLeft32, RefusesShiftsOutsideItsRange) {
  for (const std::int16_t shift : std::initializer_list<std::int16_t>{-1, 31, 32, 300}) {
    EXPECT_THROW(ShiftLeft32(1, shift), RuntimeError) << shift;
  }
}

TEST(ShiftRight32, TakesBytesOutOfAWord) {
  EXPECT_EQ(ShiftRight32(0x12345678, 8), 0x123456);
  EXPECT_EQ(ShiftRight32(0x12345678, 24), 0x12);
  EXPECT_EQ(ShiftRight32(3, 1), 1);
}

TEST(ShiftRight32, FillsWithZeros) {
  EXPECT_EQ(ShiftRight32(-1, 1), 0x7FFFFFFF);
  EXPECT_EQ(ShiftRight32(-1, 24), 0xFF);
  EXPECT_EQ(ShiftRight32(Lowest, 1), 0x40000000);
  EXPECT_EQ(ShiftRight32(Lowest, 31), 1);
  EXPECT_EQ(ShiftRight32(-1, 32), 0);
}

TEST(ShiftRight32, MasksBitZeroOffFirst) {
  EXPECT_EQ(ShiftRight32(1, 0), 0);
  EXPECT_EQ(ShiftRight32(7, 0), 6);
}

TEST(ShiftRight32, DividesByZeroWhereTheSignHasNoPlace) {
  const auto errorOf = [](std::int32_t value, std::int16_t shift) {
    try {
      ShiftRight32(value, shift);
    } catch (const RuntimeError& error) {
      return error.Number();
    }
    return 0;
  };
  EXPECT_EQ(errorOf(-1, 0), 11);
  EXPECT_EQ(errorOf(1, -1), 11);
  EXPECT_EQ(errorOf(1, 0), 0);
}

TEST(Shifts, UndoEachOtherOnBytes) {
  for (std::int32_t byte = 0; byte < 256; ++byte) {
    EXPECT_EQ(ShiftRight32(ShiftLeft32(byte, 24), 24), byte);
  }
}

}  // namespace
