#include "sound/WaveCheck.h"

#include <gtest/gtest.h>

#include "platform/RuntimeError.h"
#include "sound/WaveFile.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/sound/Waves.h"

namespace {

class WaveChecked : public testing::Test {
 protected:
  WaveCheck Check(const std::string& bytes) {
    disk.Put("/a.wav", bytes);
    return CheckWave(disk, "/a.wav");
  }
  WaveError ErrorOf(const std::string& bytes) { return Check(bytes).Error; }

  FakeFiles disk;
};

TEST_F(WaveChecked, TakesTheBytesOfAPlainFile) {
  const std::string bytes(
      "RIFF\x28\0\0\0WAVEfmt \x10\0\0\0\1\0\1\0\x22\x56\0\0\x22\x56\0\0\1\0\x8\0data\4\0\0\0\1\2\3\4", 48);
  const WaveCheck check = Check(bytes);
  EXPECT_EQ(check.Error, WaveError::None);
  EXPECT_EQ(check.DataOffset, 44U);
  EXPECT_EQ(check.DataLength, 4U);
  EXPECT_EQ(check.Format.Tag, 1);
  EXPECT_EQ(check.Format.Channels, 1);
  EXPECT_EQ(check.Format.SamplesPerSecond, 22050U);
  EXPECT_EQ(check.Format.AverageBytesPerSecond, 22050U);
  EXPECT_EQ(check.Format.BlockAlign, 1);
  EXPECT_EQ(check.Format.BitsPerSample, 8);
  EXPECT_EQ(check.Format.ExtraSize, 0);
}

TEST_F(WaveChecked, RefusesEveryOtherFormatOfSamples) {
  const std::string data = Chunk("data", "12");
  EXPECT_EQ(ErrorOf(Riff(FormatChunk(2) + data)), WaveError::NotChipFormat);
  EXPECT_EQ(ErrorOf(Riff(FormatChunk(1, 44100) + data)), WaveError::NotChipFormat);
  EXPECT_EQ(ErrorOf(Riff(FormatChunk(1, 11025) + data)), WaveError::NotChipFormat);
  EXPECT_EQ(ErrorOf(Riff(FormatChunk(1, 22050, 16) + data)), WaveError::NotChipFormat);
  EXPECT_EQ(ErrorOf(Riff(FormatChunk(0) + data)), WaveError::NotChipFormat);
}

TEST_F(WaveChecked, TellsAWrongFormatBeforeMissingSamples) {
  EXPECT_EQ(ErrorOf(Riff(FormatChunk(2))), WaveError::NotChipFormat);
}

TEST_F(WaveChecked, IgnoresTheFormatTag) {
  EXPECT_EQ(ErrorOf(Riff(FormatChunk(1, 22050, 8, 0xFFFE) + Chunk("data", "12"))), WaveError::None);
  EXPECT_EQ(ErrorOf(Riff(FormatChunk(1, 22050, 8, 7) + Chunk("data", "12"))), WaveError::None);
}

TEST_F(WaveChecked, TakesALongFormatChunkUpToTheBuffer) {
  const std::string plain = FormatChunk().substr(8);
  const std::string longer = Chunk("fmt ", plain + Little(5, 2) + std::string(200, 'x'));
  const WaveCheck check = Check(Riff(longer + Chunk("data", "12")));
  EXPECT_EQ(check.Error, WaveError::None);
  EXPECT_EQ(check.Format.ExtraSize, 5);
  EXPECT_EQ(check.DataOffset, 12U + 8 + 218 + 8);
}

TEST_F(WaveChecked, NeedsOfALongFormatChunkAsMuchAsTheBufferHolds) {
  const std::string start =
      "RIFF" + Little(1000, 4) + "WAVEfmt " + Little(60, 4) + FormatChunk().substr(8);  // of these 60, 16
  EXPECT_EQ(ErrorOf(start + std::string(49 - 16, '\0')), WaveError::CannotReadFormat);
  EXPECT_EQ(ErrorOf(start + std::string(50 - 16, '\0')), WaveError::NoData);
}

TEST_F(WaveChecked, FindsAWaveBehindAnotherForm) {
  const WaveCheck check = Check("RIFF" + Little(20, 4) + "AVI " + std::string(16, 'a') + Wave("1234"));
  EXPECT_EQ(check.Error, WaveError::None);
  EXPECT_EQ(check.DataOffset, 28U + 44);
}

TEST_F(WaveChecked, TakesAFormatChunkThatIsTooShortAsZeros) {
  EXPECT_EQ(ErrorOf(Riff(Chunk("fmt ", "") + Chunk("data", "12"))), WaveError::NotChipFormat);
  EXPECT_EQ(ErrorOf(Riff(Chunk("fmt ", FormatChunk().substr(8, 14)) + Chunk("data", "12"))),
            WaveError::NotChipFormat);
}

TEST_F(WaveChecked, WalksOverOtherChunksAndTheirPadding) {
  const std::string odd = Chunk("LIST", "abc");
  EXPECT_EQ(odd.size(), 12U);
  const WaveCheck check = Check(Riff(odd + FormatChunk() + Chunk("fact", "12345") + Chunk("data", "1234")));
  EXPECT_EQ(check.Error, WaveError::None);
  EXPECT_EQ(check.DataOffset, 12U + 12 + 24 + 14 + 8);
  EXPECT_EQ(check.DataLength, 4U);
}

TEST_F(WaveChecked, FindsSamplesBehindMoreThanOnePieceOfTheFile) {
  const WaveCheck check = Check(Riff(Chunk("LIST", std::string(5000, 'l')) + FormatChunk() +
                                     Chunk("junk", std::string(100'000, 'j')) + Chunk("data", "12")));
  EXPECT_EQ(check.Error, WaveError::None);
  EXPECT_EQ(check.DataOffset, 12U + 5008 + 24 + 100'008 + 8);
}

TEST_F(WaveChecked, CountsSamplesOnlyBehindTheFormat) {
  EXPECT_EQ(ErrorOf(Riff(Chunk("data", "12") + FormatChunk())), WaveError::NoData);
  const WaveCheck check = Check(Riff(Chunk("data", "12") + FormatChunk() + Chunk("data", "1234")));
  EXPECT_EQ(check.DataOffset, 12U + 10 + 24 + 8);
}

TEST_F(WaveChecked, LooksOnlyWithinTheSizeThatTheFileDeclares) {
  const std::string chunks = FormatChunk() + Chunk("data", "12");
  EXPECT_EQ(ErrorOf("RIFF" + Little(4 + 24, 4) + "WAVE" + chunks), WaveError::NoData);
  EXPECT_EQ(ErrorOf("RIFF" + Little(4, 4) + "WAVE" + chunks), WaveError::NoFormat);
  EXPECT_EQ(ErrorOf("RIFF" + Little(0, 4) + "WAVE" + chunks), WaveError::NoFormat);
  EXPECT_EQ(ErrorOf("RIFF" + Little(0xFFFFFFFF, 4) + "WAVE" + chunks), WaveError::None);
}

TEST_F(WaveChecked, TrustsTheDeclaredSizeOfTheSamples) {
  const WaveCheck check = Check(Riff(FormatChunk() + "data" + Little(0xFFFFFFFF, 4) + "12"));
  EXPECT_EQ(check.Error, WaveError::None);
  EXPECT_EQ(check.DataLength, 0xFFFFFFFFU);
}

TEST_F(WaveChecked, TellsAFileThatIsNoWave) {
  EXPECT_EQ(ErrorOf(""), WaveError::NotWave);
  EXPECT_EQ(ErrorOf("RIFF"), WaveError::NotWave);
  EXPECT_EQ(ErrorOf("Only a text, and longer than a header"), WaveError::NotWave);
  EXPECT_EQ(ErrorOf("RIFF" + Little(20, 4) + "AVI " + FormatChunk()), WaveError::NotWave);
  EXPECT_EQ(ErrorOf(std::string(100'000, '\0')), WaveError::NotWave);
}

TEST_F(WaveChecked, HasAnErrorForEachPlaceWhereAFileIsCut) {
  const std::string whole = Wave("1234");
  for (std::size_t length = 0; length <= whole.size(); ++length) {
    const WaveError expected = length < 12   ? WaveError::NotWave
                               : length < 20 ? WaveError::NoFormat
                               : length < 36 ? WaveError::CannotReadFormat
                               : length < 44 ? WaveError::NoData
                                             : WaveError::None;
    EXPECT_EQ(ErrorOf(whole.substr(0, length)), expected) << length;
  }
}

TEST_F(WaveChecked, TellsAFileThatCannotBeOpened) {
  EXPECT_EQ(CheckWave(disk, "/none.wav").Error, WaveError::CannotOpen);
  disk.Put("/a.wav", Wave("12"));
  disk.FailRead("/a.wav", RuntimeError(Fault::PathAccess));
  EXPECT_EQ(CheckWave(disk, "/a.wav").Error, WaveError::CannotOpen);
}

TEST(IsWave, GoesByTheLastThreeCharactersInAnyCase) {
  EXPECT_TRUE(IsWave("/a/b.wav"));
  EXPECT_TRUE(IsWave("/a/b.WaV"));
  EXPECT_TRUE(IsWave("wav"));
  EXPECT_FALSE(IsWave("/a/b.pcm"));
  EXPECT_FALSE(IsWave("/a/b.wav.raw"));
  EXPECT_FALSE(IsWave("av"));
  EXPECT_FALSE(IsWave(""));
}

class OpenWave : public testing::Test {
 protected:
  FakeFiles disk;
  FakeMessageBoxes boxes;
  WaveFile wave{disk, boxes};
};

TEST_F(OpenWave, KeepsPlaceAndSizeOfTheSamples) {
  disk.Put("/a.wav", Wave(Samples(300)));
  EXPECT_TRUE(wave.WaveOpenFile("/a.wav"));
  EXPECT_EQ(wave.ReadSize(), 300U);
  EXPECT_EQ(wave.DataOffset(), 44U);
  EXPECT_TRUE(boxes.Boxes.empty());
}

TEST_F(OpenWave, HasNoSizeAfterAFailureButTheOffsetOfTheLastGoodFile) {
  disk.Put("/a.wav", Wave(Samples(300)));
  wave.WaveOpenFile("/a.wav");
  EXPECT_FALSE(wave.WaveOpenFile("/none.wav"));
  EXPECT_EQ(wave.ReadSize(), 0U);
  EXPECT_EQ(wave.DataOffset(), 44U);
}

TEST_F(OpenWave, SaysNothingAboutAnEmptyPath) {
  EXPECT_FALSE(wave.WaveOpenFile(""));
  EXPECT_TRUE(boxes.Boxes.empty());
}

TEST_F(OpenWave, TellsEachErrorInItsWords) {
  const std::pair<std::string, std::string> files[] = {
      {Riff(FormatChunk(2)), "Only Mono, 8 bit, 22khz wave files supported."},
      {"text", "Not a Wave file."},
      {Riff(""), "Unable to retrieve format chunk"},
      {Wave("12").substr(0, 30), "Error reading format"},
      {Riff(FormatChunk()), "No Wave File Open"},
  };
  for (const auto& [bytes, text] : files) {
    disk.Put("/a.wav", bytes);
    EXPECT_FALSE(wave.WaveOpenFile("/a.wav"));
    EXPECT_EQ(boxes.Boxes.back(),
              (FakeMessageBoxes::Box{"Sound File Format error: " + text, "Tessarine", BoxIcon::None}));
  }
  EXPECT_FALSE(wave.WaveOpenFile("/none.wav"));
  EXPECT_EQ(boxes.Boxes.back().Text, "Sound File Format error: Unable to open file.");
  EXPECT_EQ(TextOf(WaveError::OutOfMemory), "Insufficient memory");
  EXPECT_EQ(TextOf(WaveError::OutOfRange), "Position out of range");
}

}  // namespace
