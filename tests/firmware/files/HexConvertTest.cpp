#include "firmware/files/HexConvert.h"

#include <gtest/gtest.h>

#include "tests/support/Thrown.h"

namespace {

TEST(HexConvert, TakesDigitsOfBothCases) {
  EXPECT_EQ(Hex_Convert("00"), 0);
  EXPECT_EQ(Hex_Convert("09"), 9);
  EXPECT_EQ(Hex_Convert("AF"), 175);
  EXPECT_EQ(Hex_Convert("af"), 175);
  EXPECT_EQ(Hex_Convert("aF"), Hex_Convert("Af"));
  EXPECT_EQ(Hex_Convert2("1fF"), 511);
}

TEST(HexConvert, OfAnEmptyTextIsZero) {
  EXPECT_EQ(Hex_Convert(""), 0);
  EXPECT_EQ(Hex_Convert2(""), 0);
}

TEST(HexConvert, TakesAnyOtherCharacterByItsCode) {
  EXPECT_EQ(Hex_Convert("G"), 71);
  EXPECT_EQ(Hex_Convert("G0"), 71 * 16);
  EXPECT_EQ(Hex_Convert("1g"), 16 + 103);
  EXPECT_EQ(Hex_Convert(" 5"), 32 * 16 + 5);
  EXPECT_EQ(Hex_Convert("\xFF"), 255);
  EXPECT_EQ(Hex_Convert("@"), 64);
  EXPECT_EQ(Hex_Convert("`"), 96);
  EXPECT_EQ(Hex_Convert("/:"), 47 * 16 + 58);
}

TEST(HexConvert, OverflowsAboveItsRange) {
  EXPECT_EQ(Hex_Convert("7FFF"), 32767);
  EXPECT_EQ(NumberThrownBy([] { Hex_Convert("8000"); }), 6);
  EXPECT_EQ(Hex_Convert2("8000"), 32768);
  EXPECT_EQ(Hex_Convert2("7FFFFFFF"), 2147483647);
  EXPECT_EQ(NumberThrownBy([] { Hex_Convert2("80000000"); }), 6);
  EXPECT_EQ(NumberThrownBy([] { Hex_Convert2("FFFFFFFF"); }), 6);
  EXPECT_EQ(NumberThrownBy([] { Hex_Convert2("FFFFFFFFFFFFFFFFFFFF"); }), 6);
}

TEST(HexConvert, KnowsWhatADigitIs) {
  for (const char digit : {'0', '9', 'A', 'F', 'a', 'f'}) {
    EXPECT_TRUE(IsHexDigit(digit)) << digit;
  }
  for (const char other : {'/', ':', '@', 'G', '`', 'g', ' ', '\n', '\0', '\xC4'}) {
    EXPECT_FALSE(IsHexDigit(other)) << other;
  }
}

}  // namespace
