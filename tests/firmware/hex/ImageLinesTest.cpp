#include "firmware/hex/ImageLines.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <chrono>

#include "firmware/hex/HexText.h"
#include "tests/support/Thrown.h"

namespace {

std::vector<std::string> Lines(const std::vector<std::uint32_t>& addresses) {
  std::vector<std::string> lines;
  for (const std::uint32_t address : addresses) {
    lines.push_back(FormatHex(address, 6) + " data of " + std::to_string(address));
  }
  return lines;
}

void ExpectSorted(std::vector<std::uint32_t> addresses) {
  std::vector<std::string> lines = Lines(addresses);
  SortImageLines(lines, 0, static_cast<std::ptrdiff_t>(lines.size()) - 1);
  std::sort(addresses.begin(), addresses.end());
  EXPECT_EQ(lines, Lines(addresses));
}

TEST(SortImageLines, SortsByAddress) {
  ExpectSorted({});
  ExpectSorted({0x10});
  ExpectSorted({0x20, 0x10});
  ExpectSorted({0xF0, 0x10, 0xABCDE0, 0, 0x9FF0, 0xA000});
  ExpectSorted({5, 4, 3, 2, 1, 0});
  ExpectSorted({0, 1, 2, 3, 4, 5});
}

TEST(SortImageLines, LeavesLinesOutsideItsRange) {
  std::vector<std::string> lines = Lines({0x50, 0x40, 0x30, 0x20, 0x10});
  SortImageLines(lines, 1, 3);
  EXPECT_EQ(lines, Lines({0x50, 0x20, 0x30, 0x40, 0x10}));
}

TEST(SortImageLines, KeepsEveryLineOfOneAddress) {
  std::vector<std::string> lines = {"000010 b", "000000 x", "000010 a", "000010 c"};
  SortImageLines(lines, 0, 3);
  EXPECT_EQ(lines[0], "000000 x");
  std::sort(lines.begin() + 1, lines.end());
  EXPECT_EQ(lines, (std::vector<std::string>{"000000 x", "000010 a", "000010 b", "000010 c"}));
}

TEST(SortImageLines, SortsOrdersThatAreMadeAgainstItsPivot) {
  // The middle one of each part is its smallest: built backwards from the swaps of the sort.
  constexpr std::uint32_t count = 20'000;
  std::vector<std::uint32_t> addresses;
  for (std::uint32_t i = 0; i < count; ++i) {
    addresses.push_back(count - i);
    std::swap(addresses[addresses.size() / 2], addresses.back());
  }
  ExpectSorted(addresses);
}

TEST(SortImageLines, RefusesALineWithoutAddress) {
  std::vector<std::string> lines = {"000010 a", "nothing"};
  EXPECT_EQ(NumberThrownBy([&] { SortImageLines(lines, 0, 1); }), 13);
}

TEST(ImageLine, HoldsSixteenBytes) {
  const ImageLine::Data bytes = {0x00, 0x01, 0x02, 0x03, 0x10, 0x20, 0x30, 0x40,
                                 0x99, 0xAB, 0xCD, 0xEF, 0xFF, 0xFE, 0x80, 0x7F};
  std::string line;
  ImageLine::Append(line, 0x1230, bytes.data());
  EXPECT_EQ(line, "001230 00 01 02 03 10 20 30 40 99 AB CD EF FF FE 80 7F ");
  EXPECT_EQ(line.size(), 55U);
  EXPECT_EQ(ImageLine::AddressOf(line), 0x1230U);
  EXPECT_EQ(ImageLine::DataOf(line), bytes);
  line.pop_back();  // lines of fill have no blank at their end
  EXPECT_EQ(ImageLine::DataOf(line), bytes);
  line.pop_back();
  EXPECT_EQ(NumberThrownBy([&] { ImageLine::DataOf(line); }), 13);
}

}  // namespace
