#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "core/game/Game.h"
#include "core/game/MemberLookup.h"

/// One line of the list of hits given or taken.
struct HitLine {
  std::string Text;
  int Index;            ///< record of the other player
  std::int32_t Amount;  ///< damage, above 0
};

/// The damage that the player at record `index` did to each player, by ascending record. If a member cannot
/// be found, a box says so and the line has no name.
std::vector<HitLine> HitsGivenBy(int index, const Game& game, MemberLookup& members);

/// The damage that each player did to the player at record `index`.
std::vector<HitLine> HitsTakenBy(int index, const Game& game, MemberLookup& members);

/// "Explosive: 5" and the like: damage taken that has no shooter.
std::vector<std::string> SpecialDamageOf(const Player& player);

/// Formats a running time given in minutes: " 2H  5M" for 125.
std::string RunTimeText(std::int32_t minutes);
