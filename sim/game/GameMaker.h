#pragma once

#include <cstdint>
#include <vector>

#include "sim/game/GunScores.h"

namespace sim {

/// A game as a venue plays it, with `players` guns (0 to 224) in the order in which they report: three teams
/// of nearly equal size as far as their guns go (96, 96 and 32), hits of opponents, some friendly fire and a
/// rare self hit. The same `seed` gives the same game on every machine. Throws std::invalid_argument for any
/// other number of players.
std::vector<GunScores> MakeGame(int players, std::uint32_t seed);

}  // namespace sim
