#pragma once

#include <cstdint>
#include <vector>

#include "sim/game/GunScores.h"

namespace sim {

/// A game as played at a venue, with `players` guns (0 to 224) in the order in which they report: three teams
/// of nearly equal size, limited by the guns each has (96, 96 and 32), with hits on opponents, some friendly
/// fire and the odd hit on oneself. The same `seed` gives the same game on every machine. Throws
/// std::invalid_argument for any other number of players.
std::vector<GunScores> MakeGame(int players, std::uint32_t seed);

}  // namespace sim
