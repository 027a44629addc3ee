#include "firmware/hex/ImagePadding.h"

#include <gtest/gtest.h>

#include "firmware/hex/HexText.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/support/Thrown.h"

namespace {

using Lines = std::vector<std::string>;

constexpr const char* Fill = " FF FF FF 00 FF FF FF 00 FF FF FF 00 FF FF FF 00";

std::string At(std::uint32_t address, const std::string& data) {
  return FormatHex(address, 6) + " " + data;
}

/// A full line whose bytes are all the same.
std::string Full(std::uint32_t address, const std::string& byte) {
  std::string data;
  for (int i = 0; i < 16; ++i) {
    data += byte + " ";
  }
  return At(address, data);
}

std::string HalfLine(const std::string& byte) {
  std::string data;
  for (int i = 0; i < 8; ++i) {
    data += byte + " ";
  }
  return data;
}

constexpr const char* HalfFill = "FF FF FF 00 FF FF FF 00 ";

Lines Padded(const Lines& lines) {
  Lines padded;
  const std::string image = PaddedImage(lines);
  for (LineReader reader(image); !reader.AtEnd();) {
    padded.emplace_back(reader.Next());
  }
  return padded;
}

/// Fill behind data has no blank at its end.
Lines WithFill(Lines lines, std::uint32_t from, std::uint32_t to) {
  for (std::uint32_t address = from; address <= to; address += 16) {
    lines.push_back(FormatHex(address, 6) + Fill);
  }
  return lines;
}

TEST(PaddedImage, FillsUpTheLastBlock) {
  EXPECT_EQ(Padded({Full(0, "11"), Full(0x10, "22")}),
            WithFill({Full(0, "11"), Full(0x10, "22")}, 0x20, 0xF0));
}

TEST(PaddedImage, LeavesWholeBlocksAsTheyAre) {
  Lines lines;
  for (std::uint32_t address = 0; address < 0x200; address += 16) {
    lines.push_back(Full(address, "5A"));
  }
  EXPECT_EQ(Padded(lines), lines);
}

TEST(PaddedImage, SortsTheLines) {
  EXPECT_EQ(Padded({Full(0x10, "22"), Full(0, "11")}), Padded({Full(0, "11"), Full(0x10, "22")}));
}

TEST(PaddedImage, BeginsWithFillWhereDataResumesAfterAHole) {
  const Lines padded = Padded({Full(0, "11"), Full(0x1230, "22"), Full(0x1240, "33")});
  Lines expected = WithFill({Full(0, "11")}, 0x10, 0xF0);
  for (std::uint32_t address = 0x1200; address < 0x1230; address += 16) {
    expected.push_back(FormatHex(address, 6) + Fill + " ");
  }
  expected.push_back(Full(0x1230, "22"));
  expected.push_back(Full(0x1240, "33"));
  EXPECT_EQ(padded, WithFill(expected, 0x1250, 0x12F0));
}

TEST(PaddedImage, PutsDataBehindAHoleOfABlockIntoABlockOfItsOwn) {
  const Lines padded = Padded({Full(0, "11"), Full(0x40, "22")});
  Lines expected = WithFill({Full(0, "11")}, 0x10, 0xF0);
  for (std::uint32_t address = 0; address < 0x40; address += 16) {
    expected.push_back(FormatHex(address, 6) + Fill + " ");
  }
  expected.push_back(Full(0x40, "22"));
  EXPECT_EQ(padded, WithFill(expected, 0x50, 0xF0));
}

TEST(PaddedImage, LeavesOutBlocksOfFill) {
  Lines lines = {Full(0, "11")};
  for (std::uint32_t address = 0x100; address < 0x200; address += 16) {
    lines.push_back(Full(address, "FF"));
  }
  EXPECT_EQ(Padded(lines), WithFill({Full(0, "11")}, 0x10, 0xF0));
  EXPECT_EQ(Padded({Full(0, "FF")}), Lines{});
}

TEST(PaddedImage, KeepsABlockWithOneOtherByte) {
  std::string line = Full(0, "FF");
  line[7 + 3 * 15] = '0';
  EXPECT_EQ(Padded({line}), WithFill({line}, 0x10, 0xF0));
}

TEST(PaddedImage, JoinsLinesThatBeginInTheMiddleOfAnother) {
  // 8 bytes at 0, then 16 at 8 and 16 at 18.
  const Lines padded = Padded({At(0, HalfLine("11") + HalfFill), Full(0x08, "22"), Full(0x18, "33")});
  EXPECT_EQ(padded, WithFill({At(0, HalfLine("11") + HalfLine("22")),
                              At(0x10, HalfLine("22") + HalfLine("33")), At(0x20, HalfLine("33") + HalfFill)},
                             // The address at hand stays that of the line before it was moved.
                             0x28, 0xE8));
}

TEST(PaddedImage, KeepsTheRestOfEachHalfLineAsALineOfItsOwn) {
  // Halves of 8 bytes at 0, 8, 10 and 18: the rest of the second one, all fill, stays in the block.
  const Lines padded = Padded({At(0, HalfLine("11") + HalfFill), At(0x08, HalfLine("22") + HalfFill),
                               At(0x10, HalfLine("33") + HalfFill), At(0x18, HalfLine("44") + HalfFill)});
  ASSERT_EQ(padded.size(), 16U);
  EXPECT_EQ(padded[0], At(0, HalfLine("11") + HalfLine("22")));
  EXPECT_EQ(padded[1], At(0x10, std::string(HalfFill) + HalfFill));
  EXPECT_EQ(padded[2], At(0x10, HalfLine("33") + HalfLine("44")));
  EXPECT_EQ(padded[3], At(0x20, std::string(HalfFill) + HalfFill));
  EXPECT_EQ(padded[4], "000028" + std::string(Fill));
}

TEST(PaddedImage, SplitsALineBehindAHoleThatBeginsBetweenMultiples) {
  const Lines padded = Padded({Full(0, "11"), Full(0x208, "22")});
  ASSERT_EQ(padded.size(), 32U);
  EXPECT_EQ(padded[16], At(0x200, HalfFill + HalfLine("22")));
  EXPECT_EQ(padded[17], At(0x210, HalfLine("22") + HalfLine("22")));
  EXPECT_EQ(padded[18], "000220" + std::string(Fill));
  EXPECT_EQ(padded[31], "0002F0" + std::string(Fill));
}

TEST(PaddedImage, FillsTheLastSlotFromTheLineAfterIt) {
  Lines lines;
  for (std::uint32_t address = 0; address < 0xF0; address += 16) {
    lines.push_back(Full(address, "11"));
  }
  lines.back() = At(0xE0, HalfLine("11") + HalfFill);
  lines.push_back(Full(0xE8, "22"));
  const Lines alone = Padded(lines);
  ASSERT_EQ(alone.size(), 16U);
  EXPECT_EQ(alone[14], At(0xE0, HalfLine("11") + HalfLine("22")));
  EXPECT_EQ(alone[15], At(0xF0, HalfLine("22") + HalfFill));
  lines.push_back(Full(0xF8, "33"));
  const Lines padded = Padded(lines);
  ASSERT_EQ(padded.size(), 32U);
  EXPECT_EQ(padded[15], At(0xF0, HalfLine("22") + HalfLine("33")));
  EXPECT_EQ(padded[16], At(0x100, HalfLine("33") + HalfFill));
}

TEST(PaddedImage, MustBeginAtAddressZero) {
  EXPECT_EQ(NumberThrownBy([] { PaddedImage({Full(0x10, "11")}); }), 9);
  EXPECT_EQ(NumberThrownBy([] { PaddedImage({Full(0x04, "11")}); }), 9);
}

TEST(PaddedImage, NeedsData) {
  EXPECT_EQ(NumberThrownBy([] { PaddedImage({}); }), 62);
}

TEST(PadProgramImage, RewritesItsFile) {
  FakeFiles files;
  files.Put("/progmem.img", Full(0x10, "22") + "\r\n" + Full(0, "11"));
  PadProgramImage(files, "/progmem.img");
  const std::string image = files.Read("/progmem.img");
  EXPECT_TRUE(image.starts_with(Full(0, "11") + "\n" + Full(0x10, "22") + "\n000020" + Fill + "\n"));
  EXPECT_TRUE(image.ends_with("\n0000F0" + std::string(Fill) + "\n"));
}

TEST(PadProgramImage, LeavesAFileThatCannotBePadded) {
  FakeFiles files;
  files.Put("/progmem.img", Full(0x10, "22") + "\n");
  EXPECT_EQ(NumberThrownBy([&] { PadProgramImage(files, "/progmem.img"); }), 9);
  EXPECT_EQ(files.Read("/progmem.img"), Full(0x10, "22") + "\n");
}

}  // namespace
