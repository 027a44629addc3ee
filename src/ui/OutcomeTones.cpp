#include "ui/OutcomeTones.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace {

/// Adds a tone of `frequency` Hz that fades in and out, so that it does not click.
void AddTone(std::vector<std::uint8_t>& samples, double frequency, double seconds) {
  constexpr double silence = 128;
  constexpr double loudness = 96;
  constexpr double fade = 0.008;  // seconds
  const int count = static_cast<int>(seconds * OutcomeTones::SamplesPerSecond);
  for (int i = 0; i < count; ++i) {
    const double time = i / double{OutcomeTones::SamplesPerSecond};
    const double volume = loudness * std::min({1.0, time / fade, (seconds - time) / fade});
    const double wave = std::sin(2 * std::numbers::pi * frequency * time);
    samples.push_back(static_cast<std::uint8_t>(std::lround(silence + volume * wave)));
  }
}

}  // namespace

std::vector<std::uint8_t> OutcomeTones::Success() {
  std::vector<std::uint8_t> samples;
  AddTone(samples, 880, 0.1);
  AddTone(samples, 1320, 0.18);
  return samples;
}

std::vector<std::uint8_t> OutcomeTones::Failure() {
  std::vector<std::uint8_t> samples;
  AddTone(samples, 220, 0.6);
  return samples;
}
