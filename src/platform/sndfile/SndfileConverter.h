#pragma once

#include "platform/SoundConverter.h"

/// Reads what libsndfile reads (wave of every kind, flac, ogg, mp3 and more), and resamples with the best
/// converter of libsamplerate. What is left after rounding to 8 bits is dithered, so that quiet passages fade
/// into noise and not into distortion.
class SndfileConverter : public SoundConverter {
 public:
  bool CanRead(const std::string& path) const override;
  std::optional<ConvertedSound> Convert(const std::string& path, int samplesPerSecond,
                                        const std::function<bool(double)>& progress) const override;
};
