#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "core/game/Game.h"
#include "core/game/MemberLookup.h"

/// Damage that a player dealt to, or took from, another one.
struct Hit {
  int Index;            ///< record of the other player
  std::int32_t Amount;  ///< damage, above 0
};

/// The damage that the player at record `index` did to each player, themselves included, in record order.
std::vector<Hit> HitsGivenBy(int index, const Game& game);

/// The damage that each player did to the player at record `index`.
std::vector<Hit> HitsTakenBy(int index, const Game& game);

/// One line of the hit list: `playerName`, damage, and the name if the player is a member: "Red  4:  40
/// (Mole)". If the member cannot be found, a box says so and the line has no name.
std::string HitText(const std::string& playerName, const Hit& hit, const Game& game, MemberLookup& members,
                    bool useNickName);

/// Damage taken that has no shooter.
struct SpecialHit {
  const char* Caption;  ///< "Explosive: " and the like
  std::int32_t Amount;  ///< above 0
};

std::vector<SpecialHit> SpecialHitsOf(const Player& player);

/// The same as lines with plain digits, "Explosive: 5".
std::vector<std::string> SpecialDamageOf(const Player& player);
