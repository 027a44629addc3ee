#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "sim/game/GunScores.h"

namespace sim {

/// Bytes that newer guns append to the two blocks of the player record; readers use the stated lengths to
/// skip them.
struct FrameExtras {
  std::size_t StatisticsBytes = 0;  ///< after the nine counters, 0 to 237
  std::size_t RecordBytes = 0;      ///< after the power cheat flag
};

/// The frame that carries `scores` over the base unit's line, including its CRC byte.
/// Throws std::length_error if a length does not fit its field.
std::vector<std::uint8_t> EncodeScoreFrame(const GunScores& scores, const FrameExtras& extras = {});

}  // namespace sim
