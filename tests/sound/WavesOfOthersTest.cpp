#include <gmock/gmock.h>
#include <sndfile.h>

#include "platform/linux/LinuxFiles.h"
#include "sound/SoundConversion.h"
#include "sound/SoundSamples.h"
#include "sound/WaveCheck.h"
#include "tests/support/TemporaryFolder.h"

// Real wave files that another library writes and reads.

namespace {

constexpr int ChipRate = 22050;
constexpr int ChipForm = SF_FORMAT_WAV | SF_FORMAT_PCM_U8;

/// Samples from one end of the scale to the other.
std::vector<std::uint8_t> Scale() {
  std::vector<std::uint8_t> samples;
  for (int i = 0; i < 1001; ++i) {
    samples.push_back(static_cast<std::uint8_t>(i * 7));
  }
  return samples;
}

class WavesOfOthers : public testing::Test {
 protected:
  /// Returns the path.
  std::string Write(int form, int rate, int channels, bool withTitle = false) const {
    SF_INFO info{};
    info.samplerate = rate;
    info.channels = channels;
    info.format = form;
    std::string path = folder / "a.wav";
    SNDFILE* file = sf_open(path.c_str(), SFM_WRITE, &info);
    EXPECT_NE(file, nullptr) << sf_strerror(nullptr);
    if (withTitle) {
      sf_set_string(file, SF_STR_TITLE, "A shot");  // a chunk before the samples
    }
    std::vector<short> wide;
    for (const std::uint8_t sample : Scale()) {
      wide.insert(wide.end(), static_cast<std::size_t>(channels), static_cast<short>((sample - 128) * 256));
    }
    sf_writef_short(file, wide.data(), static_cast<sf_count_t>(Scale().size()));
    if (withTitle) {
      sf_set_string(file, SF_STR_COMMENT, "Odd");  // and one behind them
    }
    sf_close(file);
    return path;
  }

  WaveError ErrorOf(const std::string& path) const { return CheckWave(disk, path).Error; }

  TemporaryFolder folder;
  LinuxFiles disk;
};

TEST_F(WavesOfOthers, InTheChipsFormatGiveTheSamplesThatWereWritten) {
  for (const auto& [form, withTitle] :
       {std::pair{ChipForm, false}, {ChipForm, true}, {SF_FORMAT_WAVEX | SF_FORMAT_PCM_U8, true}}) {
    const std::string path = Write(form, ChipRate, 1, withTitle);
    EXPECT_EQ(ErrorOf(path), WaveError::None);
    EXPECT_EQ(ReadSamples(disk, path, 5000), Scale());
  }
}

TEST_F(WavesOfOthers, InOtherFormatsAreRefused) {
  EXPECT_EQ(ErrorOf(Write(ChipForm, ChipRate, 2)), WaveError::NotChipFormat);
  EXPECT_EQ(ErrorOf(Write(ChipForm, 44100, 1)), WaveError::NotChipFormat);
  EXPECT_EQ(ErrorOf(Write(SF_FORMAT_WAV | SF_FORMAT_PCM_16, ChipRate, 1)), WaveError::NotChipFormat);
  EXPECT_EQ(ErrorOf(Write(SF_FORMAT_WAV | SF_FORMAT_FLOAT, ChipRate, 1)), WaveError::NotChipFormat);
  EXPECT_EQ(ErrorOf(Write(SF_FORMAT_WAV | SF_FORMAT_IMA_ADPCM, ChipRate, 1)), WaveError::NotChipFormat);
  for (const int other : {SF_FORMAT_AIFF | SF_FORMAT_PCM_U8, SF_FORMAT_W64 | SF_FORMAT_PCM_U8,
                          SF_FORMAT_RF64 | SF_FORMAT_PCM_U8, SF_FORMAT_FLAC | SF_FORMAT_PCM_16}) {
    EXPECT_EQ(ErrorOf(Write(other, ChipRate, 1)), WaveError::NotWave);
  }
}

TEST_F(WavesOfOthers, OfCompandedSamplesPassTheCheckButAreNotPlain) {
  for (const int law : {SF_FORMAT_ULAW, SF_FORMAT_ALAW}) {
    const WaveCheck check = CheckWave(disk, Write(SF_FORMAT_WAV | law, ChipRate, 1));
    EXPECT_EQ(check.Error, WaveError::None);
    EXPECT_FALSE(IsPlainChipWave(check));
  }
  EXPECT_TRUE(IsPlainChipWave(CheckWave(disk, Write(ChipForm, ChipRate, 1))));
}

TEST_F(WavesOfOthers, AreNotLookedForBehindAnyNumberOfZeros) {
  const std::string path = folder / "zeros.wav";
  WriteFile(path, std::string(7'000'000, '\0') + WaveBytes(Scale()));
  EXPECT_EQ(ErrorOf(path), WaveError::None);
  WriteFile(path, std::string(9'000'000, '\0') + WaveBytes(Scale()));
  EXPECT_EQ(ErrorOf(path), WaveError::NotWave);
}

TEST_F(WavesOfOthers, CanBeReadByThemWhenTheyAreOurs) {
  const std::string path = folder / "ours.wav";
  WriteFile(path, WaveBytes(Scale()));
  SF_INFO info{};
  SNDFILE* file = sf_open(path.c_str(), SFM_READ, &info);
  ASSERT_NE(file, nullptr) << sf_strerror(nullptr);
  EXPECT_EQ(info.format, ChipForm);
  EXPECT_EQ(info.channels, 1);
  EXPECT_EQ(info.samplerate, ChipRate);
  ASSERT_EQ(info.frames, static_cast<sf_count_t>(Scale().size()));
  std::vector<std::uint8_t> bytes(Scale().size());
  EXPECT_EQ(sf_read_raw(file, bytes.data(), info.frames), info.frames);
  sf_close(file);
  EXPECT_EQ(bytes, Scale());
}

}  // namespace
