#include "sim/recorder/SoundChip.h"

#include <gtest/gtest.h>

#include <utility>

#include "sim/recorder/RecorderReport.h"
#include "tests/support/JoinedBytes.h"

namespace sim {
namespace {

using Samples = SoundChip::Samples;

Samples Page(std::uint8_t value) {
  return Samples(256, value);
}

SoundChip::Table TableOf(const std::vector<std::pair<std::size_t, int>>& entries) {
  SoundChip::Table table{};
  for (const auto& [index, page] : entries) {
    table.at(2 * index) = static_cast<std::uint8_t>(page / 256);
    table.at(2 * index + 1) = static_cast<std::uint8_t>(page % 256);
  }
  return table;
}

// Pages 0, 1, 2 ... of the values 0, 1, 2 ...
SoundChip GunWith(int pages, const SoundChip::Table& table) {
  SoundChip chip;
  chip.SetTable(table);
  for (int i = 0; i < pages; ++i) {
    chip.SetPage(static_cast<std::uint16_t>(i), Page(static_cast<std::uint8_t>(i)));
  }
  return chip;
}

TEST(SoundChip, OfAStandAloneRecorderKeepsEachSoundUnderItsNumber) {
  SoundChip chip;
  chip.BeginSound(7);
  chip.AppendToSound(7, Page(1));
  chip.AppendToSound(7, Page(2));
  chip.BeginSound(0);
  chip.AppendToSound(0, Page(3));
  EXPECT_EQ(chip.Sounds(), (std::map<std::uint8_t, Samples>{{0, Page(3)}, {7, Page(1) + Page(2)}}));
  chip.BeginSound(7);
  EXPECT_EQ(chip.Sounds(), (std::map<std::uint8_t, Samples>{{0, Page(3)}}));
}

TEST(SoundChip, OfAGunFindsSoundsByATableThatCountsPagesFromOne) {
  EXPECT_EQ(GunWith(3, TableOf({{0, 1}, {1, 3}, {2, 4}})).Sounds(),
            (std::map<std::uint8_t, Samples>{{0, Page(0) + Page(1)}, {1, Page(2)}}));
}

TEST(SoundChip, OfAGunLeavesOutSoundsWithoutPages) {
  EXPECT_EQ(GunWith(2, TableOf({{0, 1}, {1, 1}, {2, 2}, {3, 3}})).Sounds(),
            (std::map<std::uint8_t, Samples>{{1, Page(0)}, {2, Page(1)}}));
}

TEST(SoundChip, OfAGunEndsAtThePagesThatCame) {
  EXPECT_EQ(GunWith(3, TableOf({{0, 1}, {1, 3}, {2, 9}, {3, 12}})).Sounds(),
            (std::map<std::uint8_t, Samples>{{0, Page(0) + Page(1)}, {1, Page(2)}}));
  EXPECT_TRUE(GunWith(0, TableOf({{0, 1}, {1, 3}})).Sounds().empty());
}

TEST(SoundChip, OfAGunLetsSound127RunToTheEnd) {
  EXPECT_EQ(GunWith(3, TableOf({{127, 2}})).Sounds(),
            (std::map<std::uint8_t, Samples>{{127, Page(1) + Page(2)}}));
}

TEST(SoundChip, HasHighBytesFirstInItsTable) {
  SoundChip chip = GunWith(0, TableOf({{0, 0x101}, {1, 0x103}}));
  EXPECT_EQ((*chip.IndexTable())[0], 1);
  for (const int page : {0x100, 0x101, 0x102}) {
    chip.SetPage(static_cast<std::uint16_t>(page), Page(static_cast<std::uint8_t>(page)));
  }
  EXPECT_EQ(chip.Sounds(), (std::map<std::uint8_t, Samples>{{0, Page(0) + Page(1)}}));
  EXPECT_EQ(chip.AllPages().size(), 0x103 * 256U);
  EXPECT_EQ(chip.AllPages().front(), 0x80);
}

TEST(SoundChip, IsEmptyAfterAnErase) {
  SoundChip chip = GunWith(3, TableOf({{0, 1}, {1, 3}}));
  EXPECT_FALSE(chip.IsEmpty());
  chip.Erase();
  EXPECT_TRUE(chip.IsEmpty());
  EXPECT_EQ(chip.PageCount(), 0U);
}

TEST(SoundChip, IsToldSoundBySound) {
  SoundChip chip;
  EXPECT_EQ(RecorderReport(chip), "no sounds");
  chip.BeginSound(12);
  chip.AppendToSound(12, Samples(256 * 86, 0));
  chip.BeginSound(3);
  chip.AppendToSound(3, Page(0));
  EXPECT_EQ(RecorderReport(chip), "sound 3: 1 pages, 0.01 s\nsound 12: 86 pages, 1.00 s");
}

}  // namespace
}  // namespace sim
