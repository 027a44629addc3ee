#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>
#include <vector>

#include "platform/Files.h"

/// The loudness of a sound along its time.
struct SoundLevels {
  struct Column {
    std::uint8_t Lowest;
    std::uint8_t Highest;
    bool Clips;  ///< the sound stays at full scale for a while
  };
  std::vector<Column> Columns;  ///< as many as were asked for, or fewer for a very short sound
  int Peak = 0;                 ///< farthest from rest, 0 to 128
  std::size_t Clipped = 0;      ///< samples in places where the sound clips
};

/// Measures unsigned 8-bit samples. Two or more samples in a row at the same end of the scale clip.
SoundLevels MeasureLevels(std::span<const std::uint8_t> samples, std::size_t columns);

/// The same for the samples of a file; empty for one that cannot be read.
SoundLevels LevelsOf(const Files& disk, const std::string& path, std::size_t columns);

/// A level relative to full scale in decibels with one decimal, "-3.0"; `share` is 0 to 1 or more. Empty for
/// silence.
std::string DecibelText(double share);
