#include "sound/SoundConversion.h"

#include <gmock/gmock.h>

#include "sound/SoundLevels.h"
#include "sound/WaveCheck.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/sound/Waves.h"

namespace {

using testing::IsEmpty;

TEST(GetFileName, IsWithoutFolderAndExtension) {
  EXPECT_EQ(GetFileName("/a/b c.d.wav"), "b c.d");
  EXPECT_EQ(GetFileName("/a.b/c"), "c");
  EXPECT_EQ(GetFileName("/a/.wav"), ".wav");
  EXPECT_EQ(GetFileName("c.wav"), "c");
  EXPECT_EQ(GetFileName(""), "");
}

TEST(ConvertedName, LiesBesideTheOriginalAndIsNeverTaken) {
  FakeFiles disk;
  disk.Put("/a/shot.flac", "");
  EXPECT_EQ(ConvertedName(disk, "/a/shot.flac"), "/a/shot-chip.wav");
  disk.Put("/a/shot-chip.wav", "");
  EXPECT_EQ(ConvertedName(disk, "/a/shot.flac"), "/a/shot-chip-2.wav");
  disk.AddFolder("/a/shot-chip-2.wav");
  EXPECT_EQ(ConvertedName(disk, "/a/shot.flac"), "/a/shot-chip-3.wav");
}

TEST(WaveBytes, AreAFileInTheChipsFormat) {
  const std::vector<std::uint8_t> samples = {1, 2, 3};
  const std::string expected(
      "RIFF\x28\0\0\0WAVEfmt \x10\0\0\0\1\0\1\0\x22\x56\0\0\x22\x56\0\0\1\0\x8\0data\3\0\0\0\1\2\3\0", 48);
  EXPECT_EQ(WaveBytes(samples), expected);
  FakeFiles disk;
  disk.Put("/a.wav", WaveBytes(samples));
  EXPECT_EQ(CheckWave(disk, "/a.wav").DataLength, 3U);
}

TEST(IsRawSamples, KnowsTheEndingsInAnyCase) {
  EXPECT_TRUE(IsRawSamples("/a.pcm"));
  EXPECT_TRUE(IsRawSamples("/a.RAW"));
  EXPECT_FALSE(IsRawSamples("/a.flac"));
  EXPECT_FALSE(IsRawSamples("aw"));
}

TEST(SoundLevels, HaveTheEndsOfEachColumn) {
  const std::vector<std::uint8_t> samples = {128, 130, 120, 128, 200, 100};
  const SoundLevels levels = MeasureLevels(samples, 2);
  ASSERT_EQ(levels.Columns.size(), 2U);
  EXPECT_EQ(levels.Columns[0].Lowest, 120);
  EXPECT_EQ(levels.Columns[0].Highest, 130);
  EXPECT_EQ(levels.Columns[1].Lowest, 100);
  EXPECT_EQ(levels.Columns[1].Highest, 200);
  EXPECT_EQ(levels.Peak, 72);
  EXPECT_EQ(levels.Clipped, 0U);
}

TEST(SoundLevels, MarkOnlyRunsAtFullScale) {
  const std::vector<std::uint8_t> samples = {128, 255, 128, 0, 128, 255, 255, 255, 128, 0, 0, 128};
  const SoundLevels levels = MeasureLevels(samples, 4);
  EXPECT_EQ(levels.Clipped, 5U);
  EXPECT_FALSE(levels.Columns[0].Clips);
  EXPECT_TRUE(levels.Columns[1].Clips);
  EXPECT_TRUE(levels.Columns[2].Clips);
  EXPECT_TRUE(levels.Columns[3].Clips);
}

TEST(SoundLevels, AreEmptyForAFileThatCannotBeRead) {
  const FakeFiles disk;
  EXPECT_THAT(LevelsOf(disk, "/none.raw", 10).Columns, IsEmpty());
  EXPECT_THAT(MeasureLevels({}, 10).Columns, IsEmpty());
}

TEST(DecibelText, IsRelativeToFullScale) {
  EXPECT_EQ(DecibelText(1), "0.0");
  EXPECT_EQ(DecibelText(0.5), "-6.0");
  EXPECT_EQ(DecibelText(2), "6.0");
  EXPECT_EQ(DecibelText(0), "");
}

}  // namespace
