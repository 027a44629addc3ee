#include <gtest/gtest.h>

#include "firmware/hex/HexText.h"
#include "firmware/hex/ImagePadding.h"

// Lines whose bytes all differ, at places where one step of the padding alone decides.

namespace {

using Lines = std::vector<std::string>;

/// A line of 16 bytes that count up from `first`.
std::string Line(std::uint32_t address, unsigned int first) {
  std::string line = FormatHex(address, 6) + " ";
  for (unsigned int i = 0; i < 16; ++i) {
    line += FormatHex(first + i, 2) + " ";
  }
  return line;
}

/// Lines at 0, 10 and so on, then these.
Lines Behind(std::size_t count, const Lines& others) {
  Lines lines;
  for (std::uint32_t i = 0; i < count; ++i) {
    lines.push_back(Line(16 * i, 0x10));
  }
  lines.insert(lines.end(), others.begin(), others.end());
  return lines;
}

/// `count` lines of the padded image from number `first` on.
Lines Padded(const Lines& lines, std::size_t first, std::size_t count) {
  const std::string image = PaddedImage(lines);
  Lines padded;
  std::size_t number = 0;
  for (LineReader reader(image); !reader.AtEnd(); ++number) {
    const std::string line(reader.Next());
    if (number >= first && number < first + count) {
      padded.push_back(line);
    }
  }
  return padded;
}

TEST(PaddingSteps, SkipALineWhereItsNeighboursOverlap) {
  // F8 begins a block, but reaches from F0 into 100: its start goes to F0, its rest is dropped.
  EXPECT_EQ(Padded(Behind(16, {Line(0xF8, 0x30), Line(0x100, 0x50)}), 15, 3),
            (Lines{"0000F0 10 11 12 13 14 15 16 17 30 31 32 33 34 35 36 37 ", Line(0x100, 0x50),
                   "000110 FF FF FF 00 FF FF FF 00 FF FF FF 00 FF FF FF 00"}));
}

TEST(PaddingSteps, KeepALineWhoseNextOneOnlyMeetsIt) {
  EXPECT_EQ(Padded(Behind(16, {Line(0xF8, 0x30), Line(0x108, 0x50)}), 15, 4),
            (Lines{"0000F0 10 11 12 13 14 15 16 17 30 31 32 33 34 35 36 37 ",
                   "000100 38 39 3A 3B 3C 3D 3E 3F 50 51 52 53 54 55 56 57 ",
                   "000110 58 59 5A 5B 5C 5D 5E 5F FF FF FF 00 FF FF FF 00 ",
                   "000118 FF FF FF 00 FF FF FF 00 FF FF FF 00 FF FF FF 00"}));
}

TEST(PaddingSteps, TakeSixteenAddressesForNoHole) {
  // The line at 8 makes one line more, so that the first block ends behind E0.
  Lines lines = Behind(17, {});
  lines.insert(lines.begin() + 1, Line(8, 0x30));
  EXPECT_EQ(Padded(lines, 0, 3),
            (Lines{"000000 10 11 12 13 14 15 16 17 30 31 32 33 34 35 36 37 ",
                   "000010 38 39 3A 3B 3C 3D 3E 3F FF FF FF 00 FF FF FF 00 ", Line(0x10, 0x10)}));
  EXPECT_EQ(Padded(lines, 16, 3), (Lines{Line(0xF0, 0x10), Line(0x100, 0x10),
                                         "000110 FF FF FF 00 FF FF FF 00 FF FF FF 00 FF FF FF 00"}));
}

TEST(PaddingSteps, RepeatTheEndOfALineThatIsSplitBehindAHole) {
  EXPECT_EQ(Padded({Line(0, 0x10), Line(0x208, 0x30)}, 16, 3),
            (Lines{"000200 FF FF FF 00 FF FF FF 00 30 31 32 33 34 35 36 37 ",
                   "000210 38 39 3A 3B 3C 3D 3E 3F 38 39 3A 3B 3C 3D 3E 3F ",
                   "000220 FF FF FF 00 FF FF FF 00 FF FF FF 00 FF FF FF 00"}));
  EXPECT_EQ(
      Padded({Line(0, 0x10), Line(0x104, 0x30)}, 16, 2),
      (Lines{"000100 FF FF FF 00 30 31 32 33 ", "000110 34 35 36 37 38 39 3A 3B 3C 3D 3E 3F 3C 3D 3E 3F "}));
}

TEST(PaddingSteps, LeaveALineBelowTheOneThatWasMovedUp) {
  // The rest of 4 moved up to 10, so 8 no longer begins within it.
  EXPECT_EQ(Padded({Line(0, 0x10), Line(4, 0x30), Line(8, 0x50)}, 0, 4),
            (Lines{"000000 10 11 12 13 14 15 16 17 18 19 1A 1B 30 31 32 33 ",
                   "000010 34 35 36 37 38 39 3A 3B 3C 3D 3E 3F FF FF FF 00 ", Line(8, 0x50),
                   "000018 FF FF FF 00 FF FF FF 00 FF FF FF 00 FF FF FF 00"}));
}

}  // namespace
