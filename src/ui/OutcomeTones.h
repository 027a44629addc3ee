#pragma once

#include <cstdint>
#include <vector>

/// Sounds for success (two rising tones) and failure (one long low tone): mono, unsigned 8-bit samples.
struct OutcomeTones {
  static constexpr int SamplesPerSecond = 22050;

  static std::vector<std::uint8_t> Success();
  static std::vector<std::uint8_t> Failure();
};
