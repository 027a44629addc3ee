#include "platform/sndfile/SndfileConverter.h"

#include <samplerate.h>
#include <sndfile.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <filesystem>
#include <memory>

#include "platform/RuntimeError.h"

namespace {

using File = std::unique_ptr<SNDFILE, decltype(&sf_close)>;
using Resampler = std::unique_ptr<SRC_STATE, decltype(&src_delete)>;

/// Many times what the chip holds, and still little memory.
constexpr sf_count_t MostSeconds = 3600;

/// What the library says about a file. It is made a RuntimeError where the file's name is known.
struct Unreadable {
  std::string Why;
};

/// The library would wait for ever for somebody to write into a pipe.
bool IsFile(const std::string& path) {
  std::error_code none;
  return std::filesystem::is_regular_file(path, none);
}

/// A sound file, mixed down to one channel.
class MonoReader {
 public:
  explicit MonoReader(const std::string& path) : file_(sf_open(path.c_str(), SFM_READ, &info_), &sf_close) {
    if (!file_) {
      throw Unreadable{sf_strerror(nullptr)};
    }
  }

  int SamplesPerSecond() const { return info_.samplerate; }
  /// 0 where the file does not tell.
  sf_count_t Length() const {
    return info_.frames == SF_COUNT_MAX ? 0 : std::max<sf_count_t>(info_.frames, 0);
  }
  sf_count_t Position() const { return position_; }

  /// Reads the next samples; none at the end. What is no number counts as silence.
  std::size_t Read(std::vector<float>& mono) {
    const auto channels = static_cast<std::size_t>(info_.channels);
    frames_.resize(mono.size() * channels);
    const sf_count_t got = sf_readf_float(file_.get(), frames_.data(), static_cast<sf_count_t>(mono.size()));
    if (got <= 0 && sf_error(file_.get()) != SF_ERR_NO_ERROR) {
      throw Unreadable{sf_strerror(file_.get())};
    }
    const auto count = static_cast<std::size_t>(std::max<sf_count_t>(got, 0));
    for (std::size_t i = 0; i < count; ++i) {
      float sum = 0;
      for (std::size_t channel = 0; channel < channels; ++channel) {
        sum += frames_[i * channels + channel];
      }
      const float mean = sum / static_cast<float>(channels);
      mono[i] = std::isfinite(mean) ? mean : 0.0F;
    }
    position_ += static_cast<sf_count_t>(count);
    return count;
  }

 private:
  SF_INFO info_{};
  File file_;
  std::vector<float> frames_;
  sf_count_t position_ = 0;
};

/// Turns samples from -1 to 1 into unsigned bytes.
class Quantizer {
 public:
  void Add(const float* samples, std::size_t count) {
    for (std::size_t i = 0; i < count; ++i) {
      Add(samples[i]);
    }
  }
  ConvertedSound& Sound() { return sound_; }

 private:
  void Add(float sample) {
    constexpr float fullScale = 128;
    constexpr int lowest = -128;
    constexpr int highest = 127;
    sound_.Peak = std::max(sound_.Peak, std::abs(double{sample}));
    if (std::abs(sample) > 1) {
      ++sound_.Clipped;
    }
    // Two uniform numbers make the error independent of the sound, in mean and in power.
    const float dither = Random() - Random();
    const float wanted = std::clamp(sample * fullScale + dither, float{lowest}, float{highest});
    const auto value = static_cast<int>(std::lrint(wanted));
    sound_.Samples.push_back(static_cast<std::uint8_t>(value - lowest));
  }

  /// 0 to 1; the same row of numbers for each sound.
  float Random() {
    state_ = state_ * 1664525U + 1013904223U;
    return static_cast<float>(state_ >> 8U) / static_cast<float>(1U << 24U);
  }

  ConvertedSound sound_;
  std::uint32_t state_ = 1;
};

/// Passes blocks of a sound through the resampler.
class Stream {
 public:
  Stream(double ratio, Quantizer& output) : ratio_(ratio), output_(output) {
    int error = 0;
    resampler_.reset(src_new(SRC_SINC_BEST_QUALITY, 1, &error));
    if (!resampler_) {
      throw Unreadable{src_strerror(error)};
    }
  }

  void Pass(const float* samples, std::size_t count, bool atEnd) {
    SRC_DATA data{};
    data.src_ratio = ratio_;
    data.end_of_input = atEnd ? 1 : 0;
    data.data_out = block_.data();
    data.output_frames = static_cast<long>(block_.size());
    do {
      data.data_in = samples;
      data.input_frames = static_cast<long>(count);
      if (const int error = src_process(resampler_.get(), &data); error != 0) {
        throw Unreadable{src_strerror(error)};
      }
      samples += data.input_frames_used;
      count -= static_cast<std::size_t>(data.input_frames_used);
      output_.Add(block_.data(), static_cast<std::size_t>(data.output_frames_gen));
    } while (data.output_frames_gen > 0 || (count > 0 && data.input_frames_used > 0));
  }

 private:
  const double ratio_;
  Quantizer& output_;
  Resampler resampler_{nullptr, &src_delete};
  std::array<float, 8192> block_{};
};

std::optional<ConvertedSound> ConvertFile(const std::string& path, int samplesPerSecond,
                                          const std::function<bool(double)>& progress) {
  constexpr std::size_t blockSamples = 8192;
  MonoReader reader(path);
  const double ratio = double(samplesPerSecond) / reader.SamplesPerSecond();
  Quantizer output;
  Stream stream(ratio, output);
  std::vector<float> block(blockSamples);
  for (std::size_t count = blockSamples; count > 0;) {
    // Not every file tells its length, or the truth about it.
    if (std::max(reader.Length(), reader.Position()) / reader.SamplesPerSecond() > MostSeconds) {
      throw Unreadable{"The sound is too long."};
    }
    count = reader.Read(block);
    if (samplesPerSecond == reader.SamplesPerSecond()) {
      output.Add(block.data(), count);
    } else {
      stream.Pass(block.data(), count, count == 0);
    }
    const double length = std::max(double(reader.Length()), 1.0);
    if (!progress(std::min(double(reader.Position()) / length, 1.0))) {
      return std::nullopt;
    }
  }
  return std::move(output.Sound());
}

}  // namespace

bool SndfileConverter::CanRead(const std::string& path) const {
  SF_INFO info{};
  return IsFile(path) && File(sf_open(path.c_str(), SFM_READ, &info), &sf_close) != nullptr;
}

std::optional<ConvertedSound> SndfileConverter::Convert(const std::string& path, int samplesPerSecond,
                                                        const std::function<bool(double)>& progress) const {
  if (!IsFile(path)) {
    throw RuntimeError(Fault::FileNotFound, "File not found: " + path);
  }
  try {
    return ConvertFile(path, samplesPerSecond, progress);
  } catch (const Unreadable& error) {
    throw RuntimeError(Fault::InvalidFileFormat, "Invalid file format: " + path + ". " + error.Why);
  }
}
