#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "sim/game/GunScores.h"

namespace sim {

/// Bytes that newer guns append to the two blocks of the player record; readers skip them by the stated
/// lengths.
struct FrameExtras {
  std::size_t StatisticsBytes = 0;  ///< behind the nine counters, 0 to 237
  std::size_t RecordBytes = 0;      ///< behind the power cheat flag
};

/// The frame that carries `scores` over the base unit's line, its CRC byte included.
/// Throws std::length_error when a length does not fit its place in the frame.
std::vector<std::uint8_t> EncodeScoreFrame(const GunScores& scores, const FrameExtras& extras = {});

}  // namespace sim
