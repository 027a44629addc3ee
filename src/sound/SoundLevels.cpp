#include "sound/SoundLevels.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>

#include "core/text/NumberForms.h"
#include "platform/RuntimeError.h"
#include "sound/SoundPages.h"
#include "sound/SoundSamples.h"

namespace {

constexpr std::uint8_t LowEnd = 0;
constexpr std::uint8_t HighEnd = 255;

/// Marks the samples that lie in a run at one end of the scale.
std::vector<bool> FindClipped(std::span<const std::uint8_t> samples) {
  std::vector<bool> clipped(samples.size());
  for (std::size_t i = 1; i < samples.size(); ++i) {
    const bool atEnd = samples[i] == LowEnd || samples[i] == HighEnd;
    if (atEnd && samples[i] == samples[i - 1]) {
      clipped[i - 1] = true;
      clipped[i] = true;
    }
  }
  return clipped;
}

}  // namespace

SoundLevels MeasureLevels(std::span<const std::uint8_t> samples, std::size_t columns) {
  SoundLevels levels;
  const std::vector<bool> clipped = FindClipped(samples);
  levels.Clipped = static_cast<std::size_t>(std::count(clipped.begin(), clipped.end(), true));
  columns = std::min(columns, samples.size());
  for (std::size_t column = 0; column < columns; ++column) {
    const std::size_t start = column * samples.size() / columns;
    const std::size_t end = (column + 1) * samples.size() / columns;
    const auto part = samples.subspan(start, end - start);
    const auto [lowest, highest] = std::minmax_element(part.begin(), part.end());
    const auto first = clipped.begin() + static_cast<std::ptrdiff_t>(start);
    const auto last = clipped.begin() + static_cast<std::ptrdiff_t>(end);
    levels.Columns.push_back({*lowest, *highest, std::find(first, last, true) != last});
    levels.Peak = std::max(
        {levels.Peak, std::abs(*lowest - SoundChip::Silence), std::abs(*highest - SoundChip::Silence)});
  }
  return levels;
}

SoundLevels LevelsOf(const Files& disk, const std::string& path, std::size_t columns) {
  constexpr std::size_t most = std::size_t{8} << 20U;  // as many as one sound on the chip can have
  try {
    return MeasureLevels(ReadSamples(disk, path, most), columns);
  } catch (const RuntimeError&) {
    return {};
  }
}

std::string DecibelText(double share) {
  return share > 0 ? FormatFixed(20 * std::log10(share), 1) : std::string();
}
