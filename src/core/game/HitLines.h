#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "core/game/Game.h"
#include "core/game/MemberLookup.h"

/// Damage between one player and another.
struct Hit {
  int Index;            ///< record of the other player
  std::int32_t Amount;  ///< damage, above 0
};

/// What the player at record `index` did to each player, oneself included, by ascending record.
std::vector<Hit> HitsGivenBy(int index, const Game& game);

/// What each player did to the player at record `index`.
std::vector<Hit> HitsTakenBy(int index, const Game& game);

/// A line of "who hit whom": `playerName`, damage, and for a member the name, as "Red  4:  40  (Mole)". A
/// member who cannot be found is told in a box, and the line has no name.
std::string HitText(const std::string& playerName, const Hit& hit, const Game& game, MemberLookup& members,
                    bool useNickName);

/// What hit a player without a shooter.
struct SpecialHit {
  const char* Caption;  ///< "Explosive: " and the like
  std::int32_t Amount;  ///< above 0
};

std::vector<SpecialHit> SpecialHitsOf(const Player& player);

/// The same as lines with plain digits, "Explosive: 5".
std::vector<std::string> SpecialDamageOf(const Player& player);
