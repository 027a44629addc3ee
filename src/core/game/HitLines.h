#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "core/game/Game.h"
#include "core/game/MemberLookup.h"

/// One line of "who hit whom".
struct HitLine {
  std::string Text;
  int Index;            ///< record of the other player
  std::int32_t Amount;  ///< damage, above 0
};

/// What the player at record `index` did to each player, by ascending record. A member who cannot be found is
/// told in a box, and the line has no name.
std::vector<HitLine> HitsGivenBy(int index, const Game& game, MemberLookup& members);

/// What each player did to the player at record `index`.
std::vector<HitLine> HitsTakenBy(int index, const Game& game, MemberLookup& members);

/// "Explosive: 5" and the like, for what hit the player without a shooter.
std::vector<std::string> SpecialDamageOf(const Player& player);

/// A running time in minutes as hours and minutes: " 2H  5M" for 125.
std::string RunTimeText(std::int32_t minutes);
