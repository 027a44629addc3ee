#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "sim/game/GunScores.h"

/// Numbers of the membership buttons of so many members, as the program writes them. The first members have
/// played `game` with theirs, those who dealt the most damage first; at least two have left theirs at home,
/// so that it is in no gun.
std::vector<std::string> MemberButtons(const std::vector<sim::GunScores>& game, std::size_t members);
