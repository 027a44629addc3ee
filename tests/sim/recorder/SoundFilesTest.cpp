#include "sim/recorder/SoundFiles.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <vector>

#include "tests/support/TemporaryFolder.h"

namespace sim {
namespace {

std::vector<std::string> NamesIn(const std::filesystem::path& folder) {
  std::vector<std::string> names;
  for (const auto& file : std::filesystem::directory_iterator(folder)) {
    names.push_back(file.path().filename());
  }
  std::sort(names.begin(), names.end());
  return names;
}

SoundChip ChipWithOnePage() {
  SoundChip chip;
  chip.BeginSound(5);
  chip.AppendToSound(5, SoundChip::Samples(256, 0x41));
  return chip;
}

TEST(SoundFiles, AreWaveFilesOfMono8BitAt22050) {
  const TemporaryFolder folder;
  const std::filesystem::path kept = SoundFiles(folder / "new/sounds").Keep(ChipWithOnePage());
  EXPECT_EQ(kept, folder / "new/sounds/recording-1");
  EXPECT_EQ(NamesIn(kept), std::vector<std::string>{"sound-005.wav"});
  const std::string header(
      "RIFF\x24\x01\x00\x00WAVE"
      "fmt \x10\x00\x00\x00\x01\x00\x01\x00\x22\x56\x00\x00\x22\x56\x00\x00\x01\x00\x08\x00"
      "data\x00\x01\x00\x00",
      44);
  EXPECT_EQ(ReadFile(kept / "sound-005.wav"), header + std::string(256, 'A'));
}

TEST(SoundFiles, OfAGunHaveTheTableAndAllPagesToo) {
  const TemporaryFolder folder;
  SoundChip chip;
  SoundChip::Table table{0, 1, 0, 2};
  chip.SetTable(table);
  chip.SetPage(0, SoundChip::Samples(256, 0x42));
  chip.SetPage(1, SoundChip::Samples(256, 0x43));
  const std::filesystem::path kept = SoundFiles(folder.Path()).Keep(chip);
  EXPECT_EQ(NamesIn(kept), (std::vector<std::string>{"pages.wav", "sound-000.wav", "table.bin"}));
  EXPECT_EQ(ReadFile(kept / "table.bin"), std::string(table.begin(), table.end()));
  EXPECT_EQ(ReadFile(kept / "pages.wav").substr(44), std::string(256, 'B') + std::string(256, 'C'));
  EXPECT_EQ(ReadFile(kept / "sound-000.wav").substr(44), std::string(256, 'B'));
}

TEST(SoundFiles, NeverTouchEarlierRecordings) {
  const TemporaryFolder folder;
  std::filesystem::create_directory(folder / "recording-2");
  const SoundFiles files(folder.Path());
  EXPECT_EQ(files.Keep(ChipWithOnePage()), folder / "recording-1");
  EXPECT_EQ(files.Keep(ChipWithOnePage()), folder / "recording-3");
  EXPECT_TRUE(NamesIn(folder / "recording-2").empty());
}

TEST(SoundFiles, SayWhenTheyCannotBeWritten) {
  const TemporaryFolder folder;
  WriteFile(folder / "file", "");
  EXPECT_THROW(SoundFiles(folder / "file"), std::filesystem::filesystem_error);
  WriteFile(folder / "recording-1", "");
  EXPECT_THROW(SoundFiles(folder.Path()).Keep(ChipWithOnePage()), std::system_error);
}

}  // namespace
}  // namespace sim
