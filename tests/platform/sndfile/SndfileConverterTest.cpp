#include "platform/sndfile/SndfileConverter.h"

#include <gtest/gtest.h>
#include <sndfile.h>
#include <sys/stat.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>

#include "tests/support/TemporaryFolder.h"
#include "tests/support/Thrown.h"

namespace {

constexpr int ChipRate = 22050;

/// A tone, with `right` times its level in a second channel if there is one.
std::vector<float> Tone(double hertz, double level, double seconds, int rate, int channels = 1,
                        double right = 1) {
  std::vector<float> samples;
  for (int i = 0; i < static_cast<int>(seconds * rate); ++i) {
    const double value = level * std::sin(2 * std::numbers::pi * hertz * i / rate);
    for (int channel = 0; channel < channels; ++channel) {
      samples.push_back(static_cast<float>(channel == 0 ? value : value * right));
    }
  }
  return samples;
}

/// Level of one frequency in a sound, 1 for full scale.
double LevelAt(const std::vector<std::uint8_t>& samples, double hertz, int rate = ChipRate) {
  double real = 0;
  double imaginary = 0;
  for (std::size_t i = 0; i < samples.size(); ++i) {
    const double angle = 2 * std::numbers::pi * hertz * static_cast<double>(i) / rate;
    real += (samples[i] - 128) / 128.0 * std::cos(angle);
    imaginary += (samples[i] - 128) / 128.0 * std::sin(angle);
  }
  return 2 * std::hypot(real, imaginary) / static_cast<double>(samples.size());
}

class Converted : public testing::Test {
 protected:
  std::string Write(const std::string& name, int format, int rate, int channels,
                    const std::vector<float>& samples) {
    SF_INFO info{};
    info.samplerate = rate;
    info.channels = channels;
    info.format = format;
    const std::string path = folder / name;
    SNDFILE* file = sf_open(path.c_str(), SFM_WRITE, &info);
    EXPECT_NE(file, nullptr) << sf_strerror(nullptr);
    sf_write_float(file, samples.data(), static_cast<sf_count_t>(samples.size()));
    sf_close(file);
    return path;
  }

  ConvertedSound Convert(const std::string& path) const {
    const auto sound = converter.Convert(path, ChipRate, [](double) { return true; });
    EXPECT_TRUE(sound.has_value());
    return sound.value_or(ConvertedSound{});
  }

  TemporaryFolder folder;
  SndfileConverter converter;
};

struct Format {
  const char* Name;
  int Code;
  int Rate;
  int Channels;
};

class ConvertedFrom : public Converted, public testing::WithParamInterface<Format> {};

TEST_P(ConvertedFrom, KeepsToneLevelAndLength) {
  const Format& format = GetParam();
  const std::string path = Write(format.Name, format.Code, format.Rate, format.Channels,
                                 Tone(1000, 0.5, 1, format.Rate, format.Channels));
  EXPECT_TRUE(converter.CanRead(path));
  const ConvertedSound sound = Convert(path);
  EXPECT_NEAR(static_cast<double>(sound.Samples.size()), ChipRate, ChipRate * 0.06);
  EXPECT_NEAR(LevelAt(sound.Samples, 1000), 0.5, 0.03);
  EXPECT_LT(LevelAt(sound.Samples, 3210), 0.005);
  EXPECT_EQ(sound.Clipped, 0U);
}

INSTANTIATE_TEST_SUITE_P(EachFormat, ConvertedFrom,
                         testing::Values(Format{"stereo.wav", SF_FORMAT_WAV | SF_FORMAT_PCM_16, 44100, 2},
                                         Format{"24bit.wav", SF_FORMAT_WAV | SF_FORMAT_PCM_24, 48000, 1},
                                         Format{"float.wav", SF_FORMAT_WAV | SF_FORMAT_FLOAT, 96000, 2},
                                         Format{"8bit.wav", SF_FORMAT_WAV | SF_FORMAT_PCM_U8, 11025, 1},
                                         Format{"same.wav", SF_FORMAT_WAV | SF_FORMAT_PCM_16, 22050, 1},
                                         Format{"six.wav", SF_FORMAT_WAVEX | SF_FORMAT_PCM_16, 8000, 6},
                                         Format{"a.flac", SF_FORMAT_FLAC | SF_FORMAT_PCM_16, 44100, 2},
                                         Format{"a.ogg", SF_FORMAT_OGG | SF_FORMAT_VORBIS, 44100, 2},
                                         Format{"a.mp3", SF_FORMAT_MPEG | SF_FORMAT_MPEG_LAYER_III, 44100, 2},
                                         Format{"a.aiff", SF_FORMAT_AIFF | SF_FORMAT_PCM_16, 32000, 1}),
                         [](const auto& instance) {
                           std::string name = instance.param.Name;
                           std::replace(name.begin(), name.end(), '.', '_');
                           return name;
                         });

TEST_F(Converted, MixesChannelsInEqualParts) {
  const auto sound =
      Convert(Write("a.wav", SF_FORMAT_WAV | SF_FORMAT_PCM_16, 22050, 2, Tone(1000, 0.8, 1, 22050, 2, 0)));
  EXPECT_NEAR(LevelAt(sound.Samples, 1000), 0.4, 0.01);
}

TEST_F(Converted, LosesWhatTheChipCannotPlayWithoutFoldingItBack) {
  const auto sound =
      Convert(Write("a.wav", SF_FORMAT_WAV | SF_FORMAT_PCM_16, 48000, 1, Tone(15000, 0.9, 1, 48000)));
  EXPECT_LT(LevelAt(sound.Samples, ChipRate - 15000), 0.002);
}

TEST_F(Converted, DithersAToneThatIsBelowAStep) {
  const auto sound =
      Convert(Write("a.wav", SF_FORMAT_WAV | SF_FORMAT_FLOAT, 22050, 1, Tone(1000, 0.4 / 128, 2, 22050)));
  EXPECT_NEAR(LevelAt(sound.Samples, 1000), 0.4 / 128, 0.05 / 128);
}

TEST_F(Converted, CountsWhatIsTooLoud) {
  const auto sound =
      Convert(Write("a.wav", SF_FORMAT_WAV | SF_FORMAT_FLOAT, 22050, 1, Tone(1000, 2, 1, 22050)));
  EXPECT_NEAR(sound.Peak, 2, 0.02);
  EXPECT_NEAR(static_cast<double>(sound.Clipped), ChipRate * 2.0 / 3, ChipRate * 0.05);
  EXPECT_EQ(*std::max_element(sound.Samples.begin(), sound.Samples.end()), 255);
  EXPECT_EQ(*std::min_element(sound.Samples.begin(), sound.Samples.end()), 0);
}

TEST_F(Converted, IsNotTooLoudAtFullScale) {
  const auto sound =
      Convert(Write("a.wav", SF_FORMAT_WAV | SF_FORMAT_PCM_16, 22050, 1, Tone(1000, 0.999, 1, 22050)));
  EXPECT_EQ(sound.Clipped, 0U);
}

TEST_F(Converted, IsEmptyFromAnEmptyFile) {
  const auto sound = Convert(Write("a.wav", SF_FORMAT_WAV | SF_FORMAT_PCM_16, 44100, 2, {}));
  EXPECT_TRUE(sound.Samples.empty());
}

TEST_F(Converted, TakesNoNumberAsSilence) {
  std::vector<float> samples(1000, std::numeric_limits<float>::quiet_NaN());
  samples.back() = std::numeric_limits<float>::infinity();
  const auto sound = Convert(Write("a.wav", SF_FORMAT_WAV | SF_FORMAT_FLOAT, 22050, 1, samples));
  EXPECT_EQ(sound.Peak, 0);
}

TEST_F(Converted, StopsWhenAsked) {
  const std::string path =
      Write("a.wav", SF_FORMAT_WAV | SF_FORMAT_PCM_16, 44100, 1, Tone(1000, 0.5, 5, 44100));
  int calls = 0;
  const auto sound = converter.Convert(path, ChipRate, [&](double done) {
    EXPECT_GT(done, 0);
    return ++calls < 3;
  });
  EXPECT_FALSE(sound.has_value());
  EXPECT_EQ(calls, 3);
}

TEST_F(Converted, SaysWhyAFileCannotBeRead) {
  EXPECT_FALSE(converter.CanRead(folder / "none.wav"));
  EXPECT_EQ(NumberThrownBy([&] { Convert(folder / "none.wav"); }), 53);
  WriteFile(folder / "text.wav", "Only a text");
  EXPECT_FALSE(converter.CanRead(folder / "text.wav"));
  const Thrown thrown = ThrownBy([&] { Convert(folder / "text.wav"); });
  EXPECT_EQ(thrown.Number, 321);
  const std::string start = "Invalid file format: " + folder / "text.wav. ";
  EXPECT_EQ(thrown.Text.substr(0, start.size()), start);
  EXPECT_GT(thrown.Text.size(), start.size());
}

TEST_F(Converted, IsNotMadeOfMoreThanAnHour) {
  const std::string path = Write("a.wav", SF_FORMAT_WAV | SF_FORMAT_PCM_U8, 8, 1, std::vector<float>(29'000));
  const Thrown thrown = ThrownBy([&] { Convert(path); });
  EXPECT_EQ(thrown.Text, "Invalid file format: " + path + ". The sound is too long.");
}

TEST_F(Converted, DoesNotWaitForAPipeOrTakeAFolder) {
  ASSERT_EQ(mkfifo((folder / "pipe.wav").c_str(), 0600), 0);
  for (const std::string& path : {folder / "pipe.wav", folder.Path(), "/" + std::string(5000, 'x')}) {
    EXPECT_FALSE(converter.CanRead(path));
    EXPECT_EQ(NumberThrownBy([&] { Convert(path); }), 53);
  }
}

}  // namespace
