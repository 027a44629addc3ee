#include "firmware/hex/HexText.h"

#include <gtest/gtest.h>

#include "tests/support/Thrown.h"

namespace {

TEST(FormatHex, PutsZerosInFront) {
  EXPECT_EQ(FormatHex(0, 6), "000000");
  EXPECT_EQ(FormatHex(0xABC, 6), "000ABC");
  EXPECT_EQ(FormatHex(0xFDFFF0, 6), "FDFFF0");
}

TEST(FormatHex, KeepsLeadingDigitsOfALongerNumber) {
  EXPECT_EQ(FormatHex(0x1F00010, 6), "1F0001");
  EXPECT_EQ(FormatHex(0x1F0000F, 6), "1F0000");
  EXPECT_EQ(FormatHex(0x12345678, 6), "234567");
}

TEST(HexText, HasNoZerosInFront) {
  EXPECT_EQ(HexText(0), "0");
  EXPECT_EQ(HexText(0x00FF00A0), "FF00A0");
  EXPECT_EQ(HexText(0xFFFFFFFF), "FFFFFFFF");
}

TEST(HexNumber, TakesBothCases) {
  EXPECT_EQ(HexNumber("aBcDeF"), 0xABCDEFU);
  EXPECT_EQ(HexNumber("FFFFFFFF"), 0xFFFFFFFFU);
}

TEST(HexNumber, RefusesWhatIsNone) {
  EXPECT_EQ(NumberThrownBy([] { HexNumber(""); }), 13);
  EXPECT_EQ(NumberThrownBy([] { HexNumber("12 4"); }), 13);
  EXPECT_EQ(NumberThrownBy([] { HexNumber("G0"); }), 13);
  EXPECT_EQ(NumberThrownBy([] { HexNumber("100000000"); }), 6);
}

TEST(LineReader, EndsLinesAtLineFeedsOnly) {
  LineReader lines("one\r\ntwo\nthr\ree\r\n\nlast\r");
  for (const char* line : {"one", "two", "thr\ree", "", "last\r"}) {
    ASSERT_FALSE(lines.AtEnd());
    EXPECT_EQ(lines.Next(), line);
  }
  EXPECT_TRUE(lines.AtEnd());
}

}  // namespace
